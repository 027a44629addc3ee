#pragma once

/// ASCII letters, whatever the locale. Down here because drivers of files and devices need them too.

constexpr bool IsDigit(char letter) {
  return letter >= '0' && letter <= '9';
}

/// A space or a tab.
constexpr bool IsBlank(char letter) {
  return letter == ' ' || letter == '\t';
}

/// A space, a tab, or one of the characters that end a line or page.
constexpr bool IsWhiteSpace(char letter) {
  return letter == ' ' || (letter >= '\t' && letter <= '\r');
}

/// Letters beyond ASCII stay as they are.
constexpr char LowerAscii(char letter) {
  return letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter;
}
