#pragma once

#include <QMainWindow>
#include <QTimer>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "app/BoardCharts.h"
#include "app/Desk.h"
#include "app/GameKeeping.h"
#include "app/IdleCopying.h"
#include "app/Services.h"
#include "app/WordProcessorStart.h"
#include "archive/ArchiveAccess.h"
#include "archive/copies/CopyWork.h"
#include "archive/past/PastGames.h"
#include "audience/AudienceBoard.h"
#include "audience/AudienceCopy.h"
#include "check/SystemChecks.h"
#include "core/data/IniReader.h"
#include "core/game/GuestList.h"
#include "core/game/HiddenNames.h"
#include "core/game/Session.h"
#include "core/gamefile/CurrentGameFile.h"
#include "core/line/CommPort.h"
#include "devices/baseunit/BaseUnitDownload.h"
#include "devices/box/ProgrammedBoxes.h"
#include "devices/charging/ChargedButtons.h"
#include "manual/ManualKey.h"
#include "sheets/PrintOptions.h"
#include "takeover/TakeOver.h"
#include "takeover/TakeOverResume.h"
#include "ui/Commands.h"
#include "ui/WindowPlaces.h"
#include "web/ResultsHost.h"

class QAction;

namespace Ui {
class frmRx;
}

/// The main window: menus, both score lists and the active mission. Every other window is opened from here.
class frmRx : public QMainWindow {
  Q_OBJECT

 public:
  explicit frmRx(const Services& services);
  ~frmRx() override;

  /// Finds the user's data, opens the databases and fills the window, in the order that the operator sees.
  /// Throws RuntimeError if the program cannot continue; returns false if the operator chose to end it.
  bool FormLoad();

  /// Loads this game file as soon as no command, box or window of the program is open. Asks before it
  /// replaces a game that is neither saved nor kept.
  void Open(const std::string& path);

  /// Comes to the front, where the desktop allows it; else the task bar asks for attention. `token` is the
  /// desktop's permission; it may be empty.
  void ComeToFront(const std::string& token);

  /// Something of the computer that the program needs has failed: the status line leads to System Check from
  /// now on.
  void PointToSystemCheck();

  /// The firmware update of devices with a PIC24F boot loader. No menu item gives this command.
  void UpdateTypeB();

 protected:
  void closeEvent(QCloseEvent* event) override;
  void resizeEvent(QResizeEvent* event) override;
  void dragEnterEvent(QDragEnterEvent* event) override;
  void dropEvent(QDropEvent* event) override;

 private:
  void SetUpLists();
  void ConnectCommands();

  void SetUpDesk();
  void SetUpKeeping();

  void TellOfMissingBackup();

  /// Shows changes in the session, except those that the lists show.
  void Show(SessionChange change);
  void ShowMissions();

  void LoadGame();
  /// Reads the file that was chosen.
  void ReadGame();
  /// Loads a file that came from outside, if the operator agrees: asks first where `losesGame` is true.
  void LoadFromOutside(const std::string& path, bool losesGame);
  /// Loads the file that waits to be opened, if it can be now.
  void OpenWaitingFile();
  /// Says once that the program is a new version.
  void TellNewVersion();
  /// What runs below the present command, if anything.
  std::optional<OwnText> RunningBesidesThis() const;
  /// True while a command, a box or another window of the program waits for the operator.
  bool IsBusy() const;
  void SaveGame();
  void ClearGame();
  void ExportGame();
  void ShowPastGames();
  /// What the board calls a member; empty if there is none with this number.
  void OpenPastGame(const PastGames::Opened& past);
  void ShowPastCharts(const PastGame& past);
  /// Exports the game on the board, a period's games, or these past ones.
  void ShowExport(const std::vector<std::int64_t>& chosen);
  void ImportGameFiles();
  void GetScoreData();
  /// Tracks the word processor until it is ready. If it is missing, says so once and continues without
  /// printing.
  void FollowWordProcessor();
  void PrintScores();
  void ShowCommPortSettings();
  void ShowSoldieringCalc();
  void ShowAbout();
  void ShowManual();
  void CommitGame();
  void ManageMembers();
  void CheckMembershipButton();
  void ExportMemberFile();
  void ImportMemberFile();
  void ShowMemberHistory();
  /// The history of a member, or of the first one for 0, in front of a window.
  void ShowHistoryOf(std::int32_t member, QWidget* parent);
  void ShowRankings();
  /// Deletes games that are older than the settings say: some now, the others while the window idles. Asks
  /// the first time.
  void DeleteOldGames();
  /// True if there may be more of them.
  bool DeleteSomeOldGames();
  /// Deletes the page of a ranking that a browser was given to print.
  void DeleteRankingPage();
  /// Cuts member numbers that belong to somebody else now from the board and past games; the members may be
  /// others, all of them.
  void CheckMembers();
  /// Goes on with the past games of such a check, until it is done or stopped.
  void CutNumbers();
  bool MayDeleteOldGames(int years, int games);
  /// Shows the members, starting at `contactToShow` (0 for none). Returns `ContactID` of the one chosen with
  /// OK, or an empty text.
  std::string ShowMembers(std::int32_t contactToShow);
  void ShowAdminData();
  void ShowGameCharts();
  void EnterMissionResults();
  void SetUpMissions();
  void UpdateFirmware();
  void ManageRemotely();
  void ConfigureBoxes();
  void ChargeButtons();
  void RecordSounds();
  void ShowBackupCopies();
  void ShowSystemCheck();
  WordFinding FindingOfWordProcessor();
  void TakeOverOldInstallation();
  /// Missions and members, as their copies are kept.
  std::vector<CopiedDatabase> CopiedDatabases();
  CopyWork::Parts CopyParts() const;
  /// What a take-over of old data works on.
  TakeOverWork::Parts TakeOverParts();
  ImportedGames ImportOldGames(const std::string& folder, FilesOfMembers members,
                               const TakeOver::OnImport& keepOn);
  /// What a take-over of old data began. Nothing of the data folder is open yet.
  ResumedTakeOver FinishInterruptedTakeOver();
  /// Why no old installation can be taken over now; empty if one can.
  std::string WhyNoTakeOver();

