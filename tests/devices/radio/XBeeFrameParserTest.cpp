#include "devices/radio/XBeeFrameParser.h"

#include <gmock/gmock.h>

#include <cstdlib>
#include <new>
#include <vector>

#include "platform/RuntimeError.h"
#include "tests/support/Bytes.h"

namespace {

std::size_t allocations = 0;

}  // namespace

// Counted, so that a test can tell that a frame needs none. Inlined, gcc would take them for a mismatch.
[[gnu::noinline]] void* operator new(std::size_t size) {
  ++allocations;
  if (void* memory = std::malloc(size != 0 ? size : 1)) {
    return memory;
  }
  throw std::bad_alloc();
}
[[gnu::noinline]] void operator delete(void* memory) noexcept {
  std::free(memory);
}
[[gnu::noinline]] void operator delete(void* memory, std::size_t /*size*/) noexcept {
  std::free(memory);
}

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

/// From 0013A20040112233, -40 dBm: gun 33 answers the search with firmware 2.5, 85 percent, weapon 1.
const Bytes AnswerFrame = {0x7E, 0x00, 0x14, 0x80, 0x00, 0x13, 0xA2, 0x00, 0x40, 0x11, 0x22, 0x33,
                           0x28, 0x02, 0x04, 0x21, 0x00, 0x00, 0x07, 0x02, 0x05, 0x55, 0x01, 0x71};
const Bytes ModemStatus = {0x7E, 0x00, 0x02, 0x8A, 0x06, 0x6F};
const Bytes TransmitStatus = {0x7E, 0x00, 0x03, 0x89, 0x01, 0x00, 0x75};
const Bytes ShortAddressFrame = {0x7E, 0x00, 0x06, 0x81, 0x12, 0x34, 0x28, 0x00, 0x05, 0x0B};
/// Command "SL" with frame identifier 0x52 was answered with status 0 and 40112233.
const Bytes AtFrame = {0x7E, 0x00, 0x09, 0x88, 0x52, 0x53, 0x4C, 0x00, 0x40, 0x11, 0x22, 0x33, 0xE0};

class Parser : public testing::Test {
 protected:
  /// Identifiers of the good frames in these bytes.
  std::vector<int> Receive(const Bytes& bytes) {
    std::vector<int> types;
    for (const std::uint8_t byte : bytes) {
      if (const int type = parser.Receive(byte); type != 0) {
        types.push_back(type);
      }
    }
    return types;
  }

  /// A frame of this identifier whose body is filled up with zeros to `length`.
  static Bytes FrameOfZeros(std::uint8_t identifier, std::size_t length) {
    Bytes frame = {0x7E, static_cast<std::uint8_t>(length / 256), static_cast<std::uint8_t>(length % 256),
                   identifier};
    frame.resize(3 + length, 0);
    frame.push_back(static_cast<std::uint8_t>(0xFF - identifier));
    return frame;
  }

  XBeeFrameParser parser;
  const ReceivedFrame& frame = parser.Frame();
};

TEST_F(Parser, KeepsReceivedDataWithItsSender) {
  EXPECT_THAT(Receive(AnswerFrame), ElementsAre(0x80));
  EXPECT_THAT(frame.SourceAddress, ElementsAre(0x33, 0x22, 0x11, 0x40, 0x00, 0xA2, 0x13, 0x00));
  EXPECT_EQ(frame.Rssi, 0x28);
  EXPECT_EQ(frame.Options, 2);
  ASSERT_EQ(frame.DataLength, 9);
  EXPECT_THAT(Bytes(frame.Data.begin(), frame.Data.begin() + 9),
              ElementsAre(4, 0x21, 0, 0, 7, 2, 5, 0x55, 1));
}

TEST_F(Parser, TellsOfAFrameWithItsCheckByteAndNotBefore) {
  const Bytes withoutCheckByte(AnswerFrame.begin(), AnswerFrame.end() - 1);
  EXPECT_THAT(Receive(withoutCheckByte), IsEmpty());
  EXPECT_EQ(parser.Receive(AnswerFrame.back()), 0x80);
}

TEST_F(Parser, KeepsAnAtResponseWithItsValue) {
  EXPECT_THAT(Receive(AtFrame), ElementsAre(0x88));
  EXPECT_EQ(frame.AtFrameId, 0x52);
  EXPECT_THAT(frame.AtCommand, ElementsAre('S', 'L'));
  EXPECT_EQ(frame.AtStatus, 0);
  ASSERT_EQ(frame.AtDataLength, 4);
  EXPECT_THAT(Bytes(frame.AtData.begin(), frame.AtData.begin() + 4), ElementsAre(0x40, 0x11, 0x22, 0x33));
}

