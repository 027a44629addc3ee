#include "core/game/Session.h"

#include <algorithm>
#include <utility>

#include "core/data/FieldValue.h"
#include "core/data/UserDatabase.h"
#include "core/text/Pieces.h"
#include "platform/RuntimeError.h"

Session::Session(const StringTable& strings, const Clock& time, MessageBoxes& boxes)
    : strings_(strings), time_(time), boxes_(boxes), game_(strings) {}

Subscription Session::Listen(std::function<void(SessionChange)> listener) {
  return listeners_.Listen(std::move(listener));
}

std::unique_ptr<Database> Session::OpenDatabase(const std::string& name, const std::string& table) {
  return OpenUserDatabase({sources_->UserDataFolder + "/" + name + ".mdb", table,
                           sources_->ProgramFolder + "/" + name + "_default.mdb"},
                          {.Engine = sources_->Engine,
                           .Old = sources_->Old,
                           .Disk = sources_->Disk,
                           .Boxes = boxes_,
                           .Copies = *backups_,
                           .Strings = strings_});
}

bool Session::Open(const Sources& sources) {
  sources_.emplace(sources);
  backups_.emplace(sources.UserDataFolder + "/backups", sources.Disk, time_, strings_);
  dbScenarios_ = OpenDatabase("scenarios", "Table1");
  if (!dbScenarios_) {
    return false;
  }
  rsScenarios_ = dbScenarios_->OpenRecordset("Table1");
  missions_.emplace(*rsScenarios_, strings_, unlockingBoxes_);
  FillMissionList();
  rsScenarios_->MoveFirst();
  dbMembers_ = OpenDatabase("members", "Members");
  if (!dbMembers_) {
    return false;
  }
  rsMembers_ = dbMembers_->OpenRecordset("Members");
  members_.emplace(*rsMembers_, unlockingBoxes_);
  analysis_.emplace(game_, factors_, *missions_, *members_, players_, teams_);
  return true;
}

void Session::Close() {
  if (missions_ && !missions_->Items().empty()) {
    chosen_ = missions_->Items()[static_cast<std::size_t>(missions_->ListIndex())];
  }
  analysis_.reset();
  members_.reset();
  missions_.reset();
  rsScenarios_.reset();
  rsMembers_.reset();
  dbScenarios_.reset();
  dbMembers_.reset();
}

void Session::Reopen() {
  std::unique_ptr<Database> dbScenarios = OpenDatabase("scenarios", "Table1");
  std::unique_ptr<Database> dbMembers = dbScenarios ? OpenDatabase("members", "Members") : nullptr;
  if (!dbMembers) {
    throw RuntimeError(Fault::UnrecognizedDatabase);
  }
  std::unique_ptr<Recordset> rsScenarios = dbScenarios->OpenRecordset("Table1");
  std::unique_ptr<Recordset> rsMembers = dbMembers->OpenRecordset("Members");
  MissionList missions(*rsScenarios, strings_, unlockingBoxes_);
  {
    const ReadScope scope(*dbScenarios);
    missions.FillMissionList();
  }
  rsScenarios->MoveFirst();

  Close();
  missions.Select(ChosenIn(missions));
  dbScenarios_ = std::move(dbScenarios);
  rsScenarios_ = std::move(rsScenarios);
  missions_.emplace(std::move(missions));
  dbMembers_ = std::move(dbMembers);
  rsMembers_ = std::move(rsMembers);
  members_.emplace(*rsMembers_, unlockingBoxes_);
  analysis_.emplace(game_, factors_, *missions_, *members_, players_, teams_);
  listeners_.Tell(SessionChange::Missions);
  SelectMission(missions_->ListIndex());
}

int Session::ChosenIn(const MissionList& missions) const {
  const std::vector<MissionList::Item>& items = missions.Items();
  const auto isSame = [this](const MissionList::Item& item) {
    return item.Id == chosen_.Id && item.Text == chosen_.Text;
  };
  auto found = std::find_if(items.begin(), items.end(), isSame);
  if (found == items.end()) {
    found = std::find_if(items.begin(), items.end(),
                         [this](const MissionList::Item& item) { return item.Text == chosen_.Text; });
  }
  return found == items.end() ? MissionList::None : static_cast<int>(found - items.begin());
}

bool Session::BackUpMembers(const KeepOn& keepOn) {
  return backups_->CopyNow(*dbMembers_, sources_->UserDataFolder + "/members.mdb", keepOn);
}

std::string Session::TakeBackupFailure() {
  return backups_ ? backups_->TakeFailure() : std::string();
}

void Session::CalculateScores() {
  bool complete = false;
  {
    const CalculationReads reads(*dbMembers_, *dbScenarios_, unlockingBoxes_);
    complete = analysis_->CalculateScores();
  }
  if (complete) {
    listeners_.Tell(SessionChange::Scores);
  }
}

::Game Session::ScoredCopy() {
  ::Game copy = game_;
  Board players([] {});
  Board teams([] {});
  const SilencedBoxes silence(unlockingBoxes_);
  const CalculationReads reads(*dbMembers_, *dbScenarios_, unlockingBoxes_);
  ScoreAnalysis(copy, factors_, *missions_, *members_, players, teams).CalculateScores();
  return copy;
}

void Session::CalculateScoresWhenPresent() {
  if (game_.DataPresent && analysis_) {
    CalculateScores();
  }
}

void Session::ClearPlayerData() {
  if (BeforeClear) {
    BeforeClear();
  }
  players_.Clear();
  teams_.Clear();
  game_.Clear();
  listeners_.Tell(SessionChange::Cleared);
}

void Session::SortByHeader(int header) {
  ::SortByHeader(players_, header, game_);
}

void Session::FillMissionList() {
  {
    const ReadScope scope(*dbScenarios_);
    missions_->FillMissionList();
  }
  listeners_.Tell(SessionChange::Missions);
  SelectMission(missions_->ListIndex());
}

void Session::SelectMission(int index) {
  const int before = missions_->ListIndex();
  missions_->Select(index);
  listeners_.Tell(SessionChange::Mission);
  try {
    LookUpMission();
  } catch (const RuntimeError&) {
    missions_->Select(before);  // whose scores are on the board
    listeners_.Tell(SessionChange::Mission);
    throw;
  }
  listeners_.Tell(SessionChange::MissionRow);
  CalculateScoresWhenPresent();
}

void Session::LookUpMission() {
  const bool isActive = missions_->ActivateCurrentMissionRecord();
  std::string description;
  if (isActive) {
    description = FirstLineOf(TextOf(missions_->Row().Fields("MissionDescription")));
  }
  missionIsActive_ = isActive;
  missionDescription_ = std::move(description);
}

void Session::ChooseMission(const std::string& name) {
  for (int index = 0; index < static_cast<int>(missions_->Items().size()); ++index) {
    if (missions_->Items()[static_cast<std::size_t>(index)].Text == name) {
      SelectMission(index);
    }
  }
}

void Session::LoadGame(const GameReader& read) {
  ClearPlayerData();
  if (read(game_, [this](const std::string& name) { ChooseMission(name); })) {
    game_.DataPresent = true;
    listeners_.Tell(SessionChange::Loaded);
    CalculateScores();
  }
}

void Session::SaveGame(const GameWriter& write) {
  if (write(game_, missions_->Text())) {
    listeners_.Tell(SessionChange::Saved);
  }
}

CommitResult Session::CommitGame() {
  const CommitResult result = CommitPlayers(game_, *dbMembers_, *rsMembers_, *members_, time_);
  listeners_.Tell(SessionChange::Committed);
  return result;
}
