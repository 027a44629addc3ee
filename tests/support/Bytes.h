#pragma once

#include <cstdint>
#include <vector>

/// What goes over a line or into a file.
using Bytes = std::vector<std::uint8_t>;
