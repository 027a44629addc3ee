#pragma once

#include <string>
#include <string_view>
#include <vector>

/// A pattern of Jet's LIKE, compiled so that many texts can be matched against it.
///
/// `*` matches any text, including none, `?` one character, `#` one digit 0 to 9, `[abc]` and `[a-z]` one
/// character of the set, `[!a-z]` one outside it. Within brackets `*`, `?`, `#` and `[` are literal, and so
/// is `-` at either end; `[]` matches the empty text, `[!]` an exclamation mark; `]` outside brackets is
/// literal. Case is ignored in every script that has it, but no other letter matches an ASCII letter.
/// Texts are UTF-8; a byte that is not UTF-8 is a character of its own.
class JetPattern {
 public:
  /// Throws RuntimeError 93 for an unclosed bracket or a descending range.
  explicit JetPattern(std::string_view pattern);

  /// True if the pattern matches the whole of `text`. The time is at most proportional to the product of both
  /// lengths.
  bool Matches(std::string_view text) const;

  /// The prefix that all matching texts share, ignoring the case of ASCII letters: the literal characters up
  /// to the first non-ASCII one with an upper or lower case. Empty when there is none.
  std::u32string FixedStart() const;

 private:
  struct Range {
    char32_t First;
    char32_t Last;
  };
  enum class Kind { Character, AnyCharacter, Digit, Set, AnyText };
  struct Token {
    Kind What;
    char32_t Character = 0;
    bool Negated = false;
    std::vector<Range> Ranges;
  };

  void AddSet(std::string_view& rest);
  static bool Fits(const Token& token, char32_t character);

  std::vector<Token> tokens_;
};

/// True if `pattern` matches `text`. Throws as JetPattern does.
bool JetLike(std::string_view text, std::string_view pattern);
