#include "firmware/hex/HexImage.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/firmware/hex/HexFile.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class LoadHexImageTest : public testing::Test {
 protected:
  bool Load(const std::string& text) { return LoadHexImage(text, image, boxes); }

  template <std::size_t Size>
  static std::vector<int> Set(const std::bitset<Size>& flags) {
    std::vector<int> indices;
    for (std::size_t i = 0; i < Size; ++i) {
      if (flags.test(i)) {
        indices.push_back(static_cast<int>(i));
      }
    }
    return indices;
  }

  const std::string jump = HexFile::Data(0, {0x00, 0x02, 0x04, 0x00, 0x01, 0x03, 0x05, 0x00});
  FakeMessageBoxes boxes;
  FirmwareImage image;
};

TEST_F(LoadHexImageTest, DropsTheFourthByteOfAnInstruction) {
  ASSERT_TRUE(Load(jump + HexFile::End()));
  EXPECT_THAT(std::vector<int>(image.ImageBuffer.begin(), image.ImageBuffer.begin() + 8),
              ElementsAre(0, 2, 4, 1, 3, 5, 0xFF, 0xFF));
}

TEST_F(LoadHexImageTest, CopiesTheResetJumpForTheBootLoader) {
  ASSERT_TRUE(Load(jump + HexFile::End()));
  EXPECT_THAT(std::vector<int>(image.ImageBuffer.begin() + 129018, image.ImageBuffer.begin() + 129024),
              ElementsAre(0, 2, 4, 1, 3, 5));
  EXPECT_THAT(Set(image.PageUsed), ElementsAre(0, 83));
  EXPECT_THAT(Set(image.RowUsed), ElementsAre(0, 671));
  EXPECT_EQ(image.PageCount, 2);
  EXPECT_EQ(image.RowCount, 2);
}

TEST_F(LoadHexImageTest, MarksPagesAndRows) {
  // File address 1000 is instruction 400: row 16, page 2. One record reaches into the next row.
  ASSERT_TRUE(Load(jump + HexFile::Data(0x1000, {1, 2, 3, 0}) +
                   HexFile::Data(0x10FC, {4, 5, 6, 0, 7, 8, 9, 0}) + HexFile::End()));
  EXPECT_THAT(Set(image.PageUsed), ElementsAre(0, 2, 83));
  EXPECT_THAT(Set(image.RowUsed), ElementsAre(0, 16, 17, 671));
  EXPECT_EQ(image.ImageBuffer[0xC00], 1);
  EXPECT_EQ(image.ImageBuffer[0xC00 + 63 * 3], 4);
}

TEST_F(LoadHexImageTest, RefusesAProgramThatMeetsTheBootLoader) {
  const std::string file = jump + HexFile::Upper(1) + HexFile::Data(0x5000, {1, 2, 3, 0}) + HexFile::End();
  EXPECT_FALSE(Load(file));
  EXPECT_THAT(boxes.Boxes, ElementsAre(FakeMessageBoxes::Box{
                               "The hex-file contains code that will overwrite the bootloader, aborting",
                               "Tessarine", BoxIcon::None, BoxButtons::Ok}));
}

TEST_F(LoadHexImageTest, TakesRowsBesideThoseOfTheBootLoader) {
  // Rows 335 and 360.
  EXPECT_TRUE(Load(jump + HexFile::Upper(1) + HexFile::Data(0x4FFC, {1, 2, 3, 0}) +
                   HexFile::Data(0x6800, {1, 2, 3, 0}) + HexFile::End()));
  EXPECT_THAT(Set(image.RowUsed), ElementsAre(0, 335, 360, 671));
  EXPECT_FALSE(Load(jump + HexFile::Upper(1) + HexFile::Data(0x67FC, {1, 2, 3, 0}) + HexFile::End()));
}

