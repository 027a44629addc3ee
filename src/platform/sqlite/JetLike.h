#pragma once

#include <string>
#include <string_view>
#include <vector>

/// A pattern of Jet's LIKE, ready to be held against many texts.
///
/// `*` stands for any text (also none), `?` for one character, `#` for one digit 0 to 9, `[abc]` and `[a-z]`
/// for one character of the set, `[!a-z]` for one outside it. Within brackets `*`, `?`, `#` and `[` are
/// themselves, and so is
/// `-` at either end; `[]` stands for nothing, `[!]` for an exclamation mark, and `]` outside brackets for
/// itself. Case does not count, in any script that has one; no letter counts as an ASCII letter but these.
/// Texts are UTF-8; a byte that is none is a character of its own.
class JetPattern {
 public:
  /// Throws RuntimeError 93 for a bracket that is not closed or a range that runs downwards.
  explicit JetPattern(std::string_view pattern);

  /// True when the whole of `text` fits. Takes at most time proportional to the product of both lengths.
  bool Matches(std::string_view text) const;

  /// What every text that fits begins with when the case of ASCII letters does not count: the characters
  /// before the first that has other forms. Empty when nothing can be said.
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

/// Holds one text against one pattern. Throws as JetPattern does.
bool JetLike(std::string_view text, std::string_view pattern);
