#include "platform/qt/QtSoundPlayer.h"

#include <gtest/gtest.h>

#include <QAudioDevice>
#include <QMediaDevices>
#include <chrono>

#include "platform/qt/QtEventPump.h"
#include "tests/support/Thrown.h"

using std::chrono::milliseconds;

namespace {

/// A fifth of a second of silence.
std::vector<std::uint8_t> Sound() {
  return std::vector<std::uint8_t>(22050 / 5, 128);
}

class SoundDevice : public testing::Test {
 protected:
  const bool isThere = !QMediaDevices::defaultAudioOutput().isNull();
  QtEventPump events;
  QtSoundPlayer player;
};

TEST_F(SoundDevice, IsToldToBeUnavailableAtOnceWhereThereIsNone) {
  const auto start = events.Elapsed();
  const int fault = NumberThrownBy([this] { player.Play(Sound(), 22050); });
  EXPECT_EQ(fault, isThere ? 0 : 68);
  EXPECT_EQ(player.Playing(), isThere);
  EXPECT_LT(events.Elapsed() - start, milliseconds(5000));
}

TEST_F(SoundDevice, PlaysASoundToItsEndOrNothing) {
  const int fault = NumberThrownBy([this] { player.Play(Sound(), 22050); });
  const auto end = events.WaitFor([this] { return !player.Playing(); }, milliseconds(10'000));
  EXPECT_EQ(end, WaitResult::Met);
  EXPECT_EQ(player.Position(), milliseconds(fault == 0 ? 200 : 0));
}

TEST_F(SoundDevice, IsAtTheStartAfterAStop) {
  NumberThrownBy([this] { player.Play(Sound(), 22050); });
  player.Stop();
  EXPECT_FALSE(player.Playing());
  EXPECT_EQ(player.Position(), milliseconds(0));
  player.Stop();
}

}  // namespace
