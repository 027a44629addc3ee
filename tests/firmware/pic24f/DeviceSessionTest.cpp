#include "firmware/pic24f/tool/DeviceSession.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakeSerialPort.h"
#include "tests/firmware/hex/HexFile.h"
#include "tests/firmware/pic24f/BootSite.h"
#include "tests/firmware/pic24f/LoaderModel.h"
#include "tests/support/Bytes.h"
#include "tests/support/Thrown.h"

namespace {

using std::chrono::milliseconds;
using testing::HasSubstr;
using testing::Not;

class DeviceSessionTest : public testing::Test, protected BootSite {
 protected:
  DeviceSessionTest() {
    Disk.AddFolder("/tmp");
    port.OnOutput = [this](std::uint8_t byte) {
      const Bytes answer = loader.Take(byte);
      if (!answer.empty()) {
        Events.At(milliseconds(2), [this, answer] { port.Receive(answer); });
      }
    };
    Disk.Put("/home/new.hex", Program(0, 0x400) + HexFile::End());
  }

  static std::string Program(unsigned int first, unsigned int last) {
    std::string text;
    for (unsigned int address = first; address < last; address += 16) {
      text += HexFile::Data(address, HexFile::Instructions(16, address / 16));
    }
    return text;
  }

  /// Runs a command; its code.
  std::int32_t Run(const std::vector<std::string>& words) {
    std::vector<std::string> all = words;
    all.insert(all.end(), {"--port", "/dev/pic"});
    const ToolOptions options = ParseToolOptions(all);
    testing::internal::CaptureStderr();
    std::int32_t code = -999;
    {
      DeviceSession session(parts, options);
      try {
        code = session.Run();
      } catch (const RuntimeError& error) {
        Complain(error.what());
      }
      session.TellState(code);
      facts = session.Facts();
      warnings = session.Warnings().size();
    }
    said = testing::internal::GetCapturedStderr();
    return code;
  }

