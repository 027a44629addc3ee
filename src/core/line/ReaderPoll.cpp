#include "core/line/ReaderPoll.h"

#include <algorithm>
#include <exception>

namespace {

/// More devices than any reader holds: a driver that finds ever more of them is at fault.
constexpr int MostDevices = 64;

}  // namespace

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

ReaderPoll::RomNumber ReaderPoll::Rom() {
  OneWireRom elements{};
  wire_.TMRom(sessionHandle_, stateBuffer_, elements);
  RomNumber rom{};
  std::transform(elements.begin(), elements.end(), rom.begin(),
                 [](std::int16_t element) { return static_cast<std::uint8_t>(element); });
  return rom;
}

bool ReaderPoll::Access() {
  return wire_.TMAccess(sessionHandle_, stateBuffer_) == 1;
}

bool ReaderPoll::Exchange(std::span<std::uint8_t> bytes) {
  return wire_.TMBlockStream(sessionHandle_, bytes) == 1;
}

bool ReaderPoll::IsOnBus(const RomNumber& rom) {
  OneWireState walk;
  for (int devices = 0; devices < MostDevices; ++devices) {
    if (wire_.TMNext(sessionHandle_, walk) != OneWire::DeviceFound) {
      return false;
    }
    if (walk.Rom == rom) {
      return true;
    }
  }
  return false;
}

void ReaderPoll::End() {
  wire_.TMEndSession(sessionHandle_);
}

void ReaderPoll::EndFailed() {
  try {
    End();
  } catch (const std::exception&) {
    // The same failure again, which the caller reports.
    return;
  }
}
