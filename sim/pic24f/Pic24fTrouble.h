#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

#include "sim/pic24f/Pic24fFailure.h"

namespace sim {

/// An answer as it goes over the line.
struct Pic24fReply {
  std::vector<std::uint8_t> Bytes;  ///< none: silence
  bool Late = false;
  bool Torn = false;
  bool LineEndsBehind = false;
};

/// Knows when the failure of a loader strikes and what it does.
class Pic24fTrouble {
 public:
  enum class RowFate { Programmed, Lost, BadCells, LineEnds };

  /// `place`: request, answer or row, from 1. Throws std::invalid_argument for 0 if it matters.
  Pic24fTrouble(Pic24fFailure failure, std::size_t place);

  /// To be called for each request; true if it does not reach the loader.
  bool LosesRequest();
  bool RefusesErase() const { return failure_ == Pic24fFailure::RefusedErase; }
  /// To be called for each row to write.
  RowFate NextRow();
  /// The answer with the data `data`.
  Pic24fReply Answer(std::vector<std::uint8_t> data);

 private:
  bool Strikes(Pic24fFailure failure, std::size_t at) const { return failure_ == failure && at == place_; }

  Pic24fFailure failure_;
  std::size_t place_;
  std::size_t request_ = 0;
  std::size_t row_ = 0;
  std::size_t answer_ = 0;
};

}  // namespace sim