TEST_F(Parser, KeepsAnAtResponseWithoutValue) {
  Receive(AtFrame);
  EXPECT_THAT(Receive({0x7E, 0x00, 0x05, 0x88, 0x01, 0x41, 0x50, 0x03, 0xE2}), ElementsAre(0x88));
  EXPECT_THAT(frame.AtCommand, ElementsAre('A', 'P'));
  EXPECT_EQ(frame.AtStatus, 3);
  EXPECT_EQ(frame.AtDataLength, 0);
}

TEST_F(Parser, ChecksStatusFramesAndThrowsTheirBodyAway) {
  Receive(AnswerFrame);
  EXPECT_THAT(Receive(ModemStatus), ElementsAre(0x8A));
  EXPECT_THAT(Receive(TransmitStatus), ElementsAre(0x89));
  EXPECT_THAT(Receive(ShortAddressFrame), ElementsAre(0x81));
  EXPECT_EQ(frame.DataLength, 9);
  EXPECT_EQ(frame.Data[1], 0x21);
  EXPECT_EQ(frame.SourceAddress[0], 0x33);
}

TEST_F(Parser, DropsAFrameWithAWrongCheckByteWithoutAWord) {
  for (Bytes wrong : {AnswerFrame, ModemStatus, TransmitStatus, ShortAddressFrame, AtFrame}) {
    wrong.back() ^= 1;
    EXPECT_THAT(Receive(wrong), IsEmpty());
  }
  EXPECT_THAT(Receive(AnswerFrame), ElementsAre(0x80));
}

TEST_F(Parser, DropsWhatStandsBetweenFrames) {
  EXPECT_THAT(Receive({0, 1, 0xFF, 0x80, 0x8A}), IsEmpty());
  EXPECT_THAT(Receive(ModemStatus), ElementsAre(0x8A));
  EXPECT_THAT(Receive({0x55, 0}), IsEmpty());
  EXPECT_THAT(Receive(ModemStatus), ElementsAre(0x8A));
}

TEST_F(Parser, TakesFramesWithoutAGap) {
  Bytes bytes = ModemStatus;
  bytes.insert(bytes.end(), AnswerFrame.begin(), AnswerFrame.end());
  bytes.insert(bytes.end(), AtFrame.begin(), AtFrame.end());
  EXPECT_THAT(Receive(bytes), ElementsAre(0x8A, 0x80, 0x88));
}

TEST_F(Parser, StartsAFrameWithTheStartByteThatStandsForAWrongCheckByte) {
  Bytes bytes(ModemStatus.begin(), ModemStatus.end() - 1);
  bytes.insert(bytes.end(), AnswerFrame.begin(), AnswerFrame.end());
  EXPECT_THAT(Receive(bytes), ElementsAre(0x80));
}

TEST_F(Parser, TakesAStartByteThatIsTheRightCheckByteAsThat) {
  EXPECT_THAT(Receive({0x7E, 0x00, 0x03, 0x8A, 0x00, 0xF7, 0x7E}), ElementsAre(0x8A));
  EXPECT_THAT(Receive({0x00, 0x02, 0x8A, 0x06, 0x6F}), IsEmpty());
  EXPECT_THAT(Receive(ModemStatus), ElementsAre(0x8A));
}

TEST_F(Parser, NeverUnescapes) {
  EXPECT_THAT(Receive({0x7E, 0x00, 0x0D, 0x80, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0x7E, 0x7D, 0x84}),
              ElementsAre(0x80));
  EXPECT_EQ(frame.DataLength, 2);
  EXPECT_EQ(frame.Data[0], 0x7E);
  EXPECT_EQ(frame.Data[1], 0x7D);
}

TEST_F(Parser, DropsAFrameOfAnUnknownKind) {
  EXPECT_THAT(Receive({0x7E, 0x00, 0x02, 0x92, 0x00, 0x6D}), IsEmpty());
  EXPECT_THAT(Receive(ModemStatus), ElementsAre(0x8A));
}

TEST_F(Parser, StartsAFrameWithAStartByteInPlaceOfTheIdentifier) {
  Bytes bytes = {0x7E, 0x00, 0x14};
  bytes.insert(bytes.end(), ModemStatus.begin(), ModemStatus.end());
  EXPECT_THAT(Receive(bytes), ElementsAre(0x8A));
}

