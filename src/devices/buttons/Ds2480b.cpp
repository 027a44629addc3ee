#include "devices/buttons/Ds2480b.h"

namespace {

constexpr std::uint8_t DataMode = 0xE1;     // not answered
constexpr std::uint8_t CommandMode = 0xE3;  // not answered; sent twice when it is data
constexpr std::uint8_t ResetBus = 0xC1;
constexpr std::uint8_t AcceleratorOn = 0xB1;   // not answered
constexpr std::uint8_t AcceleratorOff = 0xA1;  // not answered
constexpr std::uint8_t SearchRom = 0xF0;       // a command to the devices on the bus

/// The answer to a reset, from the highest bit: 11, one undefined bit, chip version 011, two bits of result.
constexpr std::uint8_t ResetAnswerMask = 0xDC;
constexpr std::uint8_t ResetAnswer = 0xCC;

Presence PresenceOf(std::uint8_t resetAnswer) {
  switch (resetAnswer & 3) {
    case 0:
      return Presence::Shorted;
    case 3:
      return Presence::None;
    default:  // 1: devices present, 2: one of them in alarm
      return Presence::Devices;
  }
}

}  // namespace

// The first reset after power-on only calibrates the chip's timing and is not answered, and another can get
// lost while an adapter powered from the control signals is still charging. An interrupted session may have
// left data mode or the accelerator on; either takes the reset for data and gives a different answer.
bool Ds2480b::Detect() {
  for (const std::chrono::milliseconds limit : {AnswerLimit, AnswerLimit, LastLimit}) {
    port_.Output(ResetBus);
    if (!Await(1, 1, limit)) {
      if (ended_) {
        return true;
      }
      continue;
    }
    if (TakeResetAnswer()) {
      port_.ClearInput();
      return true;
    }
    port_.Output(CommandMode);
    port_.Output(AcceleratorOff);
    port_.ClearInput();
  }
  return false;
}

Presence Ds2480b::Reset() {
  if (!busIsReset_ && !lost_) {
    SendCommand(ResetBus);
    lost_ = !Await(1, 2) || !TakeResetAnswer();
  }
  return lost_ ? Presence::None : presence_;
}

// All bytes are sent in one go: a 9600-baud line is slower than the bus, so the chip has finished each byte
// when the next one arrives, and one wait is enough for all answers.
std::optional<SearchBlock> Ds2480b::Search(const SearchBlock& path) {
  SendData(SearchRom);
  SendCommand(AcceleratorOn);
  for (const std::uint8_t byte : path) {
    SendData(byte);
  }
  SendCommand(AcceleratorOff);
  constexpr std::size_t otherBytes = 8;
  lost_ = !Await(1 + path.size(), path.size() + otherBytes) || port_.Input() != SearchRom;
  if (lost_) {
    return std::nullopt;
  }
  SearchBlock answer{};
  for (std::uint8_t& byte : answer) {
    byte = port_.Input();
  }
  return answer;
}

bool Ds2480b::Exchange(std::span<std::uint8_t> bytes) {
  if (lost_) {
    return false;
  }
  for (const std::uint8_t byte : bytes) {
    SendData(byte);
  }
  lost_ = !Await(bytes.size(), 1 + 2 * bytes.size());
  if (lost_) {
    return false;
  }
  for (std::uint8_t& byte : bytes) {
    byte = port_.Input();
  }
  return true;
}

void Ds2480b::Rest() {
  if (lost_) {
    inDataMode_ = true;
    SendCommand(AcceleratorOff);
  } else if (inDataMode_) {
    port_.Output(CommandMode);
  }
}

void Ds2480b::SendCommand(std::uint8_t command) {
  if (inDataMode_) {
    port_.Output(CommandMode);
    inDataMode_ = false;
  }
  port_.Output(command);
}

void Ds2480b::SendData(std::uint8_t byte) {
  if (!inDataMode_) {
    port_.Output(DataMode);
    inDataMode_ = true;
  }
  port_.Output(byte);
  if (byte == CommandMode) {
    port_.Output(byte);
  }
  busIsReset_ = false;
}

bool Ds2480b::Await(std::size_t answers, std::size_t bytesOnLine, std::chrono::milliseconds limit) {
  constexpr std::size_t microsecondsPerByte = 1042;  // ten bits at 9600 baud
  const auto onLine = std::chrono::milliseconds((bytesOnLine * microsecondsPerByte + 999) / 1000);
  const WaitResult result = events_.WaitFor([&] { return port_.InBufferCount() >= answers; }, limit + onLine);
  ended_ = ended_ || result == WaitResult::Ended;
  return result == WaitResult::Met;
}

bool Ds2480b::TakeResetAnswer() {
  const std::uint8_t answer = port_.Input();
  busIsReset_ = (answer & ResetAnswerMask) == ResetAnswer;
  presence_ = PresenceOf(answer);
  return busIsReset_;
}
