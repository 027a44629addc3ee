#include "archive/import/ImportGames.h"

#include <QHeaderView>
#include <QScopeGuard>
#include <QShortcut>
#include <algorithm>
#include <initializer_list>

#include "core/text/Filled.h"
#include "platform/RuntimeError.h"
#include "ui/Announce.h"
#include "ui/Captions.h"
#include "ui/RowsAsText.h"
#include "ui/RunProgress.h"
#include "ui/Text.h"
#include "ui/TimeLeft.h"
#include "ui_ImportGames.h"

ImportGames::ImportGames(const Parts& parts, QWidget* parent)
    : QDialog(parent),
      parts_(parts),
      ui_(std::make_unique<Ui::ImportGames>()),
      refused_(parts.Strings),
      commands_(*this, parts.Boxes) {
  ui_->setupUi(this);
  SetCaptions(parts_.Strings, {{this, static_cast<int>(OwnText::ImportGamesTitle)},
                               {ui_->FolderLabel, static_cast<int>(OwnText::ImportGamesFolder)},
                               {ui_->ChooseFolder, static_cast<int>(OwnText::ImportGamesChoose)},
                               {ui_->OwnTable, static_cast<int>(OwnText::ImportGamesOwnTable)},
                               {ui_->Note, static_cast<int>(OwnText::ImportGamesNote)},
                               {ui_->RefusedLabel, static_cast<int>(OwnText::ImportGamesRefused)},
                               {ui_->ListKnown, static_cast<int>(OwnText::ImportGamesListKnown)},
                               {ui_->Import, static_cast<int>(OwnText::ImportGamesStart)},
                               {ui_->Stop, static_cast<int>(OwnText::Stop)},
                               {ui_->CloseButton, 137}});
  ui_->Progress->hide();
  ui_->Stop->setEnabled(false);
  ui_->Import->setEnabled(false);
  SetUpTable();
  commands_.Connect(
      *ui_->ChooseFolder, [this] { ChooseFolder(); }, WhileBusy::Ignore);
  commands_.Connect(
      *ui_->Import, [this] { Import(); }, WhileBusy::Ignore);
  commands_.EndWaits = [this] { stopped_ = true; };
  connect(ui_->ListKnown, &QCheckBox::toggled, &refused_, &RefusedFilesModel::ListKnown);
  connect(ui_->Stop, &QPushButton::clicked, this, [this] { stopped_ = true; });
  connect(ui_->CloseButton, &QPushButton::clicked, this, &QDialog::reject);
}

ImportGames::~ImportGames() = default;

void ImportGames::SetUpTable() {
  ui_->Refused->setModel(&refused_);
  ui_->Refused->verticalHeader()->hide();
  ui_->Refused->verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
  QHeaderView& header = *ui_->Refused->horizontalHeader();
  header.setHighlightSections(false);
  header.setDefaultAlignment(Qt::AlignVCenter | Qt::AlignLeft);
  header.setStretchLastSection(true);
  constexpr int fileWidth = 300;
  constexpr int lineWidth = 80;
  header.resizeSection(RefusedFilesModel::FileColumn, fileWidth);
  header.resizeSection(RefusedFilesModel::LineColumn, lineWidth);
  auto* copy = new QShortcut(QKeySequence::Copy, ui_->Refused, nullptr, nullptr, Qt::WidgetShortcut);
  connect(copy, &QShortcut::activated, this, [this] { CopyRows(*ui_->Refused); });
}

void ImportGames::reject() {
  if (commands_.MayClose()) {
    QDialog::reject();
  }
}

void ImportGames::ChooseFolder() {
  const auto folder = parts_.CommonDialog1.ShowFolder(
      {.Filter = {}, .Title = parts_.Strings.Text(OwnText::ImportGamesTitle)});
  if (folder) {
    ui_->Folder->setText(QString::fromStdString(*folder));
    ui_->Import->setEnabled(true);
    ui_->Import->setFocus();
  }
}

void ImportGames::Import() {
  refused_.Show({}, {}, {});
  EnableEntries(false);
  ui_->Stop->setFocus();
  const auto ended = qScopeGuard([this] {
    EnableEntries(true);
    ui_->TimeLeft->clear();
    (refused_.rowCount() > 0 ? static_cast<QWidget*>(ui_->Refused) : ui_->CloseButton)->setFocus();
  });
  ImportFrom(ui_->Folder->text().toStdString());
}

