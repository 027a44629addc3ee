// The main window's commands on what the kept games tell of members, and how long games are kept.

#include <optional>
#include <string>

#include "app/StateKeys.h"
#include "app/frmRx.h"
#include "archive/history/MemberHistoryWindow.h"
#include "archive/history/OldGames.h"
#include "archive/history/PrintedRanking.h"
#include "archive/history/RankingWindow.h"
#include "core/data/SettingsTable.h"
#include "core/text/Filled.h"
#include "platform/RuntimeError.h"

void frmRx::ShowMemberHistory() {
  ShowHistoryOf(0, this);
}

void frmRx::ShowHistoryOf(std::int32_t member, QWidget* parent) {
  MemberHistoryWindow(
      {.Archive = [this]() -> Sql& { return archive_->Statements(); },
       .Forgetting = {.Engine = services_.Archives != nullptr ? *services_.Archives : services_.Databases,
                      .Disk = services_.Disk,
                      .DbMembers = session_.DbMembers(),
                      .Strings = services_.Strings,
                      .UserDataFolder = userDataFolder_},
       .Boxes = services_.Boxes,
       .Events = services_.Events,
       .Elapsed = services_.Elapsed,
       .NotToKeep = [this](const GamePersons& persons) { keeping_->ForgetPersons(persons); }},
      member, parent)
      .exec();
}

void frmRx::ShowRankings() {
  RankingWindow({.Archive = [this]() -> Sql& { return archive_->Statements(); },
                 .DbMembers = session_.DbMembers(),
                 .Hides = [this](std::int32_t member) { return hidden_->HidesMember(member); },
                 .Boxes = services_.Boxes,
                 .CommonDialog1 = services_.CommonDialog1,
                 .Disk = services_.Disk,
                 .OtherPrograms = services_.OtherPrograms,
                 .Events = services_.Events,
                 .Strings = services_.Strings,
                 .PrintedPage = PrintedRanking(userDataFolder_)},
                this)
      .exec();
}

void frmRx::DeleteOldGames() {
  const std::optional<int> years = YearsToKeep(ini_->ReadIni(Keys::YearsToKeepGames));
  if (!years) {
    return;
  }
  try {
    const std::string before = YearsBefore(services_.Time.Now(), *years);
    const int games = GamesPlayedBefore(archive_->Statements(), before);
    if (games == 0 || !MayDeleteOldGames(*years, games)) {
      return;
    }
    oldGamesBefore_ = before;
  } catch (const RuntimeError&) {
    // The status line tells of an archive that cannot be used, and the next start tries again.
  }
  DeleteSomeOldGames();
}

bool frmRx::DeleteSomeOldGames() {
  return DeleteSomeGamesBefore(*archive_, oldGamesBefore_);
}

void frmRx::DeleteRankingPage() {
  try {
    DeletePrintedRanking(services_.Disk, userDataFolder_);
  } catch (const RuntimeError&) {
    // Its folder cannot be written, which other commands tell; the next start tries again.
  }
}

bool frmRx::MayDeleteOldGames(int years, int games) {
  const std::string number = std::to_string(years);
  if (state_->ReadIni(State::Archive, State::YearsAnswered, {}) == number) {
    return state_->ReadIni(State::Archive, State::MayDelete, {}) == "1";
  }
  // Where the answer cannot be kept, the question would come at every start.
  if (!state_->WriteIni(State::Archive, {{State::MayDelete, "0"}})) {
    return false;
  }
  const bool isAllowed =
      services_.Boxes.Show(
          Filled(services_.Strings.Text(OwnText::KeepYearsQuestion), {number, std::to_string(games)}),
          DefaultBoxTitle, BoxIcon::Question, BoxButtons::YesNo) == BoxAnswer::Yes;
  return state_->WriteIni(State::Archive,
                          {{State::YearsAnswered, number}, {State::MayDelete, isAllowed ? "1" : "0"}}) &&
         isAllowed;
}
