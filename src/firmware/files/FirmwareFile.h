#pragma once

#include <string_view>

/// The kinds of firmware files, told apart by the ends of their names.
enum class FirmwareFileType { None = 0, Qvm = 1, Qvm2 = 2 };

/// By the last characters of the name, in small letters only: capitals are of no kind.
FirmwareFileType TypeOf(std::string_view fileName);
