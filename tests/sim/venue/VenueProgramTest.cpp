#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <signal.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <thread>

#include "sim/baseunit/BaseUnitAnswer.h"
#include "sim/game/GameMaker.h"
#include "sim/radio/RadioAnswer.h"
#include "tests/support/AdapterHost.h"
#include "tests/support/BootHost.h"
#include "tests/support/BoxHost.h"
#include "tests/support/RadioLiterals.h"
#include "tests/support/RawHost.h"
#include "tests/support/VenueProcess.h"

namespace sim {
namespace {

namespace fs = std::filesystem;
using testing::HasSubstr;

class VenueProgram : public testing::Test {
 protected:
  VenueProgram() {
    std::string pattern = (fs::temp_directory_path() / "tessarine-venue-XXXXXX").string();
    folder_ = ::mkdtemp(pattern.data());
  }
  ~VenueProgram() override { fs::remove_all(folder_); }

  std::string File(const std::string& name) const { return (folder_ / name).string(); }

  static std::string Content(const std::string& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
  }

  // False when `text` does not come into the file within the limit.
  static bool AwaitContent(const std::string& path, const std::string& text) {
    const auto end = std::chrono::steady_clock::now() + Limit;
    while (Content(path).find(text) == std::string::npos) {
      if (std::chrono::steady_clock::now() > end) {
        return false;
      }
      std::this_thread::sleep_for(std::chrono::milliseconds(1));
    }
    return true;
  }

  // Every frame must be as `answer` has it.
  static void Download(const std::string& device, const BaseUnitAnswer& answer) {
    RawHost host(device);
    host.Write({1, 0});
    EXPECT_EQ(host.Read(1), Bytes{answer.Count});
    for (const Bytes& frame : answer.Frames) {
      EXPECT_EQ(host.Read(frame.size()), frame);
      host.Write({170});
    }
  }

