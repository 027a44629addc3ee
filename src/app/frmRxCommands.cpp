// The commands of the menus, each one the handler of its item.

#include "app/frmRx.h"

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
#include "core/game/CommitGame.h"
#include "core/game/PlayerId.h"
#include "core/text/NumberForms.h"
#include "devices/baseunit/BaseUnitDownload.h"
#include "devices/radio/RemoteManage.h"
#include "members/MemberQueries.h"
#include "members/Members.h"
#include "missions/Scenarios.h"
#include "settings/Settings.h"
#include "settings/SoldieringCalc.h"
#include "sheets/ScoreSheets.h"
#include "sheets/SheetProgressWindow.h"
#include "ui/WaitCursor.h"
#include "ui_frmRx.h"

void frmRx::LoadGame() {
  if (!gameFile_.AskForGame()) {
    return;
  }
  const WaitCursor cursor;
  ClearPlayerData();
  const auto selectMission = [this](const std::string& name) {
    for (int index = 0; index < ui_->ActiveMission->count(); ++index) {
      if (missions_->Items()[static_cast<std::size_t>(index)].Text == name) {
        SelectMission(index);
      }
    }
  };
  if (gameFile_.LoadGame(game_, selectMission)) {
    game_.DataPresent = true;
    CalculateScores();
  }
}

void frmRx::SaveGame() {
  gameFile_.SaveGame(game_, missions_->Text());
}

void frmRx::ClearGame() {
  const BoxAnswer answer = services_.Boxes.Show(services_.Strings.Text(123), services_.Strings.Text(124),
                                                BoxIcon::Question, BoxButtons::OkCancel);
  if (answer == BoxAnswer::Ok) {
    ClearPlayerData();
  }
}

void frmRx::GetScoreData() {
  {
    UploadProgress progress(services_.Strings, this);
    BaseUnitDownload(services_.MSComm1, *commPort_, services_.Events, services_.Boxes, services_.Time,
                     progress, game_)
        .GetScores();
  }
  CalculateScores();
}

void frmRx::FollowWordProcessor() {
  try {
    if (!std::exchange(wordProcessorStarted_, true)) {
      services_.WordProcessor.Start();
    }
    switch (services_.WordProcessor.State()) {
      case WordState::Starting:
        return;
      case WordState::Ready:
        wordProcessorTimer_.stop();
        return;
      case WordState::Ended:
        break;
    }
  } catch (const RuntimeError&) {
    // Told below, like a word processor that ends while it starts.
  }
  wordProcessorTimer_.stop();
  ui_->mnuPrintScores->setEnabled(false);
  services_.Boxes.Show(services_.Strings.Text(117), services_.Strings.Text(118), BoxIcon::Exclamation);
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
  const SheetParts parts{.Board = game_,
                         .RsMembers = *rsMembers_,
                         .Members = *members_,
                         .Strings = services_.Strings,
                         .Time = services_.Time,
                         .Events = services_.Events,
                         .Disk = services_.Disk,
                         .Boxes = services_.Boxes,
                         .WordApp = services_.WordProcessor,
                         .Progress = progress,
                         .UserDataFolder = userDataFolder_,
                         .MissionName = missions_->Text()};
  ScoreSheets(parts, printOptions_->Choice()).GenerateScoreSheets();
}

void frmRx::ShowCommPortSettings() {
  Settings(*ini_, services_.Devices, services_.Boxes, services_.Strings, this).exec();
}

void frmRx::ShowSoldieringCalc() {
  SoldieringCalc(factors_, services_.Strings, this).exec();
  WriteSoldieringFactors(*ini_, factors_);
  CalculateScoresWhenPresent();
}

void frmRx::ShowAbout() {
  About(this).exec();
}

void frmRx::CommitGame() {
  CommitResult result;
  {
    const WaitCursor cursor;
    result = CommitPlayers(game_, *dbMembers_, *rsMembers_, *members_, services_.Time);
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
  const auto found = dbMembers_->OpenRecordset(ButtonQuery(dallasId));
  if (found->Eof()) {
    services_.Boxes.Show("Button is not assigned to a member", DefaultBoxTitle, BoxIcon::Information);
  } else {
    ShowMembers(RoundToInt32(NumberOf(found->Fields("ContactID"))));
  }
}

std::string frmRx::ShowMembers(std::int32_t contactToShow) {
  Members window({.DbMembers = *dbMembers_,
                  .Boxes = services_.Boxes,
                  .CommonDialog1 = services_.CommonDialog1,
                  .Disk = services_.Disk,
                  .Time = services_.Time,
                  .Strings = services_.Strings,
                  .ButtonSwipe = services_.ButtonSwipe},
                 this);
  window.ContactToShow = contactToShow;
  window.exec();
  return window.SelectedContact;
}

void frmRx::ShowAdminData() {
  AdminData(game_, services_.Strings, this).exec();
}

void frmRx::EnterMissionResults() {
  MissionResultEntry(game_, *missions_, services_.Strings, this).exec();
  CalculateScoresWhenPresent();
}

void frmRx::SetUpMissions() {
  Scenarios(*dbScenarios_, *rsScenarios_, services_.Boxes, services_.Strings, this).exec();
  rsScenarios_->MoveFirst();
  FillMissionList();
}

void frmRx::ManageRemotely() {
  RemoteManage({.MSComm1 = services_.MSComm1,
                .Port = *commPort_,
                .Events = services_.Events,
                .Boxes = services_.Boxes,
                .Time = services_.Time,
                .Strings = services_.Strings,
                .Scores = game_},
               this)
      .exec();
  CalculateScores();
}

void frmRx::ShowPopup(const QPoint& position) {
  const QModelIndexList selected = ui_->ScoreDisplay->selectionModel()->selectedRows();
  if (selected.isEmpty()) {
    return;
  }
  const int last = std::max_element(selected.begin(), selected.end())->row();
  selectedPlayer_ = IndexFromPlayerText(services_.Strings, scoreDisplay_.RowAt(last).Cells[1]);
  ui_->mnuPopup->exec(ui_->ScoreDisplay->viewport()->mapToGlobal(position));
  CalculateScores();
  services_.Events.DoEvents();
}

void frmRx::AssignMember() {
  const std::string contact = ShowMembers(0);
  if (!contact.empty()) {
    game_.Players(selectedPlayer_).MemberIndex = ToInt32(contact);
  }
}

void frmRx::UnassignMember() {
  game_.Players(selectedPlayer_).MemberIndex = 0;
}

void frmRx::ShowDetailed() {
  PlayerDetails(selectedPlayer_, game_, *members_, this).exec();
}

void frmRx::EnterBonusPoints() {
  Player& player = game_.Players(selectedPlayer_);
  BonusPoints window(player.BonusPoints, services_.Boxes, this);
  window.exec();
  player.BonusPoints = window.Value();
}
