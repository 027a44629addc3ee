#include "firmware/pic24f/tool/HexCommands.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakeFiles.h"
#include "tests/firmware/hex/HexFile.h"
#include "tests/support/Thrown.h"

namespace {

using testing::HasSubstr;

class HexCommands : public testing::Test {
 protected:
  HexCommands() { files.AddFolder("/home"); }

  void Put(const std::string& hex) { files.Put("/home/new.hex", hex); }

  /// Runs a command of one of the functions below; its exit code.
  int Run(int (*command)(const ToolParts&, const ToolOptions&), const std::vector<std::string>& words) {
    const ToolOptions options = ParseToolOptions(words);
    testing::internal::CaptureStdout();
    testing::internal::CaptureStderr();
    const int code = command({files, strings}, options);
    printed = testing::internal::GetCapturedStdout();
    said = testing::internal::GetCapturedStderr();
    return code;
  }
  int Check(const std::string& hex) {
    Put(hex);
    return Run(RunCheck, {"check", "/home/new.hex"});
  }
  int Import(const std::string& hex, const std::string& folder = "/home/images") {
    Put(hex);
    return Run(RunImport, {"import", "/home/new.hex", "--out", folder});
  }
  int Image(const std::string& hex) {
    Put(hex);
    return Run(RunImage, {"image", "/home/new.hex", "--out", "/home/image.bin"});
  }

  FakeFiles files;
  const StringTable strings{Language::English};
  std::string printed;
  std::string said;
};

TEST_F(HexCommands, CheckPrintsItsCode) {
  EXPECT_EQ(Check(HexFile::End()), 0);
  EXPECT_EQ(printed, "code 1\n");
  EXPECT_EQ(said, "");
  const std::pair<std::string, std::string> rows[] = {{"", "code -1\n"},
                                                      {":00000001FE\n", "code -3\n"},
                                                      {"x\n", "code -4\n"},
                                                      {"\n", "code -5\n"},
                                                      {":0\n", "code -6\n"}};
  for (const auto& [hex, code] : rows) {
    EXPECT_EQ(Check(hex), 1) << hex;
    EXPECT_EQ(printed, code);
    EXPECT_THAT(said, HasSubstr("/home/new.hex: "));
  }
  EXPECT_EQ(Run(RunCheck, {"check", "/home/missing.hex"}), 1);
  EXPECT_EQ(printed, "code -6\n");
}

TEST_F(HexCommands, ImportMakesTheFolderAndTheImages) {
  EXPECT_EQ(Import(HexFile::Data(0, {1, 2, 3, 0}) + HexFile::End(), "/home/new/images/"), 0);
  EXPECT_EQ(printed, "code 1\n");
  for (const char* name : {"progmem.img", "eedata.img", "config.img"}) {
    EXPECT_TRUE(files.FileExists(std::string("/home/new/images//") + name)) << name;
  }
}

TEST_F(HexCommands, ImportPrintsALineForEachWarning) {
  EXPECT_EQ(Import(HexFile::Data(0, HexFile::Instructions(32, 1)) +
                   HexFile::Data(0x40, HexFile::Instructions(16, 1)) + HexFile::Upper(0x123) +
                   HexFile::Data(0x10, {1, 2, 3}) + HexFile::End()),
            2);
  EXPECT_EQ(printed,
            "code 1\n"
            "warning 000000 32 missing\n"
            "warning 01230010 3 outside the memories that are written\n");
  EXPECT_TRUE(files.FileExists("/home/images/progmem.img"));
}

TEST_F(HexCommands, ImportLeavesNoImageOfAFileThatIsNone) {
  ASSERT_EQ(Import(HexFile::Data(0, {1}) + HexFile::End()), 0);
  EXPECT_EQ(Import("# none\n"), 1);
  EXPECT_EQ(printed, "code -4\n");
  EXPECT_FALSE(files.FileExists("/home/images/progmem.img"));
  ASSERT_EQ(Import(HexFile::Data(0, {1}) + HexFile::End()), 0);
  EXPECT_EQ(Import(HexFile::Data(0x10, {1}) + HexFile::End()), 1);
  EXPECT_EQ(printed, "code -6\n");
  EXPECT_THAT(said, HasSubstr("does not begin at address 0"));
  EXPECT_FALSE(files.FileExists("/home/images/progmem.img"));
  EXPECT_FALSE(files.FileExists("/home/images/eedata.img"));
}

TEST_F(HexCommands, ImportPrintsACodeWhereTheFolderCannotBeMade) {
  EXPECT_EQ(Import(HexFile::Data(0, {1}) + HexFile::End(), "/home/new.hex"), 1);
  EXPECT_EQ(printed, "code -6\n");
  EXPECT_NE(said, "");
}

TEST_F(HexCommands, ImageWritesTheProgram) {
  EXPECT_EQ(Image(HexFile::Data(0, {1, 2, 3, 0, 4, 5, 6, 0}) + HexFile::End()), 0);
  EXPECT_EQ(printed, "pages 2\nrows 2\n");
  const std::string image = files.Read("/home/image.bin");
  EXPECT_EQ(image.size(), 786432U);
  EXPECT_EQ(image.substr(0, 7), "\x01\x02\x03\x04\x05\x06\xFF");
  EXPECT_EQ(image.substr(129018, 6), "\x01\x02\x03\x04\x05\x06");
}

TEST_F(HexCommands, ImageSaysWhyItMakesNone) {
  EXPECT_EQ(Image(HexFile::End()), 1);
  EXPECT_THAT(said, HasSubstr("no GOTO at location 0x00, aborting"));
  EXPECT_FALSE(files.FileExists("/home/image.bin"));
  EXPECT_EQ(NumberThrownBy([&] {
              Run(RunImage, {"image", "/home/missing.hex", "--out", "/home/image.bin"});
            }),
            53);
  testing::internal::GetCapturedStdout();
  testing::internal::GetCapturedStderr();
}

}  // namespace
