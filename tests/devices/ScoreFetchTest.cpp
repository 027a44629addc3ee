#include "devices/ScoreFetch.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <chrono>
#include <map>
#include <memory>

#include "core/Checksum.h"
#include "tests/core/Frames.h"
#include "tests/devices/RadioSite.h"

namespace {

using std::chrono::milliseconds;
using testing::ElementsAre;
using testing::IsEmpty;

/// The scores of Red 1 as a block of `length` bytes, 52 or more; unknown fields fill it up.
Bytes BlockOfRed1(std::size_t length) {
  Bytes block = FrameOfRed1();
  block.pop_back();
  block.insert(block.begin() + 45, length - block.size(), 0);
  block[0] = static_cast<std::uint8_t>(length % 256);
  block[1] = static_cast<std::uint8_t>(length / 256);
  block[2] = static_cast<std::uint8_t>((length - 11) % 256);
  block[3] = static_cast<std::uint8_t>((length - 11) / 256);
  return block;
}

/// One gun at the far end.
struct SiteGun {
  Bytes Block;
  int Total = -1;  ///< what it says when that is not the block's length
  std::function<bool(const Bytes&)> Silent = [](const Bytes&) { return false; };  ///< for these packets
};

class Fetch : public testing::Test, protected RadioSite {
 protected:
  Fetch() {
    OnPacket = [this](const Bytes& packet) { Answer(packet); };
  }

  /// A gun that a search has found.
  SiteGun& PutGun(std::uint8_t playerId, Bytes block) {
    GunEntry& gun = guns[playerId - 32U];
    gun.Present = true;
    gun.PlayerID = playerId;
    gun.Address = {playerId, 2, 1, 0x40, 0, 0xA2, 0x13, 0};
    SiteGun& there = site[playerId];
    there.Block = std::move(block);
    return there;
  }

  void GetScores() {
    RadioLink link(Port, Line, Events, [this] { return stopped; });
    ScoreFetch(link, Events, Time, game, guns, display).GetScores();
    try {
      link.ThrowIfLineLost();
    } catch (const RuntimeError& error) {
      lineFault = error.Number();
    }
  }

  int FaultOfGetScores() {
    try {
      GetScores();
    } catch (const RuntimeError& error) {
      return error.Number();
    }
    return 0;
  }

  ScoreStatus StatusOf(std::uint8_t playerId) const { return guns[playerId - 32U].ScoreStatus; }
  const Player& Red1() const { return game.Players(2); }

  /// Packets of one command, of which `command` is the number.
  int CountOf(std::uint8_t command) const {
    const std::vector<Bytes> packets = Packets();
    return static_cast<int>(std::count_if(packets.begin(), packets.end(),
                                          [&](const Bytes& packet) { return packet[5] == command; }));
  }

  void Answer(const Bytes& packet) {
    const SiteGun& gun = site.at(packet[1]);
    if (!gun.Silent(packet)) {
      Arrive(20, Received(packet[1], Alter(AnswerOf(gun, packet))));
    }
  }

  static Bytes AnswerOf(const SiteGun& gun, const Bytes& packet) {
    const std::uint8_t id = packet[1];
    if (packet[5] == 1) {
      const int total = gun.Total >= 0 ? gun.Total : static_cast<int>(gun.Block.size());
      return {4,
              id,
              0,
              0,
              5,
              1,
              static_cast<std::uint8_t>(total % 255),
              static_cast<std::uint8_t>(total / 255),
              Crc8(gun.Block)};
    }
    if (packet[5] == 3) {
      return {1, id, 0, 0, 5, 3};
    }
    const std::size_t start = packet[6];
    const std::size_t count = packet[7];
    Bytes data;
    for (std::size_t i = start; i < start + count; ++i) {
      data.push_back(i < gun.Block.size() ? gun.Block[i] : 0);
    }
    return Joined({{static_cast<std::uint8_t>(3 + count), id, 0, 0, 5, 2, static_cast<std::uint8_t>(start),
                    static_cast<std::uint8_t>(count - 1)},
                   data});
  }

