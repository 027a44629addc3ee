#include "platform/linux/InstanceLine.h"

// "show" TAB TAB TOKEN or "open" TAB PATH TAB TOKEN. A control character or "%" in a field is "%" with two
// hexadecimal digits.

namespace {

constexpr std::string_view HexDigits = "0123456789ABCDEF";
constexpr std::string_view ShowWord = "show";
constexpr std::string_view OpenWord = "open";

bool NeedsEscape(char byte) {
  constexpr unsigned char blank = 0x20;
  constexpr unsigned char del = 0x7F;
  const auto code = static_cast<unsigned char>(byte);
  return code < blank || code == del || byte == '%';
}

void AppendField(std::string& line, std::string_view field) {
  constexpr unsigned halfByte = 4;
  line += '\t';
  for (const char byte : field) {
    if (NeedsEscape(byte)) {
      const auto code = static_cast<unsigned char>(byte);
      line += '%';
      line += HexDigits[code >> halfByte];
      line += HexDigits[code & 0xFU];
    } else {
      line += byte;
    }
  }
}

std::optional<std::string> FieldOf(std::string_view escaped) {
  constexpr std::size_t escapeLength = 3;
  constexpr std::size_t base = 16;
  std::string field;
  while (!escaped.empty()) {
    if (escaped.front() != '%') {
      if (NeedsEscape(escaped.front())) {
        return std::nullopt;
      }
      field += escaped.front();
      escaped.remove_prefix(1);
      continue;
    }
    const auto digit = [&escaped](std::size_t place) {
      return escaped.size() < escapeLength ? std::string_view::npos : HexDigits.find(escaped[place]);
    };
    if (digit(1) == std::string_view::npos || digit(2) == std::string_view::npos) {
      return std::nullopt;
    }
    const char byte = static_cast<char>(digit(1) * base + digit(2));
    if (byte == '\0' || !NeedsEscape(byte)) {
      return std::nullopt;
    }
    field += byte;
    escaped.remove_prefix(escapeLength);
  }
  return field;
}

}  // namespace

std::optional<std::string> InstanceLine(const InstanceRequest& request) {
  const bool isRelative = !request.Path.empty() && request.Path.front() != '/';
  const bool hasNul = (request.Path + request.Token).find('\0') != std::string::npos;
  if (isRelative || hasNul) {
    return std::nullopt;
  }
  std::string line(request.Path.empty() ? ShowWord : OpenWord);
  AppendField(line, request.Path);
  AppendField(line, request.Token);
  line += '\n';
  return line.size() <= LongestInstanceLine ? std::optional(line) : std::nullopt;
}

std::optional<InstanceRequest> ReadInstanceLine(std::string_view line) {
  const std::size_t first = line.find('\t');
  const std::size_t second = first == std::string_view::npos ? first : line.find('\t', first + 1);
  if (second == std::string_view::npos || line.size() >= LongestInstanceLine) {
    return std::nullopt;
  }
  const std::string_view word = line.substr(0, first);
  const std::optional<std::string> path = FieldOf(line.substr(first + 1, second - first - 1));
  const std::optional<std::string> token = FieldOf(line.substr(second + 1));
  if (!path || !token) {
    return std::nullopt;
  }
  const bool isSound = path->empty() ? word == ShowWord : word == OpenWord && path->front() == '/';
  return isSound ? std::optional(InstanceRequest{*path, *token}) : std::nullopt;
}
