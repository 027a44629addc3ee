#pragma once

#include <array>

#include "sim/line/DeviceFailure.h"

namespace sim {

/// What can go wrong on the base unit's side of a score download.
enum class BaseUnitFailure {
  None,
  WrongCrc,
  Silence,
  CountZero,
  NoiseBeforeCount,
  TornWrites,
  LongerStatisticsBlock,
  LengthAbove1001,
  HighBitWords,
  SameGunTwice,
  HangUp,
};

using BaseUnitFailureInfo = FailureInfo<BaseUnitFailure>;

inline constexpr std::array<BaseUnitFailureInfo, 11> BaseUnitFailures{{
    {BaseUnitFailure::None, "none", FailurePlace::None, "a faultless answer"},
    {BaseUnitFailure::WrongCrc, "wrong-crc", FailurePlace::Frame, "frame K ends with a wrong check byte"},
    {BaseUnitFailure::Silence, "silence", FailurePlace::Byte,
     "byte K of the answer and all behind it stay away (1: the count byte)"},
    {BaseUnitFailure::CountZero, "count-zero", FailurePlace::None, "the unit says that it has no score data"},
    {BaseUnitFailure::NoiseBeforeCount, "noise-before-count", FailurePlace::None,
     "line noise between the request and the count byte"},
    {BaseUnitFailure::TornWrites, "torn-writes", FailurePlace::None, "bytes in small pieces with pauses"},
    {BaseUnitFailure::LongerStatisticsBlock, "longer-statistics-block", FailurePlace::None,
     "guns of a newer make with more counters than known"},
    {BaseUnitFailure::LengthAbove1001, "length-above-1001", FailurePlace::Frame,
     "frame K is longer than the host can store"},
    {BaseUnitFailure::HighBitWords, "high-bit-words", FailurePlace::Frame,
     "the nine counters of frame K exceed a signed word"},
    {BaseUnitFailure::SameGunTwice, "same-gun-twice", FailurePlace::Frame,
     "the gun of frame K reports a second run, as the last frame"},
    {BaseUnitFailure::HangUp, "hang-up", FailurePlace::Frame,
     "the line is pulled out in the middle of frame K"},
}};
static_assert(IsInOrder(BaseUnitFailures));

}  // namespace sim
