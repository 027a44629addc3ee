#pragma once

#include <QObject>
#include <set>
#include <string>
#include <vector>

#include "app/AfterGameBar.h"
#include "archive/GameKeeper.h"
#include "board/ScoreListView.h"
#include "core/game/DeskEntries.h"
#include "core/game/GameProgress.h"
#include "devices/baseunit/BaseUnitDownload.h"
#include "platform/Programs.h"
#include "sheets/ScoreSheets.h"
#include "ui/Commands.h"
#include "ui/StatusLine.h"

class QAction;

/// The status line at the foot of the main window and the bar under its banner: what became of the game on
/// the board, and the next steps.
class Desk : public QObject {
 public:
  struct Parts {
    ::Session& Session;
    const DownloadedGuns& Guns;
    const StringTable& Strings;
    const Clock& Time;
    Commands& Run;
    Programs& OtherPrograms;
    StatusLine& Line;
    AfterGameBar& Bar;
    ScoreListView& Board;
    QAction& Pull;    ///< gets the scores from the base unit
    QAction& Save;    ///< saves the game
    QAction& Commit;  ///< adds the game to its members' totals
  };

  /// The session must be open.
  explicit Desk(const Parts& parts);

  /// The session is about to be closed: from now on nothing is shown any more.
  void End();

  GameProgress& Progress() { return progress_; }

  /// Brings line and bar up to date. Also happens by itself after each calculation.
  void Show();

  /// Says what a download left undone; nothing after one that is complete.
  void TellDownload(const DownloadResult& result);
  /// Takes back what was said about a download.
  void ForgetDownload();
  /// Offers to open what a run of score sheets has made.
  void TellSheets(const SheetFiles& files);
  /// Says which file a cancelled save has written; nothing if `path` is empty.
  void TellFileOfCancel(const std::string& path);
  /// Says that the settings in this file could not be saved; nothing if `path` is empty.
  void TellUnsavedSettings(const std::string& path);
  /// Says what became of keeping games.
  void TellKeeping(const KeptState& state);

  /// Shows an entry of another matter behind those of the game, until it is told again; one without a text
  /// goes.
  void Tell(const StatusLine::Entry& entry);

  /// Gives the board the keyboard, so that no stray key changes the game; once an open menu or list is
  /// closed.
  void FocusBoard();

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  DeskFacts Facts() const;
  void ForgetGame();
  std::vector<StatusLine::Entry> SheetEntries();
  /// An entry that opens a folder or file on the desktop, joined to the one before it; none if `path` is
  /// empty.
  StatusLine::Entry LinkTo(const std::string& path, const char* name, OwnText text);
  void OpenOnDesktop(const std::string& path);
  StatusLine::Entry EntryOf(const DeskEntry& entry);
  std::function<void()> ActOf(DeskTopic topic);
  void RankHighestFirst();
  void GoBackToMission();
  /// Selects the rows of these records on the board.
  void ShowPlayers(const std::set<int>& records);
  std::set<int> RecordsOfSharedMembers() const;

  const Parts parts_;
  GameProgress progress_;
  QString download_;
  SheetFiles sheets_;
  std::string unopened_;  ///< folder or file that the desktop could not open; empty if none
  std::string fileOfCancel_;
  std::string unsavedSettings_;
  KeptState keeping_;
  std::vector<StatusLine::Entry> others_;
  bool ended_ = false;
  Subscription subscription_;
};
