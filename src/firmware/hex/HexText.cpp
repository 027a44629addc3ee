#include "firmware/hex/HexText.h"

#include <algorithm>
#include <array>

#include "platform/RuntimeError.h"

namespace {

constexpr std::string_view Digits = "0123456789ABCDEF";
constexpr std::uint8_t NoDigit = 0xFF;

constexpr std::array<std::uint8_t, 256> ValuesOfDigits = [] {
  std::array<std::uint8_t, 256> values{};
  values.fill(NoDigit);
  for (std::size_t i = 0; i < Digits.size(); ++i) {
    const char digit = Digits[i];
    const auto value = static_cast<std::uint8_t>(i);
    values[static_cast<unsigned char>(digit)] = value;
    if (digit >= 'A') {
      values[static_cast<unsigned char>(digit - 'A' + 'a')] = value;
    }
  }
  return values;
}();

std::uint8_t ValueOf(char digit) {
  const std::uint8_t value = ValuesOfDigits[static_cast<unsigned char>(digit)];
  if (value == NoDigit) {
    throw RuntimeError(Fault::TypeMismatch);
  }
  return value;
}

}  // namespace

std::string HexText(std::uint32_t value) {
  std::string text;
  do {
    text += Digits[value % 16];
    value /= 16;
  } while (value != 0);
  std::reverse(text.begin(), text.end());
  return text;
}

std::string FormatHex(std::uint32_t value, std::size_t width) {
  const std::string text = HexText(value);
  return text.size() <= width ? std::string(width - text.size(), '0') + text
                              : text.substr(text.size() - width - 1, width);
}

void AppendHexByte(std::string& text, std::uint8_t byte) {
  text += Digits[byte / 16];
  text += Digits[byte % 16];
}

std::uint32_t HexNumber(std::string_view digits) {
  if (digits.empty()) {
    throw RuntimeError(Fault::TypeMismatch);
  }
  std::uint32_t number = 0;
  bool tooLarge = false;
  for (const char digit : digits) {
    tooLarge = tooLarge || (number >> 28U) != 0;
    number = number * 16 + ValueOf(digit);
  }
  if (tooLarge) {
    throw RuntimeError(Fault::Overflow);
  }
  return number;
}

std::uint8_t HexByteAt(std::string_view line, std::size_t at) {
  if (at + 2 > line.size()) {
    throw RuntimeError(Fault::TypeMismatch);
  }
  return static_cast<std::uint8_t>(ValueOf(line[at]) * 16 + ValueOf(line[at + 1]));
}

std::string_view LineReader::Next() {
  const std::size_t end = rest_.find('\n');
  std::string_view line = rest_.substr(0, end);
  rest_.remove_prefix(end == std::string_view::npos ? rest_.size() : end + 1);
  if (end != std::string_view::npos && line.ends_with('\r')) {
    line.remove_suffix(1);
  }
  return line;
}
