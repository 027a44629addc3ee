#pragma once

#include <string>

#include "core/text/StringTable.h"
#include "platform/RuntimeError.h"

/// Why the archive at `path` cannot be used, and what to do about it, in words. The failure's own text if it
/// is about something else.
std::string KeepingFailureText(const RuntimeError& failure, const std::string& path,
                               const StringTable& strings);

/// True if the failure's text names that file.
bool IsAboutFile(const RuntimeError& failure, const std::string& path);
