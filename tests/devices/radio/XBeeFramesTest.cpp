#include "devices/radio/XBeeFrames.h"

#include <gmock/gmock.h>

#include "devices/radio/GunPacket.h"
#include "platform/RuntimeError.h"
#include "tests/support/Bytes.h"

namespace {

using testing::ElementsAre;

TEST(TransmitRequest, AsksForABroadcastOfTheSearchOfGun32) {
  EXPECT_THAT(TransmitRequest(BroadcastAddress, MakeGunPacket(32, 0, 0, 6, {})),
              ElementsAre(0x7E, 0x00, 0x10, 0x00, 0x00,                          //
                          0x00, 0x00, 0x00, 0x00, 0x00, 0x00, 0xFF, 0xFF, 0x00,  //
                          0x00, 0x20, 0x00, 0x00, 0x06, 0xDB));
}

TEST(TransmitRequest, SendsTheAddressMostSignificantByteFirst) {
  const XBeeAddress address = {0x33, 0x22, 0x11, 0x40, 0x00, 0xA2, 0x13, 0x00};
  EXPECT_THAT(TransmitRequest(address, MakeGunPacket(33, 0, 0, 4, Bytes{2, 90, 45})),
              ElementsAre(0x7E, 0x00, 0x13, 0x00, 0x00,                          //
                          0x00, 0x13, 0xA2, 0x00, 0x40, 0x11, 0x22, 0x33, 0x00,  //
                          0x03, 0x21, 0x00, 0x00, 0x04, 0x02, 0x5A, 0x2D, 0xF3));
}

TEST(TransmitRequest, NeverEscapes) {
  EXPECT_THAT(TransmitRequest({0x7E, 0x7D, 0x11, 0x13}, Bytes{0x7E}),
              ElementsAre(0x7E, 0x00, 0x0C, 0x00, 0x00,                          //
                          0x00, 0x00, 0x00, 0x00, 0x13, 0x11, 0x7D, 0x7E, 0x00,  //
                          0x7E, 0x62));
}

TEST(TransmitRequest, HasTheHighByteOfItsLengthFirst) {
  const Bytes frame = TransmitRequest(BroadcastAddress, Bytes(300, 0));
  EXPECT_EQ(frame.size(), 315U);
  EXPECT_EQ(frame[1], 0x01);
  EXPECT_EQ(frame[2], 0x37);
  EXPECT_EQ(frame.back(), 0x01);
}

TEST(AtCommandFrame, CarriesLettersAndValue) {
  EXPECT_THAT(AtCommandFrame(0x52, {'D', 'L'}, Bytes{0x00, 0x00, 0xFF, 0xFF}),
              ElementsAre(0x7E, 0x00, 0x08, 0x08, 0x52, 0x44, 0x4C, 0x00, 0x00, 0xFF, 0xFF, 0x17));
}

TEST(AtCommandFrame, NeedsNoValue) {
  EXPECT_THAT(AtCommandFrame(0x01, {'A', 'P'}, {}),
              ElementsAre(0x7E, 0x00, 0x04, 0x08, 0x01, 0x41, 0x50, 0x65));
}

TEST(GunPackets, HaveAHeaderOfFiveBytes) {
  EXPECT_THAT(MakeGunPacket(200, 1, 2, 4, Bytes{3}), ElementsAre(1, 200, 1, 2, 4, 3));
  EXPECT_THAT(MakeGunPacket(255, 0, 0, 6, {}), ElementsAre(0, 255, 0, 0, 6));
}

class ReadPacket : public testing::Test {
 protected:
  ReadPacket() {
    for (std::size_t i = 0; i < frame.Data.size(); ++i) {
      frame.Data[i] = static_cast<std::uint8_t>(i + 100);
    }
  }

  ReceivedFrame frame;
};

TEST_F(ReadPacket, TakesTheHeaderAndOneByteMoreThanThePayload) {
  frame.Data[0] = 2;
  const GunPacket packet = ReadGunPacket(frame);
  EXPECT_THAT((Bytes{packet.PayloadLength, packet.PlayerId, packet.Byte2, packet.Byte3, packet.Type}),
              ElementsAre(2, 101, 102, 103, 104));
  EXPECT_THAT(Bytes(packet.Payload.begin(), packet.Payload.begin() + 5), ElementsAre(105, 106, 107, 0, 0));
}

TEST_F(ReadPacket, GoesByTheAnnouncedLengthAndNotByTheFrames) {
  frame.Data[0] = 3;
  frame.DataLength = 0;
  EXPECT_EQ(ReadGunPacket(frame).Payload[3], 108);
}

TEST_F(ReadPacket, HasRoomFor94BytesOfPayload) {
  frame.Data[0] = 94;
  EXPECT_EQ(ReadGunPacket(frame).Payload[94], 199);
  for (const std::uint8_t length : Bytes{95, 96, 255}) {
    frame.Data[0] = length;
    try {
      ReadGunPacket(frame);
      ADD_FAILURE() << int(length) << " fits";
    } catch (const RuntimeError& error) {
      EXPECT_EQ(error.Number(), 9);
    }
  }
}

TEST(GunBytes, HoldZeroTo255) {
  EXPECT_EQ(ByteOf(0), 0);
  EXPECT_EQ(ByteOf(255), 255);
  for (const int value : {-1, 256, 270}) {
    try {
      ByteOf(value);
      ADD_FAILURE() << value << " fits";
    } catch (const RuntimeError& error) {
      EXPECT_EQ(error.Number(), 6);
    }
  }
}

}  // namespace
