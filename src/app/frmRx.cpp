#include "app/frmRx.h"

#include <QCloseEvent>
#include <QHeaderView>
#include <QResizeEvent>
#include <QSignalBlocker>
#include <QToolButton>
#include <utility>
#include <vector>

#include "app/ChartPlayers.h"
#include "app/MenuCaptions.h"
#include "app/ScreenFit.h"
#include "app/StateKeys.h"
#include "board/BoardState.h"
#include "board/PlayerDelegate.h"
#include "board/ScoreListModel.h"
#include "core/data/FirstRun.h"
#include "core/data/UserDatabase.h"
#include "ui/CalmList.h"
#include "ui/Choice.h"
#include "ui_frmRx.h"

frmRx::frmRx(const Services& services)
    : services_(services),
      ui_(std::make_unique<Ui::frmRx>()),
      session_(services.Strings, services.Time, services.Boxes),
      subscription_(session_.Listen([this](SessionChange change) { Show(change); })),
      gameFile_(services.CommonDialog1, services.Disk, services.Boxes),
      wordProcessor_(services.WordProcessor),
      downloadedGuns_(session_.Game()),
      commands_(*this, services.Boxes),
      manual_(services.Strings, QString::fromStdString(services.Places.Program() + "/manual"), *this) {
  ui_->setupUi(this);
  setAcceptDrops(true);
  connect(&waitingFileTimer_, &QTimer::timeout, this, &frmRx::OpenWaitingFile);
}

frmRx::~frmRx() = default;

bool frmRx::FormLoad() {
  SetCaptions(*ui_, services_.Strings);
  session_.ClearPlayerData();
  FitToScreen(*this, services_.Boxes);
  SetUpLists();
  const ResumedTakeOver resumed = FinishInterruptedTakeOver();
  if (!resumed.GoOn) {
    return false;
  }
  userDataFolder_ = PrepareUserDataFolder(services_.Places, services_.Disk, services_.Boxes);
  ini_.emplace(services_.Disk, userDataFolder_ + "/tessarine.ini");
  RestorePlaces();
  commPort_.emplace(services_.MSComm1, *ini_, services_.Devices, services_.Boxes, services_.Strings,
                    [this] { ShowCommPortSettings(); });
  if (!session_.Open({.Engine = services_.Databases,
                      .Old = services_.Old,
                      .Disk = services_.Disk,
                      .UserDataFolder = userDataFolder_,
                      .ProgramFolder = services_.Places.Program()})) {
    return false;
  }
  session_.Factors() = ReadSoldieringFactors(*ini_);
  ui_->mnuCheckButton->setEnabled(services_.ButtonSwipe != nullptr);
  ui_->mnuChargeiButton->setEnabled(services_.Wire != nullptr);
  ui_->mnuSystemCheck->setEnabled(services_.Computer != nullptr);
  ConnectCommands();
  SetUpDesk();
  SetUpKeeping();
  SetUpAudience();
  idleCopying_.emplace(
      IdleCopying::Parts{.DoAPart = [this] { return DeleteSomeOldGames() || keeping_->DoAPart(); },
                         .Busy = [this] { return downloading_ || IsBusy(); },
                         .Elapsed = services_.Elapsed});
  TellNewVersion();
  desk_->Tell({QStringLiteral("TakeOverEnd"), QString::fromStdString(resumed.ToTell)});
  SetUpResults();
  // Not before the window is shown.
  constexpr int followMilliseconds = 100;
  connect(&wordProcessorTimer_, &QTimer::timeout, this,
          [this] { commands_.Run([this] { FollowWordProcessor(); }); });
  wordProcessorTimer_.start(followMilliseconds);
  return true;
}

