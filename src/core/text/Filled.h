#pragma once

#include <initializer_list>
#include <string>
#include <string_view>

/// `text` with each placeholder %1 to %9 replaced by the value of that number, counted from 1. A placeholder
/// without a value stays as it is, and values are not searched for placeholders.
std::string Filled(std::string_view text, std::initializer_list<std::string_view> values);
