#include "web/ResultsPages.h"

#include <gmock/gmock.h>

#include "tests/web/Games.h"

namespace {

using namespace std::chrono_literals;
using testing::Contains;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

class PagesOfAnEvening : public testing::Test {
 protected:
  bool Has(const std::string& path) const { return pages.Pages().contains(path); }

  /// What a reader of all orders so far has.
  std::map<std::string, std::string> Follow(const std::vector<PageFrame>& frames) {
    for (const PageFrame& frame : frames) {
      if (frame.Order == PageOrder::Put) {
        followed_[frame.Path] = frame.Body;
      } else if (frame.Order == PageOrder::Remove) {
        EXPECT_EQ(followed_.erase(frame.Path), 1U) << frame.Path;
      }
    }
    return followed_;
  }

  ResultsPages pages{Language::English, {.Games = 3, .Age = 12h, .Bytes = MostPageBytes / 2}};

 private:
  std::map<std::string, std::string> followed_;
};

TEST_F(PagesOfAnEvening, HaveAFrontBeforeTheFirstGame) {
  for (const char* path :
       {"/", "/en/", "/zh/", "/en/games", "/zh/games", "/now", "/style.css", "/follow.js", "/missing"}) {
    EXPECT_TRUE(Has(path)) << path;
  }
  EXPECT_EQ(pages.Pages().at("/"), pages.Pages().at("/en/"));
}

TEST_F(PagesOfAnEvening, ShowTheNewestGameAtTheFront) {
  pages.Put(SmallGame(1), 0h);
  pages.Put(SmallGame(2), 1h);
  EXPECT_THAT(pages.Pages().at("/"), HasSubstr("Game 2"));
  EXPECT_THAT(pages.Pages().at("/zh/"), HasSubstr("第 2 场"));
  EXPECT_THAT(pages.Pages().at("/en/games"), HasSubstr("Game 1"));
  EXPECT_TRUE(Has("/en/g/1/40"));
}

TEST_F(PagesOfAnEvening, KeepOnlyTheLastGames) {
  for (int number = 1; number <= 4; ++number) {
    pages.Put(SmallGame(number), 0h);
  }
  EXPECT_FALSE(Has("/en/g/1/"));
  EXPECT_FALSE(Has("/zh/g/1/40"));
  EXPECT_TRUE(Has("/en/g/2/"));
}

TEST_F(PagesOfAnEvening, DropGamesWhenTheyAreTwelveHoursOld) {
  pages.Put(SmallGame(1), 0h);
  pages.Put(SmallGame(2), 1h);
  pages.Put(SmallGame(1), 11h);  // shown again: it keeps its age
  pages.Prune(12h);
  EXPECT_FALSE(Has("/en/g/1/"));
  EXPECT_TRUE(Has("/en/g/2/"));
  pages.Prune(13h);
  EXPECT_THAT(pages.Pages().at("/"), HasSubstr("No game has been scored yet."));
}

TEST_F(PagesOfAnEvening, StayWithinTheirBytes) {
  ResultsPages small(Language::English, {.Games = 20, .Age = 12h, .Bytes = 30'000});
  small.Put(FullGameOf(10, 1), 0h);
  small.Put(FullGameOf(10, 2), 0h);
  EXPECT_FALSE(small.Pages().contains("/en/g/1/"));
  EXPECT_TRUE(small.Pages().contains("/en/g/2/"));
}

TEST_F(PagesOfAnEvening, OfTheFullestGameAreWithinWhatIsServed) {
  pages.Put(FullGameOf(PlayerCount), 0h);
  std::size_t bytes = 0;
  for (const auto& [path, body] : pages.Pages()) {
    EXPECT_LE(body.size(), LongestPageBody) << path;
    bytes += body.size();
  }
  EXPECT_LE(bytes, MostPageBytes);
  EXPECT_LE(pages.Pages().size(), MostPages);
}

TEST_F(PagesOfAnEvening, SendOnlyWhatChanged) {
  pages.Put(SmallGame(1), 0h);
  Follow(pages.TakeAll());
  EXPECT_THAT(pages.TakeChanges(), IsEmpty());
  pages.Put(SmallGame(2), 0h);
  const std::vector<PageFrame> changes = pages.TakeChanges();
  std::vector<std::string> paths;
  for (const PageFrame& frame : changes) {
    paths.push_back(frame.Path);
  }
  EXPECT_THAT(paths, Contains("/en/g/2/40"));
  EXPECT_THAT(paths, Not(Contains("/en/g/1/40")));
  EXPECT_THAT(paths, Not(Contains("/style.css")));
  EXPECT_EQ(changes.back(), PageFrame{});
  EXPECT_EQ(Follow(changes), pages.Pages());
}

TEST_F(PagesOfAnEvening, LoseThePageOfAPlayerWhoIsNoLongerThere) {
  Follow(pages.TakeAll());
  PublicGame game = SmallGame(1);
  pages.Put(game, 0h);
  Follow(pages.TakeChanges());
  game.Players.pop_back();
  pages.Put(game, 0h);
  EXPECT_FALSE(Has("/en/g/1/68"));
  EXPECT_EQ(Follow(pages.TakeChanges()), pages.Pages());
}

TEST_F(PagesOfAnEvening, LoseANameEverywhereWhenItIsTakenOff) {
  PublicGame game = SmallGame(1);
  pages.Put(game, 0h);
  Follow(pages.TakeAll());
  game.Players[0].Name.clear();
  pages.Put(game, 1h);
  for (const auto& [path, body] : Follow(pages.TakeChanges())) {
    EXPECT_THAT(body, Not(HasSubstr("Mole"))) << path;
  }
}

}  // namespace