void frmRx::SetUpDesk() {
  ui_->GameBar->SetUp(services_.Strings, {ui_->mnuMissionResults, ui_->mnuPrintScores, ui_->mnuCommitGame,
                                          ui_->mnuSaveScores, ui_->mnuClearScores});
  QWidget* before = ui_->RemoteManageButton;
  for (int step = 0; step < GameStepCount; ++step) {
    QWidget* button = &ui_->GameBar->Button(static_cast<GameStep>(step));
    setTabOrder(before, button);
    before = button;
  }
  desk_.emplace(Desk::Parts{.Session = session_,
                            .Guns = downloadedGuns_,
                            .Strings = services_.Strings,
                            .Time = services_.Time,
                            .Run = commands_,
                            .OtherPrograms = services_.OtherPrograms,
                            .Line = *ui_->GameLine,
                            .Bar = *ui_->GameBar,
                            .Board = *ui_->ScoreDisplay,
                            .Pull = *ui_->mnuGetKeshData,
                            .Save = *ui_->mnuSaveScores,
                            .Commit = *ui_->mnuCommitGame});
  desk_->Show();
  if (hasFailed_) {
    PointToSystemCheck();
  }
  charts_.emplace(
      session_,
      GameCharts::Parts{.Strings = services_.Strings,
                        .Boxes = services_.Boxes,
                        .CommonDialog1 = services_.CommonDialog1,
                        .Disk = services_.Disk},
      *this, [this] { return desk_->Progress().Received(); },
      [this](int index) {
        return PlayerOfChart(
            session_.Game(), index, NickNamesOfSession(), [this](int guest) { return guests_.NameOf(guest); },
            *hidden_);
      });
  ini_->AfterWrite = [this](bool written) {
    desk_->TellUnsavedSettings(written ? std::string() : userDataFolder_ + "/tessarine.ini");
  };
  gameFile_.SetSaveFolder(state_->ReadIni(State::Games, State::SaveFolder, {}));
  commands_.AfterCommand = [this] {
    desk_->Show();
    desk_->FocusBoard();
  };
  KeepCalm(*ui_->ActiveMission, [this] { desk_->FocusBoard(); });
  desk_->FocusBoard();
}

void frmRx::SetUpKeeping() {
  DatabaseEngine& archives = services_.Archives != nullptr ? *services_.Archives : services_.Databases;
  archive_.emplace(ArchiveAccess::Parts{.Session = session_,
                                        .Disk = services_.Disk,
                                        .Engine = archives,
                                        .Strings = services_.Strings,
                                        .UserDataFolder = userDataFolder_,
                                        .ProgramFolder = services_.Places.Program()});
  keeping_.emplace(
      GameKeeper::Parts{.Session = session_,
                        .Progress = desk_->Progress(),
                        .Time = services_.Time,
                        .Disk = services_.Disk,
                        .Engine = archives,
                        .Strings = services_.Strings,
                        .UserDataFolder = userDataFolder_,
                        .ProgramFolder = services_.Places.Program(),
                        .Guests = &guests_},
      [this] { return downloading_; }, [this](const KeptState& state) { desk_->TellKeeping(state); });
  DeleteRankingPage();  // a killed run may have left it
  // Not before the window is shown.
  QTimer::singleShot(0, &*keeping_, [this] {
    commands_.Run([this] {
      CheckMembers();
      keeping_->RemoveDeleted();
      DeleteOldGames();
    });
  });
}

void frmRx::SetUpLists() {
  constexpr double share = 1.0 / BoardColumnCount;
  constexpr double fromRankToPlayer = 0.027;
  std::vector<double> shares(BoardColumnCount, share);
  shares[0] -= fromRankToPlayer;
  shares[1] += fromRankToPlayer;
  const StringTable& strings = services_.Strings;
  ui_->ScoreDisplay->setModel(new ScoreListModel(session_, BoardList::Players, strings, this));
  ui_->ScoreDisplay->SetColumnShares(shares);
  ui_->ScoreDisplay->setItemDelegateForColumn(1, new PlayerDelegate(this));
  ui_->ScoreDisplay->horizontalHeader()->setSectionsClickable(true);
  ui_->TeamScores->setModel(new ScoreListModel(session_, BoardList::Teams, strings, this));
  ui_->TeamScores->SetColumnShares(std::vector<double>(TeamColumnCount, 1.0 / TeamColumnCount));
  ui_->TeamScores->ShowWholeRows(TeamCount);
  ui_->Boards->SetLists(*ui_->ScoreDisplay, *ui_->TeamScores, *ui_->boardLayout);
}

void frmRx::RestorePlaces() {
  state_.emplace(services_.Disk, userDataFolder_ + State::File);
  places_.emplace(*state_);
  const QSize pixels = PixelsOf(*screen());
  if (AlwaysFits(pixels.width(), pixels.height()) || !places_->Restore(*this)) {
    MaximiseOnSmallScreen(*this);
  }
  const BoardState board(*state_);
  ui_->Boards->SetLetters(board.Letters());
  for (ScoreListView* list : {ui_->ScoreDisplay, ui_->TeamScores}) {
    list->SetDraggedShares(board.ColumnShares(list->objectName().toStdString()));
  }
}

