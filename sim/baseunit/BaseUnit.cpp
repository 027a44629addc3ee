#include "sim/baseunit/BaseUnit.h"

#include <algorithm>
#include <limits>
#include <optional>
#include <string>
#include <utility>

namespace sim {
namespace {

constexpr int LineBaud = 19200;
constexpr std::uint8_t RequestFirst = 1;
constexpr std::uint8_t RequestSecond = 0;
constexpr std::uint8_t Accepted = 170;
constexpr std::uint8_t Rejected = 0;
// A host closes its port soon after the last reply; one that does not is left with a dead line.
constexpr std::chrono::seconds ClosingLimit{10};

}  // namespace

BaseUnit::BaseUnit(BaseUnitSettings settings)
    : Device({.LogName = "base-unit",
              .Understood = {{.Baud = LineBaud}},
              .LinePace = settings.LinePace,
              .Log = settings.Log}),
      settings_(std::move(settings)) {}

BaseUnitExchange BaseUnit::LatestExchange() const {
  return record_.Copy().Latest;
}

bool BaseUnit::WaitUntilServed(int requests, std::chrono::milliseconds limit) const {
  return record_.WaitUntil(limit, [&](const Record& record) { return record.RequestsServed >= requests; });
}

void BaseUnit::Run() {
  int served = 0;
  Ending ending = Ending::Complete;
  while (ending == Ending::AskedAnew || AwaitRequest()) {
    ending = Serve();
    ++served;
    record_.Note([&](Record& record) { record.RequestsServed = served; });
    if (ending == Ending::LineGone || served == settings_.Requests) {
      break;
    }
  }
  Line().WaitForClientToClose(ClosingLimit);
  if (settings_.OnFinished) {
    settings_.OnFinished();
  }
}

bool BaseUnit::AwaitRequest() {
  bool begun = false;
  while (const std::optional<std::uint8_t> byte = Line().ReadByte()) {
    const bool complete = begun && *byte == RequestSecond;
    begun = *byte == RequestFirst;
    Log().FromHost(*byte, complete ? "request" : begun ? "" : "ignored");
    if (complete) {
      return true;
    }
  }
  return false;
}

BaseUnit::Heard BaseUnit::AwaitReply() {
  bool requestBegun = false;
  while (const std::optional<std::uint8_t> byte = Line().ReadByte()) {
    if (requestBegun && *byte == RequestSecond) {
      Log().FromHost(*byte, "request");
      return Heard::Request;
    }
    if (*byte == Accepted || *byte == Rejected) {
      Log().FromHost(*byte, *byte == Accepted ? "accepted" : "rejected");
      record_.Note([&](Record& record) { record.Latest.Replies.push_back(*byte); });
      return Heard::Reply;
    }
    requestBegun = *byte == RequestFirst;
    Log().FromHost(*byte, requestBegun ? "" : "ignored");
  }
  return Heard::Nothing;
}

BaseUnit::Ending BaseUnit::Serve() {
  if (std::optional<BaseUnitAnswer> next = settings_.NextAnswer ? settings_.NextAnswer() : std::nullopt) {
    settings_.Answer = std::move(*next);
  }
  const BaseUnitAnswer& answer = settings_.Answer;
  bytesUntilCut_ = answer.CutAfter.value_or(std::numeric_limits<std::size_t>::max());
  record_.Note([](Record& record) { record.Latest = {}; });
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
    Log().Note("line pulled out");
    Line().HangUp();
    return Ending::LineGone;
  }
  return Ending::Complete;
}

// False if not all of `bytes` was sent: the answer is cut here, or the line was interrupted or has ended.
bool BaseUnit::Send(std::span<const std::uint8_t> bytes, bool isFrame) {
  const std::span<const std::uint8_t> due = bytes.first(std::min(bytes.size(), bytesUntilCut_));
  const std::size_t count = settings_.Answer.Torn ? Line().WriteTorn(due) : Line().Write(due);
  const std::span<const std::uint8_t> sent = bytes.first(count);
  bytesUntilCut_ -= count;
  if (!sent.empty()) {
    Log().ToHost(sent);
    record_.Note([&](Record& record) {
      record.Latest.Sent.insert(record.Latest.Sent.end(), sent.begin(), sent.end());
      if (isFrame) {
        record.Latest.Frames.emplace_back(sent.begin(), sent.end());
      }
    });
    if (isFrame && settings_.Frames != nullptr) {
      *settings_.Frames << std::string(sent.begin(), sent.end()) << std::flush;
    }
  }
  return count == bytes.size();
}

}  // namespace sim
