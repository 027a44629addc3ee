#include "platform/linux/InstanceLine.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace {

using testing::Optional;

TEST(InstanceLine, TellsAPathAndAToken) {
  EXPECT_THAT(InstanceLine({"/home/anna/Friday 1.game.xml", "abc_TIME1"}),
              Optional(std::string("open\t/home/anna/Friday 1.game.xml\tabc_TIME1\n")));
}

TEST(InstanceLine, WithoutAPathOnlyShows) {
  EXPECT_THAT(InstanceLine({"", ""}), Optional(std::string("show\t\t\n")));
}

TEST(InstanceLine, IsOneLineWhateverTheFileIsCalled) {
  EXPECT_THAT(InstanceLine({"/a\nb\t%\x7F", ""}), Optional(std::string("open\t/a%0Ab%09%25%7F\t\n")));
}

TEST(InstanceLine, KeepsEveryByteOfANameButNul) {
  std::string path = "/";
  for (int byte = 1; byte < 256; ++byte) {
    path += static_cast<char>(byte);
  }
  const std::optional<std::string> line = InstanceLine({path, path});
  ASSERT_TRUE(line);
  EXPECT_EQ(line->find('\n'), line->size() - 1);
  EXPECT_THAT(ReadInstanceLine(line->substr(0, line->size() - 1)), Optional(InstanceRequest{path, path}));
}

TEST(InstanceLine, IsRefusedForARelativePathOrANul) {
  EXPECT_FALSE(InstanceLine({"game.xml", ""}));
  EXPECT_FALSE(InstanceLine({std::string("/a\0b", 4), ""}));
  EXPECT_FALSE(InstanceLine({"", std::string(1, '\0')}));
}

TEST(InstanceLine, HasAtMostEightKilobytes) {
  const std::size_t others = std::string("open\t\t\n").size();
  const InstanceRequest longest{"/" + std::string(LongestInstanceLine - others - 1, 'a'), ""};
  const std::optional<std::string> line = InstanceLine(longest);
  ASSERT_TRUE(line);
  EXPECT_EQ(line->size(), LongestInstanceLine);
  EXPECT_THAT(ReadInstanceLine(line->substr(0, line->size() - 1)), Optional(longest));
  EXPECT_FALSE(InstanceLine({longest.Path + "a", ""}));
  EXPECT_FALSE(ReadInstanceLine("open\t" + longest.Path + "a\t"));
}

TEST(InstanceLine, IsReadOnlyAsItIsWritten) {
  for (const char* line : {"",
                           "open",
                           "open\t",
                           "open\t/a",
                           "show\t",
                           "open\t\t",
                           "show\t/a\t",
                           "open\ta\t",
                           "OPEN\t/a\t",
                           "quit\t\t",
                           "open\t/a\tb\tc",
                           "open\t/%\t",
                           "open\t/%0\t",
                           "open\t/%0g\t",
                           "open\t/%0a\t",
                           "open\t/%00\t",
                           "open\t/%41\t",
                           "open\t/a\r\t",
                           "show\t\t\r",
                           " show\t\t",
                           "GET / HTTP/1.1"}) {
    EXPECT_FALSE(ReadInstanceLine(line)) << line;
  }
  EXPECT_FALSE(ReadInstanceLine(std::string_view("open\t/a\0\t", 9)));
}

}  // namespace
