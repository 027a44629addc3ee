#pragma once

#include <cstddef>
#include <string>
#include <utility>
#include <vector>

/// What a reader of old databases writes of the table Members with these keys and first names.
inline std::string MembersAsRead(const std::vector<std::pair<std::size_t, std::string>>& members) {
  const auto number = [](std::size_t value, std::size_t bytes) {
    std::string text;
    for (std::size_t i = 0; i < bytes; ++i) {
      text += static_cast<char>(value >> (8 * i) & 255);
    }
    return text;
  };
  const auto text = [&number](const std::string& value) { return "S" + number(value.size(), 4) + value; };
  std::string words = "T" + text("Members") + number(2, 4) + text("ContactID") + text("FirstName");
  for (const auto& [key, name] : members) {
    words += "RI" + number(key, 8) + text(name);
  }
  return words + "E";
}
