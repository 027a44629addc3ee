#include "app/Desk.h"

#include <QAction>
#include <QApplication>
#include <QEvent>
#include <QItemSelection>
#include <QTimer>
#include <algorithm>
#include <filesystem>

#include "core/text/Filled.h"
#include "ui/Text.h"

namespace {

QString NameOf(DeskTopic topic) {
  switch (topic) {
    case DeskTopic::Game:
      return QStringLiteral("DeskGame");
    case DeskTopic::CountedTwice:
      return QStringLiteral("DeskCountedTwice");
    case DeskTopic::Unsaved:
      return QStringLiteral("DeskUnsaved");
    case DeskTopic::Committed:
      return QStringLiteral("DeskCommitted");
    case DeskTopic::LowestFirst:
      return QStringLiteral("DeskLowestFirst");
    case DeskTopic::MissionChanged:
      return QStringLiteral("DeskMissionChanged");
    case DeskTopic::SharedMembers:
      return QStringLiteral("DeskSharedMembers");
    case DeskTopic::FileOfCancel:
      return QStringLiteral("DeskFileOfCancel");
    case DeskTopic::Settings:
      return QStringLiteral("DeskSettings");
    case DeskTopic::Kept:
      return QStringLiteral("DeskKept");
    case DeskTopic::NotKept:
      return QStringLiteral("DeskNotKept");
    case DeskTopic::ArchiveUnusable:
      return QStringLiteral("DeskArchiveUnusable");
    case DeskTopic::CutGames:
      return QStringLiteral("DeskCutGames");
    case DeskTopic::WeeklyCopyFailed:
      return QStringLiteral("DeskWeeklyCopyFailed");
    case DeskTopic::BackupLacksRoom:
      return QStringLiteral("DeskBackupLacksRoom");
  }
  return {};
}

std::string FolderOf(const std::string& file) {
  return std::filesystem::path(file).parent_path().string();
}

OwnText TextOf(const DownloadResult& result) {
  const bool stopped = result.End == DownloadEnd::Stopped;
  if (result.Received > 0) {
    return stopped ? OwnText::DownloadStopped : OwnText::DownloadIncomplete;
  }
  return stopped ? OwnText::DownloadStoppedEmpty : OwnText::DownloadFailed;
}

}  // namespace

Desk::Desk(const Parts& parts)
    : parts_(parts),
      progress_(parts.Session, parts.Time),
      subscription_(parts.Session.Listen([this](SessionChange change) {
        if (change == SessionChange::Cleared) {
          ForgetGame();
        } else if (change == SessionChange::Scores || change == SessionChange::Saved ||
                   change == SessionChange::Committed) {
          Show();
        }
      })) {}

void Desk::ForgetGame() {
  download_.clear();
  sheets_ = {};
  unopened_.clear();
  fileOfCancel_.clear();
  Show();
}

void Desk::End() {
  ended_ = true;
  subscription_.End();
}

void Desk::Show() {
  if (ended_) {
    return;
  }
  std::vector<StatusLine::Entry> entries;
  entries.push_back({QStringLiteral("Status"), download_});
  entries.push_back(
      {QStringLiteral("PullAgain"),
       download_.isEmpty() ? QString() : Text(parts_.Strings, OwnText::DeskPullAgain),
       [this] {
         FocusBoard();  // the link goes while the pull runs, and would leave the keyboard anywhere
         parts_.Pull.trigger();
       },
       parts_.Pull.text(), true});
  for (const DeskEntry& entry : DeskEntries(Facts(), parts_.Strings)) {
    entries.push_back(EntryOf(entry));
    if (entry.Topic == DeskTopic::FileOfCancel) {
      entries.push_back(LinkTo(FolderOf(fileOfCancel_), "FolderOfCancel", OwnText::OpenFolder));
    } else if (entry.Topic == DeskTopic::Settings) {
      entries.push_back(LinkTo(FolderOf(unsavedSettings_), "FolderOfSettings", OwnText::OpenFolder));
    }
  }
  for (StatusLine::Entry& entry : SheetEntries()) {
    entries.push_back(std::move(entry));
  }
  entries.insert(entries.end(), others_.begin(), others_.end());
  parts_.Line.Show(entries);
  for (int step = 0; step < GameStepCount; ++step) {
    parts_.Bar.SetDone(static_cast<GameStep>(step), progress_.IsDone(static_cast<GameStep>(step)));
  }
}

