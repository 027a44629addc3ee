#include "firmware/hex/HexCheck.h"

#include <gtest/gtest.h>

#include "tests/fakes/FakeFiles.h"
#include "tests/firmware/hex/HexFile.h"

namespace {

constexpr const char* GoodRecord = ":10010000214601360121470136007EFE09D2190140\r\n";
constexpr const char* EndRecord = ":00000001FF\r\n";

TEST(HexCheck, PassesAGoodFile) {
  EXPECT_EQ(CheckHexText(std::string(GoodRecord) + EndRecord), 1);
  EXPECT_EQ(CheckHexText(EndRecord), 1);
  EXPECT_EQ(CheckHexText(":00000001ff"), 1);
}

TEST(HexCheck, TellsAnEmptyFile) {
  EXPECT_EQ(CheckHexText(""), -1);
}

TEST(HexCheck, TellsAWrongChecksum) {
  EXPECT_EQ(CheckHexText(std::string(":10010000214601360121470136007EFE09D2190141\n") + EndRecord), -3);
  EXPECT_EQ(CheckHexText(":00000001FE\n"), -3);
}

TEST(HexCheck, TellsALineThatIsNoRecord) {
  EXPECT_EQ(CheckHexText(std::string("# made by hand\n") + EndRecord), -4);
  EXPECT_EQ(CheckHexText(std::string("\xEF\xBB\xBF") + EndRecord), -4);
  EXPECT_EQ(CheckHexText(std::string("x") + EndRecord), -4);
  EXPECT_EQ(CheckHexText(std::string("\0", 1) + EndRecord), -4);
}

TEST(HexCheck, LetsBlankLinesPass) {
  EXPECT_EQ(CheckHexText(std::string("\n   \n\t\n\r\n\r\r\n anything behind a blank\n") + EndRecord), 1);
}

TEST(HexCheck, TellsAMissingEndRecord) {
  EXPECT_EQ(CheckHexText(GoodRecord), -5);
  EXPECT_EQ(CheckHexText("\n"), -5);
}

TEST(HexCheck, StopsAtTheEndRecord) {
  EXPECT_EQ(CheckHexText(std::string(EndRecord) + "# whatever\n:zz"), 1);
}

TEST(HexCheck, TellsRecordsThatAreCutOrHaveNoDigitsAsFailures) {
  const std::string record = ":10010000214601360121470136007EFE09D2190140";
  for (std::size_t length = 1; length < record.size(); ++length) {
    EXPECT_EQ(CheckHexText(record.substr(0, length) + "\n" + EndRecord), -6) << length;
  }
  for (std::size_t at = 1; at < record.size(); ++at) {
    std::string wrong = record;
    wrong[at] = '/';
    EXPECT_EQ(CheckHexText(wrong + "\n" + EndRecord), -6) << at;
  }
}

TEST(HexCheck, DoesNotLookBehindTheStatedLength) {
  EXPECT_EQ(CheckHexText(":00000001FF and more\n"), 1);
}

TEST(HexCheck, FailsWhereTheSumLeavesSixteenBits) {
  const std::string low = HexFile::Data(0, std::vector<std::uint8_t>(255, 1));
  EXPECT_EQ(CheckHexText(low + EndRecord), 1);
  const std::string high = HexFile::Data(0, std::vector<std::uint8_t>(140, 0xFF));
  EXPECT_EQ(CheckHexText(high + EndRecord), -6);
  // Count and 128 bytes of FF make 32768, one too many; with a byte less they fit.
  EXPECT_EQ(CheckHexText(HexFile::Data(0, std::vector<std::uint8_t>(128, 0xFF)) + EndRecord), -6);
  EXPECT_EQ(CheckHexText(HexFile::Data(0, std::vector<std::uint8_t>(127, 0xFF)) + EndRecord), 1);
}

TEST(HexCheck, TakesCarriageReturnsAloneForOneLine) {
  EXPECT_EQ(CheckHexText(":0100000001FE\r:00000001FF\r"), -5);
  EXPECT_EQ(CheckHexText(":00000001FF\r"), 1);
}

TEST(HexCheck, LetsEveryTypeOfRecordPass) {
  for (unsigned int type = 0; type < 256; ++type) {
    EXPECT_EQ(CheckHexText(HexFile::Record(type, 0, {1, 2}) + EndRecord), 1) << type;
  }
}

TEST(HexCheck, TellsAFileThatCannotBeReadAsFailure) {
  FakeFiles files;
  EXPECT_EQ(CheckHexFile(files, "/missing.hex"), -6);
  files.Put("/good.hex", EndRecord);
  EXPECT_EQ(CheckHexFile(files, "/good.hex"), 1);
}

}  // namespace
