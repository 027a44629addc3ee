#include "core/game/GameProgress.h"

#include <gmock/gmock.h>

#include <functional>
#include <optional>

#include "platform/RuntimeError.h"
#include "tests/core/game/HeardSession.h"
#include "tests/support/TestDatabase.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

constexpr int Keep = 3;  ///< entry of the mission that deducts 4 points for a respawn

class Progress : public Sessions {
 protected:
  Progress() {
    AddMissions();
    AddMember();
    Start();
    progress.emplace(session, venue.Time);
  }

  /// A game comes in: Red 0 with 5 points and a respawn, Blue 7 with 9.
  void Pull() {
    venue.Play(Red0, 5).RespawnCount = 1;
    venue.Play(Blue7, 9);
    session.Game().GameDate = "21/05/2013 14:30";
    session.CalculateScores();
  }

  void Save() {
    session.SaveGame([](const Game&, const std::string&) { return true; });
  }

  bool Load() {
    bool read = false;
    session.LoadGame([&](Game& game, const Session::MissionChoice&) {
      game.Players(Red0).Active = true;
      game.Players(Red0).DallasID = "AB00000000000001";
      return read = true;
    });
    return read;
  }

  std::vector<GameStep> Done() const {
    std::vector<GameStep> done;
    for (int step = 0; step < GameStepCount; ++step) {
      if (progress->IsDone(static_cast<GameStep>(step))) {
        done.push_back(static_cast<GameStep>(step));
      }
    }
    return done;
  }

  std::optional<GameProgress> progress;
};

TEST_F(Progress, IsUnsavedFromThePullToTheSave) {
  EXPECT_FALSE(progress->Unsaved());
  Pull();
  EXPECT_TRUE(progress->Unsaved());
  EXPECT_FALSE(progress->HasFile());
  Save();
  EXPECT_FALSE(progress->Unsaved());
  EXPECT_TRUE(progress->HasFile());
}

TEST_F(Progress, IsUnsavedAgainAfterEachChangeOfTheGame) {
  Pull();
  Player& player = session.Game().Players(Red0);
  const std::vector<std::function<void()>> changes = {
      [&] { player.BonusPoints = 6; },
      [&] { player.MemberIndex = 7; },
      [&] { player.Committed = true; },
      [&] { player.HitByPlayer(Blue7) = 10; },
      [&] { player.DallasID = "AB00000000000001"; },
      [&] { ++player.ShotCount; },
      [&] { venue.Play(Blue7 + 1, 0); },
      [&] { session.Game().ObjectiveTeams(2).SecondaryAchieved = true; },
      [&] { session.SelectMission(Keep); },
      [&] { session.Game().GameDate = "later"; },
  };
  for (std::size_t i = 0; i < changes.size(); ++i) {
    Save();
    ASSERT_FALSE(progress->Unsaved()) << i;
    changes[i]();
    EXPECT_TRUE(progress->Unsaved()) << i;
  }
}

TEST_F(Progress, IsNotUnsavedByWhatACalculationWorksOut) {
  Pull();
  Save();
  session.Factors().Death = 100;
  session.CalculateScores();
  session.SortByHeader(1);
  EXPECT_FALSE(progress->Unsaved());
}

TEST_F(Progress, IsSavedWhenAGameIsLoadedThoughMembersAreFound) {
  ASSERT_TRUE(Load());
  ASSERT_EQ(session.Game().Players(Red0).MemberIndex, 7);
  EXPECT_FALSE(progress->Unsaved());
  EXPECT_TRUE(progress->HasFile());
  session.Game().Players(Red0).BonusPoints = 1;
  EXPECT_TRUE(progress->Unsaved());
}

TEST_F(Progress, BeginsAnewWhenTheGameIsCleared) {
  Pull();
  Save();
  session.ClearPlayerData();
  EXPECT_FALSE(progress->HasFile());
  Pull();
  EXPECT_TRUE(progress->Unsaved());
}

TEST_F(Progress, KnowsWhenTheGameCameIn) {
  EXPECT_EQ(progress->Received(), "2013-05-21 14:30:05");
  venue.Time.DateAndTime = "2026-11-21 20:15:00";
  Pull();
  venue.Time.DateAndTime = "2026-11-21 22:40:00";
  session.CalculateScores();
  EXPECT_EQ(progress->Received(), "2026-11-21 20:15:00");
  session.Game().GameDate = "21/11/2026 22:41";
  session.CalculateScores();
  EXPECT_EQ(progress->Received(), "2026-11-21 22:40:00");
  session.ClearPlayerData();
  venue.Time.DateAndTime = "2026-11-21 23:00:00";
  EXPECT_EQ(progress->Received(), "2026-11-21 23:00:00");
}

