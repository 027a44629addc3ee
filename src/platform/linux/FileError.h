#pragma once

#include <string>

#include "platform/RuntimeError.h"

/// What the system's error `errorNumber` (errno) on `path` is to the operator: 61 disk full, 70 permission
/// denied, 76 path not found, 75 anything else; the text names the file.
RuntimeError FileError(int errorNumber, const std::string& path);
