#pragma once

#include <initializer_list>
#include <string>
#include <string_view>

/// `text` with each place %1 to %9 taken by the value of that number, counted from 1. A place without a value
/// stays as it stands, and what a value holds is not looked at for places.
std::string Filled(std::string_view text, std::initializer_list<std::string_view> values);
