#include "firmware/files/QvmLines.h"

#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

/// The data lines of a file.
std::vector<std::string> LinesOf(const std::string& bytes) {
  const QvmLines file(bytes);
  return {file.BufferLines().begin(), file.BufferLines().end()};
}

TEST(QvmLines, AreThoseThatBeginWithAColonInTheirOrder) {
  EXPECT_THAT(LinesOf("; made by hand\r\n:0102\r\n\r\n 03\r\n:04\r\nend :05\r\n:\r\n"),
              ElementsAre(":0102", ":04", ":"));
}

TEST(QvmLines, IncludeALastOneWithoutLineEnd) {
  EXPECT_THAT(LinesOf(":01\r\n:02"), ElementsAre(":01", ":02"));
  EXPECT_THAT(LinesOf(":"), ElementsAre(":"));
}

TEST(QvmLines, LeaveOutLinesWithANul) {
  EXPECT_THAT(LinesOf(std::string(":01\r\n:0\0002\r\n:03", 14)), ElementsAre(":01", ":03"));
}

TEST(QvmLines, EndInBothCharactersOnly) {
  EXPECT_THAT(LinesOf(":01\n:02\n"), ElementsAre(":01\n:02\n"));
  EXPECT_THAT(LinesOf(":01\r:02\r"), ElementsAre(":01\r:02\r"));
  EXPECT_THAT(LinesOf(":01\n\r:02"), ElementsAre(":01\n\r:02"));
  EXPECT_THAT(LinesOf(":01\r\r\n:02"), ElementsAre(":01\r", ":02"));
}

TEST(QvmLines, DoNotSkipAByteOrderMark) {
  EXPECT_THAT(LinesOf("\xEF\xBB\xBF:01\r\n:02\r\n"), ElementsAre(":02"));
}

TEST(QvmLines, AreNoneInFilesWithoutAny) {
  EXPECT_THAT(LinesOf(""), IsEmpty());
  EXPECT_THAT(LinesOf("\r"), IsEmpty());
  EXPECT_THAT(LinesOf("\r\n\r\n"), IsEmpty());
  EXPECT_THAT(LinesOf(std::string(1000, '\0')), IsEmpty());
}

}  // namespace
