#include "sim/pic24f/Pic24fPacket.h"

#include <gtest/gtest.h>

#include <string>

#include "tests/support/Bytes.h"

namespace sim {
namespace {

Bytes Encoded(const Bytes& data, bool escapeAll = false) {
  return EncodePic24fPacket(data, escapeAll);
}

// All that a reader makes of `bytes`: packets as their data in brackets, and faults.
std::string HeardOf(const Bytes& bytes) {
  Pic24fPacketReader reader;
  std::string heard;
  for (const std::uint8_t byte : bytes) {
    const auto taken = reader.Take(byte);
    if (!taken) {
      continue;
    }
    if (const auto* fault = std::get_if<BadPacket>(&*taken)) {
      heard += std::string(fault->What) + ';';
    } else {
      heard += '[';
      for (const std::uint8_t next : std::get<Pic24fPacket>(*taken).Data) {
        heard += ' ' + std::to_string(next);
      }
      heard += " ]";
    }
  }
  return heard;
}

TEST(Pic24fPacket, StandsBetweenTwoStartsAndAnEndWithItsChecksum) {
  EXPECT_EQ(Encoded({0x00, 0x02}), (Bytes{0x55, 0x55, 0x00, 0x02, 0xFE, 0x04}));
  EXPECT_EQ(Encoded({0x08}), (Bytes{0x55, 0x55, 0x08, 0xF8, 0x04}));
  EXPECT_EQ(Encoded({0x00, 0x00}), (Bytes{0x55, 0x55, 0x00, 0x00, 0x00, 0x04}));
}

TEST(Pic24fPacket, EscapesTheThreeValuesInDataAndChecksum) {
  EXPECT_EQ(Encoded({0x55, 0x04, 0x05}), (Bytes{0x55, 0x55, 0x05, 0x55, 0x05, 0x04, 0x05, 0x05, 0xA2, 0x04}));
  EXPECT_EQ(Encoded({0xAB}), (Bytes{0x55, 0x55, 0xAB, 0x05, 0x55, 0x04}));
  EXPECT_EQ(Encoded({0x01, 0x02}, true), (Bytes{0x55, 0x55, 0x05, 0x01, 0x05, 0x02, 0x05, 0xFD, 0x04}));
}

TEST(Pic24fPacket, CanHaveAWrongChecksum) {
  EXPECT_EQ(EncodeWrongPic24fPacket(Bytes{0x08}), (Bytes{0x55, 0x55, 0x08, 0x78, 0x04}));
  EXPECT_EQ(EncodeWrongPic24fPacket(Bytes{0x7C}), (Bytes{0x55, 0x55, 0x7C, 0x05, 0x04, 0x04}));
}

TEST(Pic24fPacketReader, FindsPacketsOneBehindTheOther) {
  EXPECT_EQ(HeardOf({0x55, 0x55, 0x00, 0x02, 0xFE, 0x04, 0x55, 0x55, 0x08, 0xF8, 0x04}), "[ 0 2 ][ 8 ]");
}

TEST(Pic24fPacketReader, TakesAnEscapedByteAsItIs) {
  EXPECT_EQ(HeardOf({0x55, 0x55, 0x05, 0x55, 0x05, 0x04, 0x05, 0x05, 0xA2, 0x04}), "[ 85 4 5 ]");
  EXPECT_EQ(HeardOf({0x55, 0x55, 0x05, 0x08, 0x05, 0xF8, 0x04}), "[ 8 ]");
}

TEST(Pic24fPacketReader, RefusesAWrongChecksum) {
  EXPECT_EQ(HeardOf({0x55, 0x55, 0x00, 0x02, 0xFF, 0x04}), "a wrong checksum;");
  EXPECT_EQ(HeardOf({0x55, 0x55, 0x00, 0x03, 0xFE, 0x04, 0x55, 0x55, 0x08, 0xF8, 0x04}),
            "a wrong checksum;[ 8 ]");
}

TEST(Pic24fPacketReader, RefusesAPacketWithoutData) {
  EXPECT_EQ(HeardOf({0x55, 0x55, 0x04}), "a packet without data;");
  EXPECT_EQ(HeardOf({0x55, 0x55, 0x00, 0x04}), "a packet without data;");
}

TEST(Pic24fPacketReader, BeginsAnewWithAStartInTheMiddle) {
  EXPECT_EQ(HeardOf({0x55, 0x55, 0x01, 0x02, 0x55, 0x55, 0x08, 0xF8, 0x04}), "a packet cut short;[ 8 ]");
  EXPECT_EQ(HeardOf({0x55, 0x55, 0x55, 0x08, 0xF8, 0x04}), "[ 8 ]");
}

TEST(Pic24fPacketReader, PassesOverARunOfStrayBytes) {
  EXPECT_EQ(HeardOf({0x01, 0x02, 0x04, 0x55, 0x55, 0x08, 0xF8, 0x04}), "a byte outside a packet;[ 8 ]");
  EXPECT_EQ(HeardOf({0x55, 0x08, 0xF8, 0x04, 0x55, 0x55, 0x08, 0xF8, 0x04}), "a byte outside a packet;[ 8 ]");
}

TEST(Pic24fPacketReader, TakesFourRowsAndNoMore) {
  const Bytes fourRows(5 + 4 * 256, 0x01);
  EXPECT_EQ(HeardOf(Encoded(fourRows)).substr(0, 6), "[ 1 1 ");
  Bytes longer = fourRows;
  longer.push_back(0x01);
  EXPECT_EQ(HeardOf(Encoded(longer)), "a packet longer than the loader's buffer;");
}

TEST(Pic24fPacketReader, KeepsTheBytesOfThePacketAsTheyCame) {
  Pic24fPacketReader reader;
  const Bytes packet{0x55, 0x55, 0x05, 0x04, 0xFC, 0x04};
  reader.Take(0x77);
  EXPECT_EQ(reader.Bytes(), Bytes{0x77});
  for (const std::uint8_t byte : packet) {
    reader.Take(byte);
  }
  EXPECT_EQ(reader.Bytes(), packet);
}

}  // namespace
}  // namespace sim
