#pragma once

#include <string>

#include "core/text/StringTable.h"
#include "firmware/hex/ImageComparison.h"
#include "platform/Files.h"

/// What the commands work with.
struct ToolParts {
  Files& Disk;
  const StringTable& Strings;
};

namespace ToolExit {
inline constexpr int Good = 0;
inline constexpr int Failed = 1;
inline constexpr int Warned = 2;
inline constexpr int WrongOptions = 3;
}  // namespace ToolExit

/// "code N" on the standard output.
void PrintCode(std::int32_t code);

/// One line "warning ADDRESS COUNT TEXT" for each stretch on the standard output.
void PrintWarnings(const std::vector<LostStretch>& warnings, const StringTable& strings);

/// A line on the standard error.
void Complain(const std::string& text);
