#pragma once

#include <optional>
#include <string_view>

/// Walks through a text whose lines end in carriage return and line feed; either of them alone is an ordinary
/// character. The last line counts with or without a line end.
class CrLfLines {
 public:
  explicit CrLfLines(std::string_view text) : rest_(text) {}

  /// The next line without its end; nothing at the end of the text.
  std::optional<std::string_view> Next() {
    if (rest_.empty()) {
      return std::nullopt;
    }
    const std::size_t end = rest_.find("\r\n");
    const std::string_view line = rest_.substr(0, end);
    rest_.remove_prefix(end == std::string_view::npos ? rest_.size() : end + 2);
    return line;
  }

 private:
  std::string_view rest_;
};
