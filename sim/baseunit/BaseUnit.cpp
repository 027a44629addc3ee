#include "sim/baseunit/BaseUnit.h"

#include <algorithm>
#include <limits>
#include <optional>
#include <utility>

namespace sim {
namespace {

constexpr int lineBaud = 19200;
constexpr std::uint8_t requestFirst = 1;
constexpr std::uint8_t requestSecond = 0;
constexpr std::uint8_t accepted = 170;
constexpr std::uint8_t rejected = 0;
// A host closes its port soon after the last reply; one that does not is left with a dead line.
constexpr std::chrono::seconds closingLimit{10};

}  // namespace

BaseUnit::BaseUnit(BaseUnitSettings settings)
    : settings_(std::move(settings)),
      terminal_(lineBaud, settings_.LinePace),
      log_(settings_.Log, "base-unit"),
      thread_([this] { Run(); }) {}

BaseUnit::~BaseUnit() {
  terminal_.Interrupt();
  thread_.join();
}

BaseUnitExchange BaseUnit::LatestExchange() const {
  const std::scoped_lock lock(mutex_);
  return latest_;
}

bool BaseUnit::WaitUntilServed(int requests, std::chrono::milliseconds limit) const {
  std::unique_lock lock(mutex_);
  return served_.wait_for(lock, limit, [&] { return requestsServed_ >= requests; });
}

void BaseUnit::Run() {
  int served = 0;
  Ending ending = Ending::Complete;
  while (ending == Ending::AskedAnew || AwaitRequest()) {
    ending = Serve();
    ++served;
    {
      const std::scoped_lock lock(mutex_);
      requestsServed_ = served;
    }
    served_.notify_all();
    if (ending == Ending::LineGone || served == settings_.Requests) {
      break;
    }
  }
  terminal_.WaitForClientToClose(closingLimit);
  if (settings_.OnFinished) {
    settings_.OnFinished();
  }
}

bool BaseUnit::AwaitRequest() {
  bool begun = false;
  while (const std::optional<std::uint8_t> byte = terminal_.ReadByte()) {
    const bool complete = begun && *byte == requestSecond;
    begun = *byte == requestFirst;
    log_.FromHost(*byte, complete ? "request" : begun ? "" : "ignored");
    if (complete) {
      return true;
    }
  }
  return false;
}

BaseUnit::Heard BaseUnit::AwaitReply() {
  bool requestBegun = false;
  while (const std::optional<std::uint8_t> byte = terminal_.ReadByte()) {
    if (requestBegun && *byte == requestSecond) {
      log_.FromHost(*byte, "request");
      return Heard::Request;
    }
    if (*byte == accepted || *byte == rejected) {
      log_.FromHost(*byte, *byte == accepted ? "accepted" : "rejected");
      const std::scoped_lock lock(mutex_);
      latest_.Replies.push_back(*byte);
      return Heard::Reply;
    }
    requestBegun = *byte == requestFirst;
    log_.FromHost(*byte, requestBegun ? "" : "ignored");
  }
  return Heard::Nothing;
}

BaseUnit::Ending BaseUnit::Serve() {
  const BaseUnitAnswer& answer = settings_.Answer;
  bytesUntilCut_ = answer.CutAfter.value_or(std::numeric_limits<std::size_t>::max());
  {
    const std::scoped_lock lock(mutex_);
    latest_ = {};
  }
  if (!Send(answer.Noise, false) || !Send({&answer.Count, 1}, false)) {
    return EndOfCutAnswer();
  }
  for (const std::vector<std::uint8_t>& frame : answer.Frames) {
    if (!Send(frame, true)) {
      return EndOfCutAnswer();
    }
    switch (AwaitReply()) {
      case Heard::Reply:
        break;
      case Heard::Request:
        return Ending::AskedAnew;
      case Heard::Nothing:
        return Ending::LineGone;
    }
  }
  return Ending::Complete;
}

BaseUnit::Ending BaseUnit::EndOfCutAnswer() {
  if (settings_.Answer.CutBy == BaseUnitAnswer::Cut::HangUp) {
    log_.Note("line pulled out");
    terminal_.HangUp();
    return Ending::LineGone;
  }
  return Ending::Complete;
}

// False when not all of `bytes` went out: the answer is cut there, or the wait was interrupted.
bool BaseUnit::Send(std::span<const std::uint8_t> bytes, bool isFrame) {
  const std::span<const std::uint8_t> due = bytes.first(std::min(bytes.size(), bytesUntilCut_));
  const std::size_t count = settings_.Answer.Torn ? terminal_.WriteTorn(due) : terminal_.Write(due);
  const std::span<const std::uint8_t> sent = bytes.first(count);
  bytesUntilCut_ -= count;
  if (!sent.empty()) {
    log_.ToHost(sent);
    const std::scoped_lock lock(mutex_);
    latest_.Sent.insert(latest_.Sent.end(), sent.begin(), sent.end());
    if (isFrame) {
      latest_.Frames.emplace_back(sent.begin(), sent.end());
      if (settings_.Frames != nullptr) {
        const std::string text(sent.begin(), sent.end());
        *settings_.Frames << text << std::flush;
      }
    }
  }
  return count == bytes.size();
}

}  // namespace sim
