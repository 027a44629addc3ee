#include "web/EveningGames.h"

#include <gmock/gmock.h>

#include "core/game/PlayerId.h"
#include "tests/web/Games.h"

namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;

class Evening : public testing::Test {
 protected:
  Player& Play(int gun, int shots) {
    Player& player = game.Players(gun);
    player.Active = true;
    player.ShotCount = shots;
    return player;
  }

  EveningGames::Scored Scored(std::chrono::microseconds played) const {
    return {.Game = game,
            .Time = "20:15",
            .Played = played,
            .OfMembers = [](std::int32_t id) { return id == 12 ? "Mole" : ""; },
            .OfGuests = [this](int index) { return index == Red0 ? guest : std::string(); }};
  }
  bool Take(std::chrono::microseconds played = 1h) { return games.Take(Scored(played)); }
  int TakeEarlier() { return games.TakeEarlier(Scored(1h)); }

  void Clear() {
    games.ForgetBoard();
    game.Clear();
  }

  std::vector<int> Numbers() {
    std::vector<int> numbers;
    for (const auto& [number, each] : games.All()) {
      numbers.push_back(number);
    }
    return numbers;
  }

  StringTable strings{Language::English};
  Game game{strings};
  EveningGames games;
  std::string guest;
};

TEST_F(Evening, NumbersItsGamesAsTheyCome) {
  Play(Red0, 10);
  EXPECT_TRUE(Take());
  EXPECT_EQ(games.OnBoard(), 1);
  Clear();
  EXPECT_EQ(games.OnBoard(), 0);
  Play(Red0, 20);
  Take();
  EXPECT_THAT(Numbers(), ElementsAre(1, 2));
  EXPECT_EQ(games.All().at(2).Figures.Number, 2);
  EXPECT_EQ(games.All().at(2).Figures.Time, "20:15");
}

TEST_F(Evening, BeginsWithTheGamesThatWereKept) {
  Play(Red0, 10);
  EXPECT_EQ(TakeEarlier(), 1);
  Play(Red0, 20);
  EXPECT_EQ(TakeEarlier(), 2);
  EXPECT_EQ(games.OnBoard(), 0);
  EXPECT_TRUE(games.All().at(2).IsPublic);
  Play(Red0, 30);
  Take();
  EXPECT_EQ(games.OnBoard(), 3);
  EXPECT_FALSE(games.All().at(3).IsPublic);
}

TEST_F(Evening, KnowsAGameThatWasKept) {
  Play(Red0, 10);
  TakeEarlier();
  EXPECT_EQ(TakeEarlier(), 1);
  Play(Blue7, 5);
  Take();
  EXPECT_EQ(games.OnBoard(), 1);
  EXPECT_THAT(Numbers(), ElementsAre(1));
}

TEST_F(Evening, HasNoKeptGameWithoutPlayers) {
  EXPECT_EQ(TakeEarlier(), 0);
  EXPECT_TRUE(games.All().empty());
}

TEST_F(Evening, HasNoGameWithoutPlayers) {
  EXPECT_FALSE(Take());
  EXPECT_TRUE(games.All().empty());
}

TEST_F(Evening, RenewsTheGameOnTheBoard) {
  Play(Red0, 10);
  Take();
  EXPECT_FALSE(Take());
  Play(Red0, 11);
  Play(Blue7, 5);
  EXPECT_TRUE(Take(2h));
  EXPECT_THAT(Numbers(), ElementsAre(1));
  EXPECT_EQ(games.All().at(1).Figures.Players.size(), 2U);
  EXPECT_EQ(games.All().at(1).Since, 1h);
}

TEST_F(Evening, RecognisesAGameThatIsPulledAgain) {
  Play(Red0, 10);
  Play(Blue7, 5);
  Take();
  Clear();
  Play(Red0, 20);
  Take();
  Clear();
  Play(Red0, 10);
  Play(Blue7, 5);
  Play(Yellow3, 9);
  Take();
  EXPECT_THAT(Numbers(), ElementsAre(1, 2));
  EXPECT_EQ(games.All().at(1).Figures.Players.size(), 3U);
}

