#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <ostream>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "sim/line/Device.h"
#include "sim/recorder/PauseWatch.h"
#include "sim/recorder/RecorderCommand.h"
#include "sim/recorder/RecorderInput.h"
#include "sim/recorder/RecorderTrouble.h"
#include "sim/recorder/SoundChip.h"
#include "sim/recorder/SoundFiles.h"

namespace sim {

/// What hardware is on the line: a gun, a stand-alone recorder, or either, as the speed of the host tells.
enum class RecorderKind { Either, Gun, StandAlone };

struct SoundRecorderSettings {
  RecorderKind Kind = RecorderKind::Either;
  RecorderFailure Failure = RecorderFailure::None;
  std::size_t FailurePlace = 1;  ///< page or answer that the failure concerns, from 1
  Pace LinePace = Pace::AsWired;
  std::chrono::milliseconds EraseTime{0};
  std::chrono::milliseconds SlowEraseTime{40'000};
  /// Silence in the middle of something after which the host has given up.
  std::chrono::milliseconds Patience{2'000};
  std::optional<SoundFiles> Files = std::nullopt;  ///< where recordings are kept
  std::ostream* Log = nullptr;                     ///< receives the traffic in both directions
};

struct SoundRecorderTraffic {
  std::vector<RecorderCommand> Commands;  ///< those that were obeyed, in order; StartOrErase never
  SoundChip Chip;
  int Recordings = 0;  ///< those that have ended
};

/// The sound hardware that the program's recordings go to: both modes, told apart by the speed of the line.
/// Every answer is one byte, 0xAA or, as a refusal, 0x55. A sound is played as long as it takes on a paced
/// line and in no time on a fast one.
///
/// A recording that is broken off leaves it in the middle of a block. It waits `Patience` for the rest; if
/// what came last then is a new start, it obeys that.
class SoundRecorder : public Device {
 public:
  /// Throws std::invalid_argument when the failure has no such place, std::system_error when the system
  /// grants no pseudo terminal. The log must outlive the recorder.
  explicit SoundRecorder(SoundRecorderSettings settings);

  SoundRecorderTraffic Traffic() const { return traffic_.Copy(); }
  /// Waits until `count` recordings have ended; false when `limit` passes first.
  bool WaitUntilRecorded(int count, std::chrono::milliseconds limit) const;

 private:
  using Clock = PseudoTerminal::Clock;
  using Bytes = std::vector<std::uint8_t>;
  enum class State { Idle, Started, Erased };

  void Run();
  std::optional<RecorderCommand> AwaitCommand();
  void DropStray(const Bytes& bytes);
  void Obey(RecorderCommand command);
  void Start();
  void Erase();
  bool WaitForErase();
  void TakePage(std::uint16_t number);
  void TakeSound(std::uint8_t number);
  std::optional<std::size_t> TakePageCount();
  void End();
  void Play(std::uint8_t number);

  using Store = std::function<void(SoundChip& chip, std::span<const std::uint8_t> page)>;
  bool TakeBlock(RecorderStep step, const Bytes& prefix, const std::string& what, const Store& store);
  bool ReadBlock(RecorderStep step, bool hasPrefix);
  void SeePauseInBlock(bool hasPrefix);
  bool LosesByteInMiddle();
  void BreakOff(bool byItself);

  bool Answer(RecorderStep step, std::uint8_t answer = RecorderAcknowledged);
  bool Expect(bool inOrder, std::string_view fault);
  void See(RecorderPause pause, std::chrono::nanoseconds length);
  void Fault(std::span<const std::uint8_t> bytes, const std::string& what);
  void KeepRecording();

  SoundRecorderSettings settings_;
  RecorderTrouble trouble_;
  PauseWatch pauses_;
  RecorderInput input_{Line()};
  std::chrono::nanoseconds gapBeforeCommand_{};
  bool astray_ = false;
  bool played_ = false;  // by the command before

  State state_ = State::Idle;
  Clock::time_point startedAt_;
  bool tableDue_ = false;
  std::uint16_t nextPage_ = 0;  // that a gun expects
  bool unkept_ = false;
  Bytes block_;                     // in progress or just ended: 256 bytes and the check byte
  Clock::time_point firstOfBlock_;  // when its first byte was through

  TrafficRecord<SoundRecorderTraffic> traffic_;
  Serving serving_{*this, [this] { Run(); }};
};

}  // namespace sim
