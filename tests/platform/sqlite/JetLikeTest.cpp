#include "platform/sqlite/JetLike.h"

#include <gtest/gtest.h>

#include <string>

#include "tests/support/Thrown.h"

namespace {

struct LikeCase {
  std::string Text;
  std::string Pattern;
  bool Fits;
};

void ExpectAll(const std::vector<LikeCase>& cases) {
  for (const LikeCase& one : cases) {
    EXPECT_EQ(JetLike(one.Text, one.Pattern), one.Fits)
        << "'" << one.Text << "' LIKE '" << one.Pattern << "'";
  }
}

TEST(JetLike, PatternWithoutWildcardsMustBeTheWholeText) {
  ExpectAll({{"Morgan", "Morgan", true},
             {"Morgan", "Morga", false},
             {"Morga", "Morgan", false},
             {"", "", true},
             {"a", "", false},
             {"", "a", false}});
}

TEST(JetLike, StarStandsForAnyText) {
  ExpectAll({{"Morgan", "mo*", true},
             {"Mole", "mo*", true},
             {"mo", "mo*", true},
             {"Belmont", "mo*", false},
             {"Belmont", "*mo*", true},
             {"Belmont", "*nt", true},
             {"Belmont", "b*t", true},
             {"Belmont", "b*m", false},
             {"", "*", true},
             {"", "**", true},
             {"abcabd", "*ab?", true},
             {"aXbXc", "a*b*c", true},
             {"aXbXc", "a*c*b", false},
             {"aab", "*ab", true},
             {"line\nbreak", "line*", true}});
}

TEST(JetLike, QuestionMarkStandsForOneCharacter) {
  ExpectAll({{"cat", "c?t", true},
             {"ct", "c?t", false},
             {"coat", "c?t", false},
             {"cat", "???", true},
             {"cat", "??", false},
             {"é", "?", true},
             {"马库斯", "???", true}});
}

TEST(JetLike, HashStandsForOneDigit) {
  ExpectAll(
      {{"A5", "a#", true}, {"A", "a#", false}, {"AB", "a#", false}, {"A55", "a#", false}, {"#", "#", false}});
}

TEST(JetLike, SetStandsForOneOfItsCharacters) {
  ExpectAll({{"bat", "[bc]at", true},
             {"cat", "[bc]at", true},
             {"rat", "[bc]at", false},
             {"at", "[bc]at", false},
             {"M", "[a-m]", true},
             {"n", "[a-m]", false},
             {"m", "[A-M]", true},
             {"7", "[a-c5-9]", true},
             {"4", "[a-c5-9]", false}});
}

TEST(JetLike, NegatedSetStandsForOneOtherCharacter) {
  ExpectAll({{"d", "[!a-c]", true},
             {"B", "[!a-c]", false},
             {"", "[!a-c]", false},
             {"é", "[!a-z]", true},
             {"d!", "d[!a]", true}});
}

TEST(JetLike, SpecialCharactersAreThemselvesInBrackets) {
  ExpectAll({{"*", "[*]", true},
             {"a", "[*]", false},
             {"what?", "what[?]", true},
             {"whats", "what[?]", false},
             {"#1", "[#]1", true},
             {"11", "[#]1", false},
             {"[x]", "[[]x]", true},
             {"x]", "x]", true},
             {"]", "]", true},
             {"-", "[a-]", true},
             {"-", "[-a]", true},
             {"b", "[a-]", false},
             {"!", "[!]", true},
             {"!", "[a!]", true},
             {"ab", "a[]b", true}});
}

TEST(JetLike, CaseDoesNotCountInAnyScript) {
  ExpectAll({{"MORGAN", "morgan", true},
             {"Émile", "éMILE", true},
             {"émile", "É*", true},
             {"Эмиль", "эМ*", true},
             {"ΑΘΗΝΑ", "αθηνα", true},
             {"e", "é", false},
             {"É", "[à-ë]", true}});
}

TEST(JetLike, MatchesChinese) {
  ExpectAll({{"马库斯", "马*", true},
             {"马库斯", "*斯", true},
             {"马库斯", "库*", false},
             {"马库斯", "马[库裤]斯", true}});
}

TEST(JetLike, MatchesTheLastCharactersOfTheBasicPlane) {
  ExpectAll({{"\uEFFF", "?", true},
             {"\uF000", "?", true},
             {"\uFFFD", "?", true},
             {"\uFFFF", "?", true},
             {"a\uF8FFb", "a?b", true},
             {"\uF900", "[\uF000-\uFFFF]", true},
             {"\uE000", "[\uF000-\uFFFF]", false},
             {"\uF000", "[!\uE000-\uFFFF]", false},
             {"\uF000", "\uF001", false},
             {"ＡＮＮＡ", "ａnna", false},
             {"ＡＮＮＡ", "ａｎ*", true},
             {"（会员）", "（*）", true}});
}

TEST(JetLike, SignsOfOtherPatternsAreOrdinary) {
  ExpectAll({{"100%", "100%", true},
             {"1000", "100%", false},
             {"a_b", "a_b", true},
             {"axb", "a_b", false},
             {"a.b", "a.b", true},
             {"a\\b", "a\\b", true}});
}

TEST(JetLike, BytesThatAreNoUtf8AreCharactersOfTheirOwn) {
  ExpectAll({{"caf\xE9", "caf?", true},
             {"caf\xE9", "caf\xE9", true},
             {"caf\xE9", "caf\xC9", false},
             {"\xE9\x80", "??", true},
             {"\xF5zz", "?zz", true},
             {std::string("a\0b", 3), "a?b", true}});
}

TEST(JetLike, BrokenSetIsRunTimeError93) {
  for (const char* pattern : {"[", "a[bc", "[!", "*[", "[z-a]", "[9-0]"}) {
    const Thrown thrown = ThrownBy([&] { JetLike("", pattern); });
    EXPECT_EQ(thrown.Number, 93) << pattern;
    EXPECT_EQ(thrown.Text, "Invalid pattern string");
  }
}

TEST(JetLike, ManyStarsDoNotMultiply) {
  std::string pattern;
  for (int i = 0; i < 200; ++i) {
    pattern += "a*";
  }
  const std::string text(20'000, 'a');
  EXPECT_FALSE(JetLike(text, pattern + "b"));
  EXPECT_TRUE(JetLike(text + "b", pattern + "b"));
}

}  // namespace
