#include "core/text/Filled.h"

#include <cstddef>

#include "platform/Letters.h"

std::string Filled(std::string_view text, std::initializer_list<std::string_view> values) {
  std::string filled;
  for (std::size_t at = 0; at < text.size(); ++at) {
    const char digit = text[at] == '%' && at + 1 < text.size() ? text[at + 1] : '0';
    const auto place = static_cast<std::size_t>(digit - '0');
    if (IsDigit(digit) && place > 0 && place <= values.size()) {
      filled += values.begin()[place - 1];
      ++at;
    } else {
      filled += text[at];
    }
  }
  return filled;
}
