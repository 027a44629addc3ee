#pragma once

#include <cstdint>
#include <vector>

#include "tests/support/Bytes.h"

/// Frames as a base unit sends them, written byte by byte from the layout; the last byte is the check byte.

/// Red 1: counters 258 and 3 to 10, button 0807060504030201, health 100, clips 2, ammunition 30, damage
/// values 4 and 10, 125 minutes, flag 1; 260 damage from Blue 0 and 5 from itself.
inline Bytes FrameOfRed1() {
  return {52, 0,   41, 0, 33, 18,                                          //
          1,  2,   0,  3, 0,  4,  0, 5, 0, 6,  0, 7,   0, 8, 0, 9, 0, 10,  //
          1,  2,   3,  4, 5,  6,  7, 8,                                    //
          0,  100, 0,  2, 0,  30, 0, 4, 0, 10, 0, 125, 1,                  //
          2,  64,  4,  1, 33, 5,  0,                                       //
          90};
}

/// The same gun in a second run: another button, less health, another flag.
inline Bytes SecondFrameOfRed1() {
  return {52,   0,  41, 0, 33, 18,                                          //
          1,    2,  0,  3, 0,  4,  0, 5, 0, 6,  0, 7,   0, 8, 0, 9, 0, 10,  //
          0xAB, 2,  3,  4, 5,  6,  7, 8,                                    //
          0,    7,  0,  2, 0,  30, 0, 4, 0, 10, 0, 125, 3,                  //
          2,    64, 4,  1, 33, 5,  0,                                       //
          4};
}

/// Blue 0: one shot, two deaths, no button, health 50, primary damage 20, one minute, no hits.
inline Bytes FrameOfBlue0() {
  return {46, 0,  41, 0, 64, 18,                                       //
          0,  1,  0,  0, 0,  0,  0, 0, 0, 2,  0, 0, 0, 0, 0, 0, 0, 0,  //
          0,  0,  0,  0, 0,  0,  0, 0,                                 //
          0,  50, 0,  0, 0,  0,  0, 0, 0, 20, 0, 1, 0,                 //
          0,                                                           //
          215};
}

/// Red 1 with the longest frame that fits the buffer, 1001 bytes: 949 unknown bytes are between the flag and
/// the number of hits, and the second hit, 517 damage, ends in the buffer's last byte.
inline Bytes LongestFrameOfRed1() {
  Bytes frame = FrameOfRed1();
  frame.insert(frame.begin() + 45, 949, 0);
  frame[0] = 0xE9;
  frame[1] = 0x03;
  frame[2] = 0xDE;
  frame[3] = 0x03;
  frame[1000] = 2;
  frame[1001] = 175;
  return frame;
}

inline Bytes WithWrongCheckByte(Bytes frame) {
  frame.back() ^= 1;
  return frame;
}
