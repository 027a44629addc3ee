#pragma once

#include <algorithm>
#include <deque>
#include <functional>
#include <optional>
#include <string>
#include <tuple>
#include <utility>
#include <vector>

#include "platform/OneWire.h"
#include "platform/RuntimeError.h"

/// A bus to which the test adds devices and from which it removes them.
class FakeOneWire : public OneWire {
 public:
  using Rom = std::array<std::uint8_t, 8>;

  /// All operations in order, with their arguments: "TMExtendedStartSession 1 5", "TMNext", ...
  std::vector<std::string> Log;

  /// Port and adapter type in the settings; if empty, TMReadDefaultPort fails.
  std::optional<std::pair<std::int16_t, std::int16_t>> DefaultPort;

  /// Handle that a session gets; if it is 0 or below, none can be opened.
  std::int32_t Handle = 7;

  /// Devices on the bus in the order in which a walk finds them.
  std::vector<Rom> Devices;

  /// Results of the next calls of TMNext, in order, instead of a device: BadRead, mostly.
  std::deque<std::int16_t> NextResults;

  /// Name of the operation that throws.
  std::string Broken;

  /// Called at the start of each operation, with its name; may add a device.
  std::function<void(const std::string&)> OnCall;

  /// What the bus answers to a byte; by default the same.
  std::function<std::uint8_t(std::uint8_t)> OnByte = [](std::uint8_t byte) { return byte; };

  bool SessionOpen() const { return open_; }

  std::int16_t TMReadDefaultPort(std::int16_t& port, std::int16_t& type) override {
    Begin("TMReadDefaultPort");
    if (!DefaultPort) {
      return 0;
    }
    std::tie(port, type) = *DefaultPort;
    return 1;
  }

  std::int32_t TMExtendedStartSession(std::int16_t port, std::int16_t type, std::int32_t reserved) override {
    Begin("TMExtendedStartSession",
          ' ' + std::to_string(port) + ' ' + std::to_string(type) + (reserved == 0 ? "" : " reserved"));
    open_ = Handle > 0;
    return Handle;
  }

  std::int16_t TMSetup(std::int32_t handle) override {
    Begin("TMSetup");
    return IsOpen(handle);
  }

  /// Counts the devices of the walk in `Branch`.
  std::int16_t TMNext(std::int32_t handle, OneWireState& state) override {
    Begin("TMNext");
    if (!NextResults.empty()) {
      const std::int16_t result = NextResults.front();
      NextResults.pop_front();
      state = {};
      return result;
    }
    if (!open_ || handle != Handle) {
      state = {};
      return BadRead;
    }
    const auto next = static_cast<std::size_t>(state.Branch - OneWireState::None);
    if (next >= Devices.size()) {
      state = {};
      return 0;
    }
    state.Found = true;
    state.Rom = Devices[next];
    ++state.Branch;
    return 1;
  }

  std::int16_t TMRom(std::int32_t handle, OneWireState& state, OneWireRom& rom) override {
    Begin("TMRom", rom[0] == 0 ? "" : " write");
    std::copy(state.Rom.begin(), state.Rom.end(), rom.begin());
    return IsOpen(handle);
  }

  std::int16_t TMAccess(std::int32_t handle, OneWireState& state) override {
    Begin("TMAccess");
    const bool there = std::find(Devices.begin(), Devices.end(), state.Rom) != Devices.end();
    return there ? IsOpen(handle) : std::int16_t{0};
  }

  std::int16_t TMTouchByte(std::int32_t handle, std::uint8_t byte) override {
    Begin("TMTouchByte", ' ' + std::to_string(byte));
    return IsOpen(handle) == 1 ? OnByte(byte) : std::int16_t{255};
  }

  std::int16_t TMBlockStream(std::int32_t handle, std::span<std::uint8_t> bytes) override {
    Begin("TMBlockStream", ' ' + std::to_string(bytes.size()));
    for (std::uint8_t& byte : bytes) {
      byte = OnByte(byte);
    }
    return IsOpen(handle);
  }

  std::int16_t TMEndSession(std::int32_t handle) override {
    Begin("TMEndSession");
    const std::int16_t result = IsOpen(handle);
    open_ = false;
    return result;
  }

 private:
  void Begin(const std::string& operation, const std::string& details = {}) {
    Log.push_back(operation + details);
    if (const auto onCall = OnCall) {
      onCall(operation);
    }
    if (operation == Broken) {
      throw RuntimeError(Fault::FileNotFound);
    }
  }

  std::int16_t IsOpen(std::int32_t handle) const { return open_ && handle == Handle ? 1 : 0; }

  bool open_ = false;
};
