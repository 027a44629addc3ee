#include "sim/onewire/Ds2480b.h"

#include <utility>

namespace sim {
namespace {

constexpr std::uint8_t DataMode = 0xE1;
constexpr std::uint8_t CommandMode = 0xE3;
constexpr std::uint8_t EndOfPulse = 0xF1;

// Commands that cause bus cycles are 1ffp ss?1: function f, polarity or parameter p, speed s.
constexpr unsigned FunctionMask = 0xE1;
constexpr unsigned SingleBitFunction = 0x81;
constexpr unsigned SearchAcceleratorFunction = 0xA1;
constexpr unsigned ResetFunction = 0xC1;
constexpr unsigned PolarityBit = 0x10;
constexpr unsigned PullUpBit = 0x02;
constexpr unsigned PulseMask = 0xED;
constexpr unsigned PulseFunction = 0xED;

constexpr std::size_t ProgrammingPulse = 2;
constexpr std::size_t StrongPullUp = 3;
constexpr std::size_t BaudRate = 7;
constexpr std::uint8_t Endless = 7;

}  // namespace

std::optional<std::uint8_t> Ds2480b::Receive(std::uint8_t byte) {
  if (!calibrated_) {
    calibrated_ = true;
    return std::nullopt;
  }
  if (endlessPulse_) {
    return byte == EndOfPulse ? std::exchange(endlessPulse_, std::nullopt) : std::nullopt;
  }
  switch (mode_) {
    case Mode::Command:
      break;
    case Mode::Data:
      if (byte == CommandMode) {
        mode_ = Mode::Check;
        return std::nullopt;
      }
      return Pass(byte);
    case Mode::Check:
      if (byte == CommandMode) {
        mode_ = Mode::Data;
        return Pass(byte);
      }
      mode_ = Mode::Command;
      break;
  }
  return Obey(byte);
}

int Ds2480b::Baud() const {
  constexpr std::array<int, 4> rates{9600, 19200, 57600, 115200};
  return rates[parameters_[BaudRate] % rates.size()];
}

std::optional<std::uint8_t> Ds2480b::Obey(std::uint8_t command) {
  if ((command & 0x81U) == 0x01) {
    return Configure(command);
  }
  if (command == DataMode) {
    mode_ = Mode::Data;
  } else if ((command & PulseMask) == PulseFunction) {
    return Pulse(command);
  } else if ((command & FunctionMask) == SingleBitFunction) {
    return SingleBit(command);
  } else if ((command & FunctionMask) == SearchAcceleratorFunction) {
    accelerating_ = (command & PolarityBit) != 0;
    searchFailed_ = false;
  } else if ((command & FunctionMask) == ResetFunction) {
    return Reset(command);
  }
  return std::nullopt;
}

// 0pppvvv1 sets parameter p to the value v; 0000ppp1 reads the value of p.
std::uint8_t Ds2480b::Configure(std::uint8_t command) {
  const std::size_t parameter = command >> 4U & 7U;
  const std::uint8_t value = command >> 1U & 7U;
  if (parameter == 0) {
    return static_cast<std::uint8_t>(parameters_[value] << 1U);
  }
  parameters_[parameter] = value;
  return command & 0xFEU;
}

std::uint8_t Ds2480b::Reset(std::uint8_t command) {
  constexpr unsigned chipVersion = 3;
  unsigned found = 3;
  switch (bus_.Reset()) {
    case OneWireBus::Presence::Shorted:
      found = 0;
      break;
    case OneWireBus::Presence::Present:
      found = 1;
      break;
    case OneWireBus::Presence::Absent:
      break;
  }
  return static_cast<std::uint8_t>((command & 0xE0U) | chipVersion << 2U | found);
}

std::uint8_t Ds2480b::SingleBit(std::uint8_t command) {
  const bool heard = bus_.Slot((command & PolarityBit) != 0);
  if ((command & PullUpBit) != 0) {
    PullUp();
  }
  return static_cast<std::uint8_t>((command & 0xFCU) | (heard ? 3U : 0U));
}

std::optional<std::uint8_t> Ds2480b::Pulse(std::uint8_t command) {
  const bool programs = (command & PolarityBit) != 0;
  const std::uint8_t answer = command & 0xFCU;
  if (!programs) {
    pullUpArmed_ = (command & PullUpBit) != 0;
  }
  if (parameters_[programs ? ProgrammingPulse : StrongPullUp] == Endless) {
    endlessPulse_ = answer;
    return std::nullopt;
  }
  return answer;
}

std::uint8_t Ds2480b::Pass(std::uint8_t data) {
  if (accelerating_) {
    return PassSearch(data);
  }
  unsigned heard = 0;
  for (unsigned bit = 0; bit < 8; ++bit) {
    heard |= (bus_.Slot((data >> bit & 1U) != 0) ? 1U : 0U) << bit;
  }
  if (pullUpArmed_) {
    PullUp();
  }
  return static_cast<std::uint8_t>(heard);
}

// Four ROM bits. The host sends the direction wanted for each in the odd bits; the answer has the direction
// taken in the odd bits and, in the even ones, whether there was a conflict or no response at all.
std::uint8_t Ds2480b::PassSearch(std::uint8_t directions) {
  unsigned answer = 0;
  for (unsigned place = 0; place < 8; place += 2) {
    const bool bit = bus_.Slot(true);
    const bool complement = bus_.Slot(true);
    searchFailed_ = searchFailed_ || (bit && complement);
    const bool conflict = !bit && !complement;
    const bool taken = searchFailed_ || (conflict ? (directions >> (place + 1) & 1U) != 0 : bit);
    bus_.Slot(taken);
    answer |= (conflict || searchFailed_ ? 1U : 0U) << place | (taken ? 2U : 0U) << place;
  }
  return static_cast<std::uint8_t>(answer);
}

// Follows a bit or byte, which is answered anyway; only an endless pull-up has an answer of its own.
void Ds2480b::PullUp() {
  if (parameters_[StrongPullUp] == Endless) {
    endlessPulse_ = static_cast<std::uint8_t>(PulseFunction & 0xFCU);
  }
}

}  // namespace sim
