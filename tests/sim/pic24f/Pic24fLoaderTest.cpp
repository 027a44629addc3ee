#include "sim/pic24f/Pic24fLoader.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sstream>

#include "sim/pic24f/Pic24fCommands.h"
#include "tests/sim/pic24f/LoaderHost.h"
#include "tests/support/TemporaryFolder.h"

namespace sim {
namespace {

using std::chrono::milliseconds;
using testing::HasSubstr;
using testing::IsEmpty;

Pic24fLoaderSettings Quick() {
  return {.LinePace = Pace::Fast};
}

Pic24fLoaderSettings QuickSmall() {
  return {.Device = Pic24fDevices[2], .LinePace = Pace::Fast};
}

TEST(Pic24fLoader, TellsVersionIdentityAndResetVector) {
  Pic24fLoader loader(Quick());
  LoaderHost host(loader.DevicePath());
  EXPECT_EQ(host.Ask(AskVersion, Version.size()), Version);
  EXPECT_EQ(host.Ask(AskIdentity, Identity1001.size()), Identity1001);
  EXPECT_EQ(host.Ask(AskResetVector, ResetVector.size()), ResetVector);
  EXPECT_TRUE(host.IsSilent());
  EXPECT_THAT(loader.HostFaults(), IsEmpty());
}

TEST(Pic24fLoader, ErasesWritesAndReadsBack) {
  Pic24fLoader loader(Quick());
  LoaderHost host(loader.DevicePath());
  EXPECT_EQ(host.Ask(ErasePage1, Erased.size()), Erased);
  EXPECT_EQ(host.Ask(WriteRow1, Written.size()), Written);
  EXPECT_EQ(host.Ask(ReadRow1, Row1.size()), Row1);
  EXPECT_FALSE(loader.Traffic().IsVerified);
  EXPECT_EQ(host.Ask(SayVerified, SayVerified.size()), SayVerified);
  EXPECT_TRUE(loader.Traffic().IsVerified);
  EXPECT_EQ(host.Ask(WriteRow1, Written.size()), Written);
  EXPECT_FALSE(loader.Traffic().IsVerified);
  EXPECT_EQ(loader.Traffic().Requests.size(), 5U);
}

TEST(Pic24fLoader, WritesEepromAsWordsAndShowsItAtItsByteAddress) {
  Pic24fLoader loader(QuickSmall());
  LoaderHost host(loader.DevicePath());
  EXPECT_EQ(host.Ask({0x55, 0x55, 0x05, 0x05, 0x08, 0x00, 0xFE, 0xFF, 0x01, 0x02, 0x03, 0x05, 0x04, 0x05,
                      0x05, 0x06, 0x07, 0x08, 0x09, 0x0A, 0x0B, 0x0C, 0x0D, 0x0E, 0x0F, 0x10, 0x6E, 0x04},
                     6),
            (Bytes{0x55, 0x55, 0x05, 0x05, 0xFB, 0x04}));
  EXPECT_EQ(host.Ask({0x55, 0x55, 0x01, 0x05, 0x04, 0x00, 0xFE, 0xFF, 0xFE, 0x04}, 28),
            (Bytes{0x55, 0x55, 0x01, 0x05, 0x04, 0x00, 0xFE, 0xFF, 0x01, 0x02, 0x03, 0x05, 0x04, 0x05,
                   0x05, 0x06, 0x07, 0x08, 0x09, 0x0A, 0x0B, 0x0C, 0x0D, 0x0E, 0x0F, 0x10, 0x76, 0x04}));
  // The first word by its own command.
  EXPECT_EQ(host.Ask({0x55, 0x55, 0x05, 0x04, 0x01, 0x00, 0xFE, 0xFF, 0xFE, 0x04}, 12),
            (Bytes{0x55, 0x55, 0x05, 0x04, 0x01, 0x00, 0xFE, 0xFF, 0x01, 0x02, 0xFB, 0x04}));
}

TEST(Pic24fLoader, WritesAndReadsConfigurationWords) {
  Pic24fLoader loader(Quick());
  LoaderHost host(loader.DevicePath());
  EXPECT_EQ(host.Ask({0x55, 0x55, 0x07, 0x01, 0x00, 0x00, 0xF8, 0x34, 0x12, 0xBA, 0x04}, 5),
            (Bytes{0x55, 0x55, 0x07, 0xF9, 0x04}));
  EXPECT_EQ(host.Ask({0x55, 0x55, 0x06, 0x01, 0x00, 0x00, 0xF8, 0x01, 0x04}, 11),
            (Bytes{0x55, 0x55, 0x06, 0x01, 0x00, 0x00, 0xF8, 0x34, 0x12, 0xBB, 0x04}));
}

TEST(Pic24fLoader, DoesNotAnswerAWrongChecksum) {
  Pic24fLoader loader(Quick());
  LoaderHost host(loader.DevicePath());
  host.Write({0x55, 0x55, 0x00, 0x02, 0xFD, 0x04});
  ASSERT_TRUE(loader.WaitUntilHostFaults(1, Limit));
  EXPECT_TRUE(host.IsSilent());
  EXPECT_EQ(loader.HostFaults(), std::vector<std::string>{"the host sent a wrong checksum"});
  EXPECT_EQ(host.Ask(AskVersion, Version.size()), Version);
}

TEST(Pic24fLoader, ForgetsAPacketThatIsCutShort) {
  Pic24fLoaderSettings settings = Quick();
  settings.Patience = milliseconds(100);
  Pic24fLoader loader(settings);
  LoaderHost host(loader.DevicePath());
  // The escape would take the next packet's first start for data.
  host.Write({0x55, 0x55, 0x01, 0x05});
  ASSERT_TRUE(loader.WaitUntilHostFaults(1, Limit));
  EXPECT_EQ(loader.HostFaults(), std::vector<std::string>{"the host sent a packet cut short"});
  EXPECT_EQ(host.Ask(AskVersion, Version.size()), Version);
}

TEST(Pic24fLoader, DoesNotAnswerWhatTheDeviceCannotDo) {
  Pic24fLoader loader(Quick());
  LoaderHost host(loader.DevicePath());
  host.Write({0x55, 0x55, 0x09, 0xF7, 0x04});                                // unknown
  host.Write({0x55, 0x55, 0x01, 0x01, 0x00, 0x00, 0x02, 0xFC, 0x04});        // beyond the program memory
  host.Write({0x55, 0x55, 0x03, 0x01, 0x80, 0x00, 0x00, 0x7C, 0x04});        // not a page
  host.Write({0x55, 0x55, 0x05, 0x04, 0x01, 0x00, 0xFE, 0xFF, 0xFE, 0x04});  // no EEPROM
  ASSERT_TRUE(loader.WaitUntilHostFaults(4, Limit));
  EXPECT_TRUE(host.IsSilent());
  EXPECT_EQ(loader.HostFaults(),
            (std::vector<std::string>{
                "the host sent an unknown command",
                "the host asked for what the device does not have: read 1 at 020000",
                "the host asked for what the device does not have: erase 1 at 000080",
                "the host asked for what the device does not have: read EEPROM 1 at FFFE00"}));
}

TEST(Pic24fLoader, UnderstandsEachOfTheUsualSpeeds) {
  Pic24fLoader loader(Quick());
  for (const int baud : {1200, 2400, 4800, 9600, 19200, 38400, 57600, 115200}) {
    LoaderHost host(loader.DevicePath());
    host.Speak({.Baud = baud});
    EXPECT_EQ(host.Ask(AskVersion, Version.size()), Version) << baud;
  }
}

TEST(Pic24fLoader, KeepsToTheSpeedOfTheLineAndItsOwnTimes) {
  Pic24fLoader loader({.RowTime = milliseconds(30), .PageTime = milliseconds(40)});
  LoaderHost host(loader.DevicePath());
  auto start = std::chrono::steady_clock::now();
  EXPECT_EQ(host.Ask(WriteRow1, Written.size()), Written);
  const double wireSeconds = static_cast<double>(WriteRow1.size() + Written.size()) * 10 / 115200;
  EXPECT_GE(std::chrono::steady_clock::now() - start,
            milliseconds(30) + std::chrono::duration<double>(wireSeconds));
  start = std::chrono::steady_clock::now();
  EXPECT_EQ(host.Ask(ErasePage1, Erased.size()), Erased);
  EXPECT_GE(std::chrono::steady_clock::now() - start, milliseconds(40));
}

TEST(Pic24fLoader, IsSilentWhileTheApplicationRuns) {
  Pic24fLoader loader(Quick());
  LoaderHost host(loader.DevicePath());
  host.Write(RunApplication);
  ASSERT_TRUE(loader.WaitUntilAsked(1, Limit));
  EXPECT_TRUE(loader.Traffic().Runs);
  host.Write(AskVersion);
  EXPECT_TRUE(host.IsSilent());
  EXPECT_EQ(ObeyPic24fCommand(loader, "reset"), "reset");
  EXPECT_EQ(host.Ask(AskVersion, Version.size()), Version);
  EXPECT_THAT(loader.HostFaults(), IsEmpty());
}

TEST(Pic24fLoader, LogsBothDirections) {
  std::ostringstream log;
  {
    Pic24fLoaderSettings settings = Quick();
    settings.Log = &log;
    Pic24fLoader loader(settings);
    LoaderHost host(loader.DevicePath());
    host.Write({0x41});
    EXPECT_EQ(host.Ask(AskResetVector, ResetVector.size()), ResetVector);
  }
  std::string rows;
  std::istringstream lines(log.str());
  for (std::string line; std::getline(lines, line);) {
    rows += line.substr(line.find("pic24f")) + '\n';
  }
  EXPECT_EQ(rows,
            "pic24f <- 41 fault: a byte outside a packet\n"
            "pic24f <- 55 55 01 02 00 00 00 FD 04 read 2 at 000000\n"
            "pic24f -> 55 55 01 02 00 00 00 00 05 04 05 04 00 00 00 00 00 F5 04\n");
}

TEST(Pic24fLoader, SavesItsProgramMemoryOnCommand) {
  const TemporaryFolder folder;
  Pic24fLoader loader(QuickSmall());
  LoaderHost host(loader.DevicePath());
  EXPECT_EQ(host.Ask(WriteRow1, Written.size()), Written);
  const std::string path = folder / "program memory";
  EXPECT_EQ(ObeyPic24fCommand(loader, "save " + path), "saved 5632 instructions");
  const std::string saved = ReadFile(path);
  ASSERT_EQ(saved.size(), 5632U * 4U);
  EXPECT_EQ(saved.substr(252, 8), std::string("\xFF\xFF\xFF\x00\x01\x02\x03\x00", 8));
  EXPECT_EQ(ObeyPic24fCommand(loader, " "), "");
  for (const char* wrong : {"save", "reset now", "load"}) {
    EXPECT_THROW(ObeyPic24fCommand(loader, wrong), std::invalid_argument) << wrong;
  }
  EXPECT_THROW(ObeyPic24fCommand(loader, "save " + folder.Path()), std::invalid_argument);
}

TEST(Pic24fLoader, TakesAWholeImageAndGivesItBack) {
  Pic24fLoader loader(QuickSmall());
  LoaderHost host(loader.DevicePath());
  const std::size_t rows = 5632 / 64;
  Bytes image;
  for (std::size_t i = 0; i < rows * 64; ++i) {
    image = std::move(image) + Bytes{static_cast<std::uint8_t>(i), static_cast<std::uint8_t>(i / 256),
                                     static_cast<std::uint8_t>(i * 7), 0};
  }
  for (std::size_t row = 0; row < rows; ++row) {
    const std::size_t address = row * 128;
    const auto begin = image.begin() + static_cast<std::ptrdiff_t>(row * 256);
    const Bytes data =
        Bytes{2, 1, static_cast<std::uint8_t>(address), static_cast<std::uint8_t>(address / 256), 0} +
        Bytes(begin, begin + 256);
    ASSERT_EQ(host.Ask(EncodePic24fPacket(data), Written.size()), Written) << row;
  }
  const Bytes program = loader.Traffic().Memory.Program();
  const Bytes loadersJump{0x00, 0x04, 0x04, 0x00, 0x00, 0x00, 0x00, 0x00};
  EXPECT_EQ(program, loadersJump + Bytes(image.begin() + 8, image.end()));
}

TEST(Pic24fLoader, EndsInTheMiddleOfALongErase) {
  Pic24fLoaderSettings settings = Quick();
  settings.PageTime = std::chrono::minutes(10);
  std::optional<Pic24fLoader> loader(std::in_place, settings);
  LoaderHost host(loader->DevicePath());
  host.Write(ErasePage1);
  host.Write(AskVersion);
  loader.reset();
  host.ReadUntilHangUp();
  EXPECT_TRUE(host.HungUp());
}

TEST(Pic24fLoader, WaitsNoLongerThanToldForRequests) {
  const Pic24fLoader loader(Quick());
  EXPECT_FALSE(loader.WaitUntilAsked(1, milliseconds(10)));
}

}  // namespace
}  // namespace sim
