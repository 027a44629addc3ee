#include "core/game/GameProgress.h"

#include <map>
#include <utility>

#include "core/game/WordDigest.h"

namespace {

void AddPlayer(WordDigest& digester, const Player& player, bool commits) {
  for (const std::int32_t value :
       {player.ShotCount, player.HealCount, player.AmmoAddCount, player.AdminKillCount, player.RespawnCount,
        player.RemainingHealth, player.RemainingClips, player.RemainingAmmo, player.DeathCount,
        player.SecondaryDamage, player.PrimaryDamage, player.RunCounter, player.MemberIndex,
        player.BonusPoints, player.ExplosiveDamage, player.RadiationDamage, player.StunCount,
        std::int32_t{player.PowerCheatFlag}, std::int32_t{commits && player.Committed}}) {
    digester.Add(value);
  }
  digester.Add(player.DallasID);
  for (int shooter = 1; shooter <= PlayerCount; ++shooter) {
    if (const std::int32_t amount = player.HitByPlayer(shooter); amount > 0) {  // a file holds no others
      digester.Add(shooter);
      digester.Add(amount);
    }
  }
}

}  // namespace

std::uint64_t InputsDigest(const Game& game, const std::string& missionName, bool commits) {
  WordDigest digester;
  digester.Add(missionName);
  digester.Add(game.GameDate);
  for (const ObjectiveTeam& team : game.ObjectiveTeams) {
    digester.Add(team.Name);
    digester.Add(std::int32_t{team.PrimaryAchieved});
    digester.Add(std::int32_t{team.SecondaryAchieved});
  }
  for (int index = 1; index <= PlayerCount; ++index) {
    if (const Player& player = game.Players(index); player.Active) {
      digester.Add(index);
      AddPlayer(digester, player, commits);
    }
  }
  return digester.Value();
}

CommitCount CountCommits(const Game& game) {
  CommitCount count;
  for (const Player& player : game.Players) {
    if (player.Active && (player.MemberIndex != 0 || player.Committed)) {
      ++count.Of;
      count.Done += player.Committed ? 1 : 0;
    }
  }
  return count;
}

std::vector<std::vector<int>> SharedMembers(const Game& game) {
  std::map<std::int32_t, std::vector<int>> guns;  // by member
  for (int index = 1; index <= PlayerCount; ++index) {
    if (const Player& player = game.Players(index); player.Active && player.MemberIndex != 0) {
      guns[player.MemberIndex].push_back(index);
    }
  }
  std::vector<std::vector<int>> shared;
  for (auto& [member, records] : guns) {
    if (records.size() > 1) {
      shared.push_back(std::move(records));
    }
  }
  return shared;
}

GameProgress::GameProgress(Session& session, const Clock& time)
    : session_(session),
      time_(time),
      missionName_(session.Missions().Text()),
      subscription_(session.Listen([this](SessionChange change) { Hear(change); })) {}

bool GameProgress::Unsaved() const {
  return session_.Game().DataPresent && (!hasFile_ || Digest(true) != inFile_);
}

std::string GameProgress::Received() const {
  return received_.empty() ? time_.Now() : received_;
}

bool GameProgress::IsDone(GameStep step) const {
  if (step == GameStep::Clear) {
    return cleared_;
  }
  if (!session_.Game().DataPresent) {
    return false;
  }
  switch (step) {
    case GameStep::Results:
      return resultsEntered_;
    case GameStep::Print:
      return printed_ == Digest(false);
    case GameStep::Commit: {
      const CommitCount commits = CountCommits(session_.Game());
      return commits.Of > 0 && commits.Done == commits.Of;
    }
    default:
      return !Unsaved();
  }
}

void GameProgress::Printed() {
  printed_ = Digest(false);
}

void GameProgress::Hear(SessionChange change) {
  switch (change) {
    case SessionChange::Cleared:
      Reset();
      break;
    case SessionChange::Mission:
      HearMission();
      break;
    case SessionChange::Loaded:
      loading_ = true;
      [[fallthrough]];
    case SessionChange::Saved:
      hasFile_ = true;
      inFile_ = Digest(true);
      break;
    case SessionChange::Scores:
      HearScores();
      break;
    default:
      break;
  }
}

void GameProgress::Reset() {
  cleared_ = cleared_ || !gameDate_.empty() || !received_.empty() || hasFile_;
  pending_.reset();
  mission_.reset();
  lowestFirst_ = false;
  hasFile_ = false;
  loading_ = false;
  printed_.reset();
  resultsEntered_ = false;
  gameDate_.clear();
  received_.clear();
}

// Told a second time with the mission before when the choice is taken back.
void GameProgress::HearMission() {
  const std::string chosen = session_.Missions().Text();
  const std::string before = std::exchange(missionName_, chosen);
  if (pending_ && pending_->From == chosen) {
    pending_.reset();
  } else if (chosen != before) {
    resultsEntered_ = false;
    if (session_.Game().DataPresent) {
      pending_ = PendingChange{before, ScoresNow()};
    }
  }
}

void GameProgress::HearScores() {
  lowestFirst_ = session_.List(BoardList::Players).SortOrder == SortOrder::Ascending;
  if (!session_.Game().DataPresent) {
    return;
  }
  cleared_ = false;
  if (received_.empty() || gameDate_ != session_.Game().GameDate) {
    gameDate_ = session_.Game().GameDate;
    received_ = time_.Now();
  }
  if (std::exchange(loading_, false)) {
    inFile_ = Digest(true);  // members that were found by their buttons are no change of the operator's
  }
  if (pending_) {
    const Scores now = ScoresNow();
    mission_ = MissionChange{pending_->From, missionName_, 0};
    for (std::size_t i = 0; i < now.size(); ++i) {
      mission_->Rescored += now[i] != pending_->Before[i] ? 1 : 0;
    }
    pending_.reset();
  }
}

GameProgress::Scores GameProgress::ScoresNow() const {
  Scores scores{};
  for (int index = 1; index <= PlayerCount; ++index) {
    const Player& player = session_.Game().Players(index);
    scores[static_cast<std::size_t>(index - 1)] = player.Active ? player.Soldiering : 0;
  }
  return scores;
}

std::uint64_t GameProgress::Digest(bool commits) const {
  return InputsDigest(session_.Game(), session_.Missions().Text(), commits);
}
