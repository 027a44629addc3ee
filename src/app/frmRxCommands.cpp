// The commands of the menus, each one the handler of its item.

#include "app/frmRx.h"

#include <QScopeGuard>
#include <algorithm>
#include <string>
#include <utility>

#include "app/About.h"
#include "app/UploadProgress.h"
#include "board/AdminData.h"
#include "board/BonusPoints.h"
#include "board/MissionResultEntry.h"
#include "board/PlayerDetails.h"
#include "core/data/FieldValue.h"
#include "core/text/NumberForms.h"
#include "devices/baseunit/BaseUnitDownload.h"
#include "devices/box/BoxConfig.h"
#include "devices/charging/ChargeiButton.h"
#include "devices/radio/RemoteManage.h"
#include "firmware/download/FirmwareFlash.h"
#include "firmware/pic24f/PortNames.h"
#include "firmware/pic24f/SerialPicBoot.h"
#include "firmware/pic24f/frmBootload.h"
#include "members/MemberQueries.h"
#include "members/Members.h"
#include "missions/Scenarios.h"
#include "settings/Settings.h"
#include "settings/SoldieringCalc.h"
#include "sheets/ScoreSheets.h"
#include "sheets/SheetProgressWindow.h"
#include "sound/ISD_rec.h"
#include "ui/WaitCursor.h"
#include "ui_frmRx.h"

void frmRx::ClearGame() {
  const BoxAnswer answer = services_.Boxes.Show(services_.Strings.Text(123), services_.Strings.Text(124),
                                                BoxIcon::Question, BoxButtons::OkCancel);
  if (answer == BoxAnswer::Ok) {
    session_.ClearPlayerData();
  }
}

void frmRx::GetScoreData() {
  if (downloading_) {
    return;
  }
  desk_->ForgetDownload();
  keeping_->BeginPull(GameSource::Cable);
  {
    downloading_ = true;
    DownloadResult result;
    AudienceState& audience = audience_->State();
    const auto ended = qScopeGuard([&] {
      downloading_ = false;
      audience.EndPull(result.Received > 0);
    });
    UploadProgress progress(services_.Strings, this);
    progress.Received = [&audience](int received, int expected) {
      audience.TellReceived(received, expected);
    };
    audience.BeginPull();
    result = BaseUnitDownload(services_.MSComm1, *commPort_, services_.Events, services_.Boxes,
                              services_.Time, progress, downloadedGuns_)
                 .GetScores();
    desk_->TellDownload(result);
  }
  session_.CalculateScores();
}

void frmRx::FollowWordProcessor() {
  const WordState state = wordProcessor_.Follow();
  if (state == WordState::Starting) {
    return;
  }
  wordProcessorTimer_.stop();
  if (state == WordState::Ended) {
    ui_->mnuPrintScores->setEnabled(false);
    services_.Boxes.Show(services_.Strings.Text(117), services_.Strings.Text(118), BoxIcon::Exclamation);
  }
}

void frmRx::PrintScores() {
  if (!printOptions_) {
    printOptions_ = std::make_unique<PrintOptions>(services_.Strings, services_.Boxes, this);
  }
  printOptions_->exec();
  if (printOptions_->Choice().SheetSelection == SheetSelection::Nothing) {
    return;
  }
  SheetProgressWindow progress(services_.Strings, this);
  const SheetParts parts{.Game = session_.Game(),
                         .RsMembers = session_.RsMembers(),
                         .Members = session_.Members(),
                         .Strings = services_.Strings,
                         .Time = services_.Time,
                         .Events = services_.Events,
                         .Disk = services_.Disk,
                         .Boxes = services_.Boxes,
                         .WordApp = services_.WordProcessor,
                         .UprightPicture = services_.UprightPicture,
                         .Progress = progress,
                         .UserDataFolder = userDataFolder_,
                         .MissionName = session_.Missions().Text()};
  ScoreSheets sheets(parts, printOptions_->Choice());
  desk_->TellSheets(sheets.GenerateScoreSheets());
  const std::int16_t whose = printOptions_->Choice().SheetSelection;
  if (sheets.AllMade() && (whose == SheetSelection::Active || whose == SheetSelection::All)) {
    desk_->Progress().Printed();
  }
}

void frmRx::ShowCommPortSettings() {
  Settings(*ini_, services_.Devices, services_.Boxes, services_.Strings, this).exec();
}