  /// Makes the last of the selected rows the player of the context menu's commands. Returns false if none is
  /// selected.
  bool SelectPlayer();
  /// The context menu of the board, for that player.
  void ShowPopup(const QPoint& position);
  /// Does for that player what the context menu's command of this item does.
  void RunPopupCommand(QAction& item);
  void AssignMember();
  void UnassignMember();
  void ShowDetailed();
  void EnterBonusPoints();
  /// The player of the context menu's commands with the member's name.
  std::string SelectedPlayerText();

  // The board for the audience.
  void SetUpAudience();
  void ToggleAudienceBoard();
  void ShowAudienceResults();
  void ShowAudienceVenue();
  void BlankAudienceBoard();
  void EnterGuestNames();
  void ShowAudienceSettings();
  /// Shows whether the board is on, and a small copy of it.
  void FollowAudienceBoard();

  // The page for phones.
  void SetUpResults();
  ResultsHost::KeptEvening KeptGames();
  NickNames NickNamesOfSession();
  /// Names were hidden or shown again.
  void ShowOtherNames();
  void ShowResultsPage();
  void PrintResultsPoster(const std::string& url);
  void HideSelectedPlayer();

  // What the board and the windows remember of the last run.
  void RestorePlaces();
  void ConnectLetters();

  const Services services_;
  std::unique_ptr<Ui::frmRx> ui_;
  Session session_;
  Subscription subscription_;
  CurrentGameFile gameFile_;
  WordProcessorStart wordProcessor_;
  std::string userDataFolder_;
  std::optional<IniReader> ini_;
  std::optional<IniReader> state_;  ///< places and sizes, which are no settings
  std::optional<WindowPlaces> places_;
  std::optional<CommPort> commPort_;
  DownloadedGuns downloadedGuns_;
  ProgrammedBoxes programmedBoxes_;
  ChargedButtons chargedButtons_;
  bool fromArchive_ = false;                    ///< the game on the board was opened there, and no file since
  bool downloading_ = false;                    ///< a score download is on the stack
  int selectedPlayer_ = 0;                      ///< record index of the player under the context menu
  std::unique_ptr<PrintOptions> printOptions_;  ///< kept, since it shows the last choices again
  QTimer wordProcessorTimer_;
  std::string waitingFile_;  ///< to be opened; empty if none
  QTimer waitingFileTimer_;
  Commands commands_;
  bool hasFailed_ = false;  ///< something at the start, before the status line was there
  std::optional<Desk> desk_;
  GuestList guests_;
  std::optional<GameKeeping> keeping_;
  std::optional<ArchiveAccess> archive_;  ///< for windows; the keeper has its own
  std::optional<IdleCopying> idleCopying_;
  std::string oldGamesBefore_;  ///< time before which games are still to be deleted; else empty
  std::optional<BoardCharts> charts_;
  std::optional<HiddenNames> hidden_;
  std::optional<AudienceBoard> audience_;
  std::optional<ResultsHost> results_;
  ManualKey manual_;
};
