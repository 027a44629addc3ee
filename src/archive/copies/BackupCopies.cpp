#include "archive/copies/BackupCopies.h"

#include <QHeaderView>
#include <algorithm>
#include <utility>

#include "archive/copies/CopyTexts.h"
#include "core/text/Filled.h"
#include "platform/RuntimeError.h"
#include "ui/Announce.h"
#include "ui/Captions.h"
#include "ui/Text.h"
#include "ui_BackupCopies.h"

/// A long operation, as long as it exists: the buttons make room for its progress.
class BackupCopies::Job {
 public:
  explicit Job(BackupCopies& window) : window_(window) {
    window_.stop_ = false;
    window_.sinceEvents_.start();
    Show(true);
  }
  ~Job() { Show(false); }
  Job(const Job&) = delete;
  Job& operator=(const Job&) = delete;

 private:
  void Show(bool running) {
    window_.ui_->Progress->setVisible(running);
    window_.ui_->Stop->setVisible(running);
    window_.ui_->CopyTable->setEnabled(!running);
    if (running) {
      for (QPushButton* button : {window_.ui_->Restore, window_.ui_->CopyNow, window_.ui_->CopyToFolder}) {
        button->setEnabled(false);
      }
      window_.ui_->Stop->setFocus();
    } else {
      window_.ui_->CopyNow->setEnabled(true);
      window_.EnableButtons();
      window_.ui_->CopyTable->setFocus();
    }
  }

  BackupCopies& window_;
};

BackupCopies::BackupCopies(Parts parts, QWidget* parent)
    : QDialog(parent),
      ui_(std::make_unique<Ui::BackupCopies>()),
      parts_(std::move(parts)),
      work_(parts_.Work),
      list_(parts_.Databases, work_, parts_.Work.Disk, parts_.Work.Strings),
      commands_(*this, parts_.Boxes) {
  ui_->setupUi(this);
  SetCaptions(parts_.Work.Strings, {{this, static_cast<int>(OwnText::BackupCopiesTitle)},
                                    {ui_->CopyLabel, static_cast<int>(OwnText::CopyList)},
                                    {ui_->Restore, static_cast<int>(OwnText::RestoreCopy)},
                                    {ui_->CopyNow, static_cast<int>(OwnText::CopyNow)},
                                    {ui_->CopyToFolder, static_cast<int>(OwnText::CopyToFolder)},
                                    {ui_->Stop, static_cast<int>(OwnText::Stop)},
                                    {ui_->Close, 137}});
  ui_->Progress->hide();
  ui_->Stop->hide();
  SetUpTable();
  ConnectCommands();
  Refresh();
}

BackupCopies::~BackupCopies() = default;

void BackupCopies::SetUpTable() {
  ui_->CopyTable->setModel(&list_);
  ui_->CopyTable->verticalHeader()->hide();
  QHeaderView& header = *ui_->CopyTable->horizontalHeader();
  header.setHighlightSections(false);
  header.setDefaultAlignment(Qt::AlignVCenter | Qt::AlignLeft);
  header.setSectionResizeMode(QHeaderView::ResizeToContents);
  header.setStretchLastSection(true);
  connect(ui_->CopyTable->selectionModel(), &QItemSelectionModel::selectionChanged, this,
          &BackupCopies::EnableButtons);
}

void BackupCopies::ConnectCommands() {
  commands_.Connect(
      *ui_->Restore, [this] { Restore(); }, WhileBusy::Ignore);
  commands_.Connect(
      *ui_->CopyNow, [this] { CopyAll(); }, WhileBusy::Ignore);
  commands_.Connect(
      *ui_->CopyToFolder, [this] { CopySelected(); }, WhileBusy::Ignore);
  connect(ui_->Stop, &QPushButton::clicked, this, [this] { stop_ = true; });
  connect(ui_->Close, &QPushButton::clicked, this, &QDialog::reject);
  commands_.EscapePresses(*ui_->Close);
  commands_.EndWaits = [this] { stop_ = true; };
  commands_.AllUnwound = [this] { countTimer_.start(); };
  // One at a time, between the window's other events. The start counts anew what commands interrupted.
  connect(&countTimer_, &QTimer::timeout, this, [this] {
    if (commands_.Running() || !list_.CountNext()) {
      countTimer_.stop();
    }
  });
}

void BackupCopies::Refresh() {
  const std::string failure = list_.Refresh(parts_.Work.Folder);
  if (!failure.empty()) {
    ShowStatus(Filled(parts_.Work.Strings.Text(OwnText::CopyListFailed), {failure}));
  }
  const int firstCopy = static_cast<int>(parts_.Databases.size());
  ui_->CopyTable->selectRow(std::min(firstCopy, list_.rowCount() - 1));
  EnableButtons();
  countTimer_.start();
}

void BackupCopies::EnableButtons() {
  const CopyListModel::Entry* entry = Selected();
  ui_->Restore->setEnabled(entry != nullptr && entry->Copy);
  ui_->CopyToFolder->setEnabled(entry != nullptr);
}

const CopyListModel::Entry* BackupCopies::Selected() const {
  const QModelIndexList rows = ui_->CopyTable->selectionModel()->selectedRows();
  return rows.isEmpty() ? nullptr : &list_.At(rows.first().row());
}

