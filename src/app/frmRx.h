#pragma once

#include <QMainWindow>
#include <QTimer>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "app/Services.h"
#include "core/data/Backups.h"
#include "core/data/IniReader.h"
#include "core/game/Game.h"
#include "core/game/MemberLookup.h"
#include "core/game/MissionList.h"
#include "core/game/ScoreAnalysis.h"
#include "core/game/ScoreList.h"
#include "core/game/SoldieringFactors.h"
#include "core/gamefile/CurrentGameFile.h"
#include "core/line/CommPort.h"
#include "sheets/PrintOptions.h"

namespace Ui {
class frmRx;
}

/// The main window. Owns the game, both score lists and the open databases; every other window is opened from
/// here.
class frmRx : public QMainWindow {
  Q_OBJECT

 public:
  explicit frmRx(const Services& services);
  ~frmRx() override;

  /// Finds the user's data, opens the databases and fills the window, in the order that the operator sees.
  /// Throws RuntimeError when the program cannot go on; returns false when the operator chose to end it.
  bool FormLoad();

 protected:
  void closeEvent(QCloseEvent* event) override;

 private:
  void SetCaptions();
  void SetCaption(QAction& action, int textNumber);
  void FitToScreenSize();
  void SetUpLists();
  bool OpenDatabases();
  void ConnectCommands();
  /// Runs a command of the operator; a failure in it is reported and ends the command.
  void Run(const std::function<void()>& command);

  void TellOfMissingBackup();

  void FillMissionList();
  void SelectMission(int index);

  void ClearPlayerData();
  void CalculateScores();
  void CalculateScoresWhenPresent();

  void LoadGame();
  void SaveGame();
  void ClearGame();
  void GetScoreData();
  /// Starts the word processor and follows it until it is ready. Where it is missing, says so once and goes
  /// on without printing.
  void FollowWordProcessor();
  void PrintScores();
  void ShowCommPortSettings();
  void ShowSoldieringCalc();
  void ShowAbout();
  void CommitGame();
  void ManageMembers();
  void CheckMembershipButton();
  /// Shows the members, standing on one of them (0 for none); `ContactID` of the one chosen with OK, or
  /// empty.
  std::string ShowMembers(std::int32_t contactToShow);
  void ShowAdminData();
  void EnterMissionResults();
  void SetUpMissions();
  void ManageRemotely();

  /// The context menu of the board, for the last of the selected rows.
  void ShowPopup(const QPoint& position);
  void AssignMember();
  void UnassignMember();
  void ShowDetailed();
  void EnterBonusPoints();

  const Services services_;
  std::unique_ptr<Ui::frmRx> ui_;
  Game game_;
  SoldieringFactors factors_;
  ScoreList scoreDisplay_;
  ScoreList teamScores_;
  CurrentGameFile gameFile_;
  std::string userDataFolder_;

  // In the order in which start-up makes them.
  std::optional<IniReader> ini_;
  std::optional<CommPort> commPort_;
  std::optional<Backups> backups_;
  std::unique_ptr<Database> dbScenarios_;
  std::unique_ptr<Recordset> rsScenarios_;
  std::optional<MissionList> missions_;
  std::unique_ptr<Database> dbMembers_;
  std::unique_ptr<Recordset> rsMembers_;
  std::optional<MemberLookup> members_;
  std::optional<ScoreAnalysis> analysis_;
  int selectedPlayer_ = 0;                      ///< record index of the player under the context menu
  std::unique_ptr<PrintOptions> printOptions_;  ///< kept, since it shows the last choices again
  QTimer wordProcessorTimer_;
  bool wordProcessorStarted_ = false;
  int runningCommands_ = 0;      ///< commands on the stack; a wait in one can start another
  bool closeRequested_ = false;  ///< close as soon as the last of them has unwound
};
