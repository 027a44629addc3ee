#pragma once

#include "core/line/Checksum.h"
#include "tests/devices/radio/RadioSite.h"
#include "tests/support/Frames.h"

/// The scores of Red 1.
inline Bytes BlockOfRed1() {
  Bytes block = FrameOfRed1();
  block.pop_back();
  return block;
}

/// Answer of a healthy gun with the scores of Red 1.
inline Bytes AnswerTo(const Bytes& packet) {
  const std::uint8_t id = packet[1];
  const Bytes block = BlockOfRed1();
  if (packet[4] == 6) {
    return SearchAnswer(id);
  }
  if (packet[5] == 1) {
    return {4, id, 0, 0, 5, 1, 52, 0, Crc8(block)};
  }
  if (packet[5] == 2) {
    return Joined({{55, id, 0, 0, 5, 2, 0, 51}, block});
  }
  return {1, id, 0, 0, 5, 3};
}