  fs::path folder_;
};

TEST_F(VenueProgram, ServesTheGameOfItsSeedAndExitsAfterItsGames) {
  const BaseUnitAnswer answer = MakeBaseUnitAnswer(MakeGame(12, 77));
  VenueProcess venue({"--players", "12", "--seed", "77", "--fast", "--games", "2"});
  const std::string device = venue.ReadDevice();
  Download(device, answer);
  Download(device, answer);
  EXPECT_EQ(venue.WaitForExit(), 0);
  EXPECT_EQ(venue.RestOfErrors(), "");
}

TEST_F(VenueProgram, ServesFortyPlayersAtTheSpeedOfTheLineUnlessTold) {
  VenueProcess venue({});
  RawHost host(venue.ReadDevice());
  const auto start = std::chrono::steady_clock::now();
  host.Write({1, 0});
  EXPECT_EQ(host.Read(1), Bytes{40});
  const Bytes frame = MakeBaseUnitAnswer(MakeGame(40, 1)).Frames[0];
  EXPECT_EQ(host.Read(frame.size()), frame);
  const double bytes = static_cast<double>(3 + frame.size());
  EXPECT_GE(std::chrono::steady_clock::now() - start, std::chrono::duration<double>(bytes * 10.0 / 19200.0));
}

TEST_F(VenueProgram, CopiesFramesAndLogsTheLine) {
  const BaseUnitAnswer answer = MakeBaseUnitAnswer(MakeGame(3, 1), BaseUnitFailure::WrongCrc, 2);
  VenueProcess venue({"--players", "3", "--fast", "--games", "1", "--failure", "wrong-crc", "--at", "2",
                      "--frames", File("frames"), "--log", File("log")});
  Download(venue.ReadDevice(), answer);
  EXPECT_EQ(venue.WaitForExit(), 0);
  std::string expected;
  for (const Bytes& frame : answer.Frames) {
    expected.append(frame.begin(), frame.end());
  }
  EXPECT_EQ(Content(File("frames")), expected);
  EXPECT_THAT(Content(File("log")), HasSubstr("base-unit <- 01\n"));
  EXPECT_THAT(Content(File("log")), HasSubstr("base-unit -> 03\n"));
  EXPECT_THAT(Content(File("log")), HasSubstr("base-unit <- AA accepted\n"));
}

TEST_F(VenueProgram, LinksTheDeviceUntilItsEnd) {
  VenueProcess venue({"--fast", "--players", "0", "--link", File("port")});
  const std::string device = venue.ReadDevice();
  EXPECT_EQ(fs::read_symlink(File("port")), device);
  Download(File("port"), MakeBaseUnitAnswer({}));
  venue.Signal(SIGTERM);
  EXPECT_EQ(venue.WaitForExit(), 0);
  EXPECT_FALSE(fs::is_symlink(fs::symlink_status(File("port"))));
}

TEST_F(VenueProgram, ExitsCleanlyOnSignalsEvenInTheMiddleOfAnAnswer) {
  for (const int signal : {SIGTERM, SIGINT, SIGHUP}) {
    VenueProcess venue({"--players", "224"});
    RawHost host(venue.ReadDevice());
    host.Write({1, 0});
    EXPECT_EQ(host.Read(2).size(), 2U);
    venue.Signal(signal);
    EXPECT_EQ(venue.WaitForExit(), 0) << "signal " << signal;
  }
}

TEST_F(VenueProgram, ExitsAtTheEndOfItsInputWhenTold) {
  VenueProcess venue({"--fast", "--until-eof"});
  venue.ReadDevice();
  EXPECT_TRUE(venue.IsRunning());
  venue.CloseInput();
  EXPECT_EQ(venue.WaitForExit(), 0);
}

TEST_F(VenueProgram, DoesNotCareForItsInputUnlessTold) {
  VenueProcess venue({"--fast", "--players", "2"});
  venue.CloseInput();
  Download(venue.ReadDevice(), MakeBaseUnitAnswer(MakeGame(2, 1)));
  EXPECT_TRUE(venue.IsRunning());
}

TEST_F(VenueProgram, ExitsWhenItsLineHasBeenPulledOut) {
  VenueProcess venue({"--fast", "--failure", "hang-up", "--at", "1", "--link", File("port")});
  RawHost host(venue.ReadDevice());
  host.Write({1, 0});
  host.ReadUntilHangUp();
  EXPECT_TRUE(host.HungUp());
  EXPECT_EQ(venue.WaitForExit(), 0);
  EXPECT_FALSE(fs::is_symlink(fs::symlink_status(File("port"))));
}

TEST_F(VenueProgram, DoesNotAnswerAHostAtOtherSettingsAndTellsSo) {
  const BaseUnitAnswer answer = MakeBaseUnitAnswer(MakeGame(2, 1));
  for (const std::vector<std::string>& pace : {std::vector<std::string>{}, {"--fast"}}) {
    std::vector<std::string> arguments{"--players", "2", "--log", File("log")};
    arguments.insert(arguments.end(), pace.begin(), pace.end());
    VenueProcess venue(arguments);
    const std::string device = venue.ReadDevice();
    RawHost host(device);
    host.Speak({.Baud = 9600, .DataBits = 7, .Parity = 'E', .StopBits = 2});
    const std::string heard = Text(host.Settings());
    host.Write({1, 0});
    EXPECT_TRUE(AwaitContent(File("log"), "fault: the host speaks " + heard));
    EXPECT_TRUE(host.IsSilent());
    host.Speak({.Baud = 19200});
    Download(device, answer);
    venue.Signal(SIGTERM);
    EXPECT_EQ(venue.WaitForExit(), 0);
    EXPECT_EQ(venue.RestOfErrors(), "base unit: the host speaks " + heard +
                                        " instead of 19200,8N1\nbase unit: faults of the host: 1\n");
  }
}

TEST_F(VenueProgram, ServesOthersWithoutTheBaseUnitWhenTold) {
  VenueProcess venue({"--fast", "--no-base-unit", "--onewire"});
  AdapterHost host(venue.ReadDevice("1-wire adapter"));
  EXPECT_EQ(host.Ask({0x17}, 1), Bytes{0x16});
  venue.Signal(SIGTERM);
  EXPECT_EQ(venue.WaitForExit(), 0);
  EXPECT_EQ(venue.RestOfOutput(), "");
}

const Bytes ReadRom{0xC1, 0xE1, 0x33, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xE3};

TEST_F(VenueProgram, HoldsButtonsToTheReaderAndTakesThemAwayOnCommand) {
  VenueProcess venue({"--fast", "--onewire", "--onewire-failure", "no-own-device"});
  venue.ReadDevice();
  AdapterHost host(venue.ReadDevice("1-wire adapter"));
  EXPECT_EQ(host.Ask({0xC1}, 1), Bytes{0xCF});
  venue.WriteInput("touch EFCDAB8967452301\n");
  EXPECT_EQ(venue.ReadLine(), "touched EFCDAB8967452301");
  EXPECT_EQ(host.Ask(ReadRom, 10), (Bytes{0xCD, 0x33, 0x01, 0x23, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0xEF}));
  venue.WriteInput("onewire leave EFCDAB8967452301\n");
  EXPECT_EQ(venue.ReadLine(), "left EFCDAB8967452301");
  venue.WriteInput("nonsense\n\nleave\n");
  EXPECT_EQ(venue.ReadLine(), "left");
  EXPECT_EQ(host.Ask({0xC1}, 1), Bytes{0xCF});
  venue.Signal(SIGTERM);
  EXPECT_EQ(venue.WaitForExit(), 0);
  EXPECT_EQ(venue.RestOfErrors(), "tessarine-venue: There is no command \"nonsense\"\n");
}

TEST_F(VenueProgram, KeepsItsButtonsWhenItsInputEnds) {
  VenueProcess venue({"--fast", "--onewire", "--players", "2"});
  const std::string baseUnit = venue.ReadDevice();
  AdapterHost host(venue.ReadDevice("1-wire adapter"));
  venue.WriteInput("touch A200000001B81C02");
  venue.CloseInput();
  EXPECT_EQ(venue.ReadLine(), "touched A200000001B81C02");
  EXPECT_EQ(host.Search(Bytes(16, 0x00)).at(2), 0x09);
  Download(baseUnit, MakeBaseUnitAnswer(MakeGame(2, 1)));
  EXPECT_TRUE(venue.IsRunning());
}

TEST_F(VenueProgram, EndsWithItsInputWhenToldAlsoWithButtons) {
  VenueProcess venue({"--fast", "--onewire", "--until-eof"});
  venue.ReadDevice();
  venue.ReadDevice("1-wire adapter");
  venue.WriteInput("touch A200000001B81C02\n");
  EXPECT_EQ(venue.ReadLine(), "touched A200000001B81C02");
  EXPECT_TRUE(venue.IsRunning());
  venue.CloseInput();
  EXPECT_EQ(venue.WaitForExit(), 0);
}

TEST_F(VenueProgram, LinksTheReaderAndLogsItBesideTheBaseUnit) {
  VenueProcess venue(
      {"--fast", "--players", "0", "--onewire", "--onewire-link", File("reader"), "--log", File("log")});
  const std::string baseUnit = venue.ReadDevice();
  EXPECT_EQ(fs::read_symlink(File("reader")), venue.ReadDevice("1-wire adapter"));
  AdapterHost host(File("reader"));
  EXPECT_EQ(host.Ask({0x17}, 1), Bytes{0x16});
  Download(baseUnit, MakeBaseUnitAnswer({}));
  venue.Signal(SIGTERM);
  EXPECT_EQ(venue.WaitForExit(), 0);
  EXPECT_FALSE(fs::is_symlink(fs::symlink_status(File("reader"))));
  EXPECT_THAT(Content(File("log")), HasSubstr("1-wire -> 16\n"));
  EXPECT_THAT(Content(File("log")), HasSubstr("base-unit -> 00\n"));
}

TEST_F(VenueProgram, ServesTheBaseUnitOnWhenTheReaderHasBeenPulledOut) {
  VenueProcess venue({"--fast", "--players", "2", "--onewire", "--onewire-failure", "hang-up"});
  const std::string baseUnit = venue.ReadDevice();
  AdapterHost host(venue.ReadDevice("1-wire adapter"));
  host.Write({0x17});
  host.ReadUntilHangUp();
  EXPECT_TRUE(host.HungUp());
  Download(baseUnit, MakeBaseUnitAnswer(MakeGame(2, 1)));
  EXPECT_TRUE(venue.IsRunning());
}

class VenueByRadio : public VenueProgram {
 protected:
  static RadioGun FirstGun(int players) { return MakeRadioGuns(MakeGame(players, 1)).at(0); }

