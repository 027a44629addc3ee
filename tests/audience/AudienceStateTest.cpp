#include "audience/AudienceState.h"

#include <gtest/gtest.h>

namespace {

class Audience : public testing::Test {
 protected:
  Audience() { state.TurnOn(); }

  /// The next game is on the operator's board: one player with that many points.
  void Play(std::int32_t points) {
    game = {};
    game.Players.push_back({.Place = 1, .Index = 1, .Team = 1, .Soldiering = points});
  }

  void Pull(std::int32_t points) {
    state.BeginPull();
    Play(points);
    state.EndPull(true);
    state.TellScored();
  }

  std::int32_t Shown() const {
    return state.Results().IsEmpty() ? -1 : state.Results().Players.front().Soldiering;
  }

  AudienceResults game;
  int changes = 0;
  int made = 0;
  AudienceState state{[this] {
                        ++made;
                        return game;
                      },
                      [this] { ++changes; }};
};

TEST_F(Audience, SeesTheVenueAtFirst) {
  EXPECT_EQ(state.View(), AudienceView::Idle);
}

TEST_F(Audience, SeesAPullComeIn) {
  state.BeginPull();
  EXPECT_EQ(state.View(), AudienceView::Incoming);
  state.TellReceived(3, 12);
  EXPECT_EQ(state.Received(), 3);
  EXPECT_EQ(state.Expected(), 12);
  EXPECT_EQ(changes, 2);
  state.EndPull(false);
  EXPECT_EQ(state.View(), AudienceView::Idle);
  EXPECT_EQ(changes, 3);
}

TEST_F(Audience, SeesAPullThatBeginsWithItsFirstCount) {
  state.TellReceived(0, 3);
  EXPECT_EQ(state.View(), AudienceView::Incoming);
  EXPECT_EQ(state.Expected(), 3);
  state.EndPull(false);
  EXPECT_EQ(state.View(), AudienceView::Idle);
  state.BeginPull();
  EXPECT_EQ(state.Expected(), 0);
}

TEST_F(Audience, SeesResultsByThemselvesOnlyWhereTheBoardFollows) {
  Pull(7);
  EXPECT_EQ(state.View(), AudienceView::Idle);
  state.SetFollows(true);
  Pull(8);
  EXPECT_EQ(state.View(), AudienceView::Results);
  EXPECT_EQ(Shown(), 8);
}

TEST_F(Audience, SeesScoresComeInUntilTheyAreMade) {
  state.SetFollows(true);
  state.BeginPull();
  Play(8);
  state.EndPull(true);
  EXPECT_EQ(state.View(), AudienceView::Incoming);
  state.TellScored();
  EXPECT_EQ(state.View(), AudienceView::Results);
  state.ShowIdle();
  state.BeginPull();
  state.EndPull(true);
  state.ForgetGame();
  EXPECT_EQ(state.View(), AudienceView::Idle);
}

TEST_F(Audience, SeesResultsOnCommand) {
  state.ShowResults();
  EXPECT_EQ(state.View(), AudienceView::Idle);
  Pull(7);
  state.ShowResults();
  EXPECT_EQ(state.View(), AudienceView::Results);
  EXPECT_EQ(Shown(), 7);
}

TEST_F(Audience, KeepsResultsWhileTheNextGameIsPulledAndAfterAClear) {
  Pull(7);
  state.ShowResults();
  const int before = changes;
  game = {};
  state.ForgetGame();
  state.TellScored();
  state.BeginPull();
  state.TellReceived(1, 2);
  EXPECT_EQ(state.View(), AudienceView::Results);
  EXPECT_EQ(Shown(), 7);
  Play(9);
  state.EndPull(true);
  state.TellScored();
  EXPECT_EQ(Shown(), 7);
  EXPECT_EQ(changes, before);
}

TEST_F(Audience, SeesNewFiguresOfTheGameThatIsShownOnceTheyAreScored) {
  Pull(7);
  state.ShowResults();
  Play(12);
  EXPECT_EQ(Shown(), 7);
  state.TellScored();
  EXPECT_EQ(Shown(), 12);
}

TEST_F(Audience, DoesNotSeeHalfOfAPull) {
  Pull(7);
  state.ShowResults();
  state.ShowIdle();
  state.BeginPull();
  Play(1);
  state.ShowResults();
  EXPECT_EQ(state.View(), AudienceView::Results);
  EXPECT_EQ(Shown(), 7);
}

TEST_F(Audience, DoesNotSeeAnOldGameThatTheOperatorOpens) {
  state.SetFollows(true);
  Pull(7);
  state.ForgetGame();
  Play(99);
  state.TellScored();
  EXPECT_EQ(Shown(), 7);
  state.ShowResults();
  EXPECT_EQ(Shown(), 99);
}

TEST_F(Audience, SeesNothingOfAFailedPull) {
  state.SetFollows(true);
  Pull(7);
  state.BeginPull();
  state.EndPull(false);
  EXPECT_EQ(state.View(), AudienceView::Results);
  EXPECT_EQ(Shown(), 7);
}

TEST_F(Audience, SeesNothingUntilTheOperatorEndsBlank) {
  state.SetFollows(true);
  state.ShowBlank();
  Pull(7);
  EXPECT_EQ(state.View(), AudienceView::Blank);
  state.ShowResults();
  EXPECT_EQ(Shown(), 7);
  EXPECT_EQ(state.View(), AudienceView::Results);
}

TEST_F(Audience, SeesTheVenueUntilTheNextPullOnceTheOperatorShowsIt) {
  state.SetFollows(true);
  Pull(7);
  state.ShowIdle();
  state.TellScored();
  EXPECT_EQ(state.View(), AudienceView::Idle);
  Pull(8);
  EXPECT_EQ(state.View(), AudienceView::Results);
}

TEST_F(Audience, GetsNothingMadeWhileTheBoardIsOff) {
  state.SetFollows(true);
  state.TurnOff();
  Pull(7);
  EXPECT_EQ(made, 0);
  state.TurnOn();
  EXPECT_EQ(Shown(), 7);
  EXPECT_EQ(state.View(), AudienceView::Results);
}

TEST(AudienceTurns, ShowPageAfterPage) {
  EXPECT_EQ(TurnCount(1, false), 1);
  EXPECT_EQ(TurnCount(3, false), 3);
  for (int turn = 0; turn < 6; ++turn) {
    EXPECT_EQ(TurnOf(turn, 3, false).View, AudienceView::Results);
    EXPECT_EQ(TurnOf(turn, 3, false).Page, turn % 3);
  }
}

TEST(AudienceTurns, ShowTheAddressAtEveryFourth) {
  for (const int pages : {1, 2, 3, 5, 7}) {
    const int turns = TurnCount(pages, true);
    std::vector<int> shown(static_cast<std::size_t>(pages), 0);
    int addresses = 0;
    int next = 0;
    for (int turn = 0; turn < turns; ++turn) {
      const AudienceTurn what = TurnOf(turn, pages, true);
      EXPECT_EQ(what.View == AudienceView::Phone, turn % 4 == 3);
      if (what.View == AudienceView::Phone) {
        ++addresses;
        continue;
      }
      EXPECT_EQ(what.Page, next % pages);
      ++next;
      ++shown.at(static_cast<std::size_t>(what.Page));
    }
    EXPECT_EQ(addresses * 4, turns);
    EXPECT_EQ(TurnOf(turns, pages, true).Page, TurnOf(0, pages, true).Page);
    for (const int times : shown) {
      EXPECT_EQ(times, shown.front()) << pages;
    }
  }
}

}  // namespace
