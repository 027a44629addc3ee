#pragma once

#include <array>

#include "sim/line/DeviceFailure.h"

namespace sim {

/// What can go wrong when a utility box is programmed.
enum class BoxFailure {
  None,
  Rejects,
  Silent,
  Late,
  AnswersTwice,
  Noise,
  Unplugged,
};

using BoxFailureInfo = FailureInfo<BoxFailure>;

inline constexpr std::array<BoxFailureInfo, 7> BoxFailures{{
    {BoxFailure::None, "none", FailurePlace::None, "a faultless box"},
    {BoxFailure::Rejects, "rejects", FailurePlace::None, "good values are rejected too"},
    {BoxFailure::Silent, "silent", FailurePlace::None, "no answer"},
    {BoxFailure::Late, "late", FailurePlace::None, "the answer comes late, see --box-late"},
    {BoxFailure::AnswersTwice, "answers-twice", FailurePlace::None,
     "the answer, and at once the opposite one"},
    {BoxFailure::Noise, "noise", FailurePlace::None, "a byte of line noise before the answer"},
    {BoxFailure::Unplugged, "unplugged", FailurePlace::Byte,
     "the box is pulled out when byte K of a frame has come (10: instead of its answer)"},
}};
static_assert(IsInOrder(BoxFailures));

}  // namespace sim