DeskFacts Desk::Facts() const {
  const Game& game = parts_.Session.Game();
  DeskFacts facts;
  facts.Present = game.DataPresent;
  facts.Players = static_cast<int>(std::count_if(game.Players.begin(), game.Players.end(),
                                                 [](const Player& player) { return player.Active; }));
  facts.Time = game.GameDate;
  facts.Mission = parts_.Session.Missions().Text();
  facts.CountedTwice = static_cast<int>(parts_.Guns.CountedTwice().size());
  facts.Unsaved = progress_.Unsaved();
  facts.Commits = CountCommits(game);
  facts.LowestFirst = progress_.LowestFirst();
  facts.Change = progress_.Mission();
  const Board& board = parts_.Session.List(BoardList::Players);
  const std::vector<std::vector<int>> shared = SharedMembers(game);
  for (int place = 0; place < board.RowCount(); ++place) {
    const BoardRow& row = board.RowAt(place);
    if (std::any_of(shared.begin(), shared.end(),
                    [&row](const std::vector<int>& guns) { return guns.front() == row.Index; })) {
      facts.SharedMembers.push_back(row.MemberName);
    }
  }
  facts.FileOfCancel = fileOfCancel_;
  facts.UnsavedSettings = unsavedSettings_;
  facts.KeptAt = keeping_.KeptAt;
  facts.NotKept = keeping_.Failure;
  facts.UnusableArchive = keeping_.Unusable;
  facts.CutGames = keeping_.CutGames;
  facts.WeeklyCopyFailure = keeping_.CopyFailure;
  facts.BackupLacksRoom = parts_.Session.BackupLacksRoom();
  return facts;
}

StatusLine::Entry Desk::EntryOf(const DeskEntry& entry) {
  return {NameOf(entry.Topic), QString::fromStdString(entry.Text),
          entry.IsLink ? ActOf(entry.Topic) : std::function<void()>(), QString::fromStdString(entry.Tip)};
}

std::function<void()> Desk::ActOf(DeskTopic topic) {
  switch (topic) {
    case DeskTopic::CountedTwice:
      return [this] { ShowPlayers(parts_.Guns.CountedTwice()); };
    case DeskTopic::Unsaved:
      return [this] { parts_.Save.trigger(); };
    case DeskTopic::Committed:
      return [this] { parts_.Commit.trigger(); };
    case DeskTopic::LowestFirst:
      return [this] { RankHighestFirst(); };
    case DeskTopic::MissionChanged:
      return [this] { GoBackToMission(); };
    case DeskTopic::SharedMembers:
      return [this] { ShowPlayers(RecordsOfSharedMembers()); };
    default:
      return {};
  }
}

void Desk::RankHighestFirst() {
  parts_.Run.Run([this] {
    parts_.Session.SortByHeader(static_cast<int>(BoardColumn::Soldiering) + 1);
    parts_.Session.CalculateScoresWhenPresent();
  });
  FocusBoard();
}

void Desk::GoBackToMission() {
  if (!progress_.Mission()) {
    return;
  }
  const std::vector<MissionList::Item>& items = parts_.Session.Missions().Items();
  const auto found = std::find_if(items.begin(), items.end(), [&](const MissionList::Item& item) {
    return item.Text == progress_.Mission()->From;
  });
  if (found != items.end()) {
    parts_.Run.Run(
        [this, index = static_cast<int>(found - items.begin())] { parts_.Session.SelectMission(index); });
  }
  FocusBoard();
}