void BackupCopies::Restore() {
  const CopyListModel::Entry entry = *Selected();
  if (!MayRestore(entry)) {
    return;
  }
  Restored restored;
  {
    const Job job(*this);
    restored = work_.Restore(*entry.Copy, parts_.Databases[entry.Database], Steps());
  }
  // First of all: what is open belongs to the file that was replaced.
  if (restored.What == Restored::Done || restored.What == Restored::Uncertain) {
    parts_.Reopen();
  }
  Refresh();
  Tell(restored);
}

bool BackupCopies::MayRestore(const CopyListModel::Entry& entry) {
  const StringTable& strings = parts_.Work.Strings;
  if (const std::optional<OwnText> reason = parts_.Busy()) {
    ShowStatus(Filled(strings.Text(OwnText::RestoreWaits), {strings.Text(*reason)}));
    return false;
  }
  const int row = ui_->CopyTable->selectionModel()->selectedRows().first().row();
  const std::string time = list_.index(row, CopyListModel::Time).data().toString().toStdString();
  const std::string title = strings.Text(parts_.Databases[entry.Database].Title);
  return parts_.Boxes.Show(Filled(strings.Text(OwnText::RestoreQuestion), {title, time}),
                           strings.Text(OwnText::RestoreTitle), BoxIcon::Question,
                           BoxButtons::OkCancel) == BoxAnswer::Ok;
}

void BackupCopies::Tell(const Restored& restored) {
  const StringTable& strings = parts_.Work.Strings;
  switch (restored.What) {
    case Restored::Done:
      ShowStatus(Filled(strings.Text(OwnText::RestoreDone), {restored.KeptAs}));
      return;
    case Restored::Stopped:
      ShowStatus(strings.Text(OwnText::CopyStopped));
      return;
    case Restored::Refused:
    case Restored::Uncertain:
      break;
  }
  const OwnText text =
      restored.What == Restored::Refused ? OwnText::RestoreRefused : OwnText::RestoreUncertain;
  ShowStatus({});
  parts_.Boxes.Show(Filled(strings.Text(text), {restored.Reason}), strings.Text(OwnText::RestoreTitle),
                    BoxIcon::Exclamation);
}

void BackupCopies::CopyAll() {
  std::string made;
  std::optional<RuntimeError> failure;
  {
    const Job job(*this);
    bool keepsOn = true;
    for (auto database = parts_.Databases.begin(); keepsOn && database != parts_.Databases.end();
         ++database) {
      try {
        const std::optional<std::string> name = work_.CopyNow(*database, Steps());
        keepsOn = name.has_value();
        made.append(made.empty() || !name ? "" : ", ").append(name.value_or(""));
      } catch (const RuntimeError& error) {  // the others can be copied all the same
        failure = failure.value_or(error);
      }
    }
  }
  Refresh();
  const StringTable& strings = parts_.Work.Strings;
  const std::string nothing = failure ? std::string() : strings.Text(OwnText::CopyStopped);
  ShowStatus(made.empty() ? nothing : Filled(strings.Text(OwnText::CopiesMade), {made}));
  if (failure) {
    throw RuntimeError(*failure);
  }
}

void BackupCopies::CopySelected() {
  const CopyListModel::Entry entry = *Selected();
  const CopiedDatabase& database = parts_.Databases[entry.Database];
  const std::string path = entry.Copy ? work_.PathOf(*entry.Copy) : database.InUse().Path();
  const std::optional<std::string> target =
      AskTarget(entry.Copy ? entry.Copy->File : work_.NameOfNow(database));
  if (!target) {
    return;
  }
  bool done = false;
  {
    const Job job(*this);
    ShowStatus({});
    done = work_.CopyToFile(path, *target, Steps());
  }
  const StringTable& strings = parts_.Work.Strings;
  ShowStatus(done ? Filled(strings.Text(OwnText::CopiesMade), {*target})
                  : strings.Text(OwnText::CopyStopped));
  Refresh();
}

std::optional<std::string> BackupCopies::AskTarget(const std::string& name) {
  const StringTable& strings = parts_.Work.Strings;
  const std::string title = strings.Text(OwnText::BackupCopiesTitle);
  std::optional<std::string> target = parts_.FileDialog.ShowSave({.Filter = title + "|*.mdb", .Name = name});
  if (target && work_.IsDataInUse(*target, parts_.Databases)) {
    parts_.Boxes.Show(Filled(strings.Text(OwnText::CopyIntoData), {*target}), title, BoxIcon::Exclamation);
    return std::nullopt;
  }
  if (!target || !parts_.Work.Disk.FileExists(*target)) {
    return target;
  }
  const BoxAnswer answer = parts_.Boxes.Show(Filled(strings.Text(OwnText::CopyExists), {*target}), title,
                                             BoxIcon::Question, BoxButtons::YesNo);
  return answer == BoxAnswer::Yes ? target : std::nullopt;
}

bool BackupCopies::KeepOn(CopyStep step) {
  constexpr qint64 eventMilliseconds = 40;
  const std::string text = TextOf(step, parts_.Work.Strings);
  if (ui_->Status->text().toStdString() != text) {
    ShowStatus(text);
    parts_.Events.DoEvents();
  } else if (sinceEvents_.elapsed() >= eventMilliseconds) {
    parts_.Events.DoEvents();
    sinceEvents_.restart();
  }
  return !stop_;
}

void BackupCopies::ShowStatus(const std::string& text) {
  ui_->Status->setText(QString::fromStdString(text));
  if (!text.empty()) {
    Announce(*ui_->Status);
  }
}

void BackupCopies::reject() {
  if (commands_.MayClose()) {
    QDialog::reject();
  }
}
