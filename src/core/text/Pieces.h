#pragma once

#include <string>
#include <string_view>

/// `text` without the characters at either end for which `isBlank` is true.
template <typename Predicate>
constexpr std::string_view Trimmed(std::string_view text, Predicate isBlank) {
  while (!text.empty() && isBlank(text.front())) {
    text.remove_prefix(1);
  }
  while (!text.empty() && isBlank(text.back())) {
    text.remove_suffix(1);
  }
  return text;
}

/// `text` up to its first carriage return and line feed, or all of it.
inline std::string FirstLineOf(std::string_view text) {
  return std::string(text.substr(0, text.find("\r\n")));
}