void frmRx::ShowSoldieringCalc() {
  SoldieringCalc(session_.Factors(), services_.Strings, this).exec();
  WriteSoldieringFactors(*ini_, session_.Factors());
  session_.CalculateScoresWhenPresent();
}

void frmRx::ShowAbout() {
  About(this).exec();
}

void frmRx::ShowManual() {
  manual_.Open();
}

void frmRx::CommitGame() {
  CommitResult result;
  {
    const WaitCursor cursor;
    result = session_.CommitGame();
  }
  TellCommitResult(result, services_.Boxes);
}

void frmRx::ManageMembers() {
  ShowMembers(0);
}

void frmRx::CheckMembershipButton() {
  const std::string dallasId = services_.ButtonSwipe();
  if (dallasId == NoDallasId) {
    return;
  }
  const auto found = session_.DbMembers().OpenRecordset(ButtonQuery(dallasId));
  if (found->Eof()) {
    services_.Boxes.Show("Button is not assigned to a member", DefaultBoxTitle, BoxIcon::Information);
  } else {
    ShowMembers(RoundToInt32(NumberOf(found->Fields("ContactID"))));
  }
}

std::string frmRx::ShowMembers(std::int32_t contactToShow) {
  Members window(
      {.DbMembers = session_.DbMembers(),
       .Boxes = services_.Boxes,
       .CommonDialog1 = services_.CommonDialog1,
       .Disk = services_.Disk,
       .Time = services_.Time,
       .Strings = services_.Strings,
       .ButtonSwipe = services_.ButtonSwipe,
       .ShowHistory = [this](std::int32_t member, QWidget& parent) { ShowHistoryOf(member, &parent); }},
      this);
  window.ContactToShow = contactToShow;
  window.exec();
  keeping_->NoteMembers();
  idleCopying_->LookSoon();  // a check that failed earlier may have begun
  ShowOtherNames();
  return window.SelectedContact();
}

void frmRx::ShowAdminData() {
  AdminData(session_.Game(), services_.Strings, this).exec();
}

void frmRx::ShowGameCharts() {
  charts_->Open();
}

void frmRx::EnterMissionResults() {
  if (MissionResultEntry(session_.Game(), session_.Missions(), services_.Strings, this).exec() ==
      QDialog::Accepted) {
    desk_->Progress().ResultsEntered();
  }
  session_.CalculateScoresWhenPresent();
}

void frmRx::SetUpMissions() {
  Scenarios(session_.DbScenarios(), session_.RsScenarios(), services_.Boxes, services_.Strings, this).exec();
  session_.RsScenarios().MoveFirst();
  session_.FillMissionList();
}

void frmRx::UpdateFirmware() {
  commPort_->CloseIfOpen();
  FirmwareFlash({.MSComm1 = services_.MSComm1,
                 .Devices = services_.Devices,
                 .Ini = *ini_,
                 .Events = services_.Events,
                 .Boxes = services_.Boxes,
                 .Cd1 = services_.CommonDialog1,
                 .Disk = services_.Disk,
                 .Time = services_.Time,
                 .Elapsed = services_.Elapsed,
                 .Strings = services_.Strings,
                 .Awake = services_.Awake,
                 .LogFolder = userDataFolder_ + "/logs"},
                this)
      .exec();
}

void frmRx::ManageRemotely() {
  keeping_->BeginPull(GameSource::Radio);
  AudienceState& audience = audience_->State();
  bool withGuns = false;
  RemoteManage({.MSComm1 = services_.MSComm1,
                .Port = *commPort_,
                .Events = services_.Events,
                .Boxes = services_.Boxes,
                .Time = services_.Time,
                .Strings = services_.Strings,
                .Game = session_.Game(),
                .BeforeGun =
                    [&](int index) {
                      downloadedGuns_.ComesOtherwise(index);
                      withGuns = true;
                    },
                .Fetching = [&](int fetched, int present) { audience.TellReceived(fetched, present); },
                .FetchEnded =
                    [&] {
                      if (!withGuns) {  // else the hall waits for the scores, which are made below
                        audience.EndPull(false);
                      }
                    }},
               this)
      .exec();
  audience.EndPull(withGuns);
  session_.CalculateScores();
}

