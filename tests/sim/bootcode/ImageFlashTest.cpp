#include "sim/bootcode/ImageFlash.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <stdexcept>

#include "tests/support/Bytes.h"
#include "tests/support/TemporaryFolder.h"

namespace sim {
namespace {

Bytes Row(const ImageFlash& flash, std::size_t row) {
  const auto begin = flash.Bytes().begin() + static_cast<std::ptrdiff_t>(row * 192);
  return {begin, begin + 192};
}

const Bytes Blank(192, 0xFF);

TEST(ImageFlash, IsErasedAtFirstAndHasRoomForAWholeProgram) {
  const ImageFlash flash(std::nullopt);
  EXPECT_EQ(flash.Bytes(), Bytes(786432, 0xFF));
}

TEST(ImageFlash, TakesARowAndErasesThePageAroundIt) {
  ImageFlash flash(std::nullopt);
  for (const std::size_t row : {7U, 8U, 15U, 16U, 4095U}) {
    EXPECT_TRUE(flash.WriteRow(row, Bytes(192, static_cast<std::uint8_t>(row))));
  }
  flash.ErasePage(1);
  EXPECT_EQ(Row(flash, 7), Bytes(192, 7));
  EXPECT_EQ(Row(flash, 8), Blank);
  EXPECT_EQ(Row(flash, 15), Blank);
  EXPECT_EQ(Row(flash, 16), Bytes(192, 16));
  EXPECT_EQ(Row(flash, 4095), Bytes(192, 0xFF));
}

TEST(ImageFlash, OnlyClearsBitsUntilItIsErased) {
  ImageFlash flash(std::nullopt);
  EXPECT_TRUE(flash.WriteRow(3, Bytes(192, 0xF0)));
  EXPECT_TRUE(flash.WriteRow(3, Bytes(192, 0xF0)));
  EXPECT_TRUE(flash.WriteRow(3, Bytes(192, 0x70)));
  EXPECT_FALSE(flash.WriteRow(3, Bytes(192, 0x3C)));
  EXPECT_EQ(Row(flash, 3), Bytes(192, 0x30));
}

TEST(ImageFlash, KeepsAllThatIsDoneInItsFile) {
  const TemporaryFolder folder;
  {
    ImageFlash flash(folder / "flash");
    EXPECT_EQ(ReadFile(folder / "flash"), std::string(786432, '\xFF'));
    flash.WriteRow(8, Bytes(192, 0x11));
    flash.WriteRow(16, Bytes(192, 0x22));
    flash.ErasePage(1);
    EXPECT_EQ(ReadFile(folder / "flash").substr(std::size_t{16} * 192, 192), std::string(192, '\x22'));
  }
  ImageFlash again(folder / "flash");
  EXPECT_EQ(Row(again, 8), Blank);
  EXPECT_EQ(Row(again, 16), Bytes(192, 0x22));
  again.WriteRow(0, Bytes(192, 0x33));
  EXPECT_EQ(Row(ImageFlash(folder / "flash"), 0), Bytes(192, 0x33));
}

TEST(ImageFlash, RefusesAFileOfAnotherLengthAndOneThatCannotBeWritten) {
  const TemporaryFolder folder;
  WriteFile(folder / "short", "abc");
  EXPECT_THROW(ImageFlash(folder / "short"), std::runtime_error);
  EXPECT_EQ(ReadFile(folder / "short"), "abc");
  EXPECT_THROW(ImageFlash(folder / "missing/flash"), std::runtime_error);
  EXPECT_THROW(ImageFlash(folder.Path()), std::runtime_error);
}

}  // namespace
}  // namespace sim