TEST_F(Progress, CountsThePlayersThatAChoiceOfAMissionRescored) {
  session.SelectMission(Keep);
  EXPECT_FALSE(progress->Mission()) << "there was no game";
  Pull();
  EXPECT_FALSE(progress->Mission());
  session.SelectMission(MissionList::None);
  ASSERT_TRUE(progress->Mission());
  EXPECT_EQ(progress->Mission()->From, "Keep");
  EXPECT_EQ(progress->Mission()->To, "None");
  EXPECT_EQ(progress->Mission()->Rescored, 1) << "only Red 0 respawned";
  session.SelectMission(MissionList::None);
  EXPECT_EQ(progress->Mission()->From, "Keep") << "nothing has changed since";
  session.ClearPlayerData();
  EXPECT_FALSE(progress->Mission());
}

TEST_F(Progress, TellsOfNoMissionWhoseChoiceWasTakenBack) {
  Pull();
  {
    OtherConnection other(venue.ScenariosFile());
    other.Execute("BEGIN EXCLUSIVE");
    EXPECT_THROW(session.SelectMission(Keep), RuntimeError);
  }
  session.CalculateScores();
  EXPECT_FALSE(progress->Mission());
}

TEST_F(Progress, NoticesTheOrderInWhichTheLastCalculationRanked) {
  Pull();
  session.SortByHeader(2);
  EXPECT_FALSE(progress->LowestFirst()) << "the places are still those of before";
  session.CalculateScores();
  EXPECT_TRUE(progress->LowestFirst());
  session.SortByHeader(3);
  EXPECT_TRUE(progress->LowestFirst());
  session.CalculateScores();
  EXPECT_FALSE(progress->LowestFirst());
}

TEST_F(Progress, TicksEachStepOnceItIsDone) {
  EXPECT_THAT(Done(), IsEmpty());
  Pull();
  EXPECT_THAT(Done(), IsEmpty());
  session.Game().Players(Red0).MemberIndex = 7;
  progress->ResultsEntered();
  progress->Printed();
  session.CommitGame();
  EXPECT_THAT(Done(), ElementsAre(GameStep::Results, GameStep::Print, GameStep::Commit));
  Save();
  EXPECT_THAT(Done(), ElementsAre(GameStep::Results, GameStep::Print, GameStep::Commit, GameStep::Save));
  session.ClearPlayerData();
  EXPECT_THAT(Done(), ElementsAre(GameStep::Clear));
  Pull();
  EXPECT_THAT(Done(), IsEmpty());
}

TEST_F(Progress, TakesTicksBackThatNoLongerHold) {
  Pull();
  session.Game().Players(Red0).MemberIndex = 7;
  progress->ResultsEntered();
  progress->Printed();
  session.CommitGame();
  Save();
  session.Game().Players(Blue7).MemberIndex = 7;
  EXPECT_THAT(Done(), ElementsAre(GameStep::Results));
  session.SelectMission(Keep);
  EXPECT_THAT(Done(), IsEmpty());
}

TEST_F(Progress, DoesNotTickResultsThatWereEnteredForAnotherMissionBeforeTheGame) {
  session.SelectMission(Keep);
  progress->ResultsEntered();
  session.SelectMission(MissionList::None);
  Pull();
  EXPECT_THAT(Done(), IsEmpty());
}

TEST(SharedMembers, AreThoseWithSeveralGuns) {
  const StringTable strings(Language::English);
  Game game(strings);
  for (const auto& [index, member] : {std::pair{3, 7}, {9, 0}, {40, 8}, {70, 7}, {90, 0}, {91, 9}}) {
    game.Players(index).Active = true;
    game.Players(index).MemberIndex = member;
  }
  game.Players(100).MemberIndex = 8;  // took no part
  EXPECT_THAT(SharedMembers(game), ElementsAre(ElementsAre(3, 70)));
}

TEST(CommitCounts, AreOfMembersOnly) {
  const StringTable strings(Language::English);
  Game game(strings);
  EXPECT_EQ(CountCommits(game).Of, 0);
  for (const int index : {1, 2, 3}) {
    game.Players(index).Active = true;
  }
  game.Players(1).MemberIndex = 7;
  game.Players(2).Committed = true;  // its member was taken away afterwards
  game.Players(4).MemberIndex = 9;   // took no part
  EXPECT_EQ(CountCommits(game).Of, 2);
  EXPECT_EQ(CountCommits(game).Done, 1);
}

}  // namespace
