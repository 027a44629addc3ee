#include <array>
#include <cstddef>
#include <cstdint>
#include <cstdlib>

#include "devices/radio/GunPacket.h"
#include "devices/radio/XBeeFrameParser.h"
#include "platform/RuntimeError.h"

namespace {

void Require(bool condition) {
  if (!condition) {
    std::abort();
  }
}

/// The parser's result for one byte: a frame's identifier, or -1 if a buffer overflowed (RuntimeError 9).
int Receive(XBeeFrameParser& parser, std::uint8_t byte) {
  try {
    return parser.Receive(byte);
  } catch (const RuntimeError& error) {
    Require(error.Number() == 9);
    return -1;
  }
}

/// True if the bytes before `end` finish with a frame of this identifier, check byte included.
bool EndsWithFrame(const std::uint8_t* begin, const std::uint8_t* end, int type) {
  unsigned int sum = *(end - 1);
  for (const std::uint8_t* body = end - 2; body - begin >= 3; --body) {
    sum += *body;
    const auto length = static_cast<std::size_t>(end - 1 - body);
    if (*body == type && *(body - 3) == FrameStart && *(body - 2) * 256U + *(body - 1) == length &&
        sum % 256 == 255) {
      return true;
    }
  }
  return false;
}

void RequireReadable(const ReceivedFrame& frame) {
  try {
    const GunPacket packet = ReadGunPacket(frame);
    Require(packet.PayloadLength == frame.Data[0] && packet.PayloadLength <= 94);
  } catch (const RuntimeError& error) {
    Require(error.Number() == 9 && frame.Data[0] >= 95);
  }
}

}  // namespace

/// Whatever the bytes: each reported frame is among them with a valid check byte, no buffer overruns, and the
/// parser accepts a frame after a reset.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  XBeeFrameParser parser;
  for (std::size_t i = 0; i < size; ++i) {
    const int type = Receive(parser, data[i]);
    const ReceivedFrame& frame = parser.Frame();
    Require(frame.DataLength <= frame.Data.size() && frame.AtDataLength <= frame.AtData.size());
    if (type > 0) {
      Require(type == XBeeApi::Receive64 || type == XBeeApi::Receive16 || type == XBeeApi::AtResponse ||
              type == XBeeApi::TransmitStatus || type == XBeeApi::ModemStatus);
      Require(EndsWithFrame(data, data + i + 1, type));
      RequireReadable(frame);
    }
  }
  parser = {};
  int last = 0;
  for (const std::uint8_t byte : std::to_array<std::uint8_t>({0x7E, 0, 2, 0x8A, 6, 0x6F})) {
    last = Receive(parser, byte);
  }
  Require(last == XBeeApi::ModemStatus);
  return 0;
}
