#include "sim/bootcode/BootFailure.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "sim/bootcode/BootCode.h"
#include "tests/support/BootHost.h"

namespace sim {
namespace {

using namespace wire;
using std::chrono::milliseconds;

constexpr milliseconds LateReply{200};
// The reply to "B", or the second packet.
constexpr std::size_t Place = 4;
constexpr std::size_t FaultyPacket = 2;

// Plays the host's part in a download of three packets.
class FailureOfTheBootCode : public testing::TestWithParam<BootFailureInfo> {
 protected:
  FailureOfTheBootCode()
      : device_({.Trouble = {.Failure = GetParam().Failure,
                             .Place = GetParam().Place == FailurePlace::Frame ? FaultyPacket : Place},
                 .Runs = 1,
                 .Times = 2,
                 .Late = LateReply,
                 .LinePace = Pace::Fast}),
        host_(device_.DevicePath()) {
    device_.PowerOn();
  }

  void ExpectWholeDownload() {
    EXPECT_EQ(host_.Begin(), "xds");
    ExpectPackets();
  }

  void ExpectPackets() {
    EXPECT_EQ(host_.Ask(ErasePage0), "b");
    EXPECT_EQ(host_.Ask(WriteBlankRow0), "f");
    EXPECT_EQ(host_.Ask(WriteCountingRow1), "f");
    EXPECT_EQ(host_.Say("F"), "f");
    EXPECT_TRUE(host_.IsSilent());
  }

  void SendB() {
    EXPECT_EQ(host_.Say("XP"), "xd");
    host_.Write({'B'});
  }

  // A line that is pulled out takes bytes with it that the host had not read yet.
  void ExpectHangUp() {
    host_.ReadUntilHangUp();
    EXPECT_TRUE(host_.HungUp());
  }

  BootCode device_;
  BootHost host_;
};

TEST_P(FailureOfTheBootCode, ReachesTheHostAsItsNameSays) {
  const BootFailure failure = GetParam().Failure;
  const std::string announced = failure == BootFailure::NoiseBeforeBoot ? std::string("\0\xF8\x80\nBOOT", 8)
                                : failure == BootFailure::StrayLetter   ? "BBOOT"
                                : failure == BootFailure::BootTwice     ? "BOOTBOOT"
                                                                        : "BOOT";
  EXPECT_EQ(host_.Hear(announced.size()), announced);
  switch (failure) {
    case BootFailure::None:
    case BootFailure::NoiseBeforeBoot:
    case BootFailure::StrayLetter:
    case BootFailure::BootTwice:
    case BootFailure::BootTorn:
      ExpectWholeDownload();
      break;
    case BootFailure::WrongProduct:
      EXPECT_EQ(host_.Say("XP"), "xp");
      break;
    case BootFailure::AsksAgain:
      EXPECT_EQ(host_.Begin(), "xds");
      EXPECT_EQ(host_.Ask(ErasePage0), "b");
      EXPECT_EQ(host_.AskAll({WriteCountingRow1, WriteCountingRow1}), "cc");
      ExpectPackets();
      EXPECT_TRUE(device_.HostFaults().empty());
      break;
    case BootFailure::BadAddress:
      EXPECT_EQ(host_.Begin(), "xds");
      EXPECT_EQ(host_.AskAll({ErasePage0, WriteBlankRow0, WriteCountingRow1}), "bef");
      EXPECT_TRUE(device_.HostFaults().empty());
      break;
    case BootFailure::UnpluggedInPacket:
      EXPECT_EQ(host_.Begin(), "xds");
      EXPECT_EQ(host_.Ask(ErasePage0), "b");
      host_.Write({0x5A});
      ExpectHangUp();
      return;
    case BootFailure::Silence:
      SendB();
      EXPECT_TRUE(host_.IsSilent());
      host_.Write(ErasePage0);
      EXPECT_TRUE(host_.IsSilent());
      break;
    case BootFailure::Unplugged:
      SendB();
      ExpectHangUp();
      return;
    case BootFailure::OtherReply:
      SendB();
      EXPECT_EQ(host_.Hear(1), "?");
      ExpectPackets();
      break;
    case BootFailure::NoiseBeforeReply:
      SendB();
      EXPECT_EQ(host_.Hear(2), "\xF8s");
      ExpectPackets();
      break;
    case BootFailure::DoubleReply:
      SendB();
      EXPECT_EQ(host_.Hear(2), "ss");
      ExpectPackets();
      break;
    case BootFailure::LateReply: {
      const auto start = std::chrono::steady_clock::now();
      SendB();
      EXPECT_EQ(host_.Hear(1), "s");
      EXPECT_GE(std::chrono::steady_clock::now() - start, LateReply);
      ExpectPackets();
      break;
    }
  }
  // The next time the device is faultless.
  device_.PowerOn();
  EXPECT_EQ(host_.Hear(4), "BOOT");
  ExpectWholeDownload();
}

INSTANTIATE_TEST_SUITE_P(Every, FailureOfTheBootCode, testing::ValuesIn(BootFailures),
                         [](const testing::TestParamInfo<BootFailureInfo>& failure) {
                           std::string name(failure.param.Name);
                           std::replace(name.begin(), name.end(), '-', '_');
                           return name;
                         });

// The failures that strike a reply, at the very first.
class FailureOfBoot : public testing::TestWithParam<BootFailure> {
 protected:
  std::string Heard(std::size_t count) {
    device_.PowerOn(BootTrouble{.Failure = GetParam(), .Place = 1});
    return host_.Hear(count);
  }

