#pragma once

/// ASCII characters, independent of the locale. In platform/ because file and device drivers need them too.

constexpr bool IsDigit(char letter) {
  return letter >= '0' && letter <= '9';
}

/// A space or a tab.
constexpr bool IsBlank(char letter) {
  return letter == ' ' || letter == '\t';
}

/// A space, a tab, or a line or page break.
constexpr bool IsWhiteSpace(char letter) {
  return letter == ' ' || (letter >= '\t' && letter <= '\r');
}

/// Letters beyond ASCII stay as they are.
constexpr char LowerAscii(char letter) {
  return letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter;
}
