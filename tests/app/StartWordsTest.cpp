#include "app/StartWords.h"

#include <gtest/gtest.h>

namespace {

using Kind = StartWords::Kind;

TEST(WordsOfAStart, MayBeNone) {
  const StartWords none = ReadStartWords({});
  EXPECT_EQ(none.Asked, Kind::Run);
  EXPECT_EQ(none.File, "");
}

TEST(WordsOfAStart, MayNameOneFile) {
  const StartWords one = ReadStartWords({"Friday 1.game.xml"});
  EXPECT_EQ(one.Asked, Kind::Run);
  EXPECT_EQ(one.File, "Friday 1.game.xml");
}

TEST(WordsOfAStart, NameAFileThatLooksLikeAnOptionBehindTwoDashes) {
  EXPECT_EQ(ReadStartWords({"--", "--help"}).File, "--help");
  EXPECT_EQ(ReadStartWords({"--", "--help"}).Asked, Kind::Run);
  EXPECT_EQ(ReadStartWords({"--"}).Asked, Kind::Run);
}

TEST(WordsOfAStart, AskForVersionOrHelp) {
  EXPECT_EQ(ReadStartWords({"--version"}).Asked, Kind::Version);
  EXPECT_EQ(ReadStartWords({"--help"}).Asked, Kind::Help);
}

TEST(WordsOfAStart, AreNotUnderstoodOtherwise) {
  const std::pair<std::vector<std::string>, std::string> starts[] = {{{"-v"}, "-v"},
                                                                     {{"--Help"}, "--Help"},
                                                                     {{"--version=1"}, "--version=1"},
                                                                     {{"-"}, "-"},
                                                                     {{"a.xml", "b.xml"}, "b.xml"},
                                                                     {{""}, ""},
                                                                     {{"--help", "--nothing"}, "--nothing"},
                                                                     {{"--version", "a.xml"}, "a.xml"},
                                                                     {{"a.xml", "--help"}, "a.xml"}};
  for (const auto& [words, unknown] : starts) {
    EXPECT_EQ(ReadStartWords(words).Asked, Kind::Unknown) << unknown;
    EXPECT_EQ(ReadStartWords(words).Word, unknown);
  }
}

}  // namespace
