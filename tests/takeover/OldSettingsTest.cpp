#include "takeover/OldSettings.h"

#include <gmock/gmock.h>

#include "core/game/SoldieringFactors.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class SettingsTaken : public testing::Test {
 protected:
  OldSettings Read(const std::string& old) {
    disk.Put("/old.ini", old);
    return ReadOldSettings(disk, "/old.ini", inUse, [](std::int16_t number) { return number == 3; });
  }

  FakeFiles disk;
  IniReader inUse{disk, "/now.ini"};
};

TEST_F(SettingsTaken, AreThoseThatBothKindsHave) {
  disk.Put("/now.ini", "[comm]\ncommport=3\n");
  const OldSettings settings = Read(
      "[COMM]\r\nCommPort=3\r\n[soldiering_calc]\r\nheals=-2\r\n[ports]\r\ncom3=/dev/"
      "x\r\n[audience]\r\nvenue=V\r\n"
      "[onewire]\r\nport=2\r\n");
  EXPECT_THAT(settings.Taken, ElementsAre(OldSetting{"comm", "commport", "3", false},
                                          OldSetting{"soldiering_calc", "heals", "-2", true}));
  EXPECT_EQ(settings.Different(), 1U);
  EXPECT_FALSE(settings.PortLeftOut);
}

TEST_F(SettingsTaken, LeaveOutAPortThatThisComputerDoesNotHave) {
  const OldSettings settings = Read("[comm]\ncommport=5\n");
  EXPECT_THAT(settings.Taken, IsEmpty());
  EXPECT_EQ(settings.PortLeftOut, std::int16_t{5});
  EXPECT_THAT(Read("[comm]\ncommport=\n").Taken, IsEmpty());
  EXPECT_THAT(Read("[comm]\ncommport=99999\n").Taken, IsEmpty());
}

TEST_F(SettingsTaken, LeaveOutAFolderOfAnotherSystem) {
  EXPECT_THAT(Read("[Paths]\nfirmware_path=C:\\Firmware\\gun.hex\n").Taken, IsEmpty());
  EXPECT_THAT(Read("[Paths]\nfirmware_path=/home/ann/gun.hex\n").Taken, IsEmpty()) << "it is not here";
  disk.Put("/home/ann/gun.hex", ":00000001FF");
  EXPECT_THAT(Read("[Paths]\nfirmware_path=/home/ann/gun.hex\n").Taken,
              ElementsAre(OldSetting{"Paths", "firmware_path", "/home/ann/gun.hex", true}));
}

TEST_F(SettingsTaken, LeaveOutFactorsWithWhichTheProgramWouldNotStart) {
  for (const char* value : {"abc", "", "1e999", "-1e999", "1,5", "nan", "0x10"}) {
    const OldSettings settings =
        Read(std::string("[soldiering_calc]\nheals=-2\naccuracy=") + value + "\nrespawns= 2.5 \n");
    EXPECT_THAT(settings.Taken, ElementsAre(OldSetting{"soldiering_calc", "respawns", "2.5", true},
                                            OldSetting{"soldiering_calc", "heals", "-2", true}))
        << value;
    EXPECT_THAT(settings.FactorsLeftOut, ElementsAre("accuracy")) << value;
    GiveSettings(disk, "/next.ini", settings.Taken);
    EXPECT_EQ(ReadSoldieringFactors(IniReader(disk, "/next.ini")).Heal, -2) << value;
  }
}

TEST_F(SettingsTaken, AreRefusedFromAFileThatIsNoText) {
  EXPECT_EQ(NumberThrownBy([&] { Read(std::string("[comm]\0", 7)); }), Fault::InvalidFileFormat);
  EXPECT_EQ(NumberThrownBy([&] { Read(std::string((1U << 20U) + 1, ' ')); }), Fault::InvalidFileFormat);
}

TEST_F(SettingsTaken, ChangeNoOtherLine) {
  disk.Put("/now.ini",
           "; mine\r\n[ports]\r\ncom1=/dev/a\r\n[soldiering_calc]\r\nheals=-1 \r\n[audience]\r\nvenue=V\r\n");
  GiveSettings(disk, "/now.ini", Read("[soldiering_calc]\nheals=-2\n[ports]\ncom1=/dev/b\n").Taken);
  EXPECT_EQ(disk.Read("/now.ini"),
            "; mine\r\n[ports]\r\ncom1=/dev/a\r\n[soldiering_calc]\r\nheals=-2\r\n[audience]\r\nvenue=V\r\n");
}

TEST_F(SettingsTaken, TellThatTheyCouldNotBeWritten) {
  disk.Put("/now.ini", "");
  disk.FailReplace("/now.ini", RuntimeError(Fault::DiskFull));
  const auto settings = Read("[soldiering_calc]\nheals=-2\n").Taken;
  EXPECT_EQ(ThrownBy([&] { GiveSettings(disk, "/now.ini", settings); }).Text,
            "Path/File access error: /now.ini");
}

}  // namespace
