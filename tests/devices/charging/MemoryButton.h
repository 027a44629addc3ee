#pragma once

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

/// A button with memory and scratchpad, written from the data sheets of its kind: what it does with the bytes
/// that come after it was selected. Lines that nobody pulls low read as ones.
class MemoryButton {
 public:
  using Rom = std::array<std::uint8_t, 8>;

  explicit MemoryButton(const Rom& rom) : Number(rom) {}

  Rom Number;
  std::array<std::uint8_t, 64> Memory{};
  bool Present = true;
  bool Protected = false;  ///< copies are refused
  std::size_t Copies = 0;

  /// A reset of the bus, after which it is selected or not.
  void Select(bool selected) {
    selected_ = selected && Present;
    taken_.clear();
  }

  /// Takes a byte from the bus and returns what it puts there.
  std::uint8_t Touch(std::uint8_t byte) {
    constexpr std::uint8_t idle = 0xFF;
    if (!Present) {
      selected_ = false;
    }
    if (!selected_) {
      return idle;
    }
    taken_.push_back(byte);
    switch (taken_.front()) {
      case 0xF0:
        return taken_.size() <= 3 ? idle : Read(Address() + taken_.size() - 4);
      case 0x0F:
        Write();
        return idle;
      case 0xAA:
        return taken_.size() == 1 ? idle : Status(taken_.size() - 2);
      case 0x55:
        Copy();
        return idle;
      default:
        return idle;
    }
  }

 private:
  std::size_t Address() const { return taken_[1] + 256U * taken_[2]; }

  std::uint8_t Read(std::size_t address) const { return address < Memory.size() ? Memory[address] : 0xFF; }

  std::uint8_t Status(std::size_t place) const {
    const std::uint8_t bytes[] = {static_cast<std::uint8_t>(target_), 0, 0x1F};
    return place < std::size(bytes) ? bytes[place] : scratchpad_[(place - std::size(bytes)) % 32];
  }

  void Write() {
    if (taken_.size() == 3) {
      target_ = Address();
    } else if (taken_.size() > 3 && taken_.size() <= 35) {
      scratchpad_[taken_.size() - 4] = taken_.back();
    }
  }

  void Copy() {
    const std::vector<std::uint8_t> right = {0x55, static_cast<std::uint8_t>(target_), 0, 0x1F};
    if (taken_ == right && !Protected && target_ + 32 <= Memory.size()) {
      std::copy(scratchpad_.begin(), scratchpad_.end(),
                Memory.begin() + static_cast<std::ptrdiff_t>(target_));
      ++Copies;
    }
  }

  bool selected_ = false;
  std::vector<std::uint8_t> taken_;
  std::size_t target_ = 0;
  std::array<std::uint8_t, 32> scratchpad_{};
};