void frmRx::ConfigureBoxes() {
  commPort_->CloseIfOpen();
  BoxConfig({.MSComm1 = services_.MSComm1,
             .Port = *commPort_,
             .Events = services_.Events,
             .Boxes = services_.Boxes,
             .Time = services_.Time,
             .Strings = services_.Strings,
             .Game = session_.Game(),
             .Programmed = programmedBoxes_,
             .Signals = {*ini_, &services_.SoundPlayer, services_.Strings}},
            this)
      .exec();
}

void frmRx::ChargeButtons() {
  ChargeiButton({.Wire = *services_.Wire,
                 .Events = services_.Events,
                 .Boxes = services_.Boxes,
                 .Time = services_.Time,
                 .Strings = services_.Strings,
                 .Charged = chargedButtons_,
                 .Signals = {*ini_, &services_.SoundPlayer, services_.Strings}},
                this)
      .exec();
}

void frmRx::UpdateTypeB() {
  commPort_->CloseIfOpen();
  const CommPortSetting ports(*ini_, services_.Devices);
  const auto makeLibrary = [&](std::function<bool()> stopped) {
    return std::make_unique<SerialPicBoot>(SerialPicBoot::Parts{
        .Port = services_.MSComm1,
        .Events = services_.Events,
        .DeviceOf = [&ports](const std::string& port) { return DeviceOfPort(port, ports); },
        .Stopped = std::move(stopped)});
  };
  frmBootload({.MakeLibrary = makeLibrary,
               .Disk = services_.Disk,
               .Events = services_.Events,
               .CommonDialog1 = services_.CommonDialog1,
               .Boxes = services_.Boxes,
               .OtherPrograms = services_.OtherPrograms,
               .Ini = *ini_,
               .Devices = services_.Devices,
               .Strings = services_.Strings,
               .Folder = {userDataFolder_, services_.Places.Program()}},
              this)
      .exec();
}

void frmRx::RecordSounds() {
  ISD_rec({.MSComm1 = services_.SoundPort,
           .Ini = *ini_,
           .Devices = services_.Devices,
           .Events = services_.Events,
           .Elapsed = services_.Elapsed,
           .Boxes = services_.Boxes,
           .CD = services_.CommonDialog1,
           .Disk = services_.Disk,
           .Player = services_.SoundPlayer,
           .Converter = services_.SoundConverter,
           .Awake = services_.Awake,
           .Strings = services_.Strings,
           .ProgramFolder = services_.Places.Program()},
          this)
      .exec();
}

bool frmRx::SelectPlayer() {
  const QModelIndexList selected = ui_->ScoreDisplay->selectionModel()->selectedRows();
  if (selected.isEmpty()) {
    return false;
  }
  const int last = std::max_element(selected.begin(), selected.end())->row();
  selectedPlayer_ = session_.List(BoardList::Players).RowAt(last).Index;
  return true;
}

void frmRx::ShowPopup(const QPoint& position) {
  if (!SelectPlayer()) {
    return;
  }
  ui_->mnuPopup->exec(ui_->ScoreDisplay->viewport()->mapToGlobal(position));
  session_.CalculateScores();
  services_.Events.DoEvents();
}

void frmRx::RunPopupCommand(QAction& item) {
  if (!SelectPlayer()) {
    return;
  }
  item.trigger();
  session_.CalculateScores();
  services_.Events.DoEvents();
}

void frmRx::AssignMember() {
  const std::string contact = ShowMembers(0);
  if (!contact.empty()) {
    session_.Game().Players(selectedPlayer_).MemberIndex = ToInt32(contact);
  }
}

void frmRx::UnassignMember() {
  session_.Game().Players(selectedPlayer_).MemberIndex = 0;
}

std::string frmRx::SelectedPlayerText() {
  const Game& game = session_.Game();
  return PlayerText(selectedPlayer_, session_.List(BoardList::Players), game,
                    BoardTexts(game, services_.Strings));
}

void frmRx::ShowDetailed() {
  PlayerDetails window(selectedPlayer_,
                       {.Game = session_.Game(),
                        .Players = session_.List(BoardList::Players),
                        .Members = session_.Members(),
                        .Strings = services_.Strings},
                       this);
  connect(&window, &PlayerDetails::PlayerShown, this,
          [this](int index) { ui_->ScoreDisplay->SelectKey(index); });
  window.exec();
}

void frmRx::EnterBonusPoints() {
  Player& player = session_.Game().Players(selectedPlayer_);
  BonusPoints window(player.BonusPoints, services_.Boxes, this, SelectedPlayerText());
  window.exec();
  player.BonusPoints = window.Value();
}
