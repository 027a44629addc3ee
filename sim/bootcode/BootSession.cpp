#include "sim/bootcode/BootSession.h"

#include <string_view>
#include <utility>

namespace sim {
namespace {

BootStep Unexpected(std::uint8_t byte, const std::string& due) {
  constexpr std::string_view digits = "0123456789ABCDEF";
  const std::string what = std::string{digits[byte >> 4U], digits[byte & 15U]} + " where " + due + " was due";
  return {.Note = "fault: " + what, .Fault = "sent " + what};
}

}  // namespace

void BootSession::SwitchOn() {
  state_ = State::Synchronise;
  spokenToWhileOff_ = false;
  packets_ = 0;
  dialect_.Restart();
}

std::optional<BootStep> BootSession::Take(std::uint8_t byte) {
  switch (state_) {
    case State::Synchronise:
      return Answer(byte, 'X', 'x', State::Identify);
    case State::Identify:
      return Answer(byte, 'P', dialect_.Product(), State::Begin);
    case State::Begin:
      return Answer(byte, 'B', dialect_.Begun(), State::Packets);
    case State::Packets:
      return TakeOfPacket(byte);
    case State::Off:
      break;
  }
  BootStep step{.Note = "ignored"};
  if (!std::exchange(spokenToWhileOff_, true)) {
    step.Fault = "spoke to a device that is not in its boot code";
    step.Note = "fault: not in the boot code";
  }
  return step;
}

BootStep BootSession::Answer(std::uint8_t byte, char due, std::uint8_t answer, State next) {
  if (byte != static_cast<std::uint8_t>(due)) {
    return Unexpected(byte, {due});
  }
  state_ = next;
  return {.Answer = answer};
}

std::optional<BootStep> BootSession::TakeOfPacket(std::uint8_t byte) {
  if (byte == 'F' && dialect_.MayFinish()) {
    state_ = State::Off;
    return BootStep{.Answer = 'f', .Note = "complete", .Finished = true};
  }
  switch (dialect_.Take(byte)) {
    case BootDialect::Heard::More:
      return std::nullopt;
    case BootDialect::Heard::Complete:
      return EndOfPacket();
    case BootDialect::Heard::Foreign:
      break;
  }
  return Unexpected(byte, "a packet");
}

BootStep BootSession::EndOfPacket() {
  if (dialect_.PacketBytes() > 0) {
    ++packets_;
    if (const std::optional<std::uint8_t> spoilt = spoil_(packets_)) {
      dialect_.Drop();
      return {.Answer = spoilt, .Note = "refused"};
    }
  }
  BootVerdict verdict = dialect_.CarryOut();
  return {.Answer = verdict.Answer, .Note = std::move(verdict.Note), .Fault = std::move(verdict.Fault)};
}

}  // namespace sim
