#include "devices/radio/XBeeFrameParser.h"

#include <cstddef>

#include "platform/RuntimeError.h"

std::uint8_t XBeeFrameParser::Receive(std::uint8_t byte) {
  switch (state_) {
    case State::Start:
      if (byte == FrameStart) {
        BeginFrame();
      }
      break;
    case State::Length:
      TakeLength(byte);
      break;
    case State::Identifier:
      TakeIdentifier(byte);
      break;
    case State::AtResponse:
      TakeAtResponse(byte);
      CountBody(byte);
      break;
    case State::Receive64:
      TakeReceive64(byte);
      CountBody(byte);
      break;
    case State::ModemStatus:
    case State::TransmitStatus:
    case State::Receive16:
      CountBody(byte);
      break;
    case State::Checksum:
      return TakeChecksum(byte);
  }
  return 0;
}

void XBeeFrameParser::BeginFrame() {
  frameLength_ = 0;
  lengthBytes_ = 0;
  state_ = State::Length;
}

void XBeeFrameParser::TakeLength(std::uint8_t byte) {
  frameLength_ = frameLength_ * 256 + byte;
  if (++lengthBytes_ == 2) {
    position_ = 0;
    sum_ = 0;
    state_ = State::Identifier;
  }
}

void XBeeFrameParser::TakeIdentifier(std::uint8_t byte) {
  frameType_ = byte;
  sum_ += byte;
  ++position_;
  switch (byte) {
    case XBeeApi::ModemStatus:
      state_ = State::ModemStatus;
      break;
    case XBeeApi::TransmitStatus:
      state_ = State::TransmitStatus;
      break;
    case XBeeApi::AtResponse:
      frame_.AtDataLength = 0;
      state_ = State::AtResponse;
      break;
    case XBeeApi::Receive64:
      frame_.SourceAddress.fill(0);
      frame_.DataLength = 0;
      state_ = State::Receive64;
      break;
    case XBeeApi::Receive16:
      state_ = State::Receive16;
      break;
    case FrameStart:
      BeginFrame();
      break;
    default:
      state_ = State::Start;
  }
}

void XBeeFrameParser::TakeAtResponse(std::uint8_t byte) {
  switch (position_) {
    case 1:
      frame_.AtFrameId = byte;
      break;
    case 2:
    case 3:
      frame_.AtCommand[position_ - 2] = byte;
      break;
    case 4:
      frame_.AtStatus = byte;
      break;
    default:
      Append(frame_.AtData, frame_.AtDataLength, byte);
  }
}

void XBeeFrameParser::TakeReceive64(std::uint8_t byte) {
  constexpr std::uint32_t addressEnd = 8;
  if (position_ > addressEnd + 2) {
    Append(frame_.Data, frame_.DataLength, byte);
  } else if (position_ <= addressEnd) {
    frame_.SourceAddress[addressEnd - position_] = byte;
  } else if (position_ == addressEnd + 1) {
    frame_.Rssi = byte;
  } else {
    frame_.Options = byte;
  }
}

// The length is compared only after the identifier: a body of 0 or 1 bytes never ends.
void XBeeFrameParser::CountBody(std::uint8_t byte) {
  sum_ += byte;
  ++position_;
  if (position_ == frameLength_) {
    state_ = State::Checksum;
  }
}

std::uint8_t XBeeFrameParser::TakeChecksum(std::uint8_t byte) {
  sum_ = (sum_ + byte) & 255;
  state_ = State::Start;
  if (sum_ == 255) {
    return frameType_;
  }
  if (byte == FrameStart) {
    BeginFrame();
  }
  return 0;
}

template <std::size_t Size>
void XBeeFrameParser::Append(std::array<std::uint8_t, Size>& data, std::uint8_t& length, std::uint8_t byte) {
  if (length == Size) {
    state_ = State::Start;
    throw RuntimeError(Fault::SubscriptOutOfRange);
  }
  data[length] = byte;
  ++length;
}
