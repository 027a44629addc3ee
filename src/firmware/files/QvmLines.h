#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

/// The data lines of a QVM file, each a ":" and what the device gets as one buffer, in hexadecimal digits.
/// The file's lines end in carriage return and line feed; all others, and those with a NUL in them, are left
/// out.
class QvmLines {
 public:
  static constexpr std::size_t MostBytesOfALine = 51;

  /// Whether a line of the file is one of data.
  static bool IsData(std::string_view line) {
    return line.starts_with(':') && line.find('\0') == std::string_view::npos;
  }

  explicit QvmLines(std::string bytes);
  QvmLines(const QvmLines&) = delete;
  QvmLines& operator=(const QvmLines&) = delete;

  /// With their ":".
  const std::vector<std::string_view>& BufferLines() const { return bufferLines_; }

 private:
  const std::string bytes_;
  std::vector<std::string_view> bufferLines_;  ///< parts of `bytes_`
};
