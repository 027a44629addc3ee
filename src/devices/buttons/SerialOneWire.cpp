#include "devices/buttons/SerialOneWire.h"

#include <algorithm>
#include <limits>

#include "core/line/EnumPorts.h"
#include "core/text/NumberForms.h"
#include "platform/RuntimeError.h"

namespace {

constexpr const char* LineSettings = "9600,N,8,1";
constexpr std::uint8_t MatchRom = 0x55;
constexpr std::uint8_t IdleBus = 0xFF;

/// Runs an operation on the line; if the line is lost meanwhile, the operation has failed.
template <typename Operation>
bool Succeeds(Operation&& operation) {
  try {
    return operation();
  } catch (const RuntimeError&) {
    return false;
  }
}

std::int16_t ResultOf(bool done) {
  return done ? 1 : 0;
}

}  // namespace

std::int16_t SerialOneWire::TMReadDefaultPort(std::int16_t& port, std::int16_t& type) {
  const auto namedPort = NumberOfDigits(ini_.ReadIni(Keys::ReaderPort));
  const auto namedType = NumberOfDigits(ini_.ReadIni(Keys::ReaderType));
  if (!namedPort || *namedPort == 0 || !namedType) {
    return 0;
  }
  port = *namedPort;
  type = *namedType;
  return 1;
}

std::int32_t SerialOneWire::TMExtendedStartSession(std::int16_t port, std::int16_t type,
                                                   std::int32_t /*reserved*/) {
  if (chip_ || type != SerialAdapter) {
    return 0;
  }
  const std::string device = EnumPorts(ini_, devices_).DeviceOf(port);
  chip_.emplace(port_, events_);
  const bool found = !device.empty() && Succeeds([&] {
    port_.Open(device, LineSettings);
    return chip_->Detect();
  });
  if (!found) {
    chip_.reset();
    port_.Close();
    return 0;
  }
  handle_ = handle_ % std::numeric_limits<std::int32_t>::max() + 1;
  return handle_;
}

std::int16_t SerialOneWire::TMSetup(std::int32_t handle) {
  return ResultOf(IsOpen(handle));
}

std::int16_t SerialOneWire::TMNext(std::int32_t handle, OneWireState& state) {
  if (!IsOpen(handle)) {
    return BadRead;
  }
  const bool behindTheLast = state.Found && state.Branch == OneWireState::None;
  std::int16_t result = BadRead;
  Succeeds([&] {
    result = behindTheLast ? ConfirmEnd(state) : FindNext(state);
    return true;
  });
  if (result != DeviceFound) {
    state = {};
  }
  return result;
}

std::int16_t SerialOneWire::FindNext(OneWireState& state) {
  switch (chip_->Reset()) {
    case Presence::Devices:
      break;
    case Presence::None:
      // In the middle of a walk there were devices a moment ago, so the end was not reached but missed.
      return chip_->Answers() && !state.Found ? EndOfBus : BadRead;
    case Presence::Shorted:  // as a button does while it is pressed on
      return BadRead;
  }
  const auto answer = chip_->Search(PathToNext(state));
  return answer && TakeFound(*answer, state) ? DeviceFound : BadRead;
}

// The bits of a search that tell of devices left have no check byte: one that got lost would end the walk
// early, and who counts devices would take a resting button for gone. So the last device is asked for once
// more.
std::int16_t SerialOneWire::ConfirmEnd(const OneWireState& last) {
  switch (chip_->Reset()) {
    case Presence::Devices:
      break;
    case Presence::None:
      return chip_->Answers() ? EndOfBus : BadRead;
    case Presence::Shorted:
      return BadRead;
  }
  const auto answer = chip_->Search(PathTo(last.Rom));
  return answer && IsLast(*answer) ? EndOfBus : BadRead;
}

std::int16_t SerialOneWire::TMRom(std::int32_t handle, OneWireState& state, OneWireRom& rom) {
  if (!IsOpen(handle) || rom[0] != 0) {
    return 0;
  }
  std::copy(state.Rom.begin(), state.Rom.end(), rom.begin());
  return 1;
}

std::int16_t SerialOneWire::TMAccess(std::int32_t handle, OneWireState& state) {
  return ResultOf(IsOpen(handle) && state.Found && Succeeds([&] { return Select(state); }));
}

bool SerialOneWire::Select(const OneWireState& state) {
  if (chip_->Reset() != Presence::Devices) {
    return false;
  }
  std::array<std::uint8_t, 9> command{MatchRom};
  std::copy(state.Rom.begin(), state.Rom.end(), command.begin() + 1);
  auto answer = command;
  return chip_->Exchange(answer) && answer == command;
}

std::int16_t SerialOneWire::TMTouchByte(std::int32_t handle, std::uint8_t byte) {
  std::array<std::uint8_t, 1> bytes{byte};
  return TMBlockStream(handle, bytes) == 1 ? bytes[0] : IdleBus;
}

std::int16_t SerialOneWire::TMBlockStream(std::int32_t handle, std::span<std::uint8_t> bytes) {
  return ResultOf(IsOpen(handle) && Succeeds([&] { return chip_->Exchange(bytes); }));
}

std::int16_t SerialOneWire::TMEndSession(std::int32_t handle) {
  if (!IsOpen(handle)) {
    return 0;
  }
  Succeeds([&] {
    chip_->Rest();
    return true;
  });
  chip_.reset();
  port_.Close();
  return 1;
}
