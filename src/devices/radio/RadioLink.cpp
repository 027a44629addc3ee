#include "devices/radio/RadioLink.h"

#include <chrono>
#include <utility>

using std::chrono::milliseconds;

namespace {

constexpr milliseconds LongWait{2000};
constexpr milliseconds ShortWait{12};

}  // namespace

RadioLink::RadioLink(SerialPort& port, CommPort& commPort, EventPump& events, std::function<bool()> stopped)
    : port_(port), commPort_(commPort), events_(events), stopped_(std::move(stopped)) {}

RadioLink::~RadioLink() {
  XBee_CloseCommPort();
}

void RadioLink::OpenXBeePort() {
  parser_ = {};
  commPort_.CloseIfOpen();
  receivedFrameType_ = 0;
  try {
    commPort_.Open(LineSettings);
  } catch (const RuntimeError&) {
    return;  // a closed line has its own fault, at the first byte
  }
}

void RadioLink::XBee_CloseCommPort() {
  commPort_.CloseIfOpen();
}

void RadioLink::SendGunPacket(std::uint8_t playerId, const XBeeAddress& address, std::uint8_t byte2,
                              std::uint8_t byte3, std::uint8_t packetType,
                              std::span<const std::uint8_t> payload) {
  Send(TransmitRequest(address, MakeGunPacket(playerId, byte2, byte3, packetType, payload)));
}

void RadioLink::SendAtCommand(std::uint8_t frameId, const AtLetters& letters,
                              std::span<const std::uint8_t> value) {
  Send(AtCommandFrame(frameId, letters, value));
}

void RadioLink::Send(std::span<const std::uint8_t> frame) {
  receivedFrameType_ = 0;
  for (const std::uint8_t byte : frame) {
    if (Stopped()) {
      return;
    }
    try {
      port_.Output(byte);
    } catch (const RuntimeError& fault) {
      lineFault_ = fault;
      return;
    }
    ++bytesSent_;
    events_.DoEvents();
  }
}

bool RadioLink::WaitForFrame(bool longWait) {
  const WaitResult result =
      events_.WaitFor([this] { return TakeFrame() || Stopped(); }, longWait ? LongWait : ShortWait);
  programCloses_ |= result == WaitResult::Ended;
  return receivedFrameType_ != 0;
}

bool RadioLink::TakeFrame() {
  receivedFrameType_ = 0;
  while (receivedFrameType_ == 0) {
    const auto byte = NextByte();
    if (!byte) {
      return false;
    }
    receivedFrameType_ = parser_.Receive(*byte);
  }
  return true;
}

std::optional<std::uint8_t> RadioLink::NextByte() {
  if (Stopped()) {
    return std::nullopt;
  }
  try {
    return port_.InBufferCount() >= 1 ? std::optional(port_.Input()) : std::nullopt;
  } catch (const RuntimeError& fault) {
    lineFault_ = fault;
    return std::nullopt;
  }
}

bool RadioLink::Stopped() const {
  return programCloses_ || lineFault_ || stopped_();
}

void RadioLink::ThrowIfLineLost() const {
  if (lineFault_ && !programCloses_ && !stopped_()) {
    throw RuntimeError(*lineFault_);
  }
}
