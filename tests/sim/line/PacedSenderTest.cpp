#include "sim/line/PacedSender.h"

#include <gtest/gtest.h>

#include "tests/support/RawHost.h"

namespace sim {
namespace {

using Clock = PacedSender::Clock;
using std::chrono::milliseconds;

constexpr int Baud = 1200;
// Ten bits a byte.
std::chrono::duration<double> WireTime(std::size_t bytes) {
  return std::chrono::duration<double>(static_cast<double>(bytes) * 10.0 / Baud);
}

class PacedSenderTest : public testing::Test {
 protected:
  // Runs the line until nothing is left to be sent.
  void Drain() {
    while (const auto left = sender_.UntilDue()) {
      line_.ReadByte(*left);
      sender_.SendDue();
      if (!line_.IsUp()) {
        break;
      }
    }
  }

  PseudoTerminal line_{Baud, Pace::AsWired};
  RawHost host_{line_.SlavePath()};
  std::vector<Bytes> sent_;
  PacedSender sender_{line_, [this](const LinePiece& piece) { sent_.push_back(piece.Bytes); }};
};

TEST_F(PacedSenderTest, HasNothingDueAtFirst) {
  EXPECT_EQ(sender_.UntilDue(), std::nullopt);
}

TEST_F(PacedSenderTest, SendsNoByteBeforeItsLastBitIsThrough) {
  const Clock::time_point ready = Clock::now() + milliseconds(10);
  sender_.Add(ready, {{1, 2, 3}});
  sender_.Add(ready, {{4}});
  EXPECT_GT(sender_.UntilDue(), milliseconds(0));
  for (std::size_t count = 1; count <= 4; ++count) {
    std::optional<std::uint8_t> byte;
    while (!(byte = host_.ReadByte(milliseconds(0)))) {
      line_.ReadByte(sender_.UntilDue());
      sender_.SendDue();
    }
    EXPECT_EQ(*byte, count);
    EXPECT_GE(Clock::now(), ready + WireTime(count));
  }
  EXPECT_EQ(sender_.UntilDue(), std::nullopt);
}

TEST_F(PacedSenderTest, SendsWholePiecesInTheOrderOfTheirTimes) {
  const Clock::time_point now = Clock::now();
  sender_.Add(now + milliseconds(2), {{5, 6}});
  sender_.Add(now, {{1, 2}});
  sender_.Add(now, {{3, 4}});
  Drain();
  EXPECT_EQ(host_.Read(6), (Bytes{1, 2, 3, 4, 5, 6}));
  EXPECT_EQ(sent_, (std::vector<Bytes>{{1, 2}, {3, 4}, {5, 6}}));
}

TEST_F(PacedSenderTest, DoesNotLetAPieceIntoAnother) {
  sender_.Add(Clock::now(), {{1, 2, 3}});
  line_.ReadByte(*sender_.UntilDue());
  sender_.SendDue();
  sender_.Add(Clock::now() - milliseconds(500), {{9}});
  Drain();
  EXPECT_EQ(host_.Read(4), (Bytes{1, 2, 3, 9}));
}

TEST_F(PacedSenderTest, PausesWithinATornPiece) {
  const Clock::time_point start = Clock::now();
  sender_.Add(start, {.Bytes = Bytes(12, 7), .Torn = true});
  Drain();
  EXPECT_EQ(host_.Read(12), Bytes(12, 7));
  // Five pauses of 3 ms: behind bytes 1, 3, 6, 7 and 9.
  EXPECT_GE(Clock::now() - start, WireTime(12) + milliseconds(15));
}

TEST_F(PacedSenderTest, PullsTheLineOutBehindAPiece) {
  sender_.Add(Clock::now(), {.Bytes = {1, 2}, .LineEndsBehind = true});
  sender_.Add(Clock::now(), {{3}});
  Drain();
  EXPECT_FALSE(line_.IsUp());
  EXPECT_EQ(sent_, std::vector<Bytes>{(Bytes{1, 2})});
  host_.ReadUntilHangUp();
  EXPECT_TRUE(host_.HungUp());
}

TEST_F(PacedSenderTest, ReadsTheLineMeanwhile) {
  sender_.Add(Clock::now(), {Bytes(20, 1)});
  host_.Write({8, 9});
  Bytes read;
  while (const auto left = sender_.UntilDue()) {
    if (const auto byte = line_.ReadByte(*left)) {
      read.push_back(*byte);
    }
    sender_.SendDue();
  }
  EXPECT_EQ(read, (Bytes{8, 9}));
  EXPECT_EQ(host_.Read(20), Bytes(20, 1));
}

}  // namespace
}  // namespace sim