  BootCode device_{{.Late = LateReply, .LinePace = Pace::Fast}};
  BootHost host_{device_.DevicePath()};
};

TEST_P(FailureOfBoot, ReachesTheHostAsItsNameSays) {
  switch (GetParam()) {
    case BootFailure::Silence:
      EXPECT_EQ(Heard(0), "");
      EXPECT_TRUE(host_.IsSilent());
      host_.Write({'X'});
      EXPECT_TRUE(host_.IsSilent());
      break;
    case BootFailure::Unplugged: {
      device_.PowerOn(BootTrouble{.Failure = GetParam()});
      const Bytes heard = host_.ReadUntilHangUp();
      EXPECT_TRUE(host_.HungUp());
      EXPECT_LE(heard.size(), 2U);
      break;
    }
    case BootFailure::OtherReply:
      EXPECT_EQ(Heard(1), "?");
      EXPECT_TRUE(host_.IsSilent());
      break;
    case BootFailure::NoiseBeforeReply:
      EXPECT_EQ(Heard(5),
                "\xF8"
                "BOOT");
      break;
    case BootFailure::DoubleReply:
      EXPECT_EQ(Heard(8), "BOOTBOOT");
      break;
    case BootFailure::LateReply: {
      const auto start = std::chrono::steady_clock::now();
      EXPECT_EQ(Heard(4), "BOOT");
      EXPECT_GE(std::chrono::steady_clock::now() - start, LateReply);
      break;
    }
    default:
      FAIL();
  }
}

INSTANTIATE_TEST_SUITE_P(EveryOfAReply, FailureOfBoot,
                         testing::Values(BootFailure::Silence, BootFailure::Unplugged,
                                         BootFailure::OtherReply, BootFailure::NoiseBeforeReply,
                                         BootFailure::DoubleReply, BootFailure::LateReply));

TEST(BootCodePulledOut, IsGoneInsteadOfEachReplyOfADownload) {
  const std::vector<Bytes> asked{{'X'}, {'P'}, {'B'}, ErasePage0, WriteBlankRow0, {'F'}};
  for (std::size_t reply = 2; reply <= 7; ++reply) {
    BootCode device({.Trouble = {.Failure = BootFailure::Unplugged, .Place = reply}, .LinePace = Pace::Fast});
    BootHost host(device.DevicePath());
    device.PowerOn();
    EXPECT_EQ(host.Hear(4), "BOOT");
    for (std::size_t step = 0; step + 2 < reply; ++step) {
      EXPECT_EQ(host.Ask(asked[step]).size(), 1U) << reply;
    }
    host.Write(asked[reply - 2]);
    EXPECT_EQ(host.ReadUntilHangUp(), Bytes{}) << reply;
    EXPECT_TRUE(host.HungUp()) << reply;
  }
}

TEST(BootCodeOfTheFirstKind, AsksAgainForABufferAndKeepsItOnce) {
  BootCode device({.Product = BootProduct::Qvm,
                   .Trouble = {.Failure = BootFailure::AsksAgain, .Place = 1},
                   .Times = 10,
                   .LinePace = Pace::Fast});
  BootHost host(device.DevicePath());
  device.PowerOn();
  EXPECT_EQ(host.Hear(4), "BOOT");
  EXPECT_EQ(host.Begin(), "xpb");
  EXPECT_EQ(host.Ask({0x53, 0x00, 0x70, 0x8F}), "f");
  const Bytes longest = Bytes{0x5A} + Bytes(51, 0x44);
  for (int time = 0; time < 10; ++time) {
    EXPECT_EQ(host.Ask(longest), "c");
  }
  EXPECT_EQ(host.Ask(longest), "f");
}

TEST(BootCodeOfTheFirstKind, PassesForTheOtherWhenItIsTheWrongProduct) {
  BootCode device({.Product = BootProduct::Qvm,
                   .Trouble = {.Failure = BootFailure::WrongProduct},
                   .LinePace = Pace::Fast});
  BootHost host(device.DevicePath());
  device.PowerOn();
  EXPECT_EQ(host.Hear(4), "BOOT");
  EXPECT_EQ(host.Say("XP"), "xd");
}

}  // namespace
}  // namespace sim
