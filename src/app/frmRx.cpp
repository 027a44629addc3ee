#include "app/frmRx.h"

#include <QCloseEvent>
#include <QHeaderView>
#include <QScreen>
#include <QSignalBlocker>
#include <algorithm>
#include <utility>
#include <vector>

#include "app/ScreenFit.h"
#include "board/PlayerDelegate.h"
#include "board/ScoreListModel.h"
#include "core/data/FieldValue.h"
#include "core/data/FirstRun.h"
#include "core/data/UserDatabase.h"
#include "core/text/Pieces.h"
#include "platform/ErrorReport.h"
#include "ui/Text.h"
#include "ui_frmRx.h"

frmRx::frmRx(const Services& services)
    : services_(services),
      ui_(std::make_unique<Ui::frmRx>()),
      game_(services.Strings),
      gameFile_(services.CommonDialog1, services.Disk, services.Boxes) {
  ui_->setupUi(this);
}

frmRx::~frmRx() = default;

bool frmRx::FormLoad() {
  SetCaptions();
  ClearPlayerData();
  FitToScreenSize();
  SetUpLists();
  userDataFolder_ = PrepareUserDataFolder(services_.Places, services_.Disk, services_.Boxes);
  ini_.emplace(services_.Disk, userDataFolder_ + "/tessarine.ini");
  commPort_.emplace(services_.MSComm1, *ini_, services_.Devices, services_.Boxes, services_.Strings,
                    [this] { ShowCommPortSettings(); });
  if (!OpenDatabases()) {
    return false;
  }
  factors_ = ReadSoldieringFactors(*ini_);
  ui_->mnuCheckButton->setEnabled(services_.ButtonSwipe != nullptr);
  ConnectCommands();
  // Not before the window has come up.
  constexpr int followMilliseconds = 100;
  connect(&wordProcessorTimer_, &QTimer::timeout, this, [this] { Run([this] { FollowWordProcessor(); }); });
  wordProcessorTimer_.start(followMilliseconds);
  return true;
}

void frmRx::SetCaptions() {
  const StringTable& strings = services_.Strings;
  ui_->Label1->setText(Text(strings, 203));
  ui_->Label2->setText(Text(strings, 201));
  ui_->ActiveMissionLabel->setText(Text(strings, 202));
  ui_->ScoreDisplay->setAccessibleName(ui_->Label1->text());
  ui_->TeamScores->setAccessibleName(ui_->Label2->text());
  const std::pair<QAction*, int> captions[] = {
      {ui_->mnuFile->menuAction(), 204},
      {ui_->mnuLoadScores, 205},
      {ui_->mnuSaveScores, 206},
      {ui_->mnuClearScores, 207},
      {ui_->mnuPrintScores, 208},
      {ui_->mnuAdminData, 209},
      {ui_->mnuExit, 210},
      {ui_->mnuMissions->menuAction(), 211},
      {ui_->mnuMissionResults, 212},
      {ui_->mnuSetupMissions, 213},
      {ui_->mnuSettings->menuAction(), 214},
      {ui_->mnuCommPort, 215},
      {ui_->mnuSoldieringCalc, 216},
      {ui_->mnuHelp->menuAction(), 217},
      {ui_->mnuAbout, 218},
  };
  for (const auto& [action, number] : captions) {
    SetCaption(*action, number);
  }
}

void frmRx::SetCaption(QAction& action, int textNumber) {
  QString caption = Text(services_.Strings, textNumber);
  // The letter for the Alt key stays that of the design where the new text has it.
  const QString old = action.text();
  const auto mark = old.indexOf(u'&');
  const auto letter = mark < 0 ? -1 : caption.indexOf(old[mark + 1], 0, Qt::CaseInsensitive);
  if (letter >= 0) {
    caption.insert(letter, u'&');
  }
  action.setText(caption);
}

void frmRx::FitToScreenSize() {
  const QSize pixels = screen()->size();
  const ScreenFit fit = FitToScreen(pixels.width(), pixels.height());
  if (fit.Warn) {
    services_.Boxes.Show("This program works best with a screen resolution of at least 1024 x 768.",
                         "Screen Resolution Warning", BoxIcon::Exclamation);
  }
  if (fit.Width) {
    setGeometry(0, y(), *fit.Width, height());
  }
  if (fit.Height) {
    setGeometry(x(), 0, width(), *fit.Height);
  }
  if (fit.Maximised) {
    setWindowState(windowState() | Qt::WindowMaximized);
  }
}

void frmRx::SetUpLists() {
  const auto headers = [this](std::initializer_list<int> numbers) {
    QStringList texts;
    for (const int number : numbers) {
      texts.append(Text(services_.Strings, number));
    }
    return texts;
  };
  constexpr double share = 1.0 / BoardColumnCount;
  constexpr double fromRankToPlayer = 0.027;
  std::vector<double> boardShares(BoardColumnCount, share);
  boardShares[0] -= fromRankToPlayer;
  boardShares[1] += fromRankToPlayer;
  ui_->ScoreDisplay->setModel(new ScoreListModel(
      scoreDisplay_, game_, headers({103, 104, 105, 106, 107, 108, 109, 110, 111}), 1, this));
  ui_->ScoreDisplay->SetColumnShares(boardShares);
  ui_->ScoreDisplay->setItemDelegateForColumn(1, new PlayerDelegate(this));
  ui_->ScoreDisplay->horizontalHeader()->setSectionsClickable(true);
  ui_->TeamScores->setModel(new ScoreListModel(teamScores_, game_, headers({112, 113, 105}), 1, this));
  ui_->TeamScores->SetColumnShares(std::vector<double>(TeamColumnCount, 1.0 / TeamColumnCount));
  ui_->TeamScores->setFixedHeight(ui_->TeamScores->HeightForRows(TeamCount));
}