TEST_F(Evening, TellsGamesApartByAnyGun) {
  Play(Red0, 10);
  Play(Blue7, 5);
  Take();
  Clear();
  Play(Red0, 10);
  Play(Blue7, 6);
  Take();
  EXPECT_THAT(Numbers(), ElementsAre(1, 2));
}

TEST_F(Evening, TakesNoGameForAnotherBecauseOneGunNotedTheSame) {
  Play(Red0, 3);
  Play(Blue7, 5);
  Take();
  Clear();
  Play(Red0, 3);
  Play(Yellow3, 9);
  Take();
  EXPECT_THAT(Numbers(), ElementsAre(1, 2));
}

TEST_F(Evening, CallsMembersAsTheyAreCalledNow) {
  Play(Red0, 10);
  Play(Blue7, 5).MemberIndex = 12;
  guest = "Ann";
  Take();
  const auto nameOf = [this](int gun) {
    const EveningGame& evening = games.All().at(1);
    for (std::size_t at = 0; at < evening.Holders.size(); ++at) {
      if (evening.Figures.Players[at].Gun == gun) {
        return evening.Holders[at].NickName + evening.Holders[at].GuestName;
      }
    }
    return std::string();
  };
  games.NameAnew([](std::int32_t id) { return id == 12 ? " Otter\n" : "nobody"; });
  EXPECT_EQ(nameOf(Blue7), "Otter");
  EXPECT_EQ(nameOf(Red0), "Ann");
  games.NameAnew([](std::int32_t) { return std::string(); });
  EXPECT_EQ(nameOf(Blue7), "");
}

TEST_F(Evening, TakesNoGameForAnotherBecauseNobodyShot) {
  Play(Red0, 0);
  Take();
  Clear();
  Play(Red0, 0);
  Take();
  EXPECT_THAT(Numbers(), ElementsAre(1, 2));
}

TEST_F(Evening, KnowsWhoseNamesItShows) {
  Play(Red0, 10);
  Play(Blue7, 5).MemberIndex = 12;
  guest = "Ann";
  Take();
  const auto name = [](const NameHolder& holder) {
    return holder.Member == 12 ? "" : holder.NickName + holder.GuestName;
  };
  const auto all = [](const NameHolder& holder) { return holder.NickName + holder.GuestName; };
  const auto namesOf = [](const PublicGame& shown) {
    std::map<int, std::string> names;
    for (const PublicPlayer& player : shown.Players) {
      names[player.Gun] = player.Name;
    }
    return names;
  };
  EXPECT_EQ(namesOf(PublicGameOf(games.All().at(1), all)),
            (std::map<int, std::string>{{Red0, "Ann"}, {Blue7, "Mole"}}));
  EXPECT_EQ(namesOf(PublicGameOf(games.All().at(1), name)),
            (std::map<int, std::string>{{Red0, "Ann"}, {Blue7, ""}}));
  guest = "Bea";
  EXPECT_TRUE(Take());
}

TEST_F(Evening, DropsWhatIsOldAndTheFirstOfTooMany) {
  Play(Red0, 1);
  Take(0h);
  Clear();
  Play(Red0, 2);
  Take(1h);
  games.Prune(11h);
  EXPECT_THAT(Numbers(), ElementsAre(1, 2));
  games.Prune(12h);
  EXPECT_THAT(Numbers(), ElementsAre(2));
  for (int shots = 3; shots < 60; ++shots) {
    Clear();
    Play(Red0, shots);
    Take(12h);
  }
  games.Prune(12h);
  EXPECT_EQ(games.All().size(), EveningGames::Most);
  EXPECT_EQ(Numbers().back(), 59);
}

TEST_F(Evening, GivesAGameThatWasDroppedANewNumber) {
  Play(Red0, 1);
  Take(0h);
  games.Prune(13h);
  Take(13h);
  EXPECT_THAT(Numbers(), ElementsAre(2));
}

}  // namespace
