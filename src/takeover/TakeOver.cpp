#include "takeover/TakeOver.h"

#include <QFileInfo>
#include <QHeaderView>
#include <QScopeGuard>
#include <utility>

#include "core/text/Filled.h"
#include "platform/RuntimeError.h"
#include "ui/Announce.h"
#include "ui/Captions.h"
#include "ui/RunProgress.h"
#include "ui/Text.h"
#include "ui_TakeOver.h"

namespace {

bool IsSameFolder(const std::string& one, const std::string& other) {
  return QFileInfo(QString::fromStdString(one)) == QFileInfo(QString::fromStdString(other));
}

TakeOverWork::Parts WithQuestion(TakeOverWork::Parts parts, MessageBoxes& boxes) {
  const std::string title = parts.Strings.Text(OwnText::TakeOverTitle);
  parts.Ask = [&boxes, title](const std::string& question) {
    return boxes.Show(question, title, BoxIcon::Question, BoxButtons::YesNo) == BoxAnswer::Yes;
  };
  return parts;
}

}  // namespace

TakeOver::TakeOver(Parts parts, QWidget* parent)
    : QDialog(parent),
      ui_(std::make_unique<Ui::TakeOver>()),
      parts_(std::move(parts)),
      work_(WithQuestion(parts_.Work, parts_.Boxes)),
      found_(parts_.Work.Strings),
      commands_(*this, parts_.Boxes) {
  ui_->setupUi(this);
  SetCaptions(parts_.Work.Strings, {{this, static_cast<int>(OwnText::TakeOverTitle)},
                                    {ui_->FolderLabel, static_cast<int>(OwnText::TakeOverFolder)},
                                    {ui_->ChooseFolder, static_cast<int>(OwnText::TakeOverChoose)},
                                    {ui_->FoundLabel, static_cast<int>(OwnText::TakeOverList)},
                                    {ui_->TakeOverButton, static_cast<int>(OwnText::TakeOverButton)},
                                    {ui_->RefusedLabel, static_cast<int>(OwnText::ImportGamesRefused)},
                                    {ui_->Stop, static_cast<int>(OwnText::Stop)},
                                    {ui_->CloseButton, 137}});
  ui_->Progress->hide();
  ListRefused({});
  SetUpTable();
  ConnectCommands();
  EnableEntries(true);
}

TakeOver::~TakeOver() = default;

void TakeOver::SetUpTable() {
  ui_->FoundTable->setModel(&found_);
  ui_->FoundTable->verticalHeader()->hide();
  QHeaderView& header = *ui_->FoundTable->horizontalHeader();
  header.setHighlightSections(false);
  header.setDefaultAlignment(Qt::AlignVCenter | Qt::AlignLeft);
  header.setSectionResizeMode(QHeaderView::ResizeToContents);
  header.setSectionResizeMode(FoundModel::Remarks, QHeaderView::Stretch);
  connect(&found_, &QAbstractItemModel::dataChanged, this,
          [this] { ui_->TakeOverButton->setEnabled(!found_.Ticked().empty()); });
}

void TakeOver::ConnectCommands() {
  commands_.Connect(
      *ui_->ChooseFolder, [this] { ChooseFolder(); }, WhileBusy::Ignore);
  commands_.Connect(
      *ui_->TakeOverButton, [this] { Take(); }, WhileBusy::Ignore);
  connect(ui_->Stop, &QPushButton::clicked, this, [this] { stopped_ = true; });
  connect(ui_->CloseButton, &QPushButton::clicked, this, &QDialog::reject);
  commands_.EscapePresses(*ui_->CloseButton);
  commands_.EndWaits = [this] { stopped_ = true; };
}