  std::map<int, SiteGun> site;
  std::function<Bytes(Bytes)> Alter = [](Bytes answer) { return answer; };
  Game game{Strings};
  GunTable guns;
  FakeRadioDisplay display;
  bool stopped = false;
  int lineFault = 0;
};

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

TEST_F(Fetch, GivesUpASilentGunAfterFourAttempts) {
  PutGun(33, BlockOfRed1(52)).Silent = [](const Bytes&) { return true; };
  GetScores();
  EXPECT_EQ(CountOf(1), 4);
  EXPECT_EQ(Frames.size(), 4U);
  EXPECT_EQ(StatusOf(33), ScoreStatus::Failed);
  EXPECT_EQ(Events.Now(), milliseconds(4 * 2000 + 3 * 50));
  EXPECT_THAT(Events.Sleeps, ElementsAre(milliseconds(50), milliseconds(50), milliseconds(50)));
  EXPECT_FALSE(Red1().Active);
}

TEST_F(Fetch, SucceedsAtTheFourthAttempt) {
  int asked = 0;
  PutGun(33, BlockOfRed1(52)).Silent = [&](const Bytes& packet) { return packet[5] == 1 && ++asked < 4; };
  GetScores();
  EXPECT_EQ(asked, 4);
  EXPECT_EQ(StatusOf(33), ScoreStatus::Ok);
}

TEST_F(Fetch, EndsAnAttemptWithAnAnswerOfAnotherType) {
  PutGun(33, BlockOfRed1(52));
  Alter = [](Bytes answer) {
    answer[4] = 7;
    return answer;
  };
  GetScores();
  EXPECT_EQ(Frames.size(), 4U);
  EXPECT_EQ(StatusOf(33), ScoreStatus::Failed);
}

TEST_F(Fetch, GoesOnToTheNextBlockWhenOneIsLost) {
  int lost = 0;
  PutGun(33, BlockOfRed1(225)).Silent = [&](const Bytes& packet) {
    return packet[5] == 2 && packet[6] == 90 && ++lost == 1;
  };
  GetScores();
  EXPECT_EQ(CountOf(1), 2);
  EXPECT_EQ(CountOf(2), 6);
  EXPECT_EQ(CountOf(3), 1);
  EXPECT_EQ(StatusOf(33), ScoreStatus::Ok);
  EXPECT_EQ(Red1().ShotCount, 258);
}

TEST_F(Fetch, PutsABlockWhereItsAnswerSays) {
  // The answers to the two requests come in each other's place.
  PutGun(33, BlockOfRed1(135));
  OnPacket = [this](const Bytes& packet) {
    Bytes asked = packet;
    if (packet[5] == 2) {
      asked[6] = packet[6] == 0 ? 90 : 0;
      asked[7] = packet[6] == 0 ? 45 : 90;
    }
    Answer(asked);
  };
  GetScores();
  EXPECT_EQ(CountOf(1), 1);
  EXPECT_EQ(StatusOf(33), ScoreStatus::Ok);
  EXPECT_EQ(Red1().HitByPlayer(33), 260);
}

TEST_F(Fetch, IgnoresWhichGunAnswers) {
  PutGun(33, BlockOfRed1(52));
  Alter = [](Bytes answer) {
    answer[1] = 99;
    return answer;
  };
  GetScores();
  EXPECT_EQ(StatusOf(33), ScoreStatus::Ok);
}

TEST_F(Fetch, CountsABlockThatCameTwiceAsOftenButLooksAtTheCheckByte) {
  // The first block twice makes 180 of 135 bytes, and the second is missing.
  int blocks = 0;
  PutGun(33, BlockOfRed1(135));
  OnPacket = [&](const Bytes& packet) {
    Bytes asked = packet;
    if (packet[5] == 2 && ++blocks <= 2) {
      asked[6] = 0;
      asked[7] = 90;
    }
    Answer(asked);
  };
  GetScores();
  EXPECT_EQ(CountOf(1), 2);
  EXPECT_EQ(CountOf(3), 1);
  EXPECT_EQ(StatusOf(33), ScoreStatus::Ok);
  EXPECT_EQ(Red1().ShotCount, 258);
}

TEST_F(Fetch, TriesAgainAfterAWrongCheckByteOfTheBlock) {
  int sizes = 0;
  PutGun(33, BlockOfRed1(52));
  Alter = [&](Bytes answer) {
    if (answer[5] == 1 && ++sizes <= 3) {
      answer[8] ^= 1;
    }
    return answer;
  };
  GetScores();
  EXPECT_EQ(sizes, 4);
  EXPECT_EQ(CountOf(3), 1);
  EXPECT_EQ(StatusOf(33), ScoreStatus::Ok);
  EXPECT_EQ(Red1().ShotCount, 258);
}

TEST_F(Fetch, TakesNoBlockFromAnAnswerToAnotherCommand) {
  PutGun(33, BlockOfRed1(52));
  Alter = [](Bytes answer) {
    answer[5] = answer[5] == 2 ? 1 : answer[5];
    return answer;
  };
  GetScores();
  EXPECT_EQ(CountOf(3), 0);
  EXPECT_EQ(StatusOf(33), ScoreStatus::Failed);
}

TEST_F(Fetch, NeverDecodesABlockWithAWrongCheckByte) {
  PutGun(33, BlockOfRed1(52));
  Alter = [](Bytes answer) {
    if (answer[5] == 2) {
      answer[20] ^= 1;
    }
    return answer;
  };
  GetScores();
  EXPECT_EQ(StatusOf(33), ScoreStatus::Failed);
  EXPECT_FALSE(Red1().Active);
  EXPECT_FALSE(game.DataPresent);
}

TEST_F(Fetch, DecodesAgainWhenTheAnswerToTheCloseIsLost) {
  int closes = 0;
  PutGun(33, BlockOfRed1(52)).Silent = [&](const Bytes& packet) { return packet[5] == 3 && ++closes == 1; };
  GetScores();
  EXPECT_EQ(StatusOf(33), ScoreStatus::Ok);
  EXPECT_EQ(Red1().ShotCount, 2 * 258);
}

TEST_F(Fetch, FailsWithoutAnAnswerToTheClose) {
  for (const std::uint8_t wrong : Bytes{4, 5}) {
    Frames.clear();
    guns[1].ScoreStatus = ScoreStatus::Pending;
    PutGun(33, BlockOfRed1(52));
    Alter = [wrong](Bytes answer) {
      if (answer[5] == 3) {
        ++answer[wrong];
      }
      return answer;
    };
    GetScores();
    EXPECT_EQ(CountOf(3), 4);
    EXPECT_EQ(StatusOf(33), ScoreStatus::Failed);
  }
}

TEST_F(Fetch, EndsAnAttemptWithAStatusFrameThatComesFirst) {
  // What counts then is the packet before, and there is none.
  PutGun(33, BlockOfRed1(52));
  const auto answer = OnPacket;
  OnPacket = [this, answer](const Bytes& packet) {
    if (Frames.size() == 1) {
      Arrive(10, ModemStatusFrame());
    }
    answer(packet);
  };
  GetScores();
  EXPECT_EQ(CountOf(1), 2);
  EXPECT_EQ(StatusOf(33), ScoreStatus::Ok);
  EXPECT_EQ(Red1().ShotCount, 258);
}

TEST_F(Fetch, TakesTheAnswerThatComesAtOnceWithAStatusFrame) {
  for (const bool first : {true, false}) {
    SiteGun& gun = PutGun(33, BlockOfRed1(100));
    guns[1].ScoreStatus = ScoreStatus::Pending;
    OnPacket = [&](const Bytes& packet) {
      const Bytes answer = Received(33, AnswerOf(gun, packet));
      Bytes burst = first ? ModemStatusFrame() : answer;
      const Bytes rest = first ? answer : TransmitStatusFrame();
      burst.insert(burst.end(), rest.begin(), rest.end());
      Arrive(10, burst);
    };
    const int sizes = CountOf(1);
    GetScores();
    EXPECT_EQ(StatusOf(33), ScoreStatus::Ok) << first;
    EXPECT_EQ(CountOf(1), sizes + 1) << first;
  }
}

TEST_F(Fetch, TakesTheBlockBeforeOnceMoreWhenAStatusFrameComesFirst) {
  PutGun(33, BlockOfRed1(135));
  const auto answer = OnPacket;
  OnPacket = [this, answer](const Bytes& packet) {
    if (Frames.size() == 3) {
      Arrive(10, TransmitStatusFrame());
    }
    answer(packet);
  };
  GetScores();
  EXPECT_EQ(CountOf(1), 2);
  EXPECT_EQ(StatusOf(33), ScoreStatus::Ok);
  EXPECT_EQ(Red1().ShotCount, 258);
}

TEST_F(Fetch, DropsAnAnswerThatComesTooLate) {
  PutGun(33, BlockOfRed1(52));
  const auto answer = OnPacket;
  OnPacket = [this, answer](const Bytes& packet) {
    if (Frames.size() == 1) {
      Arrive(2030, Received(33, {4, 33, 0, 0, 5, 1, 99, 0, 0}));
    } else {
      answer(packet);
    }
  };
  GetScores();
  EXPECT_EQ(Packets()[2], (Bytes{3, 33, 0, 0, 4, 2, 0, 52}));
  EXPECT_EQ(Frames.size(), 4U);
  EXPECT_EQ(StatusOf(33), ScoreStatus::Ok);
}

TEST_F(Fetch, OverflowsWithATotalOfZero) {
  PutGun(33, BlockOfRed1(52)).Total = 0;
  PutGun(40, BlockOfRed1(52));
  EXPECT_EQ(FaultOfGetScores(), 6);
  EXPECT_EQ(Frames.size(), 1U);
  EXPECT_FALSE(Port.PortOpen());
  EXPECT_EQ(StatusOf(33), ScoreStatus::InProgress);
  EXPECT_EQ(StatusOf(40), ScoreStatus::Pending);
}

TEST_F(Fetch, OverflowsAtTheFourthBlock) {
  PutGun(33, BlockOfRed1(300));
  EXPECT_EQ(FaultOfGetScores(), 6);
  EXPECT_EQ(CountOf(2), 3);
  EXPECT_FALSE(Red1().Active);
  EXPECT_FALSE(Port.PortOpen());
}

TEST_F(Fetch, OverflowsWithMoreBlocksThanAByteCounts) {
  PutGun(33, BlockOfRed1(52)).Total = 255 * 255 + 254;
  EXPECT_EQ(FaultOfGetScores(), 6);
  EXPECT_EQ(Frames.size(), 1U);
}

TEST_F(Fetch, AfterAnOverflowGoesOnBehindThatGun) {
  PutGun(33, BlockOfRed1(52)).Total = 0;
  PutGun(40, BlockOfRed1(52));
  EXPECT_EQ(FaultOfGetScores(), 6);
  EXPECT_EQ(FaultOfGetScores(), 0);
  EXPECT_EQ(StatusOf(40), ScoreStatus::Ok);
}

TEST_F(Fetch, FaultsWithABlockLongerThanItsPacket) {
  PutGun(33, BlockOfRed1(52));
  Alter = [](Bytes answer) {
    if (answer[5] == 2) {
      answer[7] = 92;
    }
    return answer;
  };
  EXPECT_EQ(FaultOfGetScores(), 9);
}

TEST_F(Fetch, TakesTheLargestBlockAtTheLastOffset) {
  PutGun(33, BlockOfRed1(52));
  Alter = [](Bytes answer) {
    if (answer[5] == 2) {
      answer[6] = 255;
      answer[7] = 91;
    }
    return answer;
  };
  EXPECT_EQ(FaultOfGetScores(), 0);
  EXPECT_EQ(StatusOf(33), ScoreStatus::Failed);
}

TEST_F(Fetch, WithoutALineFailsTheFirstGunAndEnds) {
  Port.FailNextOpen(8002);
  PutGun(33, BlockOfRed1(52));
  PutGun(40, BlockOfRed1(52));
  GetScores();
  EXPECT_EQ(lineFault, 8018);
  EXPECT_EQ(StatusOf(33), ScoreStatus::Failed);
  EXPECT_EQ(StatusOf(40), ScoreStatus::Pending);
  EXPECT_EQ(display.Log.back(), "Status Done");
  EXPECT_EQ(Events.Now(), milliseconds(0));
}

TEST_F(Fetch, LostInMidTransferEndsAsAfterATimeOut) {
  PutGun(33, BlockOfRed1(300)).Silent = [this](const Bytes& packet) {
    if (packet[5] == 2 && packet[6] == 90) {
      Port.Lose();
    }
    return false;
  };
  PutGun(40, BlockOfRed1(52));
  EXPECT_EQ(FaultOfGetScores(), 0);
  EXPECT_EQ(lineFault, 8012);
  EXPECT_EQ(StatusOf(33), ScoreStatus::Failed);
  EXPECT_EQ(StatusOf(40), ScoreStatus::Pending);
  EXPECT_EQ(Frames.size(), 3U);
  EXPECT_EQ(display.Log.back(), "Status Done");
  EXPECT_FALSE(Port.PortOpen());
}

TEST_F(Fetch, EndsWhenItIsStopped) {
  PutGun(33, BlockOfRed1(300)).Silent = [](const Bytes&) { return true; };
  PutGun(40, BlockOfRed1(52));
  Events.At(milliseconds(500), [this] { stopped = true; });
  GetScores();
  EXPECT_EQ(Events.Now(), milliseconds(500));
  EXPECT_EQ(Frames.size(), 1U);
  EXPECT_EQ(lineFault, 0);
  EXPECT_FALSE(Port.PortOpen());
}

TEST_F(Fetch, OfAFullSiteFetchesEveryGun) {
  for (int id = 32; id <= 255; ++id) {
    Bytes block = BlockOfRed1(60);
    block[4] = static_cast<std::uint8_t>(id);
    PutGun(static_cast<std::uint8_t>(id), block);
  }
  GetScores();
  for (int index = 1; index <= 224; ++index) {
    EXPECT_TRUE(game.Players(index).Active) << index;
    EXPECT_EQ(game.Players(index).ShotCount, 258) << index;
  }
}

}  // namespace
