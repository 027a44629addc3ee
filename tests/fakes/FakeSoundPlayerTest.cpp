#include "tests/fakes/FakeSoundPlayer.h"

#include <gtest/gtest.h>

#include "tests/support/Thrown.h"

namespace {

using namespace std::chrono_literals;

class Player : public testing::Test {
 protected:
  FakeEventPump pump;
  FakeSoundPlayer player{pump};
  const std::vector<std::uint8_t> halfSecond = std::vector<std::uint8_t>(11025, 128);
};

TEST_F(Player, PlaysAsLongAsTheSamplesLast) {
  EXPECT_FALSE(player.Playing());
  player.Play(halfSecond, 22050);
  EXPECT_TRUE(player.Playing());
  pump.Sleep(200ms);
  EXPECT_TRUE(player.Playing());
  EXPECT_EQ(player.Position(), 200ms);
  EXPECT_EQ(pump.WaitFor([&] { return !player.Playing(); }, 10s), WaitResult::Met);
  EXPECT_EQ(pump.Now(), 500ms);
  EXPECT_EQ(player.Position(), 500ms);
}

TEST_F(Player, GoesBackToTheStartWhenItIsStopped) {
  player.Play(halfSecond, 22050);
  pump.Sleep(200ms);
  player.Stop();
  EXPECT_FALSE(player.Playing());
  EXPECT_EQ(player.Position(), 0ms);
}

TEST_F(Player, SaysAtOnceThatThereIsNoDevice) {
  player.Play(halfSecond, 22050);
  player.NoDevice = true;
  const Thrown thrown = ThrownBy([&] { player.Play(halfSecond, 22050); });
  EXPECT_EQ(thrown.Number, 68);
  EXPECT_EQ(thrown.Text, "Device unavailable");
  EXPECT_FALSE(player.Playing());
  EXPECT_EQ(player.Played.size(), 1U);
}

}  // namespace
