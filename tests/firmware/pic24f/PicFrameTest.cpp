#include "firmware/pic24f/PicFrame.h"

#include <gmock/gmock.h>

#include "tests/support/Bytes.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

/// The packets that the decoder finds, one after the other.
std::vector<Bytes> Found(const Bytes& line, std::size_t longest = 300) {
  PicFrameDecoder decoder(longest);
  std::vector<Bytes> packets;
  for (const std::uint8_t byte : line) {
    if (decoder.Receive(byte)) {
      packets.push_back(decoder.Data());
    }
  }
  return packets;
}

TEST(PicFrame, HasMarksAndChecksum) {
  EXPECT_EQ(PicFrame(Bytes{0x00, 0x02}), (Bytes{0x55, 0x55, 0x00, 0x02, 0xFE, 0x04}));
  EXPECT_EQ(PicFrame(Bytes{0x00, 0x00}), (Bytes{0x55, 0x55, 0x00, 0x00, 0x00, 0x04}));
  EXPECT_EQ(PicFrame(Bytes{0x08}), (Bytes{0x55, 0x55, 0x08, 0xF8, 0x04}));
  EXPECT_EQ(PicFrame(Bytes{0x01, 0x01, 0x00, 0x00, 0xFF}),
            (Bytes{0x55, 0x55, 0x01, 0x01, 0x00, 0x00, 0xFF, 0xFF, 0x04}));
}

TEST(PicFrame, EscapesMarksInDataAndChecksum) {
  EXPECT_EQ(PicFrame(Bytes{0x55, 0x04, 0x05}),
            (Bytes{0x55, 0x55, 0x05, 0x55, 0x05, 0x04, 0x05, 0x05, 0xA2, 0x04}));
  EXPECT_EQ(PicFrame(Bytes{0xFC}), (Bytes{0x55, 0x55, 0xFC, 0x05, 0x04, 0x04}));
  EXPECT_EQ(PicFrame(Bytes{0xAB}), (Bytes{0x55, 0x55, 0xAB, 0x05, 0x55, 0x04}));
  EXPECT_EQ(PicFrame(Bytes{0xFB}), (Bytes{0x55, 0x55, 0xFB, 0x05, 0x05, 0x04}));
}

TEST(PicFrameDecoder, FindsAPacketAmongNoise) {
  EXPECT_THAT(
      Found({0x00, 0x04, 0xFF, 0x55, 0x12, 0x55, 0x55, 0x00, 0x02, 0x05, 0x05, 0x01, 0xF8, 0x04, 0x33}),
      ElementsAre(Bytes{0x00, 0x02, 0x05, 0x01}));
}

TEST(PicFrameDecoder, FindsPacketsThatFollowEachOther) {
  EXPECT_THAT(Found({0x55, 0x55, 0x02, 0xFE, 0x04, 0x55, 0x55, 0x03, 0xFD, 0x04}),
              ElementsAre(Bytes{0x02}, Bytes{0x03}));
}

TEST(PicFrameDecoder, TakesMoreStartMarksThanTwo) {
  EXPECT_THAT(Found({0x55, 0x55, 0x55, 0x02, 0xFE, 0x04}), ElementsAre(Bytes{0x02}));
}

TEST(PicFrameDecoder, BeginsAnewAtAMarkWithinAPacket) {
  EXPECT_THAT(Found({0x55, 0x55, 0x02, 0x55, 0x55, 0x03, 0xFD, 0x04}), ElementsAre(Bytes{0x03}));
}

TEST(PicFrameDecoder, PassesOverWrongChecksums) {
  EXPECT_THAT(Found({0x55, 0x55, 0x02, 0xFF, 0x04}), IsEmpty());
  EXPECT_THAT(Found({0x55, 0x55, 0x00, 0x04}), IsEmpty());
  EXPECT_THAT(Found({0x55, 0x55, 0x04}), IsEmpty());
}

TEST(PicFrameDecoder, PassesOverOneStartMark) {
  EXPECT_THAT(Found({0x55, 0x02, 0xFE, 0x04}), IsEmpty());
}

TEST(PicFrameDecoder, PassesOverPacketsThatAreTooLong) {
  EXPECT_THAT(Found(PicFrame(Bytes(20, 7)), 20), ElementsAre(Bytes(20, 7)));
  EXPECT_THAT(Found(PicFrame(Bytes(21, 7)), 20), IsEmpty());
}

TEST(PicFrameDecoder, GivesEachPacketBack) {
  for (int first = 0; first < 256; ++first) {
    const Bytes data = {static_cast<std::uint8_t>(first), 0x55, 0x04, 0x05,
                        static_cast<std::uint8_t>(255 - first)};
    EXPECT_THAT(Found(PicFrame(data)), ElementsAre(data));
  }
}

}  // namespace
