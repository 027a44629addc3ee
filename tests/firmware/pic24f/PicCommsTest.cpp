#include "firmware/pic24f/PicComms.h"

#include <gmock/gmock.h>

#include "tests/firmware/pic24f/BootSite.h"
#include "tests/support/Bytes.h"
#include "tests/support/Thrown.h"

namespace {

using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::Not;
using testing::StartsWith;

class PicCommsTest : public testing::Test, protected BootSite {
 protected:
  PicCommsTest() {
    const BootIni ini(Disk, {Data, Program});
    comms.Settings = ReadBootSettings(ini);
    comms.Device = ReadPicDevice(ini, "PIC-A", comms.Settings);
    comms.PortHandle = 3;
  }

  std::int32_t WriteProgram(const std::string& image) {
    Disk.Put("/data/progmem.img", image);
    return comms.WriteRangeDevice(256, 2, 2, "progmem.img");
  }
  std::int32_t WriteEeprom(const std::string& image) {
    Disk.Put("/data/eedata.img", image);
    return comms.WriteRangeDevice(1, 1, 5, "eedata.img");
  }

  std::vector<std::string> statuses;
  PicComms comms{{.Library = Library,
                  .Disk = Disk,
                  .Events = Events,
                  .Folder = {Data, Program},
                  .ShowStatus = [this](const std::string& text) { statuses.push_back(text); }}};
};

TEST_F(PicCommsTest, ReadsTheVersion) {
  EXPECT_EQ(comms.ReadBootVersion(), "v1.5");
  EXPECT_THAT(Library.Log, ElementsAre("SendGetPacket 3: 0 2 up to 10, 3 retries"));
  Library.Answers.clear();
  EXPECT_EQ(comms.ReadBootVersion(), "");
}

TEST_F(PicCommsTest, ReadsTheIdentity) {
  EXPECT_EQ(comms.ReadDeviceId(), "1095");
  EXPECT_THAT(Library.Log, ElementsAre("ReadPIC 3: 1 at 16711680, 4 bytes in blocks of 4, 3 retries"));
  Library.Results["ReadPIC"] = {-2, 0};
  EXPECT_EQ(comms.ReadDeviceId(), "0");
  EXPECT_EQ(comms.ReadDeviceId(), "0");
}

TEST_F(PicCommsTest, OverflowsOnAnIdentityOfSixteenBits) {
  Library.Identity = 0x7FFF;
  EXPECT_EQ(comms.ReadDeviceId(), "32767");
  Library.Identity = 0x8000;
  EXPECT_EQ(NumberThrownBy([&] { comms.ReadDeviceId(); }), 6);
}

TEST_F(PicCommsTest, ReadsTheResetVector) {
  EXPECT_EQ(comms.ReadResetVector(), "0 C 4 0 FE FF FF 0 ");
  EXPECT_THAT(Library.Log, ElementsAre("SendGetPacket 3: 1 2 0 0 0 up to 255, 5 retries"));
  Library.Answers.clear();
  EXPECT_EQ(comms.ReadResetVector(), "");
}

TEST_F(PicCommsTest, ConfirmsAndRunsTheProgram) {
  EXPECT_GT(comms.SendVerifyOk(), 0);
  comms.ResetDevice();
  EXPECT_THAT(Library.Log, ElementsAre("SendGetPacket 3: 8 up to 255, 5 retries", "SendPacket 3: 0 0"));
}

TEST_F(PicCommsTest, WritesBlocksAndReadsThemBack) {
  EXPECT_EQ(WriteProgram(Image(0, 32, 0xA5)), 1);
  EXPECT_THAT(Library.Log, ElementsAre("WritePIC 3: 2 at 0, 256 bytes in blocks of 256, 3 retries",
                                       "ReadPIC 3: 1 at 0, 256 bytes in blocks of 4, 3 retries",
                                       "WritePIC 3: 2 at 128, 256 bytes in blocks of 256, 3 retries",
                                       "ReadPIC 3: 1 at 128, 256 bytes in blocks of 4, 3 retries"));
  EXPECT_THAT(statuses, ElementsAre("Writing: 0", "Writing: 80"));
  EXPECT_EQ(Library.Flash.size(), 512U);
  EXPECT_EQ(Library.Flash.at(0x1F0), 0xA5);
  EXPECT_EQ(Log(), "");
}

TEST_F(PicCommsTest, TellsTheLibraryTheTypeOfTheDevice) {
  EXPECT_EQ(WriteProgram(Image(0, 16, 0xA5)), 1);
  EXPECT_EQ(Library.Written.DeviceType, 2);
  EXPECT_EQ(Library.Written.BytesPerAddress, 2);
  comms.Device.DeviceType = 1;
  EXPECT_EQ(WriteEeprom(Image(0xFFFC00, 1, 0x33)), 1);
  EXPECT_EQ(Library.Written.DeviceType, 1);
  EXPECT_EQ(Library.Written.BytesPerAddress, 1);
  EXPECT_EQ(Library.Written.Address, 0xFFFC00U);
}

TEST_F(PicCommsTest, DropsABlockThatIsNotCompleteAtTheEnd) {
  EXPECT_EQ(WriteProgram(Image(0, 17, 0xA5)), 1);
  EXPECT_EQ(Library.Flash.size(), 256U);
}

TEST_F(PicCommsTest, WritesTheEepromLineByLine) {
  EXPECT_EQ(WriteEeprom(Image(0xFE0000, 2, 0x33)), 1);
  EXPECT_THAT(Library.Log, ElementsAre("WritePIC 3: 5 at 16646144, 16 bytes in blocks of 1, 3 retries",
                                       "ReadPIC 3: 1 at 16646144, 16 bytes in blocks of 4, 3 retries",
                                       "WritePIC 3: 5 at 16646160, 16 bytes in blocks of 1, 3 retries",
                                       "ReadPIC 3: 1 at 16646160, 16 bytes in blocks of 4, 3 retries"));
}

TEST_F(PicCommsTest, EmptiesTheLogOfAnEarlierWrite) {
  Disk.Put("/data/verify.log", "old");
  EXPECT_EQ(WriteProgram(""), 1);
  EXPECT_EQ(Log(), "");
}

TEST_F(PicCommsTest, LogsDifferencesAndGoesOn) {
  Library.OnCall = [this](const std::string& operation) {
    if (operation == "ReadPIC") {
      Library.Flash[0x40] = 0x12;
      Library.Flash[0x41] = 0x34;
      Library.Flash[0x42] = 0x06;
    }
  };
  EXPECT_EQ(WriteProgram(Image(0, 32, 0xA5)), -101);
  EXPECT_EQ(Log(), "Verify Error at 0x20 should be: 0xA5A5A5 but read: 0x63412\n");
  EXPECT_EQ(statuses.size(), 2U);
}

TEST_F(PicCommsTest, LetsTheBootLoadersOwnWordsDiffer) {
  Library.OnCall = [this](const std::string& operation) {
    if (operation == "ReadPIC") {
      for (const std::uint32_t address : {0x0U, 0x4U, 0x1800U, 0x1804U}) {
        Library.Flash[address] = 0x77;
      }
    }
  };
  EXPECT_EQ(WriteProgram(Image(0, 16, 0xA5) + Image(0x1800, 16, 0xA5)), 1);
  EXPECT_EQ(Log(), "");
}

TEST_F(PicCommsTest, EndsWhenTheLibraryFails) {
  Library.Results["WritePIC"] = {1, -7};
  EXPECT_EQ(WriteProgram(Image(0, 48, 0xA5)), -7);
  EXPECT_EQ(statuses.size(), 1U);
  Library.Results["ReadPIC"] = {-9};
  EXPECT_EQ(WriteProgram(Image(0, 16, 0xA5)), -9);
}

TEST_F(PicCommsTest, NeverTakesAShortReadForEqual) {
  Library.Results["ReadPIC"] = {128};
  EXPECT_EQ(WriteProgram(Image(0, 16, 0)), PicCode::Short);
}

TEST_F(PicCommsTest, StopsBetweenLines) {
  Library.OnCall = [this](const std::string& operation) {
    if (operation == "WritePIC") {
      Events.At(std::chrono::milliseconds(0), [this] { comms.RunFlag = 0; });
    }
  };
  EXPECT_EQ(WriteProgram(Image(0, 48, 0xA5)), -100);
  EXPECT_EQ(statuses.size(), 1U);
}

TEST_F(PicCommsTest, TellsADifferenceRatherThanAStop) {
  Library.OnCall = [this](const std::string& operation) {
    if (operation == "ReadPIC") {
      Library.Flash[0x40] = 0x12;
      comms.RunFlag = 0;
    }
  };
  EXPECT_EQ(WriteProgram(Image(0, 48, 0xA5)), -101);
}

TEST_F(PicCommsTest, IgnoresAStopBeforeTheStart) {
  comms.RunFlag = 0;
  EXPECT_EQ(WriteProgram(Image(0, 16, 0xA5)), 1);
  comms.RunFlag = 0;
  EXPECT_EQ(comms.EraseRangeDevice(0, 0x3FF), 1);
}

TEST_F(PicCommsTest, WritesOnAlthoughTheImageVanishes) {
  Library.OnCall = [this](const std::string&) { Disk.Remove("/data/progmem.img"); };
  EXPECT_EQ(WriteProgram(Image(0, 48, 0xA5)), 1);
  EXPECT_EQ(Library.Flash.size(), 768U);
}

TEST_F(PicCommsTest, FailsWithoutAnImage) {
  EXPECT_EQ(NumberThrownBy([&] { comms.WriteRangeDevice(256, 2, 2, "nothing.img"); }), 53);
  EXPECT_THAT(Library.Log, IsEmpty());
}

TEST_F(PicCommsTest, ReadsAnImageBesideTheProgram) {
  Disk.Put("/program/progmem.img", Image(0, 16, 1));
  EXPECT_EQ(comms.WriteRangeDevice(256, 2, 2, "progmem.img"), 1);
  EXPECT_EQ(Library.Flash.size(), 256U);
}

TEST_F(PicCommsTest, TakesImagesWithCarriageReturns) {
  std::string image;
  for (const char letter : Image(0, 16, 0x5A)) {
    image += letter == '\n' ? std::string("\r\n") : std::string(1, letter);
  }
  EXPECT_EQ(WriteProgram(image), 1);
  EXPECT_EQ(Library.Flash.size(), 256U);
}

TEST_F(PicCommsTest, FailsOnImagesAndSizesThatCannotBeWritten) {
  EXPECT_EQ(NumberThrownBy([&] { WriteProgram("000000 11 22\n"); }), 13);
  EXPECT_EQ(NumberThrownBy([&] { WriteProgram("no image\n"); }), 13);
  Disk.Put("/data/progmem.img", Image(0, 64, 1));
  EXPECT_EQ(NumberThrownBy([&] { comms.WriteRangeDevice(512, 2, 2, "progmem.img"); }), 9);
  EXPECT_EQ(NumberThrownBy([&] { comms.WriteRangeDevice(0, 2, 2, "progmem.img"); }), 11);
  EXPECT_EQ(NumberThrownBy([&] { comms.WriteRangeDevice(256, 0, 2, "progmem.img"); }), 11);
  EXPECT_THAT(Library.Log, IsEmpty());
}

TEST_F(PicCommsTest, TakesTheAddressOfTheFirstLineOfABlock) {
  EXPECT_EQ(WriteProgram(Image(0x1200, 16, 1)), 1);
  EXPECT_THAT(Library.Log, Contains(StartsWith("WritePIC 3: 2 at 2304,")));
}

TEST_F(PicCommsTest, ComparesWithoutWriting) {
  Disk.Put("/data/progmem.img", Image(0, 16, 0xA5));
  EXPECT_EQ(comms.CompareRangeDevice(256, 2, 2, "progmem.img"), -101);
  EXPECT_THAT(Library.Log, Not(Contains(StartsWith("WritePIC"))));
  EXPECT_EQ(WriteProgram(Image(0, 16, 0xA5)), 1);
  EXPECT_EQ(comms.CompareRangeDevice(256, 2, 2, "progmem.img"), 1);
}

TEST_F(PicCommsTest, ErasesAWellFormedRangeAtOnce) {
  EXPECT_EQ(comms.EraseRangeDevice(0, 0xABFF), 1);
  EXPECT_THAT(Library.Log, ElementsAre("ErasePIC 3, 43 blocks from 0, 5 retries"));
  EXPECT_THAT(statuses, ElementsAre("Erasing: AC00"));
}

TEST_F(PicCommsTest, ErasesOnUntilTheRangeEnds) {
  // One and a third pages round to one: the whole range is reckoned again for the rest.
  EXPECT_EQ(comms.EraseRangeDevice(0x400, 0x400 + 0x554), 1);
  EXPECT_THAT(Library.Log, ElementsAre("ErasePIC 3, 1 blocks from 1024, 5 retries",
                                       "ErasePIC 3, 1 blocks from 2048, 5 retries"));
}

TEST_F(PicCommsTest, EndsAnEraseThatFailsOrIsStopped) {
  Library.Results["ErasePIC"] = {-4};
  EXPECT_EQ(comms.EraseRangeDevice(0, 0x3FF), -4);
  Library.OnCall = [this](const std::string&) { comms.RunFlag = 0; };
  EXPECT_EQ(comms.EraseRangeDevice(0, 0x554), -100);
}

TEST_F(PicCommsTest, ErasesNothingInAnEmptyRange) {
  EXPECT_EQ(comms.EraseRangeDevice(0x400, 0x3FF), 1);
  EXPECT_THAT(Library.Log, IsEmpty());
}

TEST_F(PicCommsTest, GivesNoBlockToTheLibraryForARangeThatRoundsToNothing) {
  Library.Results["ErasePIC"] = {-4};
  EXPECT_EQ(comms.EraseRangeDevice(0, 9), -4);
  EXPECT_THAT(Library.Log, ElementsAre("ErasePIC 3, 0 blocks from 0, 5 retries"));
}

TEST_F(PicCommsTest, NeverErasesForEver) {
  EXPECT_EQ(NumberThrownBy([&] { comms.EraseRangeDevice(0, 0x7FFFF); }), 6);
  comms.Device.EraseBlock = 0;
  EXPECT_EQ(NumberThrownBy([&] { comms.EraseRangeDevice(0, 0x3FF); }), 11);
  comms.Device.EraseBlock = -2048;
  EXPECT_EQ(NumberThrownBy([&] { comms.EraseRangeDevice(0, 0x3FF); }), 6);
  comms.Device.EraseBlock = 2048;
  comms.Device.BytesPerAddr = 0;
  EXPECT_EQ(NumberThrownBy([&] { comms.EraseRangeDevice(0, 0x3FF); }), 11);
  EXPECT_THAT(Library.Log, IsEmpty());
  comms.Device.EraseBlock = 1;
  comms.Device.BytesPerAddr = 4;
  EXPECT_EQ(NumberThrownBy([&] { comms.EraseRangeDevice(0, 0); }), 0);
  comms.Device.BytesPerAddr = 2;
  EXPECT_EQ(NumberThrownBy([&] { comms.EraseRangeDevice(0, 0); }), 0);
}

}  // namespace
