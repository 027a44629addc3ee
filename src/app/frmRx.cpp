#include "app/frmRx.h"

#include <QCloseEvent>
#include <QHeaderView>
#include <QLabel>
#include <QSignalBlocker>
#include <utility>
#include <vector>

#include "app/MenuCaptions.h"
#include "app/ScreenFit.h"
#include "board/PlayerDelegate.h"
#include "board/ScoreListModel.h"
#include "core/data/FirstRun.h"
#include "core/data/UserDatabase.h"
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
      status_(new QLabel(this)),
      commands_(*this, services.Boxes) {
  ui_->setupUi(this);
  status_->setObjectName(QStringLiteral("Status"));
  status_->setTextFormat(Qt::PlainText);
  ui_->StatusBar->addWidget(status_, 1);
}

frmRx::~frmRx() = default;

bool frmRx::FormLoad() {
  SetCaptions(*ui_, services_.Strings);
  session_.ClearPlayerData();
  FitToScreen(*this, services_.Boxes);
  SetUpLists();
  userDataFolder_ = PrepareUserDataFolder(services_.Places, services_.Disk, services_.Boxes);
  ini_.emplace(services_.Disk, userDataFolder_ + "/tessarine.ini");
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
  ConnectCommands();
  // Not before the window is shown.
  constexpr int followMilliseconds = 100;
  connect(&wordProcessorTimer_, &QTimer::timeout, this,
          [this] { commands_.Run([this] { FollowWordProcessor(); }); });
  wordProcessorTimer_.start(followMilliseconds);
  return true;
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
}

void frmRx::ConnectCommands() {
  commands_.EndWaits = [this] { services_.Events.EndWaits(); };
  commands_.AllUnwound = [this] { TellOfMissingBackup(); };
  commands_.Connect(*this, {
                               {ui_->mnuLoadScores, &frmRx::LoadGame},
                               {ui_->mnuSaveScores, &frmRx::SaveGame},
                               {ui_->mnuClearScores, &frmRx::ClearGame},
                               {ui_->mnuGetKeshData, &frmRx::GetScoreData},
                               {ui_->mnuPrintScores, &frmRx::PrintScores},
                               {ui_->mnuCommPort, &frmRx::ShowCommPortSettings},
                               {ui_->mnuSoldieringCalc, &frmRx::ShowSoldieringCalc},
                               {ui_->mnuAbout, &frmRx::ShowAbout},
                               {ui_->mnuAdminData, &frmRx::ShowAdminData},
                               {ui_->mnuMissionResults, &frmRx::EnterMissionResults},
                               {ui_->mnuSetupMissions, &frmRx::SetUpMissions},
                               {ui_->mnuCommitGame, &frmRx::CommitGame},
                               {ui_->mnuManageMembers, &frmRx::ManageMembers},
                               {ui_->mnuCheckButton, &frmRx::CheckMembershipButton},
                               {ui_->mnuAssignMember, &frmRx::AssignMember},
                               {ui_->mnuUnassignMember, &frmRx::UnassignMember},
                               {ui_->mnuShowDetailed, &frmRx::ShowDetailed},
                               {ui_->mnuBonusPoints, &frmRx::EnterBonusPoints},
                               {ui_->mnuFirmwareUpdate, &frmRx::UpdateFirmware},
                               {ui_->mnuRemoteManage, &frmRx::ManageRemotely},
                               {ui_->mnuBoxConfig, &frmRx::ConfigureBoxes},
                               {ui_->mnuChargeiButton, &frmRx::ChargeButtons},
                               {ui_->mnuSoundRecorder, &frmRx::RecordSounds},
                           });
  // In the menu bar, but never shown there: otherwise screen readers cannot find the items of an open context
  // menu.
  ui_->mnuPopup->menuAction()->setVisible(false);
  // An item pressed by a screen reader does not close its menu by itself, and the board waits for that.
  connect(ui_->mnuPopup, &QMenu::triggered, ui_->mnuPopup, &QWidget::close);
  connect(ui_->mnuExit, &QAction::triggered, this, &QWidget::close);
  connect(ui_->GetScores, &QPushButton::clicked, ui_->mnuGetKeshData, &QAction::trigger);
  connect(ui_->RemoteManageButton, &QPushButton::clicked, ui_->mnuRemoteManage, &QAction::trigger);
  OnChoice(*ui_->ActiveMission,
           [this](int index) { commands_.Run([this, index] { session_.SelectMission(index); }); });
  connect(ui_->ScoreDisplay->horizontalHeader(), &QHeaderView::sectionClicked, this,
          [this](int section) { commands_.Run([this, section] { session_.SortByHeader(section + 1); }); });
  connect(ui_->ScoreDisplay, &QWidget::customContextMenuRequested, this,
          [this](const QPoint& position) { commands_.Run([this, position] { ShowPopup(position); }); });
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
  session_.Close();
  wordProcessorTimer_.stop();
  services_.WordProcessor.Quit();
  event->accept();
}

void frmRx::Show(SessionChange change) {
  switch (change) {
    case SessionChange::Cleared:
      downloadedGuns_.Settle();
      ShowStatus({});
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