TEST_F(Parser, TakesAFrameTornAtAnyByteForTheStartOfTheNext) {
  for (std::size_t length = 1; length < AnswerFrame.size(); ++length) {
    parser = {};
    Receive(Bytes(AnswerFrame.begin(), AnswerFrame.begin() + static_cast<std::ptrdiff_t>(length)));
    Receive(AnswerFrame);
    Receive(AnswerFrame);
    EXPECT_THAT(Receive(AnswerFrame), ElementsAre(0x80)) << length;
  }
}

TEST_F(Parser, TakesAFrameThatEndsInItsAddress) {
  Receive(AnswerFrame);
  EXPECT_THAT(Receive({0x7E, 0x00, 0x04, 0x80, 0x01, 0x02, 0x03, 0x79}), ElementsAre(0x80));
  EXPECT_THAT(frame.SourceAddress, ElementsAre(0, 0, 0, 0, 0, 3, 2, 1));
  EXPECT_EQ(frame.DataLength, 0);
  EXPECT_EQ(frame.Data[1], 0x21);  // the packet of the frame before
}

TEST_F(Parser, NeverEndsABodyOfOneByteOrNone) {
  EXPECT_THAT(Receive({0x7E, 0x00, 0x01, 0x8A, 0x75}), IsEmpty());
  EXPECT_THAT(Receive(Bytes(70000, 0x8A)), IsEmpty());
  parser = {};
  EXPECT_THAT(Receive({0x7E, 0x00, 0x00, 0x8A, 0x75}), IsEmpty());
}

// A byte behind the identifier makes the body longer than its length says, with a sum that would be right.
TEST_F(Parser, NeverEndsABodyOfOneByteOrNoneAtAByteBehindIt) {
  for (const std::uint8_t length : Bytes{0, 1}) {
    parser = {};
    EXPECT_THAT(Receive({0x7E, 0x00, length, 0x8A, 0x00, 0x75}), IsEmpty()) << int(length);
    EXPECT_THAT(Receive(ModemStatus), IsEmpty()) << int(length);
  }
}

TEST_F(Parser, ReadsTheLengthHighByteFirst) {
  EXPECT_THAT(Receive(FrameOfZeros(0x89, 0x0102)), ElementsAre(0x89));
  EXPECT_THAT(Receive(FrameOfZeros(0x81, 0xFFFF)), ElementsAre(0x81));
}

TEST_F(Parser, Has101BytesOfRoomForData) {
  EXPECT_THAT(Receive(FrameOfZeros(0x80, 11 + 101)), ElementsAre(0x80));
  EXPECT_EQ(frame.DataLength, 101);
}

TEST_F(Parser, FaultsAtThe102ndByteOfDataAndGoesOnBehindIt) {
  const Bytes tooLong = FrameOfZeros(0x80, 11 + 102);
  Receive(Bytes(tooLong.begin(), tooLong.end() - 2));
  try {
    parser.Receive(0);
    FAIL() << "took the byte";
  } catch (const RuntimeError& error) {
    EXPECT_EQ(error.Number(), 9);
  }
  EXPECT_EQ(frame.DataLength, 101);
  EXPECT_THAT(Receive(AnswerFrame), ElementsAre(0x80));
}

TEST_F(Parser, Has21BytesOfRoomForAnAtValue) {
  EXPECT_THAT(Receive(FrameOfZeros(0x88, 5 + 21)), ElementsAre(0x88));
  EXPECT_EQ(frame.AtDataLength, 21);
  const Bytes tooLong = FrameOfZeros(0x88, 5 + 22);
  Receive(Bytes(tooLong.begin(), tooLong.end() - 2));
  EXPECT_THROW(parser.Receive(0), RuntimeError);
  EXPECT_THAT(Receive(AnswerFrame), ElementsAre(0x80));
}

TEST_F(Parser, AllocatesNothing) {
  Bytes bytes = AnswerFrame;
  bytes.insert(bytes.end(), AtFrame.begin(), AtFrame.end());
  bytes.insert(bytes.end(), TransmitStatus.begin(), TransmitStatus.end());
  int frames = 0;
  const std::size_t before = allocations;
  for (int i = 0; i < 100; ++i) {
    for (const std::uint8_t byte : bytes) {
      frames += parser.Receive(byte) != 0 ? 1 : 0;
    }
  }
  EXPECT_EQ(allocations, before);
  EXPECT_EQ(frames, 300);
}

}  // namespace
