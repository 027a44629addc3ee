#pragma once

#include <algorithm>
#include <cstddef>
#include <deque>
#include <functional>

#include "tests/devices/charging/MemoryButton.h"
#include "tests/fakes/FakeOneWire.h"

/// A reader with its own device on the bus, and buttons with memory that touch it. A selection by number is
/// answered by any device, as on the real bus.
class ButtonBus : public FakeOneWire {
 public:
  static constexpr Rom ReaderRom = {0x81, 0xE3, 0x10, 0x20, 0x30, 0x00, 0x00, 0x08};

  ButtonBus() {
    Devices = {ReaderRom};
    OnByte = [this](std::uint8_t byte) { return Touch(byte); };
  }

  /// All buttons, at the reader or not.
  std::deque<MemoryButton> Buttons;

  /// The adapter was pulled out: operations fail, and no session can be started.
  bool Lost = false;

  /// So many selections fail.
  int FailingAccesses = 0;

  /// Called before each byte that goes over the bus, counted from 0.
  std::function<void(std::size_t)> BeforeByte = [](std::size_t) {};

  /// Bits that change in the answer to a byte, by its place.
  std::function<std::uint8_t(std::size_t)> Disturbance = [](std::size_t) { return std::uint8_t{0}; };

  std::size_t Bytes = 0;  ///< that went over the bus

  void Put(MemoryButton& button) {
    button.Present = true;
    Devices.insert(Devices.begin(), button.Number);
  }

  void TakeAway(MemoryButton& button) {
    button.Present = false;
    std::erase(Devices, button.Number);
  }

  std::int32_t TMExtendedStartSession(std::int16_t port, std::int16_t type, std::int32_t reserved) override {
    const std::int32_t handle = FakeOneWire::TMExtendedStartSession(port, type, reserved);
    return Lost ? 0 : handle;
  }

  std::int16_t TMNext(std::int32_t handle, OneWireState& state) override {
    if (Lost) {
      NextResults = {BadRead};
    }
    return FakeOneWire::TMNext(handle, state);
  }

  std::int16_t TMAccess(std::int32_t handle, OneWireState& state) override {
    FakeOneWire::TMAccess(handle, state);
    for (MemoryButton& button : Buttons) {
      button.Select(button.Number == state.Rom);
    }
    if (FailingAccesses > 0) {
      --FailingAccesses;
      return 0;
    }
    return !Lost && SessionOpen() && !Devices.empty() ? 1 : 0;
  }

  std::int16_t TMBlockStream(std::int32_t handle, std::span<std::uint8_t> bytes) override {
    for (std::uint8_t& byte : bytes) {
      if (Lost) {
        return 0;
      }
      byte = OnByte(byte);
    }
    return SessionOpen() && handle == Handle ? 1 : 0;
  }

 private:
  std::uint8_t Touch(std::uint8_t byte) {
    const std::size_t place = Bytes++;
    BeforeByte(place);
    std::uint8_t answer = byte;
    for (MemoryButton& button : Buttons) {
      answer = static_cast<std::uint8_t>(answer & button.Touch(byte));
    }
    return static_cast<std::uint8_t>(answer ^ Disturbance(place));
  }
};
