#pragma once

#include <array>
#include <cstdint>
#include <optional>

#include "sim/onewire/OneWireBus.h"

namespace sim {

/// The DS2480B, the chip in serial 1-Wire adapters, byte by byte as in its data sheet, from power-up on.
/// Timing is not modelled: a bus cycle or a pulse of fixed length is over at once. Every speed counts as the
/// regular one.
class Ds2480b {
 public:
  /// `bus` must outlive the chip.
  explicit Ds2480b(OneWireBus& bus) : bus_(bus) {}

  /// Takes a byte from the host; returns the answer if one is due.
  std::optional<std::uint8_t> Receive(std::uint8_t byte);

  /// Whether the next byte counts as a command (or may be one, after a single 0xE3 in data mode).
  bool ExpectsCommand() const { return mode_ != Mode::Data; }
  /// Bits per second of the host's line from the next answer on.
  int Baud() const;

 private:
  enum class Mode { Command, Data, Check };

  std::optional<std::uint8_t> Obey(std::uint8_t command);
  std::uint8_t Configure(std::uint8_t command);
  std::uint8_t Reset(std::uint8_t command);
  std::uint8_t SingleBit(std::uint8_t command);
  std::optional<std::uint8_t> Pulse(std::uint8_t command);
  std::uint8_t Pass(std::uint8_t data);
  std::uint8_t PassSearch(std::uint8_t directions);
  void PullUp();

  OneWireBus& bus_;
  bool calibrated_ = false;
  Mode mode_ = Mode::Command;
  bool accelerating_ = false;
  bool searchFailed_ = false;
  bool pullUpArmed_ = false;
  std::optional<std::uint8_t> endlessPulse_;  // the answer to it, due when the host ends it
  // By parameter code; the power-up values of pulse lengths and load are 512 us, 524 ms and 3 mA.
  std::array<std::uint8_t, 8> parameters_{0, 0, 4, 4, 0, 0, 4, 0};
};

}  // namespace sim
