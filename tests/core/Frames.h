#pragma once

#include <cstdint>
#include <vector>

/// Frames as a base unit sends them, written byte by byte from the layout; the last byte is the check byte.

using Bytes = std::vector<std::uint8_t>;

/// Red 1: counters 258 and 3 to 10, button 0807060504030201, 260 damage from Blue 0 and 5 from itself.
inline Bytes FrameOfRed1() {
  return {52, 0,                                                              // L
          41, 0,                                                              // M
          33, 18,                                                             // PlayerId, S
          1,  2, 0, 3, 0, 4, 0, 5, 0, 6, 0, 7, 0, 8, 0, 9, 0, 10,             // counters
          1,  2, 3, 4, 5, 6, 7, 8,                                            // button
          0,  100, 0, 2, 0, 30, 0, 4, 0, 10, 0, 125,                          // health to run counter
          1,                                                                  // power cheat flag
          2,  64, 4, 1, 33, 5, 0,                                             // hits
          90};
}

/// Blue 0: one shot, two deaths, no button, primary damage 20, no hits.
inline Bytes FrameOfBlue0() {
  return {46, 0, 41, 0, 64, 18, 0, 1, 0, 0, 0, 0, 0, 0, 0, 2, 0, 0, 0, 0, 0, 0, 0, 0,
          0,  0, 0,  0, 0,  0,  0, 0, 0, 50, 0, 0, 0, 0, 0, 0, 0, 20, 0, 1, 0, 0, 215};
}
