#include "sim/radio/TransmitRequest.h"

#include <gtest/gtest.h>

#include <string>

#include "tests/support/RadioLiterals.h"

namespace sim {
namespace {

using namespace wire;

// Requests stand as their destination and data, faults as their text.
std::vector<std::string> Read(TransmitRequestReader& reader, const Bytes& bytes) {
  std::vector<std::string> found;
  for (const std::uint8_t byte : bytes) {
    const auto taken = reader.Take(byte);
    if (!taken) {
      continue;
    }
    if (const auto* fault = std::get_if<HostFault>(&*taken)) {
      found.emplace_back(fault->What);
    } else {
      const auto& request = std::get<TransmitRequest>(*taken);
      found.push_back(std::to_string(request.Destination) + ' ' + testing::PrintToString(request.Data));
    }
  }
  return found;
}

std::vector<std::string> Read(const Bytes& bytes) {
  TransmitRequestReader reader;
  return Read(reader, bytes);
}

using Found = std::vector<std::string>;
const std::string RedFound = "65535 " + testing::PrintToString(Bytes{0, 0x22, 0, 0, 6});

TEST(TransmitRequest, IsFoundWithItsDestinationAndData) {
  EXPECT_EQ(Read(SearchRed2), Found{RedFound});
  EXPECT_EQ(Read(SizeRed2), Found{std::to_string(0x0013A200407E0E22) + ' ' +
                                  testing::PrintToString(Bytes{1, 0x22, 0, 0, 4, 1})});
}

TEST(TransmitRequest, MayFollowTheOneBeforeAtOnce) {
  EXPECT_EQ(Read(SearchRed2 + SearchRed2), (Found{RedFound, RedFound}));
}

TEST(TransmitRequest, IsNotEscaped) {
  const Bytes data{0x7E, 0x7D, 0x11, 0x13, 0x5E};
  Bytes frame = SearchRed2;
  std::copy(data.begin(), data.end(), frame.begin() + 14);
  EXPECT_EQ(Read(MadeGood(frame)), Found{"65535 " + testing::PrintToString(data)});
}

TEST(TransmitRequest, CarriesOneToAHundredDataBytes) {
  for (const std::size_t count : {1U, 100U}) {
    Bytes frame = SearchRed2;
    frame.insert(frame.begin() + 14, count, 9);
    frame.erase(frame.begin() + 14 + static_cast<std::ptrdiff_t>(count), frame.end() - 1);
    EXPECT_EQ(Read(MadeGood(frame)), Found{"65535 " + testing::PrintToString(Bytes(count, 9))});
  }
}

TEST(TransmitRequest, MustBeRightInEveryByteOfItsHead) {
  EXPECT_EQ(Read(With(SearchRed2, 19, 0xDA)), Found{"a wrong checksum"});
  EXPECT_EQ(Read(With(SearchRed2, 15, 0x23)), Found{"a wrong checksum"});
  EXPECT_EQ(Read(MadeGood(With(SearchRed2, 3, 0x08))), Found{"an API identifier other than 0"});
  EXPECT_EQ(Read(MadeGood(With(SearchRed2, 3, 0x01))), Found{"an API identifier other than 0"});
  EXPECT_EQ(Read(MadeGood(With(SearchRed2, 4, 1))), Found{"a frame identifier other than 0"});
  EXPECT_EQ(Read(MadeGood(With(SearchRed2, 13, 1))), Found{"options other than 0"});
}

TEST(TransmitRequest, HasALengthThatFitsAndTheHighByteFirst) {
  for (const Bytes& length : {Bytes{0, 0}, Bytes{0, 11}, Bytes{0, 112}, Bytes{0x10, 0}, Bytes{0xFF, 0xFF}}) {
    EXPECT_EQ(Read(Bytes{0x7E} + length), Found{"a length that no transmit request has"});
  }
}

TEST(TransmitRequest, BeginsWithTheStartByteAndStrayBytesAreOneFault) {
  EXPECT_EQ(Read({1, 2, 3}), Found{"a byte outside a frame"});
  EXPECT_EQ(Read(Bytes{0x7D, 0x5E} + SearchRed2), (Found{"a byte outside a frame", RedFound}));
  EXPECT_EQ(Read(SearchRed2 + Bytes{0} + SearchRed2), (Found{RedFound, "a byte outside a frame", RedFound}));
}

TEST(TransmitRequest, IsFoundAgainBehindAFault) {
  TransmitRequestReader reader;
  for (const Bytes& bad :
       {With(SearchRed2, 19, 0), MadeGood(With(SearchRed2, 13, 4)), Bytes{0x7E, 9, 9, 1}}) {
    EXPECT_EQ(Read(reader, bad).size(), 1U);
    EXPECT_EQ(Read(reader, SearchRed2), Found{RedFound});
  }
}

TEST(TransmitRequest, ShowsItsBytes) {
  TransmitRequestReader reader;
  Read(reader, Bytes{1} + SearchRed2);
  EXPECT_EQ(reader.Bytes(), SearchRed2);
}

}  // namespace
}  // namespace sim
