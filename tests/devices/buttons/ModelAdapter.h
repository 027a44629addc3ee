#pragma once

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "tests/fakes/FakeSerialPort.h"

/// The chip of a serial adapter with some devices on its bus, written from its data sheet: reset, and the
/// search with its accelerator. One byte on the line can be disturbed.
class ModelAdapter {
 public:
  using Rom = std::array<std::uint8_t, 8>;

  explicit ModelAdapter(FakeSerialPort& port) : port_(port) {
    port_.OnOutput = [this](std::uint8_t byte) { Take(Disturbed(sent_++, DisturbSent, byte)); };
  }

  std::vector<Rom> Devices;
  static constexpr std::size_t Never = SIZE_MAX;
  std::size_t DisturbSent = Never;      ///< this byte of those to the adapter, counted from 0
  std::size_t DisturbAnswered = Never;  ///< this byte of those from it
  std::uint8_t Disturbance = 0;         ///< bits that change

  std::size_t Sent() const { return sent_; }
  std::size_t Answered() const { return answered_; }

 private:
  std::uint8_t Disturbed(std::size_t place, std::size_t disturbedPlace, std::uint8_t byte) const {
    return place == disturbedPlace ? static_cast<std::uint8_t>(byte ^ Disturbance) : byte;
  }

  void Answer(std::uint8_t byte) { port_.Receive({Disturbed(answered_++, DisturbAnswered, byte)}); }

  void Take(std::uint8_t byte) {
    if (byte == 0xE3) {
      inDataMode_ = false;
    } else if (inDataMode_) {
      TakeData(byte);
    } else if (byte == 0xE1) {
      inDataMode_ = true;
    } else if (byte == 0xC1) {
      Answer(Devices.empty() ? 0xCF : 0xCD);
    } else if (byte == 0xB1 || byte == 0xA1) {
      accelerated_ = byte == 0xB1;
      path_.clear();
    }
  }

  void TakeData(std::uint8_t byte) {
    if (!accelerated_) {
      Answer(byte);
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
    for (const std::uint8_t byte : answer) {
      Answer(byte);
    }
  }

  FakeSerialPort& port_;
  std::size_t sent_ = 0;
  std::size_t answered_ = 0;
  bool inDataMode_ = false;
  bool accelerated_ = false;
  std::vector<std::uint8_t> path_;
};
