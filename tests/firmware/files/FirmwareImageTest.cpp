#include "firmware/files/FirmwareImage.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <string>
#include <vector>

#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;

class Image : public testing::Test {
 protected:
  bool Load(const std::string& bytes) { return image.LoadQvm2File(bytes); }
  int FailureOf(const std::string& bytes) {
    return NumberThrownBy([&] { image.LoadQvm2File(bytes); });
  }

  std::vector<int> Pages() const { return Set(image.PageUsed); }
  std::vector<int> Rows() const { return Set(image.RowUsed); }

  std::vector<int> FirstBytes(std::size_t count) const {
    return {image.ImageBuffer.begin(), image.ImageBuffer.begin() + static_cast<std::ptrdiff_t>(count)};
  }

  FirmwareImage image;

 private:
  template <std::size_t Size>
  static std::vector<int> Set(const std::bitset<Size>& flags) {
    std::vector<int> set;
    for (std::size_t i = 0; i < Size; ++i) {
      if (flags[i]) {
        set.push_back(static_cast<int>(i));
      }
    }
    return set;
  }
};

TEST_F(Image, HasPagesRowsAndDataOfTheFile) {
  EXPECT_TRUE(Load("0,1,A\r\n0,8,50\r\n0102ff\r\nFE\r\n"));
  EXPECT_THAT(Pages(), ElementsAre(0, 1, 10));
  EXPECT_THAT(Rows(), ElementsAre(0, 8, 80));
  EXPECT_EQ(image.PageCount, 3);
  EXPECT_EQ(image.RowCount, 3);
  EXPECT_THAT(FirstBytes(6), ElementsAre(1, 2, 255, 254, 255, 255));
}

TEST_F(Image, AlwaysUsesThePageOfTheResetVector) {
  EXPECT_TRUE(Load("\r\n\r\n"));
  EXPECT_THAT(Pages(), ElementsAre(0));
  EXPECT_THAT(Rows(), ElementsAre(0));
  EXPECT_EQ(image.PageCount, 1);
  EXPECT_EQ(image.RowCount, 1);
  EXPECT_TRUE(Load("5\r\n28\r\n"));
  EXPECT_THAT(Pages(), ElementsAre(0, 5));
  EXPECT_THAT(Rows(), ElementsAre(0, 40));
}

TEST_F(Image, SkipsEmptyElements) {
  Load(",,1,,2,\r\n,\r\n");
  EXPECT_THAT(Pages(), ElementsAre(0, 1, 2));
  EXPECT_THAT(Rows(), ElementsAre(0));
}

TEST_F(Image, TakesElementsInAnyOrderAndCase) {
  Load("1ff,1FE,3,3\r\nFFF,fff,1\r\n");
  EXPECT_THAT(Pages(), ElementsAre(0, 3, 510, 511));
  EXPECT_THAT(Rows(), ElementsAre(0, 1, 4095));
  EXPECT_EQ(image.PageCount, 4);
  EXPECT_EQ(image.RowCount, 3);
}

TEST_F(Image, HasALastPageAndRowThatAreNotCounted) {
  Load("200\r\n1000\r\n");
  EXPECT_THAT(Pages(), ElementsAre(0, 512));
  EXPECT_THAT(Rows(), ElementsAre(0, 4096));
  EXPECT_EQ(image.PageCount, 1);
  EXPECT_EQ(image.RowCount, 1);
}

TEST_F(Image, RefusesNumbersBeyondItsTables) {
  EXPECT_EQ(FailureOf("201\r\n\r\n"), 9);
  EXPECT_EQ(FailureOf("7FFFFFFF\r\n\r\n"), 9);
  EXPECT_EQ(FailureOf("80000000\r\n\r\n"), 6);
  EXPECT_EQ(FailureOf("0\r\n1001\r\n"), 9);
  EXPECT_EQ(FailureOf("0\r\n7FFF\r\n"), 9);
  EXPECT_EQ(FailureOf("0\r\n8000\r\n"), 6);
  EXPECT_EQ(FailureOf("G0\r\n\r\n"), 9);
  EXPECT_EQ(FailureOf("0, 1\r\n\r\n"), 9);  // a blank counts as a digit of 32
}

TEST_F(Image, NeedsItsFirstTwoLines) {
  EXPECT_EQ(FailureOf(""), 62);
  EXPECT_EQ(FailureOf("0"), 62);
  EXPECT_EQ(FailureOf("0\r\n"), 62);
  EXPECT_TRUE(Load("0\r\n0"));
}

TEST_F(Image, FailsOnAFileWithLineFeedsAlone) {
  EXPECT_EQ(FailureOf("0\n0\nFF\n"), 6);
  EXPECT_EQ(FailureOf("0,1,2\n0,1,2\n" + std::string(3072, 'F') + "\n"), 6);
  EXPECT_EQ(FailureOf("\n\n"), 6);
  EXPECT_EQ(FailureOf("0\r\n1\n2\r\n"), 6);
}

