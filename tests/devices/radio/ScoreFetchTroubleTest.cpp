#include "devices/radio/ScoreFetch.h"

#include <gmock/gmock.h>

#include "tests/devices/radio/FetchSite.h"

namespace {

using std::chrono::milliseconds;
using testing::ElementsAre;

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

/// As long as its frame may be, with other figures than any answer here, and of the kind that starts like
/// one.
Bytes AnotherFrame() {
  return Received(99, Joined({{93, 99, 0, 0, 5, 2, 0, 89}, Bytes(90, 0xEE)}));
}

// The bytes behind the answer begin a frame that is never finished, so what they swallow must come again.
TEST_F(Fetch, ReadsAnAnswerWhateverBeginsBehindIt) {
  const Bytes another = AnotherFrame();
  for (std::uint8_t command = 1; command <= 3; ++command) {
    for (std::size_t length = 1; length < another.size(); ++length) {
      SiteGun& gun = PutGun(33, BlockOfRed1(225));
      guns[1].ScoreStatus = ScoreStatus::Pending;
      Frames.clear();
      game.Clear();
      bool struck = false;
      OnPacket = [&](const Bytes& packet) {
        Bytes burst = Received(33, AnswerOf(gun, packet));
        if (packet[5] == command && !struck) {
          struck = true;
          burst.insert(burst.end(), another.begin(), another.begin() + static_cast<std::ptrdiff_t>(length));
        }
        Arrive(10, burst);
      };
      ASSERT_EQ(FaultOfGetScores(), 0) << int(command) << ": " << length;
      EXPECT_EQ(StatusOf(33), ScoreStatus::Ok) << int(command) << ": " << length;
      EXPECT_EQ(Red1().ShotCount, 258) << int(command) << ": " << length;
      if (command == 1) {
        EXPECT_EQ(Packets()[1], (Bytes{3, 33, 0, 0, 4, 2, 0, 90})) << length;
      }
    }
  }
}

TEST_F(Fetch, ReadsTheDataAmongFramesThatComeAtOnceAndNotWhatABadOneLeft) {
  SiteGun& gun = PutGun(33, BlockOfRed1(52));
  Bytes bad = AnotherFrame();
  bad.back() ^= 1;
  OnPacket = [&](const Bytes& packet) {
    Arrive(10, Joined({Received(33, AnswerOf(gun, packet)), bad, ModemStatusFrame()}));
  };
  EXPECT_EQ(FaultOfGetScores(), 0);
  EXPECT_EQ(CountOf(1), 1);
  EXPECT_EQ(StatusOf(33), ScoreStatus::Ok);
}

TEST_F(Fetch, ServesEventsInEachRoundAlsoForIdsWithoutAGun) {
  int rounds = 0;
  std::function<void()> count = [&] {
    ++rounds;
    Events.At(milliseconds(0), count);
  };
  Events.At(milliseconds(0), count);
  GetScores();
  EXPECT_EQ(rounds, 224);
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