void ImportGames::ImportFrom(const std::string& folder) {
  RunProgress progress(*ui_->Progress, *ui_->Stop, parts_.Events, stopped_);
  const auto step = [&](const GameImport::State& state) {
    ShowStep(state);
    return progress.GoOn(
        state.Files == 0 ? 0 : static_cast<double>(state.Done) / static_cast<double>(state.Files));
  };
  std::optional<GameImport> import;
  bool complete = false;
  std::string failure;
  try {
    CheckSpaceForGames(parts_.Disk, parts_.UserDataFolder, parts_.Strings);
    import.emplace(GameImport::Parts{.Archive = parts_.Archives.File(),
                                     .Members = parts_.Members,
                                     .Disk = parts_.Disk,
                                     .Time = parts_.Time,
                                     .Strings = parts_.Strings,
                                     .Factors = parts_.Factors,
                                     .UserDataFolder = parts_.UserDataFolder},
                   ui_->OwnTable->isChecked() ? FilesOf::ThisTable : FilesOf::OtherTable);
    complete = import->Run(folder, step);
  } catch (const RuntimeError& error) {
    failure = error.what();
  }
  ShowEnd(import, complete, failure);
  if (import) {
    refused_.Show(import->Refused(), import->KnownFiles(), folder);
  }
}

void ImportGames::EnableEntries(bool enabled) {
  for (QWidget* entry : std::initializer_list<QWidget*>{ui_->ChooseFolder, ui_->OwnTable, ui_->Import,
                                                        ui_->ListKnown, ui_->Refused}) {
    entry->setEnabled(enabled);
  }
}

void ImportGames::ShowStep(const GameImport::State& state) {
  const std::string done = std::to_string(state.Done);
  if (state.Files == 0) {
    ui_->Status->setText(
        QString::fromStdString(Filled(parts_.Strings.Text(OwnText::ImportGamesSearching), {done})));
    begun_ = parts_.Elapsed.Elapsed();
    return;
  }
  const std::string current = std::to_string(std::min(state.Done + 1, state.Files));
  ui_->Status->setText(QString::fromStdString(
      Filled(parts_.Strings.Text(OwnText::ImportGamesWorking), {current, std::to_string(state.Files)})));
  ShowTimeLeft(state);
}

void ImportGames::ShowTimeLeft(const GameImport::State& state) {
  const auto spent = std::chrono::duration_cast<std::chrono::milliseconds>(parts_.Elapsed.Elapsed() - begun_);
  const auto left = TimeLeft(spent, static_cast<double>(state.Done), static_cast<double>(state.Files));
  if (!left) {
    ui_->TimeLeft->clear();
    return;
  }
  const auto minutes = std::chrono::round<std::chrono::minutes>(*left).count();
  ui_->TimeLeft->setText(QString::fromStdString(
      minutes == 0 ? parts_.Strings.Text(OwnText::LessThanMinuteLeft)
                   : Filled(parts_.Strings.Text(OwnText::MinutesLeft), {std::to_string(minutes)})));
}

void ImportGames::ShowEnd(const std::optional<GameImport>& import, bool complete,
                          const std::string& failure) {
  const std::string imported = std::to_string(import ? import->Imported() : 0);
  const std::string known = std::to_string(import ? import->Known() : 0);
  const std::string refused = std::to_string(import ? import->Refused().size() : 0);
  const std::size_t broughtBack = import ? import->BroughtBack() : 0;
  hasImported_ = hasImported_ || imported != "0" || broughtBack > 0;
  std::string text;
  if (!failure.empty()) {
    text = Filled(parts_.Strings.Text(OwnText::ImportGamesFailed), {failure, imported, known, refused});
  } else if (complete && import->Imported() + import->Known() + broughtBack + import->Refused().size() == 0) {
    text = parts_.Strings.Text(OwnText::ImportGamesNothing);
  } else {
    text = Filled(parts_.Strings.Text(complete ? OwnText::ImportGamesDone : OwnText::ImportGamesStopped),
                  {imported, known, refused});
  }
  if (broughtBack > 0) {
    text.append("\n").append(
        Filled(parts_.Strings.Text(OwnText::ImportGamesBroughtBack), {std::to_string(broughtBack)}));
  }
  ShowStatus(text);
}

void ImportGames::ShowStatus(const std::string& text) {
  ui_->Status->setText(QString::fromStdString(text));
  Announce(*ui_->Status);
}