TEST_F(Image, TakesNoMeaningFromLineBreaksInItsData) {
  Load("0\r\n0\r\n01\r\n\r\n0203\r\n\r\n\r\n04");
  EXPECT_THAT(FirstBytes(5), ElementsAre(1, 2, 3, 4, 255));
  EXPECT_EQ(image.BytesLoaded, 4U);
}

TEST_F(Image, FailsOnAnOddLineInsteadOfHanging) {
  EXPECT_EQ(FailureOf("0\r\n0\r\n0102F\r\n"), 6);
  EXPECT_EQ(FailureOf("0\r\n0\r\nF"), 6);
  // The position overflows after 16,384 pairs; with less room than that, the image ends first.
  const std::string nearlyFull = [] {
    std::string lines;
    for (int line = 0; line < 786432 / 16384; ++line) {
      lines += std::string(32766, 'A') + "\r\nAA\r\n";
    }
    return lines;
  }();
  EXPECT_EQ(FailureOf("0\r\n0\r\n" + nearlyFull + "A\r\n"), 9);
}

TEST_F(Image, FailsOnALineBeyondThePositionsRange) {
  EXPECT_TRUE(Load("0\r\n0\r\n" + std::string(32766, '1') + "\r\n"));
  EXPECT_EQ(image.BytesLoaded, 16383U);
  EXPECT_EQ(FailureOf("0\r\n0\r\n" + std::string(32767, '1') + "\r\n"), 6);
  EXPECT_EQ(FailureOf("0\r\n0\r\n" + std::string(32768, '1') + "\r\n"), 6);
  EXPECT_EQ(FailureOf("0\r\n0\r\n" + std::string(100000, '1') + "\r\n"), 6);
}

TEST_F(Image, FailsOnPairsThatAreNoBytes) {
  EXPECT_EQ(FailureOf("0\r\n0\r\n01G0\r\n"), 6);
  EXPECT_EQ(FailureOf("0\r\n0\r\n 1\r\n"), 6);
  EXPECT_TRUE(Load("0\r\n0\r\n0G\r\n"));  // 0 and a digit of 71
  EXPECT_THAT(FirstBytes(2), ElementsAre(71, 255));
}

/// `count` bytes of data in lines of 64.
std::string Data(std::size_t count) {
  std::string lines;
  for (std::size_t at = 0; at < count; at += 64) {
    lines += std::string(2 * std::min<std::size_t>(64, count - at), '5') + "\r\n";
  }
  return lines;
}

TEST_F(Image, HoldsAFullDeviceAndOneByteMore) {
  EXPECT_TRUE(Load("0\r\n0\r\n" + Data(786432)));
  EXPECT_EQ(image.ImageBuffer[786431], 0x55);
  EXPECT_TRUE(Load("0\r\n0\r\n" + Data(786433)));
  EXPECT_EQ(image.ImageBuffer[786432], 0x55);
  EXPECT_EQ(FailureOf("0\r\n0\r\n" + Data(786434)), 9);
}

TEST_F(Image, ForgetsTheFileBefore) {
  Load("1FF\r\nFFF\r\n" + Data(786433));
  EXPECT_TRUE(Load("1\r\n8\r\n00\r\n"));
  EXPECT_THAT(Pages(), ElementsAre(0, 1));
  EXPECT_THAT(Rows(), ElementsAre(0, 8));
  EXPECT_THAT(FirstBytes(2), ElementsAre(0, 255));
  EXPECT_TRUE(std::all_of(image.ImageBuffer.begin() + 1, image.ImageBuffer.end() - 1,
                          [](std::uint8_t byte) { return byte == 0xFF; }));
  EXPECT_EQ(image.ImageBuffer.back(), 0x55);  // lies behind the last page and stays
}

TEST_F(Image, CanBeLoadedAgainAfterAFailure) {
  EXPECT_EQ(FailureOf("0,1,201\r\n\r\n"), 9);
  EXPECT_TRUE(Load("2\r\n10\r\n0A\r\n"));
  EXPECT_THAT(Pages(), ElementsAre(0, 2));
  EXPECT_THAT(FirstBytes(2), ElementsAre(10, 255));
}

TEST_F(Image, TakesAnyBytesWithoutHarm) {
  std::string every;
  for (int code = 0; code < 256; ++code) {
    every += static_cast<char>(code);
  }
  EXPECT_NE(FailureOf(every), 0);
  EXPECT_NE(FailureOf("\xEF\xBB\xBF"
                      "0\r\n0\r\n"),
            0);
  EXPECT_NE(FailureOf("0\r\n0\r\n" + every), 0);
}

}  // namespace
