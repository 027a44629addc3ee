#include "sim/pic24f/Pic24fMemory.h"

#include <gtest/gtest.h>

#include "sim/pic24f/Pic24fRequest.h"
#include "tests/sim/pic24f/LoaderHost.h"

namespace sim {
namespace {

const Bytes Blank{0xFF, 0xFF, 0xFF, 0x00};
const Bytes LoadersJump{0x00, 0x04, 0x04, 0x00, 0x00, 0x00, 0x00, 0x00};

Pic24fMemory Small() {
  return Pic24fMemory(Pic24fDevices[2]);
}

TEST(Pic24fMemory, IsBlankButForTheJumpToTheLoader) {
  const Pic24fMemory memory = Small();
  EXPECT_EQ(memory.Read(0, 3), LoadersJump + Blank);
  EXPECT_EQ(memory.Read(0x2BFC, 2), Blank + Blank);
  EXPECT_EQ(memory.Read(0x2BFE, 2), std::nullopt);
  EXPECT_EQ(memory.Program().size(), 5632U * 4U);
}

TEST(Pic24fMemory, HasTwoAddressesForEachInstruction) {
  Pic24fMemory memory = Small();
  Bytes row = Repeated(64, Blank);
  row[4] = 0x12;
  EXPECT_TRUE(memory.WriteRows(0x80, row));
  EXPECT_EQ(memory.Read(0x82, 1), (Bytes{0x12, 0xFF, 0xFF, 0x00}));
  EXPECT_EQ(memory.Read(0x80, 1), Blank);
  EXPECT_EQ(memory.Read(0x81, 1), std::nullopt);
}

TEST(Pic24fMemory, NeverKeepsAFourthByte) {
  Pic24fMemory memory = Small();
  EXPECT_TRUE(memory.WriteRows(0x80, Repeated(64, {0x01, 0x02, 0x03, 0x04})));
  EXPECT_EQ(memory.Read(0x80, 1), (Bytes{0x01, 0x02, 0x03, 0x00}));
}

TEST(Pic24fMemory, ClearsBitsWhenItIsWrittenAndSetsThemWhenItIsErased) {
  Pic24fMemory memory = Small();
  EXPECT_TRUE(memory.WriteRows(0x480, Repeated(64, {0x0F, 0x0F, 0x0F, 0x00})));
  EXPECT_TRUE(memory.WriteRows(0x480, Repeated(64, {0x3C, 0x3C, 0x3C, 0x00})));
  EXPECT_EQ(memory.Read(0x480, 1), (Bytes{0x0C, 0x0C, 0x0C, 0x00}));
  EXPECT_TRUE(memory.ErasePages(0x400, 1));
  EXPECT_EQ(memory.Read(0x480, 1), Blank);
}

TEST(Pic24fMemory, ErasesWholePagesOnly) {
  Pic24fMemory memory = Small();
  const Bytes row = Repeated(64, {0x01, 0x02, 0x03, 0x00});
  for (const std::uint32_t address : {0x380U, 0x400U, 0x780U, 0x800U}) {
    EXPECT_TRUE(memory.WriteRows(address, row));
  }
  EXPECT_TRUE(memory.ErasePages(0x400, 1));
  EXPECT_NE(memory.Read(0x380, 1), Blank);
  EXPECT_EQ(memory.Read(0x400, 1), Blank);
  EXPECT_EQ(memory.Read(0x780, 1), Blank);
  EXPECT_NE(memory.Read(0x800, 1), Blank);
  EXPECT_FALSE(memory.ErasePages(0x80, 1));
  EXPECT_FALSE(memory.ErasePages(0x400, 11));
  EXPECT_FALSE(memory.ErasePages(0x400, 0));
  EXPECT_NE(memory.Read(0x800, 1), Blank);
}

TEST(Pic24fMemory, WritesSeveralRowsAndNothingBeyondItsEnd) {
  Pic24fMemory memory = Small();
  EXPECT_TRUE(memory.WriteRows(0x2B00, Repeated(128, {0x01, 0x02, 0x03, 0x00})));
  EXPECT_EQ(memory.Read(0x2BFE, 1), (Bytes{0x01, 0x02, 0x03, 0x00}));
  EXPECT_FALSE(memory.WriteRows(0x2B80, Repeated(128, {0, 0, 0, 0})));
  EXPECT_FALSE(memory.WriteRows(0x2B40, Repeated(64, {0, 0, 0, 0})));
  EXPECT_EQ(memory.Read(0x2B80, 1), (Bytes{0x01, 0x02, 0x03, 0x00}));
}

TEST(Pic24fMemory, KeepsTheResetWordsWhateverIsWrittenThere) {
  Pic24fMemory memory = Small();
  EXPECT_TRUE(memory.WriteRows(0, Repeated(64, {0x01, 0x02, 0x03, 0x00})));
  EXPECT_EQ(memory.Read(0, 3), (LoadersJump + Bytes{0x01, 0x02, 0x03, 0x00}));
  EXPECT_TRUE(memory.ErasePages(0, 1));
  EXPECT_EQ(memory.Read(0, 3), LoadersJump + Blank);
}

TEST(Pic24fMemory, KeepsStartOfTheApplicationAndDelayWhereItIsTold) {
  Pic24fDevice device = Pic24fDevices[2];
  device.UserResetVector = 0xC00;
  device.BootDelay = 0xC02;
  Pic24fMemory memory(device);
  EXPECT_EQ(memory.Read(0xC00, 3), (Blank + Bytes{0x05, 0x00, 0x00, 0x00} + Blank));
  // GOTO 0x01ABCC.
  EXPECT_TRUE(
      memory.WriteRows(0, Bytes{0xCC, 0xAB, 0x04, 0x00, 0x01, 0x00, 0x00, 0x00} + Repeated(62, Blank)));
  EXPECT_TRUE(memory.WriteRows(0xC00, Repeated(64, {0x01, 0x02, 0x03, 0x00})));
  EXPECT_EQ(memory.Read(0xC00, 3),
            (Bytes{0xCC, 0xAB, 0x01, 0x00, 0x05, 0x00, 0x00, 0x00, 0x01, 0x02, 0x03, 0x00}));
}

TEST(Pic24fMemory, ShowsItsEepromAsProgramMemoryToo) {
  Pic24fMemory memory = Small();
  const Bytes line{1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13, 14, 15, 16};
  EXPECT_TRUE(memory.WriteEeprom(0xFFFE10, line));
  EXPECT_EQ(memory.ReadEeprom(0xFFFE10, 8), line);
  EXPECT_EQ(memory.Read(0xFFFE10, 4), line);
  EXPECT_EQ(memory.ReadEeprom(0xFFFE00, 8), Bytes(16, 0xFF));
  EXPECT_TRUE(memory.WriteEeprom(0xFFFFFE, Bytes{7, 8}));
  EXPECT_FALSE(memory.WriteEeprom(0xFFFFFE, line));
  EXPECT_FALSE(memory.WriteEeprom(0xFFFBFE, Bytes{7, 8}));
  EXPECT_EQ(memory.ReadEeprom(0xFFFE11, 1), std::nullopt);
  EXPECT_FALSE(Pic24fMemory(Pic24fDevices[0]).WriteEeprom(0xFFFE10, line));
}

TEST(Pic24fMemory, HasItsEepromAtTwiceTheChipsProgramAddress) {
  // 256 words from program address 7FFE00 on: FFFC00 in a HEX file.
  Pic24fMemory memory = Small();
  const Bytes line{1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13, 14, 15, 16};
  EXPECT_TRUE(memory.WriteEeprom(0xFFFC00, line));
  EXPECT_TRUE(memory.WriteEeprom(0xFFFFF0, line));
  EXPECT_EQ(memory.Read(0xFFFC00, 4), line);
  EXPECT_EQ(memory.ReadEeprom(0xFFFFF0, 8), line);
  EXPECT_FALSE(memory.WriteEeprom(0xFE0000, line));
  EXPECT_FALSE(memory.WriteEeprom(0xFFFBF8, line));
}

TEST(Pic24fMemory, TellsItsIdentityBesideTheLargestEeprom) {
  Pic24fDevice device = Pic24fDevices[2];
  device.EepromBytes = 32'764;
  Pic24fMemory memory(device);
  EXPECT_TRUE(memory.WriteEeprom(0xFF0008, Bytes(16, 0)));
  EXPECT_EQ(memory.Read(0xFF0000, 1), (Bytes{0xEB, 0x03, 0x00, 0x00}));
}

TEST(Pic24fMemory, HasEightConfigurationWords) {
  Pic24fMemory memory = Small();
  EXPECT_TRUE(memory.WriteConfiguration(0xF8000C, Bytes{1, 2, 3, 4}));
  EXPECT_EQ(memory.ReadConfiguration(0xF8000E, 1), (Bytes{3, 4}));
  EXPECT_EQ(memory.Read(0xF8000C, 2), (Bytes{1, 2, 0, 0, 3, 4, 0, 0}));
  EXPECT_EQ(memory.ReadConfiguration(0xF80000, 8)->size(), 16U);
  EXPECT_EQ(memory.ReadConfiguration(0xF80000, 9), std::nullopt);
  EXPECT_FALSE(memory.WriteConfiguration(0xF80010, Bytes{1, 2}));
  EXPECT_FALSE(memory.WriteConfiguration(0xF7FFFE, Bytes{1, 2}));
}

TEST(Pic24fMemory, TellsItsIdentity) {
  Pic24fDevice device = Pic24fDevices[0];
  device.Identity = 0x8001;
  EXPECT_EQ(Pic24fMemory(device).Read(0xFF0000, 1), (Bytes{0x01, 0x80, 0x00, 0x00}));
  EXPECT_EQ(Pic24fMemory(device).Read(0xFF0000, 2)->size(), 8U);
  EXPECT_EQ(Pic24fMemory(device).Read(0xFF0000, 3), std::nullopt);
}

TEST(Pic24fDevices, HaveWholePages) {
  for (const Pic24fDevice& device : Pic24fDevices) {
    EXPECT_EQ(device.Instructions % PageInstructions, 0U) << device.Name;
    EXPECT_EQ(Pic24fMemory(device).Program().size(), device.Instructions * 4U);
  }
}

}  // namespace
}  // namespace sim