void TakeOver::ChooseFolder() {
  const std::optional<std::string> folder =
      parts_.FileDialog.ShowFolder({.Filter = {}, .Title = Words(OwnText::TakeOverTitle)});
  if (!folder) {
    return;
  }
  old_.reset();
  found_.Show({});
  ListRefused({});
  ui_->Folder->setText(QString::fromStdString(*folder));
  EnableEntries(false);
  const auto ended = qScopeGuard([this] { EnableEntries(true); });
  LookInto(*folder);
}

void TakeOver::LookInto(const std::string& folder) {
  std::optional<OldInstallation> old = FindOldInstallation(parts_.Work.Disk, folder);
  if (!old) {
    ShowStatus(Filled(Words(OwnText::TakeOverNotOne), {folder}));
    return;
  }
  ui_->Folder->setText(QString::fromStdString(old->Folder));
  if (IsSameFolder(old->Folder, parts_.Work.DataFolder)) {
    ShowStatus(Filled(Words(OwnText::TakeOverOwnFolder), {old->Folder}));
    return;
  }
  constexpr double kinds = 5;
  RunProgress progress(*ui_->Progress, *ui_->Stop, parts_.Events, stopped_);
  std::optional<OldItem> shown;
  std::vector<FoundItem> found = work_.Look(*old, [&](OldItem item) {
    if (shown != item) {
      shown = item;
      ui_->Status->setText(QString::fromStdString(
          Filled(Words(OwnText::TakeOverReading), {TitleOf(item, parts_.Work.Strings)})));
    }
    return progress.GoOn(static_cast<double>(item) / kinds);
  });
  if (found.empty()) {
    ShowStatus(Words(OwnText::CopyStopped));
    return;
  }
  LeaveOutGames(found);
  found_.Show(std::move(found));
  old_ = std::move(old);
  ShowStatus({});
}

void TakeOver::LeaveOutGames(std::vector<FoundItem>& found) const {
  for (FoundItem& item : found) {
    if (item.What == OldItem::Games && item.State == FoundItem::Usable && !parts_.ImportGames) {
      item.State = FoundItem::Unusable;
      item.Remark = Words(OwnText::TakeOverNoArchive);
    }
  }
}

void TakeOver::Take() {
  if (!MayTake()) {
    return;
  }
  EnableEntries(false);
  const auto ended = qScopeGuard([this] { EnableEntries(true); });
  TakeTicked();
}

bool TakeOver::MayTake() {
  if (const std::optional<OwnText> reason = parts_.Busy()) {
    ShowStatus(Filled(Words(OwnText::TakeOverWaits), {Words(*reason)}));
    return false;
  }
  return parts_.Boxes.Show(Words(OwnText::TakeOverQuestion), Words(OwnText::TakeOverTitle), BoxIcon::Question,
                           BoxButtons::OkCancel) == BoxAnswer::Ok;
}

void TakeOver::TakeTicked() {
  const std::set<OldItem> items = found_.Ticked();
  TakenOver taken;
  {
    RunProgress progress(*ui_->Progress, *ui_->Stop, parts_.Events, stopped_);
    taken = work_.Take(items, [&](TakeStep step) {
      const OwnText text = step == TakeStep::Keeping ? OwnText::CopyKeepsPresent : OwnText::TakeOverPreparing;
      ui_->Status->setText(Text(parts_.Work.Strings, text));
      return progress.GoOn(step == TakeStep::Keeping ? 0 : 1);
    });
  }
  Tell(taken, items);
}

void TakeOver::Tell(const TakenOver& taken, const std::set<OldItem>& items) {
  switch (taken.What) {
    case TakenOver::Stopped:
      ShowStatus(Words(OwnText::CopyStopped));
      return;
    case TakenOver::Refused:
    case TakenOver::Pending:
      ShowStatus({});
      parts_.Boxes.Show(Filled(Words(taken.What == TakenOver::Refused ? OwnText::TakeOverRefused
                                                                      : OwnText::TakeOverPending),
                               {taken.Reason}),
                        Words(OwnText::TakeOverTitle), BoxIcon::Exclamation);
      break;
    case TakenOver::Done:
      break;
  }
  if (taken.What == TakenOver::Pending) {
    found_.Show({});
    parts_.EndProgram();
    reject();
  } else if (taken.What == TakenOver::Done) {
    TellDone(taken, items);
  }
}

