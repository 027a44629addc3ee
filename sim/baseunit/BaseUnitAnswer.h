#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

#include "sim/baseunit/BaseUnitFailure.h"
#include "sim/game/GunScores.h"

namespace sim {

/// What the base unit sends for one request.
struct BaseUnitAnswer {
  /// How the bytes after `CutAfter` are lost.
  enum class Cut { Silence, HangUp };

  std::vector<std::uint8_t> Noise{};  ///< before the count byte
  std::uint8_t Count = 0;
  std::vector<std::vector<std::uint8_t>> Frames{};  ///< each with its CRC byte
  bool Torn = false;
  std::optional<std::size_t> CutAfter{};  ///< number of bytes, noise and count included, that are still sent
  Cut CutBy = Cut::Silence;
};

/// The answer that reports `game`, with `failure` built in. `place` is the frame or byte concerned, counted
/// from 1; failures that concern neither ignore it. Throws std::invalid_argument if the answer has no such
/// frame or byte, or if the game needs more than 255 frames.
BaseUnitAnswer MakeBaseUnitAnswer(std::vector<GunScores> game,
                                  BaseUnitFailure failure = BaseUnitFailure::None, std::size_t place = 1);

}  // namespace sim
