#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

#include "sim/recorder/RecorderFailure.h"

namespace sim {

constexpr std::uint8_t RecorderAcknowledged = 0xAA;
/// Any other byte refuses as well.
constexpr std::uint8_t RecorderRefused = 0x55;

/// Knows when the failure of a sound recorder strikes and what it does.
class RecorderTrouble {
 public:
  /// `place`: page of a recording or answer, from 1. Throws std::invalid_argument for 0 if it matters.
  RecorderTrouble(RecorderFailure failure, std::size_t place);

  /// To be called when a recording or a page of it begins.
  void BeginRecording() { page_ = 0; }
  void BeginPage() { ++page_; }

  /// The bytes to send for the answer `answer` at `step`: empty if they come later, none if the recorder acts
  /// as if it had not heard the host.
  std::optional<std::vector<std::uint8_t>> Answer(RecorderStep step, std::uint8_t answer);

  bool SlowsErase() const { return failure_ == RecorderFailure::SlowErase; }
  bool EndsLineInErase() const { return failure_ == RecorderFailure::UnpluggedInErase; }
  /// Of the page in progress.
  bool EndsLineInPage() const { return failure_ == RecorderFailure::UnpluggedInPage && page_ == place_; }
  bool LosesByteOfPage() const { return failure_ == RecorderFailure::LostByte && page_ == place_; }
  bool RefusesPage() const { return failure_ == RecorderFailure::RefusedPage && page_ == place_; }

 private:
  RecorderFailure failure_;
  std::size_t place_;
  std::size_t page_ = 0;
  std::size_t answer_ = 0;
};

}  // namespace sim
