#pragma once

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <utility>
#include <vector>

/// The chip of a serial adapter with some devices on its bus, written from its data sheet: reset, data bytes,
/// and the search with its accelerator.
class ChipModel {
 public:
  using Rom = std::array<std::uint8_t, 8>;

  /// `answer` puts a byte on the line.
  explicit ChipModel(std::function<void(std::uint8_t)> answer) : answer_(std::move(answer)) {}

  std::vector<Rom> Devices;

  // What happens on the bus. A data byte is answered by what the bus reads meanwhile.
  std::function<void()> OnReset = [] {};
  std::function<std::uint8_t(std::uint8_t)> OnByte = [](std::uint8_t byte) { return byte; };
  std::function<void(const Rom&)> OnFound = [](const Rom&) {};

  /// Takes a byte from the line. The one that ends data mode is a data byte when it comes twice.
  void Take(std::uint8_t byte) {
    if (byte == CommandMode && inDataMode_) {
      inDataMode_ = false;
      mayBeData_ = true;
    } else if (byte == CommandMode && mayBeData_) {
      mayBeData_ = false;
      inDataMode_ = true;
      TakeData(byte);
    } else if (inDataMode_) {
      TakeData(byte);
    } else {
      mayBeData_ = false;
      TakeCommand(byte);
    }
  }

 private:
  static constexpr std::uint8_t CommandMode = 0xE3;

  void TakeCommand(std::uint8_t byte) {
    if (byte == 0xE1) {
      inDataMode_ = true;
    } else if (byte == 0xC1) {
      OnReset();
      answer_(Devices.empty() ? 0xCF : 0xCD);
    } else if (byte == 0xB1 || byte == 0xA1) {
      accelerated_ = byte == 0xB1;
      path_.clear();
    }
  }

  void TakeData(std::uint8_t byte) {
    if (!accelerated_) {
      answer_(OnByte(byte));
      return;
    }
    path_.push_back(byte);
    if (path_.size() == 16) {
      Search();
      path_.clear();
    }
  }

  void Search() {
    std::vector<Rom> left = Devices;
    std::array<std::uint8_t, 16> answer{};
    for (std::size_t bit = 0; bit < 64; ++bit) {
      const auto isOne = [bit](const Rom& rom) { return (rom[bit / 8] >> (bit % 8) & 1) != 0; };
      const auto ones = std::count_if(left.begin(), left.end(), isOne);
      const bool differ = left.empty() || (ones > 0 && ones < static_cast<std::ptrdiff_t>(left.size()));
      const std::size_t shift = bit % 4 * 2;
      const bool asked = (path_[bit / 4] >> (shift + 1) & 1) != 0;
      const bool taken = left.empty() || (differ ? asked : ones > 0);
      answer[bit / 4] |= static_cast<std::uint8_t>(((taken ? 2U : 0U) | (differ ? 1U : 0U)) << shift);
      std::erase_if(left, [&](const Rom& rom) { return isOne(rom) != taken; });
    }
    if (!left.empty()) {
      OnFound(left.front());
    }
    for (const std::uint8_t byte : answer) {
      answer_(byte);
    }
  }

  bool inDataMode_ = false;
  bool mayBeData_ = false;  ///< the last byte ended data mode
  bool accelerated_ = false;
  std::vector<std::uint8_t> path_;
  std::function<void(std::uint8_t)> answer_;
};
