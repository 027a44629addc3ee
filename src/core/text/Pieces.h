#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

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

/// The parts of `text` between its separators, at least one.
inline std::vector<std::string> PartsOf(std::string_view text, char separator) {
  std::vector<std::string> parts;
  for (std::size_t at = text.find(separator); at != std::string_view::npos; at = text.find(separator)) {
    parts.emplace_back(text.substr(0, at));
    text.remove_prefix(at + 1);
  }
  parts.emplace_back(text);
  return parts;
}

/// `text` up to its first carriage return and line feed, or all of it.
inline std::string FirstLineOf(std::string_view text) {
  return std::string(text.substr(0, text.find("\r\n")));
}
