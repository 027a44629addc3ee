#pragma once

#include <gtest/gtest.h>

#include <chrono>
#include <string>

#include "sim/recorder/SoundRecorder.h"
#include "tests/support/JoinedBytes.h"

namespace sim {

/// A page of 0x80, and one of rising samples.
inline const Bytes SilentPage(256, 0x80);
inline const Bytes RisingPage = [] {
  Bytes page(256);
  for (std::size_t i = 0; i < page.size(); ++i) {
    page[i] = static_cast<std::uint8_t>(i);
  }
  return page;
}();
/// Their check bytes without a page number; page 0 has the same.
constexpr std::uint8_t SilentCheck = 0xA3;
constexpr std::uint8_t RisingCheck = 0x18;

/// A table of three entries, 1, 3 and 4: sound 0 has two pages and sound 1 has one.
inline const Bytes TableOfTwo = Bytes{0, 1, 0, 3, 0, 4} + Bytes(250, 0);
constexpr std::uint8_t TableOfTwoCheck = 0x30;

inline const Bytes Ack{0xAA};
inline const Bytes Refusal{0x55};

/// A host that speaks to sound hardware without any pauses.
class RecorderHost : public RawHost {
 public:
  RecorderHost(const std::string& path, int baud) : RawHost(path) { Speak({.Baud = baud}); }

  /// Writes `bytes` and reads `answers` bytes.
  Bytes Ask(const Bytes& bytes, std::size_t answers = 1) {
    Write(bytes);
    return Read(answers);
  }
};

/// Up to the end of the erase.
inline void BeginInProduct(RecorderHost& host) {
  EXPECT_EQ(host.Ask({10, 0}), Ack);
  EXPECT_EQ(host.Ask({2, 0}, 2), Ack + Ack);
}
inline void BeginStandAlone(RecorderHost& host) {
  EXPECT_EQ(host.Ask({2, 3}), Ack);
  EXPECT_EQ(host.Ask({2, 3}, 2), Ack + Ack);
}

inline constexpr int Gun = 19200;
inline constexpr int Alone = 115200;

/// A recorder without waits.
inline SoundRecorderSettings Quick() {
  return {.LinePace = Pace::Fast, .Patience = std::chrono::milliseconds(400)};
}

/// A whole recording of two sounds, of two pages and of one.
inline void RecordTwoInProduct(RecorderHost& host) {
  BeginInProduct(host);
  EXPECT_EQ(host.Ask(Bytes{1, 0, 0, 0} + TableOfTwo + Bytes{TableOfTwoCheck}), Ack);
  EXPECT_EQ(host.Ask(Bytes{1, 0, 0, 0} + RisingPage + Bytes{RisingCheck}), Ack);
  EXPECT_EQ(host.Ask(Bytes{1, 0, 1, 0} + SilentPage + Bytes{0x2C}), Ack);
  EXPECT_EQ(host.Ask(Bytes{1, 0, 2, 0} + SilentPage + Bytes{0xA4}), Ack);
  EXPECT_EQ(host.Ask({0, 0}), Ack);
}

inline void RecordTwoStandAlone(RecorderHost& host) {
  BeginStandAlone(host);
  EXPECT_EQ(host.Ask({1, 0}), Ack);
  EXPECT_EQ(host.Ask(Bytes{2, 0} + RisingPage + Bytes{RisingCheck}), Ack);
  EXPECT_EQ(host.Ask(SilentPage + Bytes{SilentCheck}), Ack);
  // The host does not wait for the answer to a later header.
  EXPECT_EQ(host.Ask(Bytes{1, 9, 1, 0} + SilentPage + Bytes{SilentCheck}, 2), Ack + Ack);
  EXPECT_EQ(host.Ask({0, 0}), Ack);
}

}  // namespace sim
