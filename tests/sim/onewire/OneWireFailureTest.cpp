#include "sim/onewire/OneWireFailure.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "sim/onewire/OneWireAdapter.h"
#include "tests/support/AdapterHost.h"

namespace sim {
namespace {

constexpr std::size_t FaultyAnswer = 3;
constexpr std::size_t LastBit = 12;

const Bytes Detection{0x17, 0x45, 0x5B, 0x0F, 0x91};
const Bytes Detected{0x16, 0x44, 0x5A, 0x00, 0x93};

// The first bit tells the button (family 02) from the reader's own device (81).
const Bytes ToLowest(16, 0x00);
const Bytes ToReader{2, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0};

// Answers to reset, search command and directions.
const Bytes FoundButton{0xCD, 0xF0, 0x09, 0x00, 0xA0, 0x02, 0x80, 0x8A, 0x02,
                        0x00, 0x00, 0x00, 0x00, 0x00, 0x00, 0x00, 0x08, 0x88};
const Bytes FoundReader{0xCD, 0xF0, 0x03, 0x80, 0x2A, 0x0A, 0x88, 0x22, 0xA8,
                        0x02, 0x00, 0x00, 0x00, 0x00, 0x00, 0x00, 0x2A, 0xA0};

Bytes With(Bytes bytes, std::size_t index, std::uint8_t value) {
  bytes.at(index) = value;
  return bytes;
}

// Plays the host's part with a button at the reader.
class FailureOfTheAdapter : public testing::TestWithParam<OneWireFailureInfo> {
 protected:
  FailureOfTheAdapter()
      : adapter_({.Failure = GetParam().Failure,
                  .FailurePlace = GetParam().Place == FailurePlace::Bit ? LastBit : FaultyAnswer,
                  .LinePace = Pace::Fast}),
        host_(adapter_.DevicePath()) {
    adapter_.Touch({0x02, 0x1C, 0xB8, 0x01, 0x00, 0x00, 0x00, 0xA2});
  }

  void ExpectDetection() { EXPECT_EQ(host_.Ask(Detection, Detected.size()), Detected); }

  // Twice, since a failure must stay.
  void ExpectSearches(const Bytes& lowest, const Bytes& reader) {
    for (int round = 0; round < 2; ++round) {
      EXPECT_EQ(host_.Search(ToLowest), lowest);
      EXPECT_EQ(host_.Search(ToReader), reader);
    }
    EXPECT_TRUE(host_.IsSilent());
  }

  void ExpectTwoButtons() {
    ExpectSearches(With(FoundButton, 4, 0xA1), FoundReader);
    EXPECT_EQ(host_.Search(With(ToLowest, 2, 0x02)),
              (Bytes{0xCD, 0xF0, 0x09, 0x00, 0xA3, 0x02, 0x80, 0x8A, 0x02, 0x00, 0x00, 0x00, 0x00, 0x00, 0x00,
                     0x00, 0x22, 0x82}));
    EXPECT_TRUE(adapter_.Leave({0x02, 0x1C, 0xB8, 0x01, 0x00, 0x00, 0x00, 0xA2}));
    EXPECT_EQ(host_.Search(ToLowest), With(FoundReader, 2, 0x02));
  }

  OneWireAdapter adapter_;
  AdapterHost host_;
};

const Bytes LostOnTheWay{0xCD, 0xF0, 0x09, 0x00, 0xE0, 0xFF, 0xFF, 0xFF, 0xFF,
                         0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF};
const Bytes Shorted{0xCC, 0x00, 0x55, 0x55, 0x55, 0x55, 0x55, 0x55, 0x55,
                    0x55, 0x55, 0x55, 0x55, 0x55, 0x55, 0x55, 0x55, 0x55};

TEST_P(FailureOfTheAdapter, ReachesTheHostAsItsNameSays) {
  switch (GetParam().Failure) {
    case OneWireFailure::None:
    case OneWireFailure::TornWrites:
    case OneWireFailure::RemovedInRead:  // these strike only at memories
    case OneWireFailure::RemovedInWrite:
    case OneWireFailure::TornCopy:
    case OneWireFailure::DisturbedRead:
    case OneWireFailure::DisturbedWrite:
    case OneWireFailure::WriteProtected:
      ExpectDetection();
      ExpectSearches(FoundButton, FoundReader);
      break;
    case OneWireFailure::Silence:
      EXPECT_EQ(host_.Ask(Detection, 2), (Bytes{0x16, 0x44}));
      host_.Write({0xC1});
      EXPECT_TRUE(host_.IsSilent());
      EXPECT_FALSE(host_.HungUp());
      break;
    case OneWireFailure::NoDetection:
      EXPECT_EQ(host_.Ask(Detection, 1), Bytes{0x93});
      ExpectSearches(FoundButton, FoundReader);
      EXPECT_EQ(host_.Ask({0xE1, 0x17}, 1), Bytes{0x17});
      break;
    case OneWireFailure::ShortCircuit:
      EXPECT_EQ(host_.Ask(Detection, 5), With(Detected, 4, 0x90));
      ExpectSearches(Shorted, With(Shorted, 2, 0x57));
      break;
    case OneWireFailure::ContactLost:
      ExpectDetection();
      ExpectSearches(LostOnTheWay, FoundReader);
      break;
    case OneWireFailure::WrongCrc:
      ExpectDetection();
      ExpectSearches(With(FoundButton, 17, 0x08), FoundReader);
      break;
    case OneWireFailure::HangUp: {
      host_.Write(Detection);
      const Bytes heard = host_.ReadUntilHangUp();
      EXPECT_TRUE(host_.HungUp());
      // A line that is pulled out takes bytes with it that the host had not read yet.
      EXPECT_LE(heard.size(), FaultyAnswer - 1);
      EXPECT_TRUE(std::equal(heard.begin(), heard.end(), Detected.begin()));
      break;
    }
    case OneWireFailure::NoiseByte:
      EXPECT_EQ(host_.Ask(Detection, 6), (Bytes{0x16, 0x44, 0xF8, 0x5A, 0x00, 0x93}));
      ExpectSearches(FoundButton, FoundReader);
      break;
    case OneWireFailure::TwoButtons:
      ExpectDetection();
      ExpectTwoButtons();
      break;
    case OneWireFailure::NoOwnDevice:
      ExpectDetection();
      ExpectSearches(With(FoundButton, 2, 0x08), With(FoundButton, 2, 0x08));
      break;
  }
}

INSTANTIATE_TEST_SUITE_P(Every, FailureOfTheAdapter, testing::ValuesIn(OneWireFailures),
                         [](const testing::TestParamInfo<OneWireFailureInfo>& failure) {
                           std::string name(failure.param.Name);
                           std::replace(name.begin(), name.end(), '-', '_');
                           return name;
                         });

}  // namespace
}  // namespace sim
