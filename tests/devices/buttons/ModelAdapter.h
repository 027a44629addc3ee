#pragma once

#include <cstddef>
#include <cstdint>

#include "tests/devices/buttons/ChipModel.h"
#include "tests/fakes/FakeSerialPort.h"

/// A serial adapter on a line of which one byte can be disturbed.
class ModelAdapter : public ChipModel {
 public:
  explicit ModelAdapter(FakeSerialPort& port)
      : ChipModel([this](std::uint8_t byte) { Answer(byte); }), port_(port) {
    port_.OnOutput = [this](std::uint8_t byte) { Take(Disturbed(sent_++, DisturbSent, byte)); };
  }

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

  FakeSerialPort& port_;
  std::size_t sent_ = 0;
  std::size_t answered_ = 0;
};