bool frmRx::OpenDatabases() {
  backups_.emplace(userDataFolder_ + "/backups", services_.Disk, services_.Time, services_.Strings);
  const auto open = [this](const std::string& name, const std::string& table) {
    const std::string program = services_.Places.Program();
    return OpenUserDatabase(
        {userDataFolder_ + "/" + name + ".mdb", table, program + "/" + name + "_default.mdb"},
         {.Engine = services_.Databases,
          .Old = services_.Old,
          .Disk = services_.Disk,
          .Boxes = services_.Boxes,
          .Copies = *backups_,
          .Strings = services_.Strings});
  };
  dbScenarios_ = open("scenarios", "Table1");
  if (!dbScenarios_) {
    return false;
  }
  rsScenarios_ = dbScenarios_->OpenRecordset("Table1");
  missions_.emplace(*rsScenarios_, services_.Strings, services_.Boxes);
  FillMissionList();
  rsScenarios_->MoveFirst();
  dbMembers_ = open("members", "Members");
  if (!dbMembers_) {
    return false;
  }
  rsMembers_ = dbMembers_->OpenRecordset("Members");
  members_.emplace(*rsMembers_, services_.Boxes);
  analysis_.emplace(game_, factors_, *missions_, *members_, services_.Strings, scoreDisplay_, teamScores_);
  return true;
}

void frmRx::ConnectCommands() {
  const std::pair<QAction*, void (frmRx::*)()> commands[] = {
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
      {ui_->mnuRemoteManage, &frmRx::ManageRemotely},
  };
  for (const auto& entry : commands) {
    const auto command = entry.second;
    connect(entry.first, &QAction::triggered, this,
            [this, command] { Run([this, command] { (this->*command)(); }); });
  }
  // In the bar, but never shown there: tools that read the screen find the items of an open context menu only
  // so.
  ui_->mnuPopup->menuAction()->setVisible(false);
  // An item that such a tool presses does not close its menu by itself, and the board waits for that.
  connect(ui_->mnuPopup, &QMenu::triggered, ui_->mnuPopup, &QWidget::close);
  connect(ui_->mnuExit, &QAction::triggered, this, &QWidget::close);
  connect(ui_->GetScores, &QPushButton::clicked, ui_->mnuGetKeshData, &QAction::trigger);
  connect(ui_->RemoteManageButton, &QPushButton::clicked, ui_->mnuRemoteManage, &QAction::trigger);
  connect(ui_->ActiveMission, &QComboBox::currentIndexChanged, this,
          [this](int index) { Run([this, index] { SelectMission(index); }); });
  connect(ui_->ScoreDisplay->horizontalHeader(), &QHeaderView::sectionClicked, this,
          [this](int section) { Run([this, section] { SortByHeader(scoreDisplay_, section + 1, game_); }); });
  connect(ui_->ScoreDisplay, &QWidget::customContextMenuRequested, this,
          [this](const QPoint& position) { Run([this, position] { ShowPopup(position); }); });
}

void frmRx::Run(const std::function<void()>& command) {
  ++runningCommands_;
  ReportErrors(services_.Boxes, command);
  --runningCommands_;
  if (runningCommands_ == 0) {
    TellOfMissingBackup();
  }
  if (closeRequested_ && runningCommands_ == 0) {
    close();
  }
}

void frmRx::TellOfMissingBackup() {
  if (const std::string reason = backups_->TakeFailure(); !reason.empty()) {
    services_.Boxes.Show(reason, "Database status", BoxIcon::Exclamation);
  }
}

void frmRx::closeEvent(QCloseEvent* event) {
  if (runningCommands_ > 0) {
    closeRequested_ = true;
    services_.Events.EndWaits();
    event->ignore();
    return;
  }
  if (commPort_ && !commPort_->CommDisabled()) {
    commPort_->CloseIfOpen();
  }
  rsScenarios_.reset();
  rsMembers_.reset();
  dbScenarios_.reset();
  dbMembers_.reset();
  wordProcessorTimer_.stop();
  services_.WordProcessor.Quit();
  event->accept();
}

void frmRx::FillMissionList() {
  {
    const ReadScope scope(*dbScenarios_);
    missions_->FillMissionList();
  }
  const QSignalBlocker blocker(ui_->ActiveMission);
  ui_->ActiveMission->clear();
  for (const MissionList::Item& item : missions_->Items()) {
    ui_->ActiveMission->addItem(QString::fromStdString(item.Text));
  }
  SelectMission(missions_->ListIndex());
}

void frmRx::SelectMission(int index) {
  missions_->Select(index);
  const QSignalBlocker blocker(ui_->ActiveMission);
  ui_->ActiveMission->setCurrentIndex(index);
  QString description;
  const bool active = missions_->ActivateCurrentMissionRecord();
  ui_->mnuMissionResults->setEnabled(active);
  if (active) {
    description = QString::fromStdString(FirstLineOf(TextOf(missions_->Row().Fields("MissionDescription"))));
  }
  ui_->ActiveMissionLabel->setToolTip(description);
  ui_->ActiveMission->setToolTip(description);
  CalculateScoresWhenPresent();
}

void frmRx::ClearPlayerData() {
  scoreDisplay_.Clear();
  teamScores_.Clear();
  game_.Clear();
}

void frmRx::CalculateScores() {
  const ReadScope members(*dbMembers_);
  const ReadScope missions(*dbScenarios_);
  analysis_->CalculateScores();
}

void frmRx::CalculateScoresWhenPresent() {
  if (game_.DataPresent) {
    CalculateScores();
  }
}
