#pragma once

#include <cstdint>
#include <limits>

/// Members have numbers up to this one, which leaves a million for those who are entered after the last. A
/// higher number in a file is a mistake: no member comes to have it, and after it there would be none left.
inline constexpr std::int32_t HighestMemberNumber =
    std::numeric_limits<std::int32_t>::max() - (std::int32_t{1} << 20U);
