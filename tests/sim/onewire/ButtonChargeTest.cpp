#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <sstream>

#include "sim/onewire/OneWireAdapter.h"
#include "tests/support/AdapterHost.h"
#include "tests/support/JoinedBytes.h"

namespace sim {
namespace {

constexpr RomId AmmoMag{0x06, 0x1C, 0xB8, 0x01, 0x00, 0x00, 0x00, 0x56};
constexpr ChargeBlock Charged{0x00, 0x01, 0x3E, 0x4F, 0x60, 0x71, 0x82, 0x93, 0xA4, 0xB5, 0xC6,
                              0xD7, 0xE8, 0xF9, 0x0A, 0x1B, 0x2C, 0x3D, 0x4E, 0x5F, 0x70, 0x81,
                              0x92, 0xA3, 0xB4, 0xC5, 0xD6, 0xE7, 0xF8, 0x09, 0x1A, 0xA6};

const Bytes Address{0x55, 0x06, 0x1C, 0xB8, 0x01, 0x00, 0x00, 0x00, 0x56};
const Bytes Ones(32, 0xFF);

// Charges an Ammo Mag, from the search to the copy, as a host without any doubts would.
class Charge : public testing::TestWithParam<OneWireFailureInfo> {
 protected:
  explicit Charge(OneWireFailure failure)
      : adapter_({.Failure = failure, .FailurePlace = 20, .LinePace = Pace::Fast}),
        host_(adapter_.DevicePath()) {
    adapter_.Fill(AmmoMag, ButtonContent::AmmoMag);
    adapter_.Touch(AmmoMag);
    before_ = adapter_.BlockOf(AmmoMag);
  }
  Charge() : Charge(GetParam().Failure) {}

  // Selects the button and sends it `bytes`; the answer to these.
  Bytes Ask(const Bytes& bytes) {
    host_.Write(Bytes{0xC1, 0xE1} + Address + bytes + Bytes{0xE3});
    const Bytes answer = host_.Read(1 + Address.size() + bytes.size());
    const std::size_t echoed = std::min(answer.size(), 1 + Address.size());
    return {answer.begin() + static_cast<std::ptrdiff_t>(echoed), answer.end()};
  }

  Bytes Read() {
    Bytes answer = Ask(Bytes{0xF0, 0x20, 0x00} + Ones);
    answer.erase(answer.begin(), answer.begin() + std::min<std::ptrdiff_t>(3, std::ssize(answer)));
    return answer;
  }

  void Write() {
    Ask(Bytes{0x0F, 0x20, 0x00} + Bytes(Charged.begin(), Charged.end()));
    const Bytes registers = Ask({0xAA, 0xFF, 0xFF, 0xFF});
    ASSERT_EQ(registers.size(), 4U);
    Ask({0x55, registers[1], registers[2], registers[3]});
  }

  ChargeBlock Block() { return adapter_.BlockOf(AmmoMag); }

