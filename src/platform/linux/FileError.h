#pragma once

#include <string>

#include "platform/RuntimeError.h"

/// The RuntimeError for the system error `errorNumber` (errno) on `path`: 61 disk full, 70 permission denied,
/// 76 path not found, 75 anything else. The text names the file.
RuntimeError FileError(int errorNumber, const std::string& path);