  LoaderModel loader;
  FakeSerialPort port;
  const StringTable strings{Language::English};
  int stops = 0;
  const DeviceSession::Parts parts{.Tool = {Disk, strings},
                                   .Line = port,
                                   .Events = Events,
                                   .Folder = {Data, BootSite::Program},
                                   .DeviceOf = [](const std::string& name) { return name; },
                                   .StopRequests = [this] { return stops; }};
  std::string facts;
  std::string said;
  std::size_t warnings = 0;
};

TEST_F(DeviceSessionTest, Identifies) {
  EXPECT_EQ(Run({"identify", "--rate", "9600"}), 1095);
  EXPECT_EQ(facts, "identity 1095\ndevice PIC-A\nversion v1.5\n");
  EXPECT_EQ(port.Log.front(), "Open /dev/pic 9600,N,8,1");
  EXPECT_FALSE(port.PortOpen());
}

TEST_F(DeviceSessionTest, TellsADeviceThatDoesNotAnswer) {
  loader.OnPacket = [](const Bytes&) { return false; };
  EXPECT_EQ(Run({"identify"}), 0);
  EXPECT_EQ(Run({"erase"}), 0);
  EXPECT_THAT(said, HasSubstr("--device"));
  EXPECT_THAT(said, HasSubstr("is as it was"));
}

TEST_F(DeviceSessionTest, HasATimeOutAndRetriesOfItsOwnWhereTheIniFileHasNone) {
  std::string ini = Ini;
  for (const std::string line : {"CommTimeOut=1000\r\n", "maxretry=3\r\n"}) {
    ini.erase(ini.find(line), line.size());
  }
  Disk.Put("/data/P24qp.ini", ini);
  std::vector<Bytes> packets;
  loader.OnPacket = [&](const Bytes& packet) {
    packets.push_back(packet);
    return false;
  };
  EXPECT_EQ(Run({"erase"}), 0);
  EXPECT_EQ(packets, std::vector<Bytes>(4, Bytes{0x01, 0x01, 0x00, 0x00, 0xFF}));
  EXPECT_GE(Events.Now(), milliseconds(4000));
  EXPECT_LE(Events.Now(), milliseconds(4100));
}

TEST_F(DeviceSessionTest, TellsAPortThatDoesNotOpen) {
  port.FailNextOpen(8005);
  EXPECT_LT(Run({"identify"}), 0);
  EXPECT_THAT(said, HasSubstr("/dev/pic cannot be opened"));
}

TEST_F(DeviceSessionTest, WritesWhatItThenFindsEqual) {
  EXPECT_EQ(Run({"verify", "/home/new.hex"}), -101);
  EXPECT_THAT(said, HasSubstr("Verify Error at 0x4 should be: 0xA0908"));
  EXPECT_THAT(said, HasSubstr("more"));
  EXPECT_EQ(Run({"write", "/home/new.hex"}), 1);
  EXPECT_EQ(said, "");
  EXPECT_EQ(loader.Confirmed, 1);
  EXPECT_EQ(loader.Instruction(0x1FE), (Bytes{0x4B, 0x4C, 0x4D, 0}));
  EXPECT_EQ(Run({"verify", "/home/new.hex"}), 1);
  EXPECT_EQ(loader.Confirmed, 1);
}

TEST_F(DeviceSessionTest, LeavesNoImageBehind) {
  Run({"write", "/home/new.hex"});
  for (const auto& [path, bytes] : Disk.Contents()) {
    EXPECT_THAT(path, Not(HasSubstr("/tmp/")));
    EXPECT_THAT(path, Not(HasSubstr(".img")));
  }
}

TEST_F(DeviceSessionTest, RefusesAFileWithWarnings) {
  Disk.Put("/home/new.hex", Program(0, 0x20) + Program(0x40, 0x60) + HexFile::End());
  EXPECT_EQ(Run({"write", "/home/new.hex"}), 0);
  EXPECT_EQ(warnings, 1U);
  EXPECT_TRUE(port.Log.empty());
  EXPECT_THAT(said, HasSubstr("--despite-warnings"));
  EXPECT_EQ(Run({"write", "/home/new.hex", "--despite-warnings"}), 1);
  EXPECT_EQ(loader.Confirmed, 1);
}

TEST_F(DeviceSessionTest, RefusesAFileThatIsNone) {
  Disk.Put("/home/new.hex", "#\n");
  EXPECT_EQ(Run({"write", "/home/new.hex"}), 0);
  EXPECT_THAT(said, HasSubstr("a line is no record"));
  EXPECT_EQ(Run({"verify", "/home/missing.hex"}), 0);
  EXPECT_TRUE(port.Log.empty());
}

TEST_F(DeviceSessionTest, WritesTheEeprom) {
  loader.Identity = 1103;
  Disk.Put("/home/new.hex", Program(0, 0x100) + HexFile::Upper(0xFE) +
                                HexFile::Data(0, {1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13, 14, 15, 16}) +
                                HexFile::End());
  EXPECT_EQ(Run({"write", "/home/new.hex"}), 1);
  EXPECT_EQ(loader.Eeprom.at(0xFE000E), 0x100F);
  EXPECT_EQ(Run({"verify", "/home/new.hex"}), 1);
  loader.Eeprom[0xFE0002] = 0;
  EXPECT_EQ(Run({"verify", "/home/new.hex"}), -101);
}

TEST_F(DeviceSessionTest, RefusesEepromDataForADeviceWithoutOne) {
  Disk.Put("/home/new.hex",
           Program(0, 0x100) + HexFile::Upper(0xFE) + HexFile::Data(0, {1, 2}) + HexFile::End());
  EXPECT_EQ(Run({"write", "/home/new.hex"}), 0);
  EXPECT_TRUE(loader.Flash.empty());
  EXPECT_EQ(Run({"write", "/home/new.hex", "--despite-warnings"}), 1);
  EXPECT_TRUE(loader.Eeprom.empty());
}

TEST_F(DeviceSessionTest, ErasesProgramMemory) {
  Run({"write", "/home/new.hex"});
  loader.Flash[0xABFE] = {1, 2, 3, 0};
  EXPECT_EQ(Run({"erase", "--keep-config"}), 1);
  EXPECT_EQ(loader.Flash.size(), 1U);
  EXPECT_EQ(Run({"erase"}), 1);
  EXPECT_TRUE(loader.Flash.empty());
}

TEST_F(DeviceSessionTest, TakesTheDeviceFromItsOption) {
  loader.OnPacket = [](const Bytes& packet) { return packet[0] == 3; };
  EXPECT_EQ(Run({"erase", "--device", "PIC-E"}), 1);
  EXPECT_EQ(Run({"erase", "--device", "PIC-X"}), 0);
  EXPECT_THAT(said, HasSubstr("PIC-X"));
}

TEST_F(DeviceSessionTest, TellsAnIdentityThatNobodyKnows) {
  loader.Identity = 77;
  EXPECT_EQ(Run({"identify"}), 77);
  EXPECT_THAT(facts, HasSubstr("device unknown"));
  EXPECT_EQ(Run({"erase"}), 0);
  EXPECT_THAT(said, HasSubstr("77"));
}

TEST_F(DeviceSessionTest, RunsTheProgram) {
  EXPECT_EQ(Run({"run"}), 1);
  EXPECT_TRUE(loader.Running);
}

TEST_F(DeviceSessionTest, SaysWhatAnInterruptedWriteLeaves) {
  int rows = 0;
  loader.OnPacket = [&](const Bytes& packet) {
    rows += packet[0] == 2 ? 1 : 0;
    stops = rows >= 2 ? 1 : 0;
    return true;
  };
  EXPECT_EQ(Run({"write", "/home/new.hex"}), -100);
  EXPECT_EQ(rows, 2);
  EXPECT_EQ(loader.Confirmed, 0);
  EXPECT_THAT(said, HasSubstr("holds no whole program"));
}

TEST_F(DeviceSessionTest, EndsAWaitAtASecondStop) {
  loader.OnPacket = [&](const Bytes& packet) {
    if (packet[0] == 2) {
      Events.At(milliseconds(10), [this] { stops = 2; });
      return false;
    }
    return true;
  };
  EXPECT_LT(Run({"write", "/home/new.hex"}), 0);
  EXPECT_LT(Events.Now(), milliseconds(200));
}

TEST_F(DeviceSessionTest, EndsAtTheFirstStopAsLongAsNothingWasChanged) {
  for (const std::vector<std::string>& command :
       {std::vector<std::string>{"identify"}, {"erase"}, {"write", "/home/new.hex"}}) {
    stops = 0;
    loader.OnPacket = [&](const Bytes&) {
      Events.At(milliseconds(10), [this] { stops = 1; });
      return false;
    };
    const auto start = Events.Now();
    EXPECT_EQ(Run(command), -100) << command[0];
    EXPECT_LT(Events.Now() - start, milliseconds(200)) << command[0];
    EXPECT_EQ(said, command[0] == "identify" ? "" : "tessarine-pic24f: the device is as it was\n");
  }
}

TEST_F(DeviceSessionTest, EndsAComparisonAtTheFirstStop) {
  loader.OnPacket = [&](const Bytes& packet) {
    if (packet[1] == 64) {
      Events.At(milliseconds(10), [this] { stops = 1; });
      return false;
    }
    return true;
  };
  EXPECT_EQ(Run({"verify", "/home/new.hex"}), -100);
  EXPECT_LT(Events.Now(), milliseconds(200));
  EXPECT_THAT(said, HasSubstr("is as it was"));
}

TEST_F(DeviceSessionTest, SaysWhatALostLineLeaves) {
  loader.OnPacket = [&](const Bytes& packet) {
    if (packet[0] == 2) {
      port.Lose();
    }
    return true;
  };
  EXPECT_EQ(Run({"write", "/home/new.hex"}), -999);
  EXPECT_THAT(said, HasSubstr("holds no whole program"));
  EXPECT_FALSE(port.PortOpen());
}

TEST_F(DeviceSessionTest, SaysWhatALostLineLeavesOfAnErase) {
  loader.OnPacket = [&](const Bytes& packet) {
    if (packet[0] == 3) {
      port.Lose();
    }
    return true;
  };
  EXPECT_EQ(Run({"erase"}), -999);
  EXPECT_THAT(said, HasSubstr("may be erased in part"));
}

TEST_F(DeviceSessionTest, TellsAProgramThatWasNotConfirmed) {
  loader.OnPacket = [](const Bytes& packet) { return packet[0] != 8; };
  EXPECT_LT(Run({"write", "/home/new.hex"}), 0);
  EXPECT_THAT(said, HasSubstr("did not confirm"));
}

TEST_F(DeviceSessionTest, GoesOnThroughSilenceNoiseAndDoubleAnswers) {
  int packets = 0;
  port.OnOutput = [this](std::uint8_t byte) {
    const Bytes answer = loader.Take(byte);
    if (!answer.empty()) {
      Events.At(milliseconds(1), [this] { port.Receive({0xFF, 0x55, 0x00}); });
      Events.At(milliseconds(2), [this, answer] { port.Receive(answer); });
      Events.At(milliseconds(3), [this, answer] { port.Receive(answer); });
    }
  };
  loader.OnPacket = [&](const Bytes&) { return ++packets % 5 != 0; };
  EXPECT_EQ(Run({"write", "/home/new.hex"}), 1);
  EXPECT_EQ(loader.Confirmed, 1);
}

}  // namespace
