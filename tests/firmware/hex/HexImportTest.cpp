#include "firmware/hex/HexImport.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/firmware/hex/HexFile.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

constexpr const char* HalfFill = "FF FF FF 00 FF FF FF 00 ";

TEST(DivideHexText, MakesALineOfEachSixteenBytes) {
  const HexData data = DivideHexText(
      ":10010000214601360121470136007EFE09D2190140\r\n"
      ":080110000102030405060708C3\r\n"
      ":00000001FF\r\n");
  EXPECT_THAT(data.ProgMem, ElementsAre("000100 21 46 01 36 01 21 47 01 36 00 7E FE 09 D2 19 01 ",
                                        std::string("000110 01 02 03 04 05 06 07 08 ") + HalfFill));
  EXPECT_EQ(data.EeData, "");
  EXPECT_EQ(data.Config, "");
}

TEST(DivideHexText, CutsALongRecordIntoLines) {
  const HexData data =
      DivideHexText(HexFile::Data(0x1000, std::vector<std::uint8_t>(24, 0xA5)) + HexFile::End());
  EXPECT_THAT(data.ProgMem, ElementsAre("001000 A5 A5 A5 A5 A5 A5 A5 A5 A5 A5 A5 A5 A5 A5 A5 A5 ",
                                        std::string("001010 A5 A5 A5 A5 A5 A5 A5 A5 ") + HalfFill));
}

TEST(DivideHexText, HasFillBehindTheLongestRecord) {
  const HexData data = DivideHexText(HexFile::Data(0, std::vector<std::uint8_t>(255, 1)) + HexFile::End());
  ASSERT_EQ(data.ProgMem.size(), 16U);
  EXPECT_EQ(data.ProgMem[15], "0000F0 01 01 01 01 01 01 01 01 01 01 01 01 01 01 01 00 ");
}

TEST(DivideHexText, NeverShowsDataOfAnEarlierRecord) {
  const HexData data = DivideHexText(HexFile::Data(0, std::vector<std::uint8_t>(16, 0xAA)) +
                                     HexFile::Data(0x10, {1}) + HexFile::End());
  EXPECT_EQ(data.ProgMem[1], "000010 01 FF FF 00 FF FF FF 00 FF FF FF 00 FF FF FF 00 ");
}

TEST(DivideHexText, ChoosesTheMemoryByTheUpperAddress) {
  const struct {
    unsigned int Upper;
    const char* Memory;
  } rows[] = {{0, "program"}, {253, "program"}, {254, "eeprom"}, {255, "eeprom"},  {256, "none"},
              {495, "none"},  {496, "config"},  {497, "none"},   {0x7FFF, "none"}, {0xFFFF, "none"}};
  for (const auto& row : rows) {
    const HexData data =
        DivideHexText(HexFile::Upper(row.Upper) + HexFile::Data(0x20, {1, 2, 3, 4}) + HexFile::End());
    const std::string memory = !data.ProgMem.empty()  ? "program"
                               : !data.EeData.empty() ? "eeprom"
                               : !data.Config.empty() ? "config"
                                                      : "none";
    EXPECT_EQ(memory, row.Memory) << row.Upper;
  }
}

TEST(DivideHexText, AddsTheUpperAddress) {
  const HexData data = DivideHexText(HexFile::Upper(0xFE) + HexFile::Data(0x0008, {0xAB}) +
                                     HexFile::Upper(0x00FD) + HexFile::Data(0xFFF0, {0xCD}) + HexFile::End());
  EXPECT_EQ(data.EeData, "FE0008 AB FF FF 00 FF FF FF 00 FF FF FF 00 FF FF FF 00 \n");
  EXPECT_THAT(data.ProgMem, ElementsAre("FDFFF0 CD FF FF 00 FF FF FF 00 FF FF FF 00 FF FF FF 00 "));
}

TEST(DivideHexText, LabelsConfigurationLinesBySixLeadingDigits) {
  const HexData data =
      DivideHexText(HexFile::Upper(0x1F0) + HexFile::Data(0x0018, {0x12, 0x34}) + HexFile::End());
  EXPECT_EQ(data.Config, "1F0001 12 34 FF 00 FF FF FF 00 FF FF FF 00 FF FF FF 00 \n");
}

TEST(DivideHexText, TakesTheChecksumOfATooShortUpperRecordForPartOfIt) {
  // No data: the checksum FC behind a 1 is 1FC, no memory; one byte: FE 00 and its checksum.
  EXPECT_THAT(DivideHexText(":00000004FC\n" + HexFile::Data(0, {1}) + HexFile::End()).ProgMem, IsEmpty());
  EXPECT_EQ(
      DivideHexText(":0100000400FB\n" + HexFile::Data(0, {1}) + HexFile::End()).ProgMem.at(0).substr(0, 6),
      "FB0000");
  EXPECT_EQ(NumberThrownBy([] { DivideHexText(":00000004FCzz\n:00000001FF\n"); }), 13);
}