void frmRx::ConnectLetters() {
  ui_->mnuLargerLetters->setShortcuts(
      {QKeySequence(Qt::CTRL | Qt::Key_Plus), QKeySequence(Qt::CTRL | Qt::Key_Equal)});
  connect(ui_->mnuLargerLetters, &QAction::triggered, ui_->Boards, &BoardPane::MakeLettersLarger);
  connect(ui_->mnuSmallerLetters, &QAction::triggered, ui_->Boards, &BoardPane::MakeLettersSmaller);
  connect(ui_->mnuUsualLetters, &QAction::triggered, ui_->Boards, &BoardPane::MakeLettersUsual);
  connect(ui_->Boards, &BoardPane::LettersChosen, this,
          [this] { BoardState(*state_).SetLetters(ui_->Boards->Letters()); });
  for (ScoreListView* list : {ui_->ScoreDisplay, ui_->TeamScores}) {
    const auto keep = [this, list] {
      BoardState(*state_).SetColumnShares(list->objectName().toStdString(), list->DraggedShares());
    };
    connect(list, &ScoreListView::WidthsDragged, this, keep);
    connect(ui_->mnuUsualColumns, &QAction::triggered, list, [list, keep] {
      list->SetDraggedShares({});
      keep();
    });
  }
}

void frmRx::ConnectCommands() {
  commands_.EndWaits = [this] { services_.Events.EndWaits(); };
  commands_.AllUnwound = [this] { TellOfMissingBackup(); };
  commands_.Connect(*this, {
                               {ui_->mnuLoadScores, &frmRx::LoadGame},
                               {ui_->mnuSaveScores, &frmRx::SaveGame},
                               {ui_->mnuClearScores, &frmRx::ClearGame},
                               {ui_->mnuExport, &frmRx::ExportGame},
                               {ui_->mnuPastGames, &frmRx::ShowPastGames},
                               {ui_->mnuImportGames, &frmRx::ImportGameFiles},
                               {ui_->mnuGetKeshData, &frmRx::GetScoreData},
                               {ui_->mnuPrintScores, &frmRx::PrintScores},
                               {ui_->mnuCommPort, &frmRx::ShowCommPortSettings},
                               {ui_->mnuSoldieringCalc, &frmRx::ShowSoldieringCalc},
                               {ui_->mnuAbout, &frmRx::ShowAbout},
                               {ui_->mnuManual, &frmRx::ShowManual},
                               {ui_->mnuSystemCheck, &frmRx::ShowSystemCheck},
                               {ui_->mnuAdminData, &frmRx::ShowAdminData},
                               {ui_->mnuGameCharts, &frmRx::ShowGameCharts},
                               {ui_->mnuMissionResults, &frmRx::EnterMissionResults},
                               {ui_->mnuSetupMissions, &frmRx::SetUpMissions},
                               {ui_->mnuCommitGame, &frmRx::CommitGame},
                               {ui_->mnuManageMembers, &frmRx::ManageMembers},
                               {ui_->mnuCheckButton, &frmRx::CheckMembershipButton},
                               {ui_->mnuExportMembers, &frmRx::ExportMemberFile},
                               {ui_->mnuImportMembers, &frmRx::ImportMemberFile},
                               {ui_->mnuMemberHistory, &frmRx::ShowMemberHistory},
                               {ui_->mnuRankings, &frmRx::ShowRankings},
                               {ui_->mnuAssignMember, &frmRx::AssignMember},
                               {ui_->mnuUnassignMember, &frmRx::UnassignMember},
                               {ui_->mnuShowDetailed, &frmRx::ShowDetailed},
                               {ui_->mnuBonusPoints, &frmRx::EnterBonusPoints},
                               {ui_->mnuFirmwareUpdate, &frmRx::UpdateFirmware},
                               {ui_->mnuRemoteManage, &frmRx::ManageRemotely},
                               {ui_->mnuBoxConfig, &frmRx::ConfigureBoxes},
                               {ui_->mnuChargeiButton, &frmRx::ChargeButtons},
                               {ui_->mnuSoundRecorder, &frmRx::RecordSounds},
                               {ui_->mnuBackupCopies, &frmRx::ShowBackupCopies},
                               {ui_->mnuTakeOver, &frmRx::TakeOverOldInstallation},
                               {ui_->mnuAudienceBoard, &frmRx::ToggleAudienceBoard},
                               {ui_->mnuAudienceResults, &frmRx::ShowAudienceResults},
                               {ui_->mnuAudienceVenue, &frmRx::ShowAudienceVenue},
                               {ui_->mnuAudienceBlank, &frmRx::BlankAudienceBoard},
                               {ui_->mnuGuestNames, &frmRx::EnterGuestNames},
                               {ui_->mnuAudienceSettings, &frmRx::ShowAudienceSettings},
                               {ui_->mnuResultsPage, &frmRx::ShowResultsPage},
                               {ui_->mnuHidePlayer, &frmRx::HideSelectedPlayer},
                           });
  // In the menu bar, but never shown there: otherwise screen readers cannot find the items of an open context
  // menu.
  ui_->mnuPopup->menuAction()->setVisible(false);
  // An item pressed by a screen reader does not close its menu by itself, and the board waits for that.
  connect(ui_->mnuPopup, &QMenu::triggered, ui_->mnuPopup, &QWidget::close);
  connect(ui_->mnuExit, &QAction::triggered, this, &QWidget::close);
  connect(ui_->GetScores, &QPushButton::clicked, ui_->mnuGetKeshData, &QAction::trigger);
  connect(ui_->RemoteManageButton, &QPushButton::clicked, ui_->mnuRemoteManage, &QAction::trigger);
  OnChoice(*ui_->ActiveMission, [this](int index) {
    commands_.Run([this, index] { session_.SelectMission(index); });
    desk_->FocusBoard();
  });
  connect(ui_->ScoreDisplay->horizontalHeader(), &QHeaderView::sectionClicked, this,
          [this](int section) { commands_.Run([this, section] { session_.SortByHeader(section + 1); }); });
  connect(ui_->ScoreDisplay, &QWidget::customContextMenuRequested, this,
          [this](const QPoint& position) { commands_.Run([this, position] { ShowPopup(position); }); });
  connect(ui_->ScoreDisplay, &ScoreListView::RowChosen, this,
          [this] { commands_.Run([this] { RunPopupCommand(*ui_->mnuShowDetailed); }); });
  ConnectLetters();
}

