#pragma once

#include <gtest/gtest.h>

#include <string>

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

}  // namespace sim
