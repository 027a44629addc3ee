#include "sim/line/PacedSender.h"

#include <algorithm>
#include <utility>

namespace sim {
namespace {

constexpr std::chrono::milliseconds TearPause{3};

// Pieces of one, two and three bytes in turn.
bool IsTornBehind(std::size_t bytes) {
  const std::size_t inTurn = bytes % 6;
  return inTurn == 1 || inTurn == 3 || inTurn == 0;
}

}  // namespace

PacedSender::PacedSender(PseudoTerminal& line, std::function<void(const LinePiece&)> onSent)
    : line_(line), onSent_(std::move(onSent)) {}

void PacedSender::Add(Clock::time_point ready, LinePiece piece) {
  waiting_.emplace(ready, std::move(piece));
}

std::optional<std::chrono::nanoseconds> PacedSender::UntilDue() const {
  const bool sending = sent_ < piece_.Bytes.size();
  if (!sending && waiting_.empty()) {
    return std::nullopt;
  }
  const Clock::time_point due = sending ? due_ : waiting_.begin()->first;
  return std::max(std::chrono::nanoseconds(due - Clock::now()), std::chrono::nanoseconds(0));
}

void PacedSender::SendDue() {
  const Clock::time_point now = Clock::now();
  while (line_.IsUp()) {
    if (sent_ < piece_.Bytes.size()) {
      if (due_ > now) {
        return;
      }
      SendByte();
    } else if (!waiting_.empty() && waiting_.begin()->first <= now) {
      auto next = waiting_.extract(waiting_.begin());
      Begin(next.key(), std::move(next.mapped()));
    } else {
      return;
    }
  }
}

void PacedSender::Begin(Clock::time_point ready, LinePiece piece) {
  piece_ = std::move(piece);
  sent_ = 0;
  due_ = std::max(ready, due_) + line_.DurationOf(1);
}

void PacedSender::SendByte() {
  line_.Put({&piece_.Bytes[sent_], 1});
  ++sent_;
  if (sent_ == piece_.Bytes.size()) {
    onSent_(piece_);
    if (piece_.LineEndsBehind) {
      line_.HangUp();
    }
    return;
  }
  due_ += line_.DurationOf(1);
  if (piece_.Torn && IsTornBehind(sent_)) {
    due_ += TearPause;
  }
}

}  // namespace sim
