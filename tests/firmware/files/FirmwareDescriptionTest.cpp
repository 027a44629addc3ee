#include "firmware/files/FirmwareDescription.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakeFiles.h"

namespace {

using testing::HasSubstr;
using testing::Not;

class Description : public testing::TestWithParam<Language> {
 protected:
  std::string Of(const std::string& name, const std::string& bytes) const {
    return DescriptionText(Describe(name, bytes), strings);
  }
  bool IsEnglish() const { return GetParam() == Language::English; }

  StringTable strings{GetParam()};
};

TEST_P(Description, TellsOfAQvmFile) {
  const std::string text = Of("/a/b.qvm", ":0102\r\n:0304\r\n");
  EXPECT_EQ(text, IsEnglish()
                      ? "QVM file: 2 lines, 14 bytes, checksum 6C968F73. Sending takes about 0 min 0 s."
                      : "QVM 文件：2 行，14 字节，校验和 6C968F73。发送约需 0 分 0 秒。");
}

TEST_P(Description, TellsOfAQvm2FileAndHowLongAFullDeviceTakes) {
  std::string pages;
  for (int page = 0; page < 512; ++page) {
    std::array<char, 8> number{};
    std::snprintf(number.data(), number.size(), "%X,", static_cast<unsigned int>(page));
    pages += number.data();
  }
  std::string data;
  for (int line = 0; line < 512 * 24; ++line) {
    data += std::string(128, '0') + "\r\n";
  }
  const std::string text = Of("b.qvm2", pages + "\r\n0,1\r\n" + data);
  EXPECT_THAT(text, HasSubstr(IsEnglish() ? "QVM2 file: 512 pages, 2 rows, " : "QVM2 文件：512 页，2 行，"));
  EXPECT_THAT(text, HasSubstr(IsEnglish() ? "about 7 min 4 s." : "发送约需 7 分 4 秒。"));
  EXPECT_THAT(text, Not(HasSubstr("\n")));
}

TEST_P(Description, SaysThatAFileOfNoKindIsNotSent) {
  EXPECT_EQ(Of("A.QVM2", "123456789"),
            IsEnglish()
                ? "9 bytes, checksum CBF43926. The name ends neither in qvm nor in qvm2 (small letters): "
                  "nothing of it would be sent."
                : "9 字节，校验和 CBF43926。文件名不以小写的 qvm 或 qvm2 结尾：其内容不会发送。");
}

TEST_P(Description, SaysWhyAFileCannotBeLoaded) {
  EXPECT_THAT(Of("a.qvm2", ""), HasSubstr("Input past end of file"));
  EXPECT_THAT(Of("a.qvm2", "201\r\n\r\n"), HasSubstr("Subscript out of range"));
  EXPECT_THAT(Of("a.qvm2", "0\n0\nFF\n"), HasSubstr("Overflow"));
}

INSTANTIATE_TEST_SUITE_P(Languages, Description,
                         testing::Values(Language::English, Language::SimplifiedChinese),
                         [](const auto& language) {
                           return language.param == Language::English ? "English" : "Chinese";
                         });

/// What an English description says behind "Looks odd: "; empty if nothing looks odd.
std::string OddIn(const std::string& name, const std::string& bytes) {
  const std::string start = "\nLooks odd: ";
  const std::string text = DescriptionText(Describe(name, bytes), StringTable(Language::English));
  const std::size_t at = text.find(start);
  return at == std::string::npos ? "" : text.substr(at + start.size());
}

TEST(OddFirmware, OfAGoodFileIsNothing) {
  EXPECT_EQ(OddIn("a.qvm", ":01\r\n\r\n:02\r\n:" + std::string(102, '0')), "");
  EXPECT_EQ(OddIn("a.qvm2", "0,1\r\n0,F\r\n" + std::string(3074, 'f') + "\r\n"), "");
}

TEST(OddFirmware, IsWhatADeviceWouldNotGet) {
  EXPECT_EQ(OddIn("a.qvm", ""), "no lines of data");
  EXPECT_EQ(OddIn("a.qvm", ":01\r\n"), "a single line of data, which cannot be sent");
  EXPECT_EQ(OddIn("a.qvm", ":01\r\n; note\r\n:02\r\n"), "other lines, which are left out: 1");
  EXPECT_EQ(
      OddIn("a.qvm", ":01\n:02\n"),
      "line feeds without carriage returns; a single line of data, which cannot be sent; lines with an odd "
      "count of digits: 1; lines with characters that are no hexadecimal digits: 1");
}

TEST(OddFirmware, IsALineThatCannotBeSent) {
  EXPECT_EQ(OddIn("a.qvm", ":01\r\n:012\r\n:3\r\n"), "lines with an odd count of digits: 2");
  EXPECT_EQ(OddIn("a.qvm", ":01\r\n:" + std::string(104, '0')), "lines of more than 51 bytes: 1");
  EXPECT_EQ(OddIn("a.qvm", ":01\r\n:0G\r\n:  \r\n"),
            "lines with characters that are no hexadecimal digits: 2");
  EXPECT_EQ(OddIn("a.qvm2", "0\r\n0\r\n0F\r\n0\r\n"), "lines with an odd count of digits: 1");
}

TEST(OddFirmware, IsWhatLiesOutsideThePages) {
  const std::string page(3072, 'A');
  EXPECT_EQ(OddIn("a.qvm2", "0\r\n7,8,9,20\r\n" + page.substr(0, 100)), "rows outside the pages: 3");
  EXPECT_EQ(OddIn("a.qvm2", "0,1,2\r\n\r\n" + page + "\r\n00\r\n"), "pages behind the end of the data: 1");
  EXPECT_EQ(OddIn("a.qvm2", "0\r\n\r\n" + page + "\r\n00FF01\r\n"),
            "bytes of data outside the pages, which are not sent: 2");
  EXPECT_EQ(OddIn("a.qvm2", "\r\n\r\n"), "pages behind the end of the data: 1");
}

class DescribedFile : public testing::Test {
 protected:
  std::string Text() { return DescribeFile(disk, "/a.qvm", StringTable(Language::English)); }

  FakeFiles disk;
};

TEST_F(DescribedFile, IsReadFromTheDisk) {
  disk.Put("/a.qvm", ":0102\r\n:0304\r\n");
  EXPECT_THAT(Text(), HasSubstr("2 lines, 14 bytes"));
}

TEST_F(DescribedFile, IsNothingIfThereIsNone) {
  EXPECT_EQ(Text(), "");
  EXPECT_EQ(DescribeFile(disk, "", StringTable(Language::English)), "");
}

TEST_F(DescribedFile, SaysThatItCannotBeRead) {
  disk.Put("/a.qvm", ":01\r\n");
  disk.FailRead("/a.qvm", RuntimeError(75));
  EXPECT_EQ(Text(), "The file cannot be read: Path/File access error");
}

TEST_F(DescribedFile, IsNotExaminedIfItIsTooLarge) {
  disk.Put("/a.qvm", std::string(MostDescribedBytes, ':'));
  EXPECT_THAT(Text(), HasSubstr("QVM file"));
  disk.Put("/a.qvm", std::string(MostDescribedBytes + 1, ':'));
  EXPECT_EQ(Text(), "4194305 bytes: more than any device holds. The file has not been examined.");
}

}  // namespace