void Desk::ShowPlayers(const std::set<int>& records) {
  const Board& board = parts_.Session.List(BoardList::Players);
  const QAbstractItemModel& rows = *parts_.Board.model();
  QItemSelection selection;
  for (int place = 0; place < board.RowCount(); ++place) {
    if (records.contains(board.RowAt(place).Index)) {
      selection.select(rows.index(place, 0), rows.index(place, rows.columnCount() - 1));
    }
  }
  parts_.Board.selectionModel()->select(selection, QItemSelectionModel::ClearAndSelect);
  if (!selection.isEmpty()) {
    parts_.Board.scrollTo(selection.front().topLeft());
  }
  FocusBoard();
}

std::set<int> Desk::RecordsOfSharedMembers() const {
  std::set<int> records;
  for (const std::vector<int>& guns : SharedMembers(parts_.Session.Game())) {
    records.insert(guns.begin(), guns.end());
  }
  return records;
}

void Desk::TellDownload(const DownloadResult& result) {
  download_ = result.End == DownloadEnd::Complete
                  ? QString()
                  : QString::fromStdString(
                        Filled(parts_.Strings.Text(TextOf(result)),
                               {std::to_string(result.Received), std::to_string(result.Expected)}));
  Show();
}

void Desk::ForgetDownload() {
  download_.clear();
  Show();
}

void Desk::TellSheets(const SheetFiles& files) {
  sheets_ = files;
  unopened_.clear();
  Show();
}

std::vector<StatusLine::Entry> Desk::SheetEntries() {
  const auto plain = [this](const char* name, OwnText text, const std::string& path) {
    return StatusLine::Entry{
        QString::fromLatin1(name),
        path.empty() ? QString() : QString::fromStdString(Filled(parts_.Strings.Text(text), {path}))};
  };
  return {plain("Sheets", OwnText::SheetsAreReady, sheets_.Folder),
          LinkTo(sheets_.Folder, "SheetFolder", OwnText::OpenFolder),
          LinkTo(sheets_.Pdf, "SheetPdf", OwnText::OpenPdf),
          plain("Unopened", OwnText::CannotBeOpened, unopened_)};
}

StatusLine::Entry Desk::LinkTo(const std::string& path, const char* name, OwnText text) {
  return {QString::fromLatin1(name), path.empty() ? QString() : Text(parts_.Strings, text),
          [this, path] { parts_.Run.Run([this, path] { OpenOnDesktop(path); }); },
          QString::fromStdString(path), true};
}

void Desk::OpenOnDesktop(const std::string& path) {
  unopened_.clear();
  try {
    parts_.OtherPrograms.Start({"xdg-open", path});
  } catch (const RuntimeError&) {
    unopened_ = path;
  }
  Show();
  FocusBoard();
}

void Desk::TellFileOfCancel(const std::string& path) {
  fileOfCancel_ = path;
  Show();
}

void Desk::TellUnsavedSettings(const std::string& path) {
  unsavedSettings_ = path;
  Show();
}

void Desk::TellKeeping(const KeptState& state) {
  keeping_ = state;
  Show();
}

void Desk::Tell(const StatusLine::Entry& entry) {
  const auto found =
      std::find_if(others_.begin(), others_.end(), [&](const auto& each) { return each.Name == entry.Name; });
  if (found != others_.end()) {
    *found = entry;
  } else {
    others_.push_back(entry);
  }
  Show();
}

void Desk::FocusBoard() {
  if (QWidget* open = QApplication::activePopupWidget()) {
    open->installEventFilter(this);
  } else {
    parts_.Board.setFocus();
  }
}

bool Desk::eventFilter(QObject* watched, QEvent* event) {
  if (event->type() == QEvent::Hide) {
    watched->removeEventFilter(this);
    QTimer::singleShot(0, this, &Desk::FocusBoard);  // there may be another menu behind it
  }
  return QObject::eventFilter(watched, event);
}