void frmRx::TellOfMissingBackup() {
  if (const std::string reason = session_.TakeBackupFailure(); !reason.empty()) {
    services_.Boxes.Show(reason, DatabaseBoxTitle, BoxIcon::Exclamation);
  }
}

void frmRx::closeEvent(QCloseEvent* event) {
  if (!commands_.MayClose()) {
    event->ignore();
    return;
  }
  if (commPort_ && !commPort_->CommDisabled()) {
    commPort_->CloseIfOpen();
  }
  if (desk_) {
    idleCopying_->End();
    DeleteRankingPage();
    keeping_->End();
    archive_->Close();
    desk_->End();
    charts_->Close();
  }
  if (audience_) {
    results_->End();
    audience_->End();
  }
  session_.Close();
  wordProcessorTimer_.stop();
  services_.WordProcessor.Quit();
  event->accept();
}

void frmRx::resizeEvent(QResizeEvent* event) {
  constexpr int leastHeightWithBar = 700;
  ui_->GameBar->setVisible(event->size().height() >= leastHeightWithBar);
  QMainWindow::resizeEvent(event);
}

void frmRx::Show(SessionChange change) {
  switch (change) {
    case SessionChange::Cleared:
      ui_->ScoreDisplay->ForgetSelection();
      downloadedGuns_.Forget();
      guests_.Forget();
      fromArchive_ = false;
      break;
    case SessionChange::Missions:
      ShowMissions();
      break;
    case SessionChange::Mission: {
      const QSignalBlocker blocker(ui_->ActiveMission);
      ui_->ActiveMission->setCurrentIndex(session_.Missions().ListIndex());
      break;
    }
    case SessionChange::MissionRow: {
      const QString description = QString::fromStdString(session_.MissionDescription());
      ui_->mnuMissionResults->setEnabled(session_.MissionIsActive());
      ui_->ActiveMissionLabel->setToolTip(description);
      ui_->ActiveMission->setToolTip(description);
      break;
    }
    case SessionChange::Saved:
      fromArchive_ = false;
      break;
    default:
      break;
  }
}

void frmRx::ShowMissions() {
  const QSignalBlocker blocker(ui_->ActiveMission);
  ui_->ActiveMission->clear();
  for (const MissionList::Item& item : session_.Missions().Items()) {
    ui_->ActiveMission->addItem(QString::fromStdString(item.Text));
  }
}
