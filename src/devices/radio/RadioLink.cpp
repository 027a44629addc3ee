#include "devices/radio/RadioLink.h"

#include <chrono>
#include <utility>

using std::chrono::milliseconds;

namespace {

constexpr milliseconds LongWait{2000};
constexpr milliseconds ShortWait{12};

}  // namespace

RadioLink::RadioLink(SerialPort& port, CommPort& commPort, EventPump& events, std::function<bool()> stopped)
    : commPort_(commPort), events_(events), job_(port, events, "radio-modem", std::move(stopped)) {}

void RadioLink::OpenXBeePort() {
  parser_ = {};
  job_.Close();
  receivedFrameType_ = 0;
  try {
    job_.Open(commPort_.Device(), LineSettings);
  } catch (const RuntimeError&) {
    return;  // the first byte sent on the closed line fails instead
  }
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
    if (!job_.Send(byte)) {
      return;
    }
    ++bytesSent_;
    events_.DoEvents();
  }
}

bool RadioLink::WaitForFrame(bool longWait) {
  receivedFrameType_ = 0;
  return job_.WaitUntil([this] { return TakeFrame(); }, longWait ? LongWait : ShortWait) == LineWait::Met;
}

bool RadioLink::TakeFrame() {
  receivedFrameType_ = 0;
  while (receivedFrameType_ == 0) {
    const auto byte = job_.Take();
    if (!byte) {
      return false;
    }
    receivedFrameType_ = parser_.Receive(*byte);
  }
  return true;
}

void RadioLink::ThrowIfLineLost() const {
  if (job_.Fault() && !job_.Stopped()) {
    throw RuntimeError(job_.Fault()->Error);
  }
}
