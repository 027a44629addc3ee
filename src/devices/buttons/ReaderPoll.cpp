#include "devices/buttons/ReaderPoll.h"

#include <algorithm>

bool ReaderPoll::Begin() {
  if (wire_.TMReadDefaultPort(portNum_, portType_) < 1) {
    portNum_ = 1;
    portType_ = 5;
  }
  sessionHandle_ = wire_.TMExtendedStartSession(portNum_, portType_);
  if (sessionHandle_ <= 0) {
    return false;
  }
  if (!setupDone_) {
    wire_.TMSetup(sessionHandle_);
    setupDone_ = true;
  }
  return true;
}

BusStep ReaderPoll::Next() {
  switch (wire_.TMNext(sessionHandle_, stateBuffer_)) {
    case OneWire::DeviceFound:
      return BusStep::Device;
    case OneWire::EndOfBus:
      return BusStep::End;
    default:
      return BusStep::BadRead;
  }
}

std::array<std::uint8_t, 8> ReaderPoll::Rom() {
  OneWireRom elements{};
  wire_.TMRom(sessionHandle_, stateBuffer_, elements);
  std::array<std::uint8_t, 8> rom{};
  std::transform(elements.begin(), elements.end(), rom.begin(),
                 [](std::int16_t element) { return static_cast<std::uint8_t>(element); });
  return rom;
}

void ReaderPoll::End() {
  wire_.TMEndSession(sessionHandle_);
}
