#include <gmock/gmock.h>

#include <string>

#include "tests/support/PrivateData.h"
#include "tests/support/ScoredGame.h"
#include "tests/web/Games.h"
#include "tests/web/server/ResultsProgram.h"
#include "web/ResultsPages.h"

namespace {

using testing::HasSubstr;
using testing::Not;

/// A game with a member of whom everything is known, and the pages made of it.
class MembersData : public testing::Test {
 protected:
  void SetUp() override {
    ExecuteSql(scored.MembersFile(), PrivateMember);
    Player& player = scored.Activate(Red0);
    player.DallasID = "AA0000000000D5E7";
    player.ShotCount = 10;
    player.PrimaryDamage = 5;
    scored.Activate(Blue7).HitByPlayer(Red0) = 15;
    scored.CalculateScores();
    ASSERT_EQ(player.MemberIndex, 918273645);
  }

  /// Pages of the game, with names or without.
  ResultsPages PagesWith(bool shown) {
    const ShownNames names{.Shown = shown,
                           .OfMembers = [this](std::int32_t id) { return scored.Members->NickNameOf(id); },
                           .OfGuests = nullptr,
                           .Hidden = nullptr};
    ResultsPages pages(Language::English);
    pages.Put(PublicGameOf(scored.game, 1, "20:15", names), std::chrono::hours(0));
    return pages;
  }

  ScoredGame scored;
};

TEST_F(MembersData, IsOnNoPage) {
  for (const bool shown : {false, true}) {
    const ResultsPages pages = PagesWith(shown);
    for (const auto& [path, body] : pages.Pages()) {
      for (const std::string& text : Private) {
        EXPECT_THAT(body, Not(HasSubstr(text))) << path;
      }
    }
    EXPECT_EQ(pages.Pages().at("/").find("Molefinger") != std::string::npos, shown);
  }
}

TEST_F(MembersData, IsNotInTheMemoryOfTheProgramThatServesThePages) {
  ResultsProgram program(18'500);
  ResultsPages pages = PagesWith(true);
  for (const PageFrame& frame : pages.TakeAll()) {
    program.Write(EncodeFrame(frame));
  }
  program.Settle();
  ASSERT_THAT(program.Get("/en/g/1/1"), HasSubstr("Molefinger"));
  const ProcessMemory memory(program.Process());
  EXPECT_TRUE(memory.Holds("Molefinger"));
  for (const std::string& text : Private) {
    EXPECT_FALSE(memory.Holds(text)) << text;
  }
}

TEST_F(MembersData, LeavesTheMemoryOfThatProgramWhenTheNameIsHidden) {
  ResultsProgram program(18'500);
  ResultsPages pages = PagesWith(true);
  const auto send = [&program](const std::vector<PageFrame>& frames) {
    for (const PageFrame& frame : frames) {
      program.Write(EncodeFrame(frame));
    }
    program.Settle();
  };
  send(pages.TakeAll());
  ASSERT_THAT(program.Get("/"), HasSubstr("Molefinger"));
  pages.Put(PublicGameOf(scored.game, 1, "20:15", {}), std::chrono::hours(0));
  send(pages.TakeChanges());
  ASSERT_THAT(program.Get("/"), Not(HasSubstr("Molefinger")));
  EXPECT_FALSE(ProcessMemory(program.Process()).Holds("Molefinger"));
}

TEST_F(MembersData, LeavesTheMemoryOfThatProgramWithItsGame) {
  ResultsProgram program(18'500);
  ResultsPages pages = PagesWith(true);
  for (const PageFrame& frame : pages.TakeAll()) {
    program.Write(EncodeFrame(frame));
  }
  pages.Prune(std::chrono::hours(24));
  for (const PageFrame& frame : pages.TakeChanges()) {
    program.Write(EncodeFrame(frame));
  }
  program.Settle();
  ASSERT_THAT(program.Get("/en/g/1/"), testing::StartsWith("HTTP/1.1 404 "));
  EXPECT_FALSE(ProcessMemory(program.Process()).Holds("Molefinger"));
}

}  // namespace