  // The first gun of the game of `players` is searched and answers.
  static void ExpectFound(RawHost& host, int players) {
    const RadioGun gun = FirstGun(players);
    host.Write(wire::MadeGood(wire::With(wire::SearchRed2, 15, gun.PlayerId)));
    const Bytes answer = EncodeReceivedFrame(
        gun.Address, AnswerPacket(gun, {.Command = GunCommand::Search, .PlayerId = gun.PlayerId}));
    EXPECT_EQ(host.Read(answer.size()), answer);
  }
};

TEST_F(VenueByRadio, ServesTheGunsOfItsGameBesideTheBaseUnit) {
  VenueProcess venue({"--radio", "--players", "12", "--radio-link", File("port"), "--log", File("log")});
  const std::string baseUnit = venue.ReadDevice();
  const std::string modem = venue.ReadDevice("radio modem");
  EXPECT_EQ(fs::read_symlink(File("port")), modem);
  {
    RawHost host(modem);
    ExpectFound(host, 12);
  }
  Download(baseUnit, MakeBaseUnitAnswer(MakeGame(12, 1)));
  venue.Signal(SIGTERM);
  EXPECT_EQ(venue.WaitForExit(), 0);
  EXPECT_EQ(venue.RestOfErrors(), "radio modem: faults of the host: 0\n");
  EXPECT_FALSE(fs::is_symlink(fs::symlink_status(File("port"))));
  EXPECT_THAT(Content(File("log")), HasSubstr("radio-modem -> 7E 00 14 80"));
}

TEST_F(VenueByRadio, TellsTheFaultsOfTheHost) {
  VenueProcess venue({"--radio", "--players", "3", "--fast"});
  venue.ReadDevice();
  RawHost host(venue.ReadDevice("radio modem"));
  host.Write(wire::With(wire::SearchRed2, 19, 0));
  ExpectFound(host, 3);
  venue.Signal(SIGINT);
  EXPECT_EQ(venue.WaitForExit(), 0);
  EXPECT_EQ(venue.RestOfErrors(),
            "radio modem: the host sent a wrong checksum\nradio modem: faults of the host: 1\n");
}

TEST_F(VenueByRadio, CopiesTheFramesOfGunsThatWereClosed) {
  VenueProcess venue({"--radio", "--players", "3", "--fast", "--radio-frames", File("frames")});
  venue.ReadDevice();
  RawHost host(venue.ReadDevice("radio modem"));
  const RadioGun gun = FirstGun(3);
  Bytes close = wire::CloseRed2;
  close[11] = static_cast<std::uint8_t>(gun.Address >> 8 & 0xFF);
  close[12] = gun.PlayerId;
  close[15] = gun.PlayerId;
  host.Write(wire::MadeGood(close));
  EXPECT_EQ(host.Read(21).size(), 21U);
  venue.Signal(SIGTERM);
  EXPECT_EQ(venue.WaitForExit(), 0);
  EXPECT_EQ(Content(File("frames")), std::string(gun.Frame.begin(), gun.Frame.end()));
}

TEST_F(VenueByRadio, GoesOnWithItsOtherDevicesWhenTheModemHasBeenPulledOut) {
  VenueProcess venue({"--radio", "--players", "3", "--fast", "--radio-failure", "hang-up-in-search"});
  const std::string baseUnit = venue.ReadDevice();
  RawHost host(venue.ReadDevice("radio modem"));
  host.Write(wire::MadeGood(wire::With(wire::SearchRed2, 15, FirstGun(3).PlayerId)));
  host.ReadUntilHangUp();
  EXPECT_TRUE(host.HungUp());
  Download(baseUnit, MakeBaseUnitAnswer(MakeGame(3, 1)));
  EXPECT_TRUE(venue.IsRunning());
}

TEST_F(VenueProgram, ServesAUtilityBoxThatTellsWhatItWasTold) {
  VenueProcess venue({"--no-base-unit", "--box", "--box-link", File("port"), "--log", File("log")});
  BoxHost host(venue.ReadDevice("utility box"));
  venue.WriteInput("told\n");
  EXPECT_EQ(venue.ReadLine(), "told nothing");
  host.Send({0x42, 0x43, 0x38, 0x14, 0x05, 0x64, 0x02, 0x01, 0x00, 0x00});
  EXPECT_EQ(host.Read(1), Bytes{0xAA});
  const std::string told =
      "told Dom. (iBtn), yellow, 20 points per activation, 5 to recharge, 100 to give, automatic after 20 s, "
      "destroyable";
  venue.WriteInput("box told\n");
  EXPECT_EQ(venue.ReadLine(), told);
  venue.Signal(SIGTERM);
  EXPECT_EQ(venue.WaitForExit(), 0);
  EXPECT_EQ(venue.RestOfErrors(), "");
  EXPECT_THAT(Content(File("log")), HasSubstr("box -> AA\n"));
}

TEST_F(VenueProgram, ServesBootCodeThatKeepsItsFlashFromRunToRun) {
  const std::vector<std::string> arguments{"--no-base-unit", "--fast", "--bootcode", "--bootcode-flash",
                                           File("flash")};
  {
    VenueProcess venue(arguments);
    BootHost host(venue.ReadDevice("boot code"));
    venue.WriteInput("power\n");
    EXPECT_EQ(venue.ReadLine(), "switched on");
    EXPECT_EQ(host.Hear(4), "BOOT");
    EXPECT_EQ(host.Begin(), "xds");
    EXPECT_EQ(host.Ask(wire::WriteCountingRow1), "f");
    venue.Signal(SIGTERM);
    EXPECT_EQ(venue.WaitForExit(), 0);
    EXPECT_EQ(venue.RestOfErrors(), "");
  }
  const std::string before = Content(File("flash"));
  EXPECT_EQ(before.size(), 786432U);
  EXPECT_EQ(before.substr(192, 3), std::string("\0\1\2", 3));
  VenueProcess venue(arguments);
  BootHost host(venue.ReadDevice("boot code"));
  venue.WriteInput("bootcode power bad-address 1\n");
  EXPECT_EQ(venue.ReadLine(), "switched on");
  EXPECT_EQ(host.Hear(4), "BOOT");
  EXPECT_EQ(host.Begin(), "xds");
  EXPECT_EQ(host.Ask(wire::ErasePage0), "e");
  EXPECT_EQ(Content(File("flash")), before);
}

TEST_F(VenueProgram, SwitchesADeviceOnByItselfOnceItsLineIsOpenedWhenTold) {
  VenueProcess venue(
      {"--no-base-unit", "--fast", "--bootcode", "--bootcode-product", "qvm", "--bootcode-power-on", "1"});
  BootHost host(venue.ReadDevice("boot code"));
  EXPECT_EQ(host.Hear(4), "BOOT");
  EXPECT_EQ(host.Begin(), "xpb");
}

TEST_F(VenueProgram, SaysWhenItCannotUseAFlashFile) {
  std::ofstream(File("flash")) << "short";
  VenueProcess venue({"--no-base-unit", "--bootcode", "--bootcode-flash", File("flash")});
  EXPECT_EQ(venue.WaitForExit(), 1);
  EXPECT_THAT(venue.RestOfErrors(), HasSubstr("flash is no program memory of 786432 bytes"));
  EXPECT_EQ(Content(File("flash")), "short");
}

TEST_F(VenueProgram, ChargesAButtonOnCommand) {
  VenueProcess venue({"--no-base-unit", "--fast", "--onewire", "--onewire-failure", "no-own-device"});
  AdapterHost host(venue.ReadDevice("1-wire adapter"));
  venue.WriteInput("fill 5600000001B81C06 zeros\ntouch 5600000001B81C06\n");
  EXPECT_EQ(venue.ReadLine(), "filled 5600000001B81C06");
  EXPECT_EQ(venue.ReadLine(), "touched 5600000001B81C06");
  EXPECT_EQ(host.Ask({0xC1, 0xE1, 0xCC, 0x0F, 0x21, 0x00, 0x01, 0xE3}, 6),
            (Bytes{0xCD, 0xCC, 0x0F, 0x21, 0x00, 0x01}));
  EXPECT_EQ(host.Ask({0xC1, 0xE1, 0xCC, 0x55, 0x21, 0x00, 0x01, 0xE3}, 6),
            (Bytes{0xCD, 0xCC, 0x55, 0x21, 0x00, 0x01}));
  venue.WriteInput("show 5600000001B81C06\n");
  EXPECT_THAT(venue.ReadLine(), testing::StartsWith("5600000001B81C06 00 01 00 00 "));
}

TEST_F(VenueProgram, RefusesBadOptionsWithAMessage) {
  const std::vector<std::vector<std::string>> refused{
      {"--players", "225"},
      {"--failure", "fire"},
      {"--nonsense"},
      {"--failure", "wrong-crc", "--at", "41"},
      {"--failure", "wrong-crc", "--at", "0"},
      {"--onewire", "--onewire-failure", "contact-lost", "--onewire-at", "65"},
      {"--failure", "hang-up", "--players", "0"},
      {"--failure", "silence", "--players", "0", "--at", "2"},
      {"--radio", "--radio-failure", "silent-gun", "--radio-at", "41"},
      {"--box", "--box-failure", "unplugged", "--box-at", "0"},
      {"--bootcode", "--bootcode-failure", "silence", "--bootcode-at", "0"},
      {"--no-base-unit"}};
  for (const std::vector<std::string>& arguments : refused) {
    VenueProcess venue(arguments);
    EXPECT_EQ(venue.WaitForExit(), 2) << testing::PrintToString(arguments);
    EXPECT_EQ(venue.RestOfOutput(), "");
    EXPECT_THAT(venue.RestOfErrors(), testing::StartsWith("tessarine-venue: "));
  }
}

TEST_F(VenueProgram, SaysWhenItCannotWriteAFile) {
  VenueProcess venue({"--log", File("missing/log")});
  EXPECT_EQ(venue.WaitForExit(), 1);
  EXPECT_THAT(venue.RestOfErrors(), HasSubstr("missing/log"));
}

TEST_F(VenueProgram, ExplainsItself) {
  VenueProcess venue({"--help"});
  EXPECT_EQ(venue.WaitForExit(), 0);
  EXPECT_THAT(venue.RestOfOutput(), HasSubstr("--failure NAME"));
}

}  // namespace
}  // namespace sim
