#include "firmware/pic24f/BootIni.h"

#include <gtest/gtest.h>

#include "firmware/pic24f/BootSettings.h"
#include "tests/firmware/pic24f/BootSite.h"
#include "tests/resources/DefaultFile.h"
#include "tests/support/Thrown.h"

namespace {

class BootIniTest : public testing::Test, protected BootSite {
 protected:
  void Put(const std::string& text) { Disk.Put("/data/P24qp.ini", text); }

  const BootIni ini{Disk, {Data, Program}};
};

TEST_F(BootIniTest, ReadsTheFileBesideTheProgram) {
  EXPECT_EQ(ini.ReadBootIni("DEVICELIST", "1095"), "PIC-A");
  EXPECT_EQ(ini.ReadBootIni("PIC24FBOOT", "progmem"), "progmem.img");
}

TEST_F(BootIniTest, PrefersTheFileInTheDataFolder) {
  Put("[DEVICELIST]\n1095=Another\n");
  EXPECT_EQ(ini.ReadBootIni("DEVICELIST", "1095"), "Another");
  EXPECT_EQ(ini.ReadBootIni("DEVICELIST", "1103"), "");
}

TEST_F(BootIniTest, HasNoValueWithoutAFile) {
  Disk.Remove("/program/P24qp.ini");
  EXPECT_EQ(ini.ReadBootIni("PIC24FBOOT", "progmem"), "");
  EXPECT_EQ(ini.Decimal("PIC24FBOOT", "CommTimeOut"), 0);
  EXPECT_EQ(ini.Hexadecimal("PIC-A", "pmrangehigh"), 0U);
}

TEST_F(BootIniTest, CutsAValueAfterNineteenBytes) {
  Put("[s]\nk=1234567890123456789\nlong=12345678901234567890\n");
  EXPECT_EQ(ini.ReadBootIni("s", "k"), "1234567890123456789");
  EXPECT_EQ(ini.ReadBootIni("s", "long"), "1234567890123456789");
}

TEST_F(BootIniTest, EndsAValueAtItsFirstNul) {
  Put(std::string("[s]\nk=ab\0cd\n", 12));
  EXPECT_EQ(ini.ReadBootIni("s", "k"), "ab");
}

TEST_F(BootIniTest, ReadsNumbers) {
  Put("[s]\nd=-12\nh=1F0\nbig=FFFFFFFF\nzero=0\nempty=\n");
  EXPECT_EQ(ini.Decimal("s", "d"), -12);
  EXPECT_EQ(ini.Hexadecimal("s", "h"), 0x1F0U);
  EXPECT_EQ(ini.Hexadecimal("s", "big"), 0xFFFFFFFFU);
  EXPECT_EQ(ini.Decimal("s", "zero"), 0);
  EXPECT_EQ(ini.Decimal("s", "empty"), 0);
  EXPECT_EQ(ini.Hexadecimal("s", "missing"), 0U);
}

TEST_F(BootIniTest, RefusesWhatIsNoNumberOrTooLarge) {
  Put("[s]\ntext=abc\nhex=12G\nlarge=40000\nhuge=123456789012\nneg=-1\n");
  EXPECT_EQ(NumberThrownBy([&] { ini.Decimal("s", "text"); }), 13);
  EXPECT_EQ(NumberThrownBy([&] { ini.Hexadecimal("s", "hex"); }), 13);
  EXPECT_EQ(NumberThrownBy([&] { ini.Decimal16("s", "large"); }), 6);
  EXPECT_EQ(NumberThrownBy([&] { ini.Decimal("s", "huge"); }), 6);
  EXPECT_EQ(NumberThrownBy([&] { ini.Hexadecimal("s", "huge"); }), 6);
  EXPECT_EQ(NumberThrownBy([&] { ini.DecimalByte("s", "neg"); }), 6);
}

TEST_F(BootIniTest, ReadsItsSettings) {
  const BootSettings settings = ReadBootSettings(ini);
  EXPECT_EQ(settings.EeData, "eedata.img");
  EXPECT_EQ(settings.ErrorLog, "verify.log");
  EXPECT_EQ(settings.Editor, "viewer -n");
  EXPECT_EQ(settings.CommTimeOut, 1000);
  EXPECT_EQ(settings.MaxRetry, 3);
  EXPECT_EQ(settings.UserResetVector, 0xC00U);
  EXPECT_EQ(settings.BootDelay, 0xC02U);
  EXPECT_EQ(settings.BitRateIndex, 8);
  EXPECT_EQ(settings.Images({Data, Program}).Config, "/data/config.img");
}

TEST_F(BootIniTest, ReadsADevice) {
  const BootSettings settings = ReadBootSettings(ini);
  const PicDevice device = ReadPicDevice(ini, "PIC-A", settings);
  EXPECT_EQ(device.PmRangeHigh, 0xABFFU);
  EXPECT_EQ(device.CfgRangeLow, 0xABFCU);
  EXPECT_EQ(device.BytesPerAddr, 2);
  EXPECT_EQ(device.MaxPacketSize, 261);
  EXPECT_EQ(device.EraseBlock, 2048);
  EXPECT_EQ(device.ReadBlock, 4);
  EXPECT_EQ(device.WriteBlock, 256);
  EXPECT_EQ(device.DeviceType, 2);
  EXPECT_EQ(device.UserResetVector, 0xC00U);
  const PicDevice other = ReadPicDevice(ini, "PIC-E", settings);
  EXPECT_EQ(other.UserResetVector, 0x1000U);
  EXPECT_EQ(other.BootDelay, 0xC02U);
  EXPECT_EQ(other.EeRangeHigh, 0x7FFFFFU);
}

TEST_F(BootIniTest, HasInitialRangesOfADevice) {
  const PicDevice device;
  EXPECT_EQ(device.PmRangeLow, 512U);
  EXPECT_EQ(device.PmRangeHigh, 512U);
  EXPECT_EQ(device.EeRangeHigh, 0U);
  EXPECT_EQ(device.CfgRangeLow, 0x300000U);
  EXPECT_EQ(device.UsrRangeHigh, 0x200000U);
}

TEST(ShippedBootIni, DescribesEachListedDevice) {
  FakeFiles files;
  files.Put("/p/P24qp.ini", DefaultFileBytes("P24qp.ini"));
  const BootIni ini(files, {"/d", "/p"});
  const BootSettings settings = ReadBootSettings(ini);
  EXPECT_EQ(settings.BitRateIndex, 8);
  const struct {
    const char* Identity;
    const char* Name;
    std::uint32_t Pages;
  } devices[] = {
      {"1095", "PIC24FJ64GA002", 43}, {"1103", "PIC24FJ64GA004", 43}, {"1037", "PIC24FJ128GA010", 86}};
  for (const auto& row : devices) {
    EXPECT_EQ(ini.ReadBootIni(BootIni::DeviceListSection, row.Identity), row.Name);
    const PicDevice device = ReadPicDevice(ini, row.Name, settings);
    EXPECT_EQ((device.PmRangeHigh + 1 - device.PmRangeLow) * device.BytesPerAddr,
              row.Pages * static_cast<std::uint32_t>(device.EraseBlock));
    EXPECT_EQ(device.ReadBlock, 4);
    EXPECT_EQ(device.WriteBlock, 256);
    EXPECT_FALSE(ini.ReadBootIni(row.Name, FormatHex(device.CfgRangeHigh, 6)).empty());
  }
}

}  // namespace