TEST(DivideHexText, PassesOverOtherRecordsAndLines) {
  const HexData data =
      DivideHexText(" comment\n" + HexFile::Record(2, 0, {0x10, 0x00}) + HexFile::Record(3, 0, {0, 0, 0, 0}) +
                    HexFile::Record(5, 0, {0, 0, 0, 0}) + HexFile::Data(0, {7}) + HexFile::End() +
                    HexFile::Data(0x10, {8}));
  EXPECT_THAT(data.ProgMem, ElementsAre("000000 07 FF FF 00 FF FF FF 00 FF FF FF 00 FF FF FF 00 "));
}

class ImportHexFileTest : public testing::Test {
 protected:
  ImportHexFileTest() {
    files.Put("/old/progmem.img", "old");
    files.Put("/old/eedata.img", "old");
    files.Put("/old/config.img", "old");
  }

  std::int16_t Import(const std::string& text) {
    files.Put("/new.hex", text);
    return ImportHexFile(files, boxes, "/new.hex", images);
  }

  FakeFiles files;
  FakeMessageBoxes boxes;
  const ImagePaths images{"/old/progmem.img", "/old/eedata.img", "/old/config.img"};
};

TEST_F(ImportHexFileTest, WritesAllImages) {
  EXPECT_EQ(Import(HexFile::Data(0, HexFile::Instructions(16, 0x10)) + HexFile::Upper(0xFE) +
                   HexFile::Data(0, {1}) + HexFile::Upper(0x1F0) + HexFile::Data(0, {2}) + HexFile::End()),
            1);
  EXPECT_TRUE(files.Read(images.ProgMem)
                  .starts_with("000000 10 11 12 00 14 15 16 00 18 19 1A 00 1C 1D 1E 00 \n"
                               "000010 FF FF FF 00 FF FF FF 00 FF FF FF 00 FF FF FF 00\n"));
  EXPECT_EQ(files.Read(images.ProgMem).size(), 56U + 15 * 55);
  EXPECT_EQ(files.Read(images.EeData), "FE0000 01 FF FF 00 FF FF FF 00 FF FF FF 00 FF FF FF 00 \n");
  EXPECT_EQ(files.Read(images.Config), "1F0000 02 FF FF 00 FF FF FF 00 FF FF FF 00 FF FF FF 00 \n");
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(ImportHexFileTest, EmptiesTheImagesOfMemoriesWithoutData) {
  EXPECT_EQ(Import(HexFile::Data(0, {1, 2, 3}) + HexFile::End()), 1);
  EXPECT_EQ(files.Read(images.EeData), "");
  EXPECT_EQ(files.Read(images.Config), "");
}

TEST_F(ImportHexFileTest, ShowsANegativeCodeAndLeavesTheImages) {
  EXPECT_EQ(Import(":0000000100\r\n"), -3);
  EXPECT_THAT(boxes.Boxes,
              ElementsAre(FakeMessageBoxes::Box{"-3", "Tessarine", BoxIcon::None, BoxButtons::Ok}));
  EXPECT_EQ(files.Read(images.ProgMem), "old");
}

TEST_F(ImportHexFileTest, LeavesNoImageWhenItCannotBePadded) {
  EXPECT_EQ(NumberThrownBy([&] { Import(HexFile::Data(0x100, {1}) + HexFile::End()); }), 9);
  EXPECT_FALSE(files.FileExists(images.ProgMem));
  EXPECT_FALSE(files.FileExists(images.EeData));
  EXPECT_FALSE(files.FileExists(images.Config));
}

TEST_F(ImportHexFileTest, LeavesNoImageWithoutProgramData) {
  EXPECT_EQ(NumberThrownBy([&] { Import(HexFile::Upper(0xFE) + HexFile::Data(0, {1}) + HexFile::End()); }),
            62);
  EXPECT_FALSE(files.FileExists(images.EeData));
}

TEST_F(ImportHexFileTest, LeavesNoImageOnAFullDisk) {
  for (const std::string& path : {images.ProgMem, images.EeData, images.Config}) {
    FakeFiles full;
    full.AddFolder("/old");
    full.Put("/new.hex", HexFile::Data(0, {1}) + HexFile::End());
    full.FailReplace(path, RuntimeError(61));
    EXPECT_EQ(NumberThrownBy([&] { ImportHexFile(full, boxes, "/new.hex", images); }), 61);
    EXPECT_EQ(full.Contents().size(), 1U);
  }
}

}  // namespace
