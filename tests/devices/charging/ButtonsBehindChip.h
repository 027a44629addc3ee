#pragma once

#include <deque>
#include <vector>

#include "tests/devices/buttons/ChipModel.h"
#include "tests/devices/charging/MemoryButton.h"

/// Buttons with memory on the bus of an adapter's chip, beside the reader's own device.
class ButtonsBehindChip {
 public:
  static constexpr MemoryButton::Rom ReaderRom = {0x81, 0xE3, 0x10, 0x20, 0x30, 0x00, 0x00, 0x08};

  explicit ButtonsBehindChip(ChipModel& chip) : chip_(chip) {
    chip_.Devices = {ReaderRom};
    chip_.OnReset = [this] {
      romCommand_.clear();
      selecting_ = true;
    };
    chip_.OnFound = [this](const ChipModel::Rom& rom) { Select(rom); };
    chip_.OnByte = [this](std::uint8_t byte) { return Touch(byte); };
  }
  ButtonsBehindChip(const ButtonsBehindChip&) = delete;
  ButtonsBehindChip& operator=(const ButtonsBehindChip&) = delete;

  std::deque<MemoryButton> Buttons;

  MemoryButton& Put(const MemoryButton::Rom& rom) {
    chip_.Devices.push_back(rom);
    return Buttons.emplace_back(rom);
  }

 private:
  void Select(const MemoryButton::Rom& rom) {
    selecting_ = false;
    for (MemoryButton& button : Buttons) {
      button.Select(button.Number == rom);
    }
  }

  std::uint8_t Touch(std::uint8_t byte) {
    constexpr std::uint8_t matchRom = 0x55;
    if (selecting_) {
      romCommand_.push_back(byte);
      if (romCommand_.size() == 9 && romCommand_[0] == matchRom) {
        MemoryButton::Rom rom{};
        std::copy(romCommand_.begin() + 1, romCommand_.end(), rom.begin());
        Select(rom);
      }
      return byte;
    }
    std::uint8_t answer = byte;
    for (MemoryButton& button : Buttons) {
      answer = static_cast<std::uint8_t>(answer & button.Touch(byte));
    }
    return answer;
  }

  ChipModel& chip_;
  bool selecting_ = true;
  std::vector<std::uint8_t> romCommand_;
};