TEST_F(LoadHexImageTest, RefusesAProgramWithoutResetJump) {
  for (const std::string& file :
       {HexFile::End(), HexFile::Data(0x100, {1, 2, 3, 0}) + HexFile::End(),
        HexFile::Data(0, {0xFF, 0xFF, 0xFF, 0, 0xFF, 0xFF, 0xFF, 0}) + HexFile::End()}) {
    boxes.Boxes.clear();
    EXPECT_FALSE(Load(file));
    EXPECT_THAT(boxes.Boxes,
                ElementsAre(FakeMessageBoxes::Box{"There\xC2\xB4s no GOTO at location 0x00, aborting",
                                                  "Tessarine", BoxIcon::None, BoxButtons::Ok}));
  }
}

TEST_F(LoadHexImageTest, PassesOverAddressesBehindTheProgram) {
  // Program addresses 2AC02 (beyond 175104) and 800000.
  EXPECT_TRUE(Load(jump + HexFile::Upper(5) + HexFile::Data(0x5804, {1, 2, 3, 0}) + HexFile::Upper(0x100) +
                   HexFile::Data(0, {1, 2, 3, 0}) + HexFile::Upper(0xFFFF) +
                   HexFile::Data(0xFFFC, {1, 2, 3, 0}) + HexFile::End()));
  EXPECT_EQ(image.RowCount, 2);
}

TEST_F(LoadHexImageTest, OverflowsBehindInstruction32767) {
  EXPECT_TRUE(Load(jump + HexFile::Upper(1) + HexFile::Data(0xFFFC, {1, 2, 3, 0}) + HexFile::End()));
  EXPECT_EQ(NumberThrownBy([&] {
              Load(jump + HexFile::Upper(2) + HexFile::Data(0, {1, 2, 3, 0}) + HexFile::End());
            }),
            6);
}

TEST_F(LoadHexImageTest, FailsOnConfigurationWordsBeyondTheImage) {
  EXPECT_EQ(NumberThrownBy([&] {
              Load(jump + HexFile::Upper(0x1F0) + HexFile::Data(0, {1, 2, 3, 0}) + HexFile::End());
            }),
            9);
  EXPECT_TRUE(Load(jump + HexFile::Upper(0x1F0) + HexFile::Data(0x20, {1, 2, 3, 0}) + HexFile::End()));
}

TEST_F(LoadHexImageTest, LeavesOutBytesThatAreNoWholeInstruction) {
  ASSERT_TRUE(Load(jump + HexFile::Data(0x100, {1, 2, 3, 0, 5, 6, 7}) + HexFile::End()));
  EXPECT_EQ(image.ImageBuffer[0xC0], 1);
  EXPECT_EQ(image.ImageBuffer[0xC3], 0xFF);
}

TEST_F(LoadHexImageTest, TruncatesOddAddresses) {
  // File address 102 is program address 81: image offset 121, counted from 0.
  ASSERT_TRUE(Load(jump + HexFile::Data(0x102, {1, 2, 3, 0}) + HexFile::End()));
  EXPECT_EQ(image.ImageBuffer[121 + 72], 1);
  EXPECT_EQ(image.ImageBuffer[0x81 * 3 / 2], 1);
}

TEST_F(LoadHexImageTest, CountsOtherCharactersWithTheirCode) {
  EXPECT_EQ(NumberThrownBy([&] { Load(":04000000G0020300xx\n" + HexFile::End()); }), 6);
  EXPECT_EQ(NumberThrownBy([&] { Load(":zzzzzzzzzzzzzz\n" + HexFile::End()); }), 0);
}

TEST_F(LoadHexImageTest, StartsAfresh) {
  ASSERT_TRUE(Load(jump + HexFile::Data(0x1000, {1, 2, 3, 0}) + HexFile::End()));
  ASSERT_TRUE(Load(jump + HexFile::End()));
  EXPECT_EQ(image.ImageBuffer[0xC00], 0xFF);
  EXPECT_EQ(image.RowCount, 2);
}

}  // namespace
