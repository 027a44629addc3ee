#include "devices/radio/ScoreFetch.h"

#include <gmock/gmock.h>

#include "tests/devices/radio/FetchSite.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

TEST_F(Fetch, SpeaksAsTheGunExpects) {
  PutGun(33, BlockOfRed1(52));
  GetScores();
  ASSERT_EQ(Frames.size(), 3U);
  EXPECT_THAT(Frames[0], ElementsAre(0x7E, 0x00, 0x11, 0x00, 0x00,                          //
                                     0x00, 0x13, 0xA2, 0x00, 0x40, 0x01, 0x02, 0x21, 0x00,  //
                                     0x01, 0x21, 0x00, 0x00, 0x04, 0x01, 0xBF));
  EXPECT_THAT(Frames[1], ElementsAre(0x7E, 0x00, 0x13, 0x00, 0x00,                          //
                                     0x00, 0x13, 0xA2, 0x00, 0x40, 0x01, 0x02, 0x21, 0x00,  //
                                     0x03, 0x21, 0x00, 0x00, 0x04, 0x02, 0x00, 0x34, 0x88));
  EXPECT_THAT(Frames[2], ElementsAre(0x7E, 0x00, 0x11, 0x00, 0x00,                          //
                                     0x00, 0x13, 0xA2, 0x00, 0x40, 0x01, 0x02, 0x21, 0x00,  //
                                     0x01, 0x21, 0x00, 0x00, 0x04, 0x03, 0xBD));
}

TEST_F(Fetch, TakesTheAnswersOfAGunByteForByte) {
  PutGun(33, {});
  std::vector<Bytes> answers = {
      {0x7E, 0x00, 0x14, 0x80, 0x00, 0x13, 0xA2, 0x00, 0x40, 0x01, 0x02, 0x21,  //
       0x28, 0x00, 0x04, 0x21, 0x00, 0x00, 0x05, 0x01, 0x34, 0x00, 0x5A, 0x85},
      Received(33, Joined({{55, 33, 0, 0, 5, 2, 0, 51}, BlockOfRed1(52)})),
      {0x7E, 0x00, 0x11, 0x80, 0x00, 0x13, 0xA2, 0x00, 0x40, 0x01, 0x02, 0x21,  //
       0x28, 0x00, 0x01, 0x21, 0x00, 0x00, 0x05, 0x03, 0x14},
  };
  OnPacket = [&](const Bytes&) { Arrive(20, answers.at(Frames.size() - 1)); };
  GetScores();
  EXPECT_EQ(StatusOf(33), ScoreStatus::Ok);
  EXPECT_TRUE(Red1().Active);
}

TEST_F(Fetch, KeepsTheLineOpenOnlyWhileItRuns) {
  PutGun(33, BlockOfRed1(52));
  {
    RadioLink link(Port, Line, Events, [] { return false; });
    ScoreFetch(link, Events, Time, Strings, game, guns, display).GetScores();
    EXPECT_FALSE(Port.PortOpen());
  }
  EXPECT_EQ(Port.Log.front(), "Open /dev/ttyS0 57600,N,8,1");
  EXPECT_EQ(Port.Log.back(), "Close");
  EXPECT_THAT(Port.Log, testing::Contains("Close").Times(1));
}

TEST_F(Fetch, AddsTheGunsScoresToTheGame) {
  PutGun(33, BlockOfRed1(52));
  GetScores();
  EXPECT_EQ(StatusOf(33), ScoreStatus::Ok);
  EXPECT_TRUE(Red1().Active);
  EXPECT_EQ(Red1().ShotCount, 258);
  EXPECT_EQ(Red1().HitByPlayer(33), 260);
  EXPECT_EQ(Red1().DallasID, "0807060504030201");
  EXPECT_TRUE(game.DataPresent);
  EXPECT_EQ(game.GameDate, "21/05/2013 14:30");
}

struct Blocks {
  std::size_t Total;
  std::vector<std::pair<int, int>> StartsAndCounts;
};

TEST_F(Fetch, AsksForBlocksOf90BytesAndTheRest) {
  const std::vector<Blocks> cases = {{52, {{0, 52}}},
                                     {89, {{0, 89}}},
                                     {90, {{0, 90}}},
                                     {91, {{0, 90}, {90, 1}}},
                                     {135, {{0, 90}, {90, 45}}},
                                     {136, {{0, 90}, {90, 46}}},
                                     {180, {{0, 90}, {90, 90}}},
                                     {181, {{0, 90}, {90, 90}, {180, 1}}},
                                     {225, {{0, 90}, {90, 90}, {180, 45}}},
                                     {226, {{0, 90}, {90, 90}, {180, 46}}},
                                     {270, {{0, 90}, {90, 90}, {180, 90}}}};
  for (const Blocks& one : cases) {
    Frames.clear();
    game.Clear();
    guns[1].ScoreStatus = ScoreStatus::Pending;
    PutGun(33, BlockOfRed1(one.Total));
    GetScores();
    std::vector<std::pair<int, int>> asked;
    for (const Bytes& packet : Packets()) {
      if (packet[5] == 2) {
        asked.emplace_back(packet[6], packet[7]);
      }
    }
    EXPECT_EQ(asked, one.StartsAndCounts) << one.Total;
    EXPECT_EQ(StatusOf(33), ScoreStatus::Ok) << one.Total;
    EXPECT_EQ(Red1().ShotCount, 258) << one.Total;
    EXPECT_EQ(Red1().HitByPlayer(2), 5) << one.Total;
  }
}

