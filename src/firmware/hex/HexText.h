#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

/// Hexadecimal texts and the lines that hold them.

/// `value` in `width` upper-case digits, with zeros in front. Of a text that is longer than that, it is the
/// `width` digits from its character number (length - width) on, counted from 1: 1F00010 in 6 digits is
/// "1F0001".
std::string FormatHex(std::uint32_t value, std::size_t width);

/// `value` in upper-case digits without zeros in front.
std::string HexText(std::uint32_t value);

/// Appends the two upper-case digits of a byte.
void AppendHexByte(std::string& text, std::uint8_t byte);

/// The value of a text of hexadecimal digits, upper or lower case. Throws RuntimeError 13 for an empty text
/// and for any other character, 6 above 32 bits.
std::uint32_t HexNumber(std::string_view digits);

/// The byte in the two digits at `at`, counted from 0. Throws RuntimeError 13 if they are not there.
std::uint8_t HexByteAt(std::string_view line, std::size_t at);

/// Up to `count` characters of `text` from `at` on, counted from 0; none beyond its end.
inline std::string_view Middle(std::string_view text, std::size_t at, std::size_t count) {
  return at < text.size() ? text.substr(at, count) : std::string_view();
}

/// Takes the lines of a text one by one, each without its line end: a line feed, or a carriage return and a
/// line feed. A carriage return alone ends no line, nor does the last line need an end.
class LineReader {
 public:
  /// `text` must outlive the reader.
  explicit LineReader(std::string_view text) : rest_(text) {}

  bool AtEnd() const { return rest_.empty(); }

  /// Must not be called at the end.
  std::string_view Next();

 private:
  std::string_view rest_;
};
