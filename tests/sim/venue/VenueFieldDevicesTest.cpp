#include <gmock/gmock.h>
#include <signal.h>

#include "sim/game/GameMaker.h"
#include "sim/radio/RadioAnswer.h"
#include "tests/sim/venue/VenueProgram.h"
#include "tests/support/AdapterHost.h"
#include "tests/support/BootHost.h"
#include "tests/support/BoxHost.h"
#include "tests/support/RadioLiterals.h"

// The devices of the venue beside its base unit.

namespace sim {
namespace {

namespace fs = std::filesystem;
using testing::HasSubstr;

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

}  // namespace
}  // namespace sim
