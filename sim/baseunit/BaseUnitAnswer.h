#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

#include "sim/baseunit/BaseUnitFailure.h"
#include "sim/game/GunScores.h"

namespace sim {

/// What the base unit puts on the line for one request.
struct BaseUnitAnswer {
  /// How the bytes behind `CutAfter` are lost.
  enum class Cut { Silence, HangUp };

  std::vector<std::uint8_t> Noise{};  ///< before the count byte
  std::uint8_t Count = 0;
  std::vector<std::vector<std::uint8_t>> Frames{};  ///< each with its CRC byte
  bool Torn = false;
  std::optional<std::size_t> CutAfter{};  ///< bytes of noise, count and frames that still go out
  Cut CutBy = Cut::Silence;
};

/// The answer that tells `game`, with `failure` in it. `place` is the frame or the byte, from 1, that the
/// failure concerns; failures that concern neither do not look at it. Throws std::invalid_argument when the
/// answer has no such frame or byte, or when the game does not fit 255 frames.
BaseUnitAnswer MakeBaseUnitAnswer(std::vector<GunScores> game,
                                  BaseUnitFailure failure = BaseUnitFailure::None, std::size_t place = 1);

}  // namespace sim
