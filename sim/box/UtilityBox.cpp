#include "sim/box/UtilityBox.h"

#include <algorithm>
#include <stdexcept>
#include <string>
#include <utility>

namespace sim {
namespace {

constexpr int LineBaud = 19200;
constexpr std::uint8_t Accepted = 0xAA;
constexpr std::uint8_t Rejected = 0x55;
constexpr std::uint8_t Noise = 0xF8;
// A host that stops in mid-frame will begin anew; far longer than any pause that a busy machine puts in.
constexpr std::chrono::seconds BrokenOffAfter{1};
// On the line, bytes without pauses of 1 ms follow each other after 0.52 ms.
constexpr std::chrono::microseconds ShortestPause{800};
// On a busy machine a frame's bytes may be seen all at once although they did not come so, but not every
// time.
constexpr int HastyFramesInARow = 3;

UtilityBoxSettings Checked(UtilityBoxSettings settings) {
  const bool hasPlace = settings.Failure == BoxFailure::Unplugged;
  if (hasPlace && (settings.FailurePlace == 0 || settings.FailurePlace > BoxFrame().size())) {
    throw std::invalid_argument("There is no byte " + std::to_string(settings.FailurePlace) +
                                " in a frame of 10");
  }
  return settings;
}

}  // namespace

UtilityBox::UtilityBox(UtilityBoxSettings settings)
    : Device({.LogName = "box",
              .Understood = {{.Baud = LineBaud}},
              .LinePace = settings.LinePace,
              .Log = settings.Log}),
      settings_(Checked(settings)),
      sender_(Line(), [this](const LinePiece& piece) { NoteSent(piece); }) {}

bool UtilityBox::WaitUntilTold(std::size_t frames, std::chrono::milliseconds limit) const {
  return traffic_.WaitUntil(
      limit, [&](const UtilityBoxTraffic& traffic) { return traffic.Frames.size() >= frames; });
}

void UtilityBox::Run() {
  while (Line().IsUp()) {
    if (const std::optional<std::uint8_t> byte = Line().ReadByte(UntilDue())) {
      Take(*byte);
    } else if (reader_.Count() > 0 && Clock::now() - latest_ >= BrokenOffAfter) {
      BreakOff();
    }
    sender_.SendDue();
  }
}

std::optional<std::chrono::nanoseconds> UtilityBox::UntilDue() const {
  const std::optional<std::chrono::nanoseconds> answer = sender_.UntilDue();
  if (reader_.Count() == 0) {
    return answer;
  }
  const std::chrono::nanoseconds patience = std::max<std::chrono::nanoseconds>(
      latest_ + BrokenOffAfter - Clock::now(), std::chrono::nanoseconds(0));
  return answer ? std::min(*answer, patience) : patience;
}

void UtilityBox::Take(std::uint8_t byte) {
  const Clock::time_point now = Clock::now();
  const std::optional<BoxFrame> frame = reader_.Take(byte);
  if (reader_.Count() == 1) {
    longestPause_ = Clock::duration(0);
  } else {
    longestPause_ = std::max(longestPause_, now - latest_);
  }
  latest_ = now;
  const std::size_t count = frame ? frame->size() : reader_.Count();
  if (Strikes(BoxFailure::Unplugged) && count == settings_.FailurePlace) {
    Log().FromHost(byte);
    Log().Note("box pulled out");
    Line().HangUp();
    return;
  }
  if (!frame) {
    Log().FromHost(byte, count == 0 ? "ignored" : "");
    return;
  }
  const std::optional<std::string> wrong = WrongIn(*frame);
  Log().FromHost(byte, wrong ? "fault: " + *wrong : "told: " + Describe(*frame));
  if (wrong) {
    NoteHostFault("the host sent a frame with " + *wrong);
  }
  CheckPauses();
  Answer(*frame);
}

void UtilityBox::CheckPauses() {
  hastyFrames_ = longestPause_ < ShortestPause ? hastyFrames_ + 1 : 0;
  if (hastyFrames_ == HastyFramesInARow) {
    NoteFault("frames without pauses of 1 ms between their bytes");
  }
}

void UtilityBox::BreakOff() {
  NoteFault("only " + std::to_string(reader_.Count()) + " bytes of a frame");
  reader_.StartOver();
}

void UtilityBox::Answer(const BoxFrame& frame) {
  ++frames_;
  const bool accepts = !WrongIn(frame) && !Strikes(BoxFailure::Rejects);
  const std::uint8_t answer = accepts ? Accepted : Rejected;
  LinePiece piece{.Bytes = {answer}};
  if (Strikes(BoxFailure::AnswersTwice)) {
    piece.Bytes.push_back(accepts ? Rejected : Accepted);
  } else if (Strikes(BoxFailure::Noise)) {
    piece.Bytes.insert(piece.Bytes.begin(), Noise);
  }
  if (!Strikes(BoxFailure::Silent)) {
    const bool late = Strikes(BoxFailure::Late);
    sender_.Add(Clock::now() + (late ? settings_.Late : std::chrono::milliseconds(0)), std::move(piece));
  }
  traffic_.Note([&](UtilityBoxTraffic& traffic) {
    traffic.Frames.push_back(frame);
    if (accepts) {
      traffic.Accepted = frame;
    }
  });
}

void UtilityBox::NoteSent(const LinePiece& piece) {
  Log().ToHost(piece.Bytes);
  traffic_.Note([&](UtilityBoxTraffic& traffic) {
    traffic.Answers.insert(traffic.Answers.end(), piece.Bytes.begin(), piece.Bytes.end());
  });
}

// Whether it strikes the frame that has come last, or, in the midst of one, this one.
bool UtilityBox::Strikes(BoxFailure failure) const {
  return settings_.Failure == failure && (settings_.Times == 0 || frames_ <= settings_.Times);
}

void UtilityBox::NoteFault(const std::string& what) {
  Log().Note("fault: " + what);
  NoteHostFault("the host sent " + what);
}

}  // namespace sim
