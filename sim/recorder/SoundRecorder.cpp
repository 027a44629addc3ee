#include "sim/recorder/SoundRecorder.h"

#include <map>
#include <system_error>
#include <utility>

#include "sim/line/Crc.h"

namespace sim {
namespace {

constexpr std::size_t BlockBytes = PageBytes + 1;
constexpr std::size_t MiddleOfPage = PageBytes / 2;

std::vector<LineSettings> Understood(RecorderKind kind) {
  const LineSettings gun{.Baud = InProductBaud};
  const LineSettings standAlone{.Baud = StandAloneBaud};
  switch (kind) {
    case RecorderKind::Gun:
      return {gun};
    case RecorderKind::StandAlone:
      return {standAlone};
    case RecorderKind::Either:
      break;
  }
  return {gun, standAlone};
}

}  // namespace

SoundRecorder::SoundRecorder(SoundRecorderSettings settings)
    : Device({.LogName = "recorder",
              .Understood = Understood(settings.Kind),
              .LinePace = settings.LinePace,
              .Log = settings.Log}),
      settings_(std::move(settings)),
      trouble_(settings_.Failure, settings_.FailurePlace) {}

bool SoundRecorder::WaitUntilRecorded(int count, std::chrono::milliseconds limit) const {
  return traffic_.WaitUntil(limit,
                            [&](const SoundRecorderTraffic& traffic) { return traffic.Recordings >= count; });
}

void SoundRecorder::Run() {
  while (Line().IsUp()) {
    if (const std::optional<RecorderCommand> command = AwaitCommand()) {
      Obey(*command);
    }
  }
  KeepRecording();
}

std::optional<RecorderCommand> SoundRecorder::AwaitCommand() {
  Bytes bytes;
  for (;;) {
    const std::optional<std::uint8_t> byte = input_.Read(
        bytes.empty() ? std::nullopt : std::optional<std::chrono::nanoseconds>(settings_.Patience));
    if (!byte) {
      if (!bytes.empty() && Line().IsUp()) {
        Fault(bytes, "a command cut short");
      }
      return std::nullopt;
    }
    if (bytes.empty()) {
      gapBeforeCommand_ = input_.Gap();
    } else if (!input_.IsReadAgain()) {
      See(RecorderPause::InCommand, input_.Gap());
    }
    bytes.push_back(*byte);
    const RecorderMode mode = ModeAt(Line().Current().Baud);
    if (const std::optional<RecorderCommand> command = ReadRecorderCommand(mode, bytes)) {
      astray_ = false;
      Log().FromHost(bytes, Describe(*command));
      return command;
    }
    if (!BeginsRecorderCommand(mode, bytes)) {
      DropStray(bytes);
      return std::nullopt;
    }
  }
}

// A run of stray bytes is one fault. The last of several may begin a command.
void SoundRecorder::DropStray(const Bytes& bytes) {
  const bool several = bytes.size() > 1;
  const std::span<const std::uint8_t> dropped = std::span(bytes).first(several ? bytes.size() - 1 : 1);
  if (several) {
    input_.PutBack(std::span(bytes).last(1));
  }
  if (std::exchange(astray_, true)) {
    Log().FromHost(dropped, "astray");
  } else {
    Fault(dropped, "bytes that are no command");
  }
}

void SoundRecorder::Obey(RecorderCommand command) {
  if (command.Kind == RecorderCommandKind::StartOrErase) {
    const bool goesOn = state_ == State::Started && Clock::now() - startedAt_ < settings_.Patience;
    command.Kind = goesOn ? RecorderCommandKind::Erase : RecorderCommandKind::Start;
  }
  const bool isPlay = command.Kind == RecorderCommandKind::Play;
  if (std::exchange(played_, isPlay) && isPlay) {
    See(RecorderPause::BetweenSounds, gapBeforeCommand_);
  }
  traffic_.Note([&](SoundRecorderTraffic& traffic) { traffic.Commands.push_back(command); });
  switch (command.Kind) {
    case RecorderCommandKind::Start:
    case RecorderCommandKind::StartOrErase:
      Start();
      break;
    case RecorderCommandKind::Erase:
      Erase();
      break;
    case RecorderCommandKind::Page:
      TakePage(command.Number);
      break;
    case RecorderCommandKind::Header:
      TakeSound(static_cast<std::uint8_t>(command.Number));
      break;
    case RecorderCommandKind::End:
      End();
      break;
    case RecorderCommandKind::Play:
      Play(static_cast<std::uint8_t>(command.Number));
      break;
  }
}

void SoundRecorder::Start() {
  KeepRecording();
  state_ = State::Idle;
  if (Answer(RecorderStep::Start)) {
    state_ = State::Started;
    startedAt_ = Clock::now();
  }
}

void SoundRecorder::Erase() {
  if (!Expect(state_ == State::Started, "an erase without a start")) {
    return;
  }
  state_ = State::Idle;
  if (!Answer(RecorderStep::Erase) || !WaitForErase()) {
    return;
  }
  traffic_.Note([](SoundRecorderTraffic& traffic) { traffic.Chip.Erase(); });
  state_ = State::Erased;
  tableDue_ = true;
  trouble_.BeginRecording();
  nextPage_ = 0;
  unkept_ = true;
  Answer(RecorderStep::EraseEnd);
}

// False when the line is gone.
bool SoundRecorder::WaitForErase() {
  const Clock::time_point end =
      Clock::now() + (trouble_.SlowsErase() ? settings_.SlowEraseTime : settings_.EraseTime);
  if (trouble_.EndsLineInErase()) {
    Log().Note("line pulled out");
    Line().HangUp();
  }
  Bytes ignored;
  while (Line().IsUp() && Clock::now() < end) {
    if (const std::optional<std::uint8_t> byte = input_.Read(end - Clock::now())) {
      ignored.push_back(*byte);
    }
  }
  if (!ignored.empty()) {
    Fault(ignored, "bytes during the erase");
  }
  return Line().IsUp();
}

void SoundRecorder::TakePage(std::uint16_t number) {
  const bool isTable = std::exchange(tableDue_, false) && number == 0;
  const Bytes bytesOfNumber{static_cast<std::uint8_t>(number % 256), static_cast<std::uint8_t>(number / 256)};
  if (!Expect(state_ == State::Erased, "a page before the erase")) {
    return;
  }
  See(RecorderPause::BeforePage, gapBeforeCommand_);
  if (isTable) {
    TakeBlock(RecorderStep::Table, {}, "table", [](SoundChip& chip, std::span<const std::uint8_t> bytes) {
      chip.SetTable(bytes.first<PageBytes>());
    });
    return;
  }
  Expect(number == nextPage_, "page " + std::to_string(number) + " in place of " + std::to_string(nextPage_));
  nextPage_ = static_cast<std::uint16_t>(number + 1U);
  TakeBlock(RecorderStep::Page, bytesOfNumber, "page " + std::to_string(number),
            [&](SoundChip& chip, std::span<const std::uint8_t> bytes) { chip.SetPage(number, bytes); });
}

void SoundRecorder::TakeSound(std::uint8_t number) {
  if (!Expect(state_ == State::Erased, "a sound before the erase")) {
    return;
  }
  See(RecorderPause::BeforePage, gapBeforeCommand_);
  if (!Answer(RecorderStep::Header)) {
    return;
  }
  const std::optional<std::size_t> count = TakePageCount();
  if (!count || !Expect(*count > 0, "a sound of 0 pages")) {
    return;
  }
  traffic_.Note([&](SoundRecorderTraffic& traffic) { traffic.Chip.BeginSound(number); });
  for (std::size_t page = 0; page < *count; ++page) {
    if (!TakeBlock(RecorderStep::Page, {}, "page " + std::to_string(page),
                   [&](SoundChip& chip, std::span<const std::uint8_t> bytes) {
                     chip.AppendToSound(number, bytes);
                   })) {
      return;
    }
  }
}

std::optional<std::size_t> SoundRecorder::TakePageCount() {
  block_.clear();
  while (block_.size() < 2) {
    const std::optional<std::uint8_t> byte = input_.Read(settings_.Patience);
    if (!byte) {
      BreakOff(false);
      return std::nullopt;
    }
    See(block_.empty() ? RecorderPause::BeforePageCount : RecorderPause::InPageCount, input_.Gap());
    block_.push_back(*byte);
  }
  const std::size_t count = block_[0] + 256U * block_[1];
  Log().FromHost(block_, std::to_string(count) + " pages");
  return count;
}

void SoundRecorder::End() {
  if (Expect(state_ == State::Erased, "an end before the erase")) {
    state_ = State::Idle;
    KeepRecording();
    traffic_.Note([](SoundRecorderTraffic& traffic) { ++traffic.Recordings; });
    Answer(RecorderStep::End);
  }
}

// A host that does not wait for the end is obeyed at once.
void SoundRecorder::Play(std::uint8_t number) {
  if (settings_.LinePace == Pace::AsWired) {
    const std::map<std::uint8_t, SoundChip::Samples> sounds =
        traffic_.Ask([](const SoundRecorderTraffic& traffic) { return traffic.Chip.Sounds(); });
    const auto sound = sounds.find(number);
    const std::size_t samples = sound == sounds.end() ? 0 : sound->second.size();
    const std::chrono::microseconds duration(samples * 1'000'000 / SamplesPerSecond);
    if (const std::optional<std::uint8_t> byte = input_.Read(duration)) {
      Log().Note("sound ended by the host");
      input_.PutBack({&*byte, 1});
      return;
    }
  }
  Answer(RecorderStep::Play);
}

// The 256 bytes of a page or table and their check byte, which also covers `prefix`; true if all came and
// were accepted.
bool SoundRecorder::TakeBlock(RecorderStep step, const Bytes& prefix, const std::string& what,
                              const Store& store) {
  if (!ReadBlock(step, step == RecorderStep::Table || !prefix.empty())) {
    return false;
  }
  Bytes checked = prefix;
  checked.insert(checked.end(), block_.begin(), block_.end() - 1);
  const bool right = Crc8(checked) == block_.back();
  if (right) {
    Log().FromHost(block_, what);
  } else {
    Fault(block_, "a wrong check byte of " + what);
  }
  const bool accepted = right && !(step == RecorderStep::Page && trouble_.RefusesPage());
  if (accepted) {
    traffic_.Note([&](SoundRecorderTraffic& traffic) {
      store(traffic.Chip, std::span<const std::uint8_t>(block_).first(PageBytes));
    });
  }
  return Answer(step, accepted ? RecorderAcknowledged : RecorderRefused) && accepted;
}

bool SoundRecorder::ReadBlock(RecorderStep step, bool hasPrefix) {
  const bool isPage = step == RecorderStep::Page;
  if (isPage) {
    trouble_.BeginPage();
  }
  bool middlePassed = false;
  block_.clear();
  while (block_.size() < BlockBytes) {
    // Between the pages of a sound without prefixes nothing tells that the host has given up.
    const bool unlimited = !hasPrefix && block_.empty();
    const std::optional<std::uint8_t> byte =
        input_.Read(unlimited ? std::nullopt : std::optional<std::chrono::nanoseconds>(settings_.Patience));
    if (!byte) {
      BreakOff(isPage && trouble_.LosesByteOfPage());
      return false;
    }
    SeePauseInBlock(hasPrefix);
    block_.push_back(*byte);
    if (isPage && block_.size() == MiddleOfPage && !std::exchange(middlePassed, true) &&
        LosesByteInMiddle()) {
      block_.pop_back();
    }
  }
  return true;
}

// Before the byte that has just come.
void SoundRecorder::SeePauseInBlock(bool hasPrefix) {
  if (block_.empty()) {
    firstOfBlock_ = input_.Latest();
    See(hasPrefix ? RecorderPause::InCommand : RecorderPause::BeforePage, input_.Gap());
  } else if (block_.size() == PageBytes - 1 && hasPrefix) {
    See(RecorderPause::InData, input_.Latest() - firstOfBlock_);
  } else if (block_.size() == PageBytes) {
    See(RecorderPause::BeforeCheckByte, input_.Gap());
  }
}

// True if the latest byte of the page does not reach the recorder. May end the line.
bool SoundRecorder::LosesByteInMiddle() {
  if (trouble_.EndsLineInPage()) {
    Log().Note("line pulled out");
    Line().HangUp();
  }
  if (trouble_.LosesByteOfPage()) {
    Log().Note("a byte lost");
  }
  return trouble_.LosesByteOfPage();
}

// The host has given up in the middle of a block, or the line is gone.
void SoundRecorder::BreakOff(bool byItself) {
  if (!Line().IsUp()) {
    return;
  }
  const std::size_t anew = NewBeginningAtEndOf(ModeAt(Line().Current().Baud), block_);
  input_.PutBack(std::span(block_).last(anew));
  block_.resize(block_.size() - anew);
  if (block_.empty() || byItself) {
    Log().FromHost(block_, "broken off");
  } else {
    Fault(block_, std::to_string(block_.size()) + " bytes of a longer block");
  }
}

// False if the recorder acts as if it had not heard the host.
bool SoundRecorder::Answer(RecorderStep step, std::uint8_t answer) {
  const std::optional<Bytes> bytes = trouble_.Answer(step, answer);
  if (!bytes) {
    Log().Note("no answer");
    return false;
  }
  if (!bytes->empty()) {
    Line().Write(*bytes);
    Log().ToHost(*bytes);
    input_.NoteAnswer();
  }
  return true;
}

bool SoundRecorder::Expect(bool inOrder, std::string_view fault) {
  if (!inOrder) {
    Fault({}, std::string(fault));
  }
  return inOrder;
}

void SoundRecorder::See(RecorderPause pause, std::chrono::nanoseconds length) {
  if (const std::optional<std::string> fault = pauses_.See(pause, length)) {
    Log().Note("fault: " + *fault);
    NoteHostFault("the host " + *fault);
  }
}

void SoundRecorder::Fault(std::span<const std::uint8_t> bytes, const std::string& what) {
  if (bytes.empty()) {
    Log().Note("fault: " + what);
  } else {
    Log().FromHost(bytes, "fault: " + what);
  }
  NoteHostFault("the host sent " + what);
}

void SoundRecorder::KeepRecording() {
  const bool isEmpty =
      traffic_.Ask([](const SoundRecorderTraffic& traffic) { return traffic.Chip.IsEmpty(); });
  if (!std::exchange(unkept_, false) || !settings_.Files || isEmpty) {
    return;
  }
  try {
    Log().Note("kept in " + settings_.Files->Keep(Traffic().Chip).string());
  } catch (const std::system_error& failure) {
    Log().Note(std::string("not kept: ") + failure.what());
  }
}

}  // namespace sim
