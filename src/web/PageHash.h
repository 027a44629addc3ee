#pragma once

#include <string>
#include <string_view>

/// 16 hexadecimal digits that differ for different texts, as far as nobody tries to make two agree (FNV-1a).
std::string PageHash(std::string_view text);
