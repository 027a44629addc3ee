#include "platform/sqlite/LikeRange.h"

#include <strings.h>

#include <algorithm>
#include <optional>
#include <string_view>

#include "platform/RuntimeError.h"
#include "platform/Utf8.h"
#include "platform/sqlite/JetLike.h"

namespace {

constexpr std::string_view Blanks = " \t\r\n";

std::string_view WithoutBlanks(std::string_view text) {
  const std::size_t first = text.find_first_not_of(Blanks);
  return first == std::string_view::npos ? std::string_view() : text.substr(first);
}

bool EqualWords(std::string_view left, std::string_view right) {
  return left.size() == right.size() && strncasecmp(left.data(), right.data(), left.size()) == 0;
}

bool IsLetter(char character) {
  return (character >= 'a' && character <= 'z') || (character >= 'A' && character <= 'Z');
}

// CanPrecede and CanFollow: true if the comparison between them is a whole term of AND, OR, NOT and brackets.
bool CanPrecede(std::string_view before) {
  const std::size_t last = before.find_last_not_of(Blanks);
  if (last == std::string_view::npos || before[last] == '(') {
    return true;
  }
  before = before.substr(0, last + 1);
  std::size_t word = before.size();
  while (word > 0 && IsLetter(before[word - 1])) {
    --word;
  }
  const std::string_view name = before.substr(word);
  return EqualWords(name, "AND") || EqualWords(name, "OR") || EqualWords(name, "NOT");
}

bool CanFollow(std::string_view behind) {
  behind = WithoutBlanks(behind);
  const auto end = std::find_if_not(behind.begin(), behind.end(), IsLetter);
  const std::string_view word = behind.substr(0, static_cast<std::size_t>(end - behind.begin()));
  return behind.empty() || behind.front() == ')' || EqualWords(word, "AND") || EqualWords(word, "OR");
}

// Length of the quoted string at the start of `text`, quotes included; 0 if it is not closed.
std::size_t QuotedLength(std::string_view text) {
  std::size_t end = 1;
  while ((end = text.find('\'', end)) != std::string_view::npos) {
    if (end + 1 >= text.size() || text[end + 1] != '\'') {
      return end + 1;
    }
    end += 2;
  }
  return 0;
}

std::string Unquoted(std::string_view quoted) {
  std::string text;
  for (std::size_t i = 1; i + 1 < quoted.size(); ++i) {
    text += quoted[i];
    i += quoted[i] == '\'' ? 1 : 0;
  }
  return text;
}

std::string Quoted(std::u32string_view text) {
  std::string quoted = "'";
  for (const char32_t character : text) {
    quoted += character == U'\'' ? "'" : "";  // doubled
    Utf8::Append(quoted, character);
  }
  return quoted + "'";
}

// The range that holds all texts matching the quoted `pattern`, as a condition on the bracketed `column`.
std::optional<std::string> RangeOf(const SqliteTable& table, std::string_view column,
                                   std::string_view pattern) {
  const std::string_view name = column.substr(1, column.size() - 2);
  const auto known = std::find_if(table.Columns().begin(), table.Columns().end(),
                                  [name](const SqliteColumn& own) { return EqualWords(own.Name, name); });
  if (known == table.Columns().end() || !known->IsText) {
    return std::nullopt;
  }
  std::u32string start;
  try {
    start = JetPattern(Unquoted(pattern)).FixedStart();
  } catch (const RuntimeError&) {
    return std::nullopt;  // an invalid pattern is reported by the search itself
  }
  if (start.empty()) {
    return std::nullopt;
  }
  std::u32string behind = start;
  ++behind.back();
  const std::string brackets(column);
  return " AND " + brackets + " >= " + Quoted(start) + " COLLATE NOCASE AND " + brackets + " < " +
         Quoted(behind) + " COLLATE NOCASE";
}

// Length of "LIKE 'text'" with the blanks before it, and of its quoted string; 0 for anything else.
struct LikeTerm {
  std::size_t Length = 0;
  std::size_t QuotedText = 0;
};

LikeTerm LikeTermAt(std::string_view text) {
  constexpr std::string_view keyword = "LIKE";
  const std::string_view word = WithoutBlanks(text);
  if (!EqualWords(word.substr(0, keyword.size()), keyword)) {
    return {};
  }
  const std::string_view quoted = WithoutBlanks(word.substr(keyword.size()));
  const std::size_t length = quoted.starts_with('\'') ? QuotedLength(quoted) : 0;
  if (length == 0 || !CanFollow(quoted.substr(length))) {
    return {};
  }
  return {text.size() - quoted.size() + length, length};
}

}  // namespace

std::string WithLikeRanges(const SqliteTable& table, const std::string& condition) {
  constexpr std::string_view unreadable("\0", 1);
  const std::string_view text = condition;
  for (const std::string_view part : {std::string_view("--"), std::string_view("/*"), unreadable}) {
    if (text.find(part) != std::string_view::npos) {
      return condition;
    }
  }
  std::string result;
  for (std::size_t i = 0; i < text.size();) {
    const std::size_t closing = text[i] == '[' ? text.find(']', i) : std::string_view::npos;
    std::size_t length = text[i] == '\'' ? std::max<std::size_t>(QuotedLength(text.substr(i)), 1) : 1;
    if (closing != std::string_view::npos) {
      length = closing + 1 - i;
      const LikeTerm term = LikeTermAt(text.substr(closing + 1));
      const std::size_t end = closing + 1 + term.Length;
      if (term.Length != 0 && CanPrecede(text.substr(0, i))) {
        const std::string_view pattern = text.substr(end - term.QuotedText, term.QuotedText);
        if (const auto range = RangeOf(table, text.substr(i, length), pattern)) {
          result += "(" + std::string(text.substr(i, end - i)) + *range + ")";
          i = end;
          continue;
        }
      }
    }
    result += text.substr(i, length);
    i += length;
  }
  return result;
}

std::vector<std::string> LikeAlternatives(const SqliteTable& table, const std::string& condition) {
  std::string_view rest = WithoutBlanks(condition);
  if (rest.starts_with('(') && rest.ends_with(')')) {
    rest = rest.substr(1, rest.size() - 2);
  }
  std::vector<std::string> alternatives;
  for (;;) {
    rest = WithoutBlanks(rest);
    const std::size_t column = rest.starts_with('[') ? rest.find(']') + 1 : 0;  // length
    const LikeTerm term = column != 0 ? LikeTermAt(rest.substr(column)) : LikeTerm();
    if (term.Length == 0) {
      return {};
    }
    const std::size_t end = column + term.Length;
    const std::string_view pattern = rest.substr(end - term.QuotedText, term.QuotedText);
    const auto range = RangeOf(table, rest.substr(0, column), pattern);
    if (!range || pattern.find('\0') != std::string_view::npos) {
      return {};
    }
    alternatives.push_back(std::string(rest.substr(0, end)) + *range);
    rest = WithoutBlanks(rest.substr(end));
    if (rest.empty()) {
      return alternatives;
    }
    constexpr std::string_view separator = "OR";
    if (!EqualWords(rest.substr(0, separator.size()), separator)) {
      return {};
    }
    rest.remove_prefix(separator.size());
  }
}