TEST_F(Fetch, TakesTheHighPartOfTheTotalTimes255) {
  PutGun(33, BlockOfRed1(260));
  Alter = [](Bytes answer) {
    if (answer[5] == 1) {
      EXPECT_EQ(answer[6], 5);
      EXPECT_EQ(answer[7], 1);
    }
    return answer;
  };
  GetScores();
  EXPECT_EQ(StatusOf(33), ScoreStatus::Ok);
  EXPECT_EQ(Packets()[3], (Bytes{3, 33, 0, 0, 4, 2, 180, 80}));
}

TEST_F(Fetch, DoesNotLookAtTheFirstByteOfTheSizeAnswer) {
  PutGun(33, BlockOfRed1(52));
  Alter = [](Bytes answer) {
    answer[5] = answer[5] == 1 ? 77 : answer[5];
    return answer;
  };
  GetScores();
  EXPECT_EQ(StatusOf(33), ScoreStatus::Ok);
}

TEST_F(Fetch, OfAnEmptyTableOpensTheLineAndIsDone) {
  GetScores();
  EXPECT_THAT(Port.Log, ElementsAre("Open /dev/ttyS0 57600,N,8,1", "Close"));
  EXPECT_THAT(display.Log, ElementsAre("Status Getting Scores...", "Status Done"));
}

TEST_F(Fetch, OfAnEmptyTableNeedsNoLine) {
  Port.FailNextOpen(8002);
  GetScores();
  EXPECT_EQ(lineFault, 0);
  EXPECT_THAT(display.Log, ElementsAre("Status Getting Scores...", "Status Done"));
}

TEST_F(Fetch, ShowsItsCourse) {
  PutGun(33, BlockOfRed1(52));
  PutGun(35, BlockOfRed1(52));
  std::vector<ScoreStatus> seen;
  display.OnRefresh = [&] { seen.push_back(StatusOf(33)); };
  GetScores();
  EXPECT_THAT(display.Log, ElementsAre("Status Getting Scores...", "Refresh", "Refresh", "Refresh", "Refresh",
                                       "Status Done"));
  EXPECT_THAT(seen, ElementsAre(ScoreStatus::InProgress, ScoreStatus::Ok, ScoreStatus::Ok, ScoreStatus::Ok));
  EXPECT_THAT(display.Progress, ElementsAre("Gun 1 of 2: 0/2", "Gun 2 of 2: 1/2"));
  EXPECT_EQ(Port.Log.back(), "Close");
}

TEST_F(Fetch, GoesThroughTheGunsByTheirIds) {
  for (const std::uint8_t id : Bytes{255, 32, 160, 33}) {
    PutGun(id, BlockOfRed1(52));
  }
  GetScores();
  std::vector<int> asked;
  for (const Bytes& packet : Packets()) {
    if (packet[5] == 1) {
      asked.push_back(packet[1]);
    }
  }
  EXPECT_THAT(asked, ElementsAre(32, 33, 160, 255));
}

TEST_F(Fetch, PassesOverGunsThatAreOkOrStillInProgress) {
  PutGun(33, BlockOfRed1(52));
  PutGun(34, BlockOfRed1(52));
  guns[1].ScoreStatus = ScoreStatus::Ok;
  guns[2].ScoreStatus = ScoreStatus::InProgress;
  GetScores();
  EXPECT_THAT(Frames, IsEmpty());
}

TEST_F(Fetch, PressedAgainFetchesOnlyWhatFailed) {
  PutGun(33, BlockOfRed1(52));
  SiteGun& silent = PutGun(40, BlockOfRed1(52));
  silent.Silent = [](const Bytes&) { return true; };
  GetScores();
  EXPECT_EQ(StatusOf(40), ScoreStatus::Failed);
  silent.Silent = [](const Bytes&) { return false; };
  Frames.clear();
  GetScores();
  EXPECT_EQ(StatusOf(40), ScoreStatus::Ok);
  for (const Bytes& packet : Packets()) {
    EXPECT_EQ(packet[1], 40);
  }
}

}  // namespace
