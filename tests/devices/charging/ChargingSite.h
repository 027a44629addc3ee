#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <string>
#include <vector>

#include "devices/charging/ButtonCharger.h"
#include "tests/devices/charging/ButtonBus.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeMessageBoxes.h"

/// Records what the charging shows.
class FakeChargingDisplay : public ChargingDisplay {
 public:
  std::string Status;
  bool Reader = true;
  int Begun = 0;
  int Left = 0;
  bool IsClosing = false;
  std::vector<ChargedButton> Notes;

  void SetStatus(const std::string& text) override { Status = text; }
  void BeginButton() override { ++Begun; }
  void ButtonsLeft() override { ++Left; }
  void SetReader(bool present) override { Reader = present; }
  void Note(const ChargedButton& button) override { Notes.push_back(button); }
  bool Closing() const override { return IsClosing; }
};

inline ChargeBlock BlockOf(const MemoryButton& button) {
  ChargeBlock block{};
  std::copy(button.Memory.begin() + 32, button.Memory.end(), block.begin());
  return block;
}

/// Gives a button this kind, charge and third byte, others that differ from button to button, and the right
/// check byte.
inline void Fill(MemoryButton& button, const std::vector<std::uint8_t>& start) {
  for (std::size_t i = 0; i < 31; ++i) {
    button.Memory[32 + i] = i < start.size() ? start[i] : static_cast<std::uint8_t>(7 * i + button.Number[1]);
  }
  button.Memory[63] = CheckByteOf(BlockOf(button));
}

/// The charging on a bus.
class ChargingSite : public testing::Test {
 protected:
  static FakeMessageBoxes::Box RecoveryQuestion() {
    return {"Was this an Ammo Mag iButton?", "iButton Invalid - Recovering", BoxIcon::Exclamation,
            BoxButtons::YesNo};
  }
  static FakeMessageBoxes::Box DriverError() {
    return {"Error loading button driver", "Button Error", BoxIcon::None};
  }

  /// A new button, not yet at the reader.
  MemoryButton& NewButton(const std::vector<std::uint8_t>& start) {
    const auto serial = static_cast<std::uint8_t>(bus.Buttons.size() + 1);
    bus.Buttons.emplace_back(
        MemoryButton::Rom{0x0C, serial, 0, 0, 0, 0, 0, static_cast<std::uint8_t>(0xA0 + serial)});
    Fill(bus.Buttons.back(), start);
    return bus.Buttons.back();
  }

  /// The same, touched to the reader.
  MemoryButton& TouchedButton(const std::vector<std::uint8_t>& start) {
    MemoryButton& button = NewButton(start);
    bus.Put(button);
    return button;
  }

  void Ticks(int count) {
    for (int i = 0; i < count; ++i) {
      charger.Tick();
    }
  }

  /// Ticks until the walk has been at the end of the bus.
  void Pass() { Ticks(static_cast<int>(bus.Devices.size()) + 1); }

  /// Takes a button away and lets a pass without it go by: the next tick meets the first device.
  void Leave(MemoryButton& button) {
    bus.TakeAway(button);
    bus.NextResults = {OneWire::EndOfBus};
    Ticks(1);
    Pass();
  }

  auto Count(const std::string& operation) const {
    return std::count(bus.Log.begin(), bus.Log.end(), operation);
  }

  std::vector<ChargeResult> Results() const {
    std::vector<ChargeResult> results;
    for (const ChargedButton& note : display.Notes) {
      results.push_back(note.Result);
    }
    return results;
  }

  ButtonBus bus;
  FakeEventPump events;
  FakeMessageBoxes boxes;
  FakeClock clock;
  FakeChargingDisplay display;
  ButtonCharger charger{{.Wire = bus, .Events = events, .Boxes = boxes, .Time = clock, .Display = display}};
};
