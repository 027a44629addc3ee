#include "firmware/hex/ImageComparison.h"

#include <gmock/gmock.h>

#include "firmware/hex/ImagePadding.h"
#include "tests/firmware/hex/HexFile.h"

namespace {

using Cause = LostStretch::Cause;
using testing::ElementsAre;
using testing::IsEmpty;

/// What an import of the file loses.
std::vector<LostStretch> LostOf(const std::string& hex) {
  const HexData data = DivideHexText(hex);
  return CompareImages(hex, PaddedImage(data.ProgMem), data.EeData);
}

std::string Program(unsigned int first, unsigned int last) {
  std::string text;
  for (unsigned int address = first; address < last; address += 16) {
    text += HexFile::Data(address, HexFile::Instructions(16, address / 16 + 1));
  }
  return text;
}

TEST(CompareImages, FindsNothingInAWholeProgram) {
  EXPECT_THAT(LostOf(Program(0, 0x340) + HexFile::End()), IsEmpty());
}

TEST(CompareImages, FindsNothingWhereRecordsComeInAnyOrder) {
  EXPECT_THAT(LostOf(Program(0x100, 0x200) + Program(0, 0x100) + HexFile::End()), IsEmpty());
}

TEST(CompareImages, FindsNothingBehindAHoleOfWholeBlocks) {
  EXPECT_THAT(LostOf(Program(0, 0x100) + Program(0x1240, 0x1280) + HexFile::End()), IsEmpty());
}

TEST(CompareImages, FindsDataThatFillOfALaterBlockOverwrites) {
  // The second block begins at 0 once more, with fill up to 40.
  EXPECT_THAT(LostOf(Program(0, 0x20) + Program(0x40, 0x60) + HexFile::End()),
              ElementsAre(LostStretch{0, 0x20, Cause::Missing}));
}

TEST(CompareImages, FindsDataOfSegmentsWithoutMemory) {
  EXPECT_THAT(
      LostOf(Program(0, 0x10) + HexFile::Upper(0x100) + HexFile::Data(0x20, {1, 2, 3, 4, 5}) +
             HexFile::Upper(0xFFFF) + HexFile::Data(0xFFFE, {6, 7}) + HexFile::End()),
      ElementsAre(LostStretch{0x1000020, 5, Cause::NoMemory}, LostStretch{0xFFFFFFFE, 2, Cause::NoMemory}));
}

TEST(CompareImages, JoinsSegmentsWithoutMemoryThatMeetOrOverlap) {
  EXPECT_THAT(LostOf(Program(0, 0x10) + HexFile::Upper(0x100) + HexFile::Data(8, {1, 2, 3, 4}) +
                     HexFile::Data(0, {1, 2, 3, 4, 5, 6, 7, 8}) + HexFile::Data(4, {1, 2}) + HexFile::End()),
              ElementsAre(LostStretch{0x1000000, 12, Cause::NoMemory}));
}

TEST(CompareImages, LeavesConfigurationWordsAlone) {
  EXPECT_THAT(LostOf(Program(0, 0x10) + HexFile::Upper(0x1F0) + HexFile::Data(3, {1, 2, 3}) + HexFile::End()),
              IsEmpty());
}

TEST(CompareImages, ReadsSegmentAddresses) {
  // The import passes over the segment, so its data lands at 10 and not at 10010.
  EXPECT_THAT(LostOf(Program(0, 0x10) + HexFile::Record(2, 0, {0x10, 0x00}) +
                     HexFile::Data(0x10, HexFile::Instructions(16, 1)) + HexFile::End()),
              ElementsAre(LostStretch{0x10010, 16, Cause::Missing}));
  EXPECT_THAT(LostOf(Program(0, 0x10) + HexFile::Record(2, 0, {0, 0}) + Program(0x10, 0x20) + HexFile::End()),
              IsEmpty());
}

TEST(CompareImages, WrapsTheAddressesOfASegment) {
  const std::string hex =
      HexFile::Record(2, 0, {0x10, 0x00}) + HexFile::Data(0xFFFE, {1, 2, 3, 4}) + HexFile::End();
  EXPECT_THAT(CompareImages(hex, "", ""),
              ElementsAre(LostStretch{0x10000, 2, Cause::Missing}, LostStretch{0x1FFFE, 2, Cause::Missing}));
}

TEST(CompareImages, PassesOverASegmentThatIsTooShort) {
  EXPECT_THAT(LostOf(Program(0, 0x10) + HexFile::Record(2, 0, {0x10}) + Program(0x10, 0x20) + HexFile::End()),
              IsEmpty());
}

TEST(CompareImages, WritesABlockFromTheEvenAddressBelow) {
  // The device has one address for two bytes.
  std::string image;
  for (int line = 0; line < 16; ++line) {
    image += "000101 01 02 03 00 05 06 07 00 09 0A 0B 00 0D 0E 0F 00 \n";
  }
  const std::vector<std::uint8_t> data = {1, 2, 3, 0, 5, 6, 7, 0, 9, 10, 11, 0, 13, 14, 15, 0};
  EXPECT_THAT(CompareImages(HexFile::Data(0x100, data) + HexFile::End(), image, ""), IsEmpty());
}

TEST(CompareImages, FindsDisplacedData) {
  // 16 bytes at 4: the second line of the block takes them four bytes late.
  const std::vector<LostStretch> lost = LostOf(
      HexFile::Data(0, {1, 2, 3, 0}) + HexFile::Data(0x14, HexFile::Instructions(16, 0x50)) + HexFile::End());
  ASSERT_FALSE(lost.empty());
  EXPECT_GE(lost.front().Address, 0x14U);
}

TEST(CompareImages, TellsDisplacedFromMissing) {
  std::string image = "000000 01 02 03 00 05 06 07 00 09 0A 0B 00 0D 0E 0F 00 \n";
  for (unsigned int address = 0x10; address < 0x100; address += 16) {
    image += "0000" + HexFile::TwoDigits(address) + " FF FF FF 00 FF FF FF 00 FF FF FF 00 FF FF FF 00\n";
  }
  const std::string hex =
      HexFile::Data(0, {1, 2, 3, 0, 6, 5, 7, 0}) + HexFile::Data(0x10, {1, 2}) + HexFile::End();
  EXPECT_THAT(CompareImages(hex, image, ""),
              ElementsAre(LostStretch{4, 2, Cause::Displaced}, LostStretch{0x10, 2, Cause::Missing}));
}

TEST(CompareImages, DoesNotLookAtTheFourthByteOfAnInstruction) {
  EXPECT_THAT(LostOf(HexFile::Data(0, {1, 2, 3, 0x44, 5, 6, 7, 0x88}) + HexFile::End()), IsEmpty());
  const std::string hex = HexFile::Data(0, {1, 2, 3, 4}) + HexFile::End();
  EXPECT_THAT(CompareImages(hex, "", ""), ElementsAre(LostStretch{0, 4, Cause::Missing}));
}

TEST(CompareImages, NeverMissesFill) {
  EXPECT_THAT(LostOf(Program(0, 0x10) + HexFile::Data(0x500, std::vector<std::uint8_t>(16, 0xFF)) +
                     HexFile::Data(0x700, {0xFF, 0xFF, 0xFF, 0}) + HexFile::Upper(0x200) +
                     HexFile::Data(0, {0xFF, 0xFF, 0xFF, 0, 0xFF, 0xFF, 0xFF, 0xFF}) + HexFile::End()),
              IsEmpty());
}

TEST(CompareImages, DoesNotCountABlockThatIsNotWhole) {
  const std::string hex = Program(0, 0x20) + HexFile::End();
  EXPECT_THAT(CompareImages(hex, "000000 01 02 03 00 05 06 07 00 09 0A 0B 00 0D 0E 0F 00 \n", ""),
              ElementsAre(LostStretch{0, 0x20, Cause::Missing}));
}

TEST(CompareImages, LaterBytesOfAnAddressCount) {
  const std::string hex = HexFile::Data(0, {9}) + HexFile::Data(0, {1}) + HexFile::End();
  std::string image = "000000 01 FF FF 00 FF FF FF 00 FF FF FF 00 FF FF FF 00 \n";
  for (int line = 1; line < 16; ++line) {
    image += "0000F0 FF FF FF 00 FF FF FF 00 FF FF FF 00 FF FF FF 00\n";
  }
  EXPECT_THAT(CompareImages(hex, image, ""), IsEmpty());
}

TEST(CompareImages, ComparesTheEeprom) {
  const std::string hex = Program(0, 0x10) + HexFile::Upper(0xFE) +
                          HexFile::Data(0, {1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13, 14, 15, 16}) +
                          HexFile::End();
  EXPECT_THAT(LostOf(hex), IsEmpty());
}

TEST(CompareImages, LooksAtEachFourthByteOfTheEeprom) {
  const std::string hex = HexFile::Upper(0xFF) + HexFile::Data(0xFC00, {1, 2, 3, 4}) + HexFile::End();
  EXPECT_THAT(CompareImages(hex, "", "FFFC00 01 02 03 05 FF FF FF 00 FF FF FF 00 FF FF FF 00 \n"),
              ElementsAre(LostStretch{0xFFFC03, 1, Cause::Displaced}));
}

TEST(CompareImages, FindsEepromDataThatFillOfALaterLineOverwrites) {
  // The line of the second record reaches over the first one.
  EXPECT_THAT(LostOf(Program(0, 0x10) + HexFile::Upper(0xFE) + HexFile::Data(8, {1, 2, 3, 4}) +
                     HexFile::Data(0, {5, 6, 7, 8}) + HexFile::End()),
              ElementsAre(LostStretch{0xFE0008, 4, Cause::Missing}));
}

TEST(CompareImages, FindsDataAcrossTheEndOfTheEeprom) {
  EXPECT_THAT(
      LostOf(Program(0, 0x10) + HexFile::Upper(0xFF) + HexFile::Data(0xFFFE, {1, 2, 3, 4}) + HexFile::End()),
      ElementsAre(LostStretch{0x1000000, 2, Cause::NoMemory}));
}

TEST(AddressText, HasSixDigitsOrEight) {
  EXPECT_EQ(AddressText({0x10, 1, Cause::Missing}), "000010");
  EXPECT_EQ(AddressText({0xFFFFFF, 1, Cause::Missing}), "FFFFFF");
  EXPECT_EQ(AddressText({0x1000000, 1, Cause::NoMemory}), "01000000");
  EXPECT_EQ(AddressText({0xFFFF0000, 1, Cause::NoMemory}), "FFFF0000");
}

}  // namespace
