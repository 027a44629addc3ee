#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "platform/Files.h"

/// Results of the check of a HEX file.
namespace HexCode {
inline constexpr std::int16_t Good = 1;
inline constexpr std::int16_t Empty = -1;
inline constexpr std::int16_t NotPadded = -2;  ///< never the result; has a text of its own in the window
inline constexpr std::int16_t WrongChecksum = -3;
inline constexpr std::int16_t NoRecord = -4;  ///< a line begins with something else than a record
inline constexpr std::int16_t NoEnd = -5;     ///< there is no end record
inline constexpr std::int16_t Failure = -6;   ///< unreadable file, or a record that is cut or has no digits
}  // namespace HexCode

/// Checks the text of an INHEX32 file, up to its end record; returns a HexCode. Of a record that is longer
/// than it says, the rest is not looked at. A record whose bytes add up to more than 32767 is a Failure.
std::int16_t CheckHexText(std::string_view text);

/// Checks a file; a HexCode.
std::int16_t CheckHexFile(const Files& files, const std::string& path);