  OneWireAdapter adapter_;
  AdapterHost host_;
  ChargeBlock before_{};
};

class ChargeWithoutFailure : public Charge {
 protected:
  ChargeWithoutFailure() : Charge(OneWireFailure::None) {}
};

TEST_F(ChargeWithoutFailure, IsTheToldExchangeByteForByte) {
  EXPECT_EQ(Read(), (Bytes{0x00, 0x00, 0x3E, 0x4F, 0x60, 0x71, 0x82, 0x93, 0xA4, 0xB5, 0xC6,
                           0xD7, 0xE8, 0xF9, 0x0A, 0x1B, 0x2C, 0x3D, 0x4E, 0x5F, 0x70, 0x81,
                           0x92, 0xA3, 0xB4, 0xC5, 0xD6, 0xE7, 0xF8, 0x09, 0x1A, 0xB0}));
  const Bytes block(Charged.begin(), Charged.end());
  EXPECT_EQ(Ask(Bytes{0x0F, 0x20, 0x00} + block), (Bytes{0x0F, 0x20, 0x00} + block));
  EXPECT_EQ(Ask({0xAA, 0xFF, 0xFF, 0xFF}), (Bytes{0xAA, 0x20, 0x00, 0x1F}));
  EXPECT_EQ(Block(), before_);
  EXPECT_EQ(Ask({0x55, 0x20, 0x00, 0x1F}), (Bytes{0x55, 0x20, 0x00, 0x1F}));
  EXPECT_EQ(Block(), Charged);
  EXPECT_EQ(Read(), block);
  EXPECT_EQ(Ask({0xAA, 0xFF, 0xFF, 0xFF}), (Bytes{0xAA, 0x20, 0x00, 0x9F}));
}

TEST_F(ChargeWithoutFailure, WorksBehindASearchToo) {
  Bytes toButton(16, 0x00);
  EXPECT_EQ(host_.Search(toButton).size(), 18U);
  EXPECT_EQ(host_.Ask({0xE1, 0xF0, 0x20, 0x00, 0xFF, 0xFF, 0xFF, 0xE3}, 6),
            (Bytes{0xF0, 0x20, 0x00, 0x00, 0x00, 0x3E}));
}

TEST_F(ChargeWithoutFailure, OutlastsTheTouch) {
  Write();
  EXPECT_TRUE(adapter_.Leave(AmmoMag));
  EXPECT_EQ(Read(), Ones);
  adapter_.Touch(AmmoMag);
  EXPECT_EQ(Read(), Bytes(Charged.begin(), Charged.end()));
}

TEST_F(ChargeWithoutFailure, LeavesASecondButtonAlone) {
  constexpr RomId other{0x08, 0x1D, 0xB8, 0x01, 0x00, 0x00, 0x00, 0x1E};
  adapter_.Fill(other, ButtonContent::Bandage);
  const ChargeBlock before = adapter_.BlockOf(other);
  adapter_.Touch(other);
  Write();
  EXPECT_EQ(Block(), Charged);
  EXPECT_EQ(adapter_.BlockOf(other), before);
}

TEST(ButtonsInTheLog, TellWhatTheyDo) {
  std::ostringstream log;
  {
    OneWireAdapter adapter({.LinePace = Pace::Fast, .Log = &log});
    AdapterHost host(adapter.DevicePath());
    adapter.Touch(AmmoMag);
    host.Ask(Bytes{0xC1, 0xE1} + Address + Bytes{0x0F, 0x20, 0x00, 0x11, 0xE3}, 14);
    host.Ask(Bytes{0xC1, 0xE1} + Address + Bytes{0x55, 0x20, 0x00, 0x1F, 0xE3}, 14);
    host.Ask(Bytes{0xC1, 0xE1} + Address + Bytes{0x55, 0x20, 0x00, 0x00, 0xE3}, 14);
  }
  EXPECT_THAT(log.str(),
              testing::ContainsRegex(
                  "1-wire -- button 5600000001B81C06 refuses to copy for 20 00 1F, its registers "
                  "are 20 00 00\n(.*\n)*.*1-wire -- button 5600000001B81C06 copied 1 bytes to 00 20"));
}

// What lies in the button after a charge, and whether it is still at the reader.
TEST_P(Charge, LeavesTheButtonAsTheNameOfTheFailureSays) {
  const Bytes before(before_.begin(), before_.end());
  switch (GetParam().Failure) {
    case OneWireFailure::RemovedInRead: {
      Bytes cut = before;
      std::fill(cut.begin() + 20, cut.end(), 0xFF);
      EXPECT_EQ(Read(), cut);
      EXPECT_FALSE(adapter_.Leave(AmmoMag));
      EXPECT_EQ(Block(), before_);
      break;
    }
    case OneWireFailure::RemovedInWrite:
      EXPECT_EQ(Read(), before);
      Ask(Bytes{0x0F, 0x20, 0x00} + Bytes(Charged.begin(), Charged.end()));
      EXPECT_FALSE(adapter_.Leave(AmmoMag));
      EXPECT_EQ(Ask({0xAA, 0xFF, 0xFF, 0xFF}), (Bytes{0xAA, 0xFF, 0xFF, 0xFF}));
      EXPECT_EQ(Block(), before_);
      break;
    case OneWireFailure::TornCopy: {
      Write();
      EXPECT_FALSE(adapter_.Leave(AmmoMag));
      ChargeBlock torn = before_;
      std::copy_n(Charged.begin(), 20, torn.begin());
      EXPECT_EQ(Block(), torn);
      break;
    }
    case OneWireFailure::DisturbedRead: {
      Bytes disturbed = before;
      disturbed.at(19) ^= 0x10U;
      EXPECT_EQ(Read(), disturbed);
      EXPECT_EQ(Read(), before);
      break;
    }
    case OneWireFailure::DisturbedWrite: {
      Write();
      ChargeBlock disturbed = Charged;
      disturbed.at(16) ^= 0x10U;
      EXPECT_EQ(Block(), disturbed);
      break;
    }
    case OneWireFailure::WriteProtected:
      Write();
      EXPECT_EQ(Block(), before_);
      EXPECT_TRUE(adapter_.Leave(AmmoMag));
      return;
    default:
      FAIL() << GetParam().Name;
  }
  // It strikes once: the next touch ends well.
  adapter_.Touch(AmmoMag);
  Write();
  EXPECT_EQ(Read(), Bytes(Charged.begin(), Charged.end()));
}

INSTANTIATE_TEST_SUITE_P(EveryFailureOfMemory, Charge,
                         testing::ValuesIn(OneWireFailures.begin() +
                                               static_cast<std::size_t>(OneWireFailure::RemovedInRead),
                                           OneWireFailures.end()),
                         [](const testing::TestParamInfo<OneWireFailureInfo>& failure) {
                           std::string name(failure.param.Name);
                           std::replace(name.begin(), name.end(), '-', '_');
                           return name;
                         });

}  // namespace
}  // namespace sim