void TakeOver::TellDone(const TakenOver& taken, const std::set<OldItem>& items) {
  std::string names;
  for (const std::string& name : taken.KeptAs) {
    names.append(names.empty() ? "" : ", ").append(name);
  }
  const std::string done = Filled(Words(OwnText::TakeOverDone), {TitlesOf(items), names});
  found_.Show({});
  try {
    parts_.Reopen(items);
  } catch (const RuntimeError& error) {
    // What is open may still belong to the files that were replaced: nothing may be written into those.
    parts_.Boxes.Show(done + "\n" + Filled(Words(OwnText::TakeOverUnopened), {error.what()}),
                      Words(OwnText::TakeOverTitle), BoxIcon::Exclamation);
    parts_.EndProgram();
    reject();
    return;
  }
  const std::string games =
      items.contains(OldItem::Games)
          ? "\n" +
                ImportGames(items.contains(OldItem::Members) ? FilesOfMembers::Taken : FilesOfMembers::Others)
          : std::string();
  ShowStatus(done + games);
}

std::string TakeOver::ImportGames(FilesOfMembers members) {
  RunProgress progress(*ui_->Progress, *ui_->Stop, parts_.Events, stopped_);
  ui_->Status->setText(Text(parts_.Work.Strings, OwnText::TakeOverImporting));
  try {
    const ImportedGames games = parts_.ImportGames(old_->GamesFolder, members,
                                                   [&progress](double done) { return progress.GoOn(done); });
    const std::string result =
        Filled(Words(OwnText::TakeOverGamesDone),
               {std::to_string(games.Imported), std::to_string(games.Known), std::to_string(games.Refused)});
    ListRefused(games.RefusedFiles);
    return games.Whole ? result : result + "\n" + Words(OwnText::TakeOverGamesStopped);
  } catch (const RuntimeError& error) {  // the rest has been taken over all the same
    return TitleOf(OldItem::Games, parts_.Work.Strings) + ": " + error.what();
  }
}

void TakeOver::ListRefused(const std::vector<std::string>& files) {
  std::string lines;
  for (const std::string& file : files) {
    lines.append(lines.empty() ? "" : "\n").append(file);
  }
  ui_->RefusedFiles->setPlainText(QString::fromStdString(lines));
  const bool any = !files.empty();
  ui_->RefusedLabel->setVisible(any);
  ui_->RefusedFiles->setVisible(any);
  ui_->FoundLabel->setVisible(!any);
  ui_->FoundTable->setVisible(!any);
}

std::string TakeOver::TitlesOf(const std::set<OldItem>& items) const {
  std::string titles;
  for (const OldItem item : items) {
    titles.append(titles.empty() ? "" : ", ").append(TitleOf(item, parts_.Work.Strings));
  }
  return titles;
}

void TakeOver::EnableEntries(bool enabled) {
  ui_->ChooseFolder->setEnabled(enabled);
  ui_->FoundTable->setEnabled(enabled);
  ui_->TakeOverButton->setEnabled(enabled && !found_.Ticked().empty());
  ui_->Stop->setVisible(!enabled);
  if (!enabled) {
    ui_->Stop->setFocus();
  } else if (ui_->TakeOverButton->isEnabled()) {
    ui_->FoundTable->setFocus();
  } else {
    ui_->ChooseFolder->setFocus();
  }
}

void TakeOver::ShowStatus(const std::string& text) {
  ui_->Status->setText(QString::fromStdString(text));
  if (!text.empty()) {
    Announce(*ui_->Status);
  }
}

void TakeOver::reject() {
  if (commands_.MayClose()) {
    QDialog::reject();
  }
}
