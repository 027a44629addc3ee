#pragma once

#include <chrono>
#include <cstdint>
#include <vector>

#include "sim/game/GunScores.h"

namespace sim {

/// A gun as seen over the radio.
struct RadioGun {
  std::uint8_t PlayerId = 32;  ///< 32 to 255
  std::uint64_t Address = 0;   ///< of its radio
  std::uint8_t FirmwareMajor = 0;
  std::uint8_t FirmwareMinor = 0;
  std::uint8_t Battery = 0;  ///< percent
  std::uint8_t Weapon = 0;   ///< weapon code
  /// Its scores as the base unit would hand them over, the CRC byte last.
  std::vector<std::uint8_t> Frame;
  std::chrono::microseconds AnswerTime{5000};  ///< from the last bit of a request to the first of the answer
};

/// The guns of `game` in the order of their player ids. Address, firmware, battery and weapon depend on the
/// player id alone.
std::vector<RadioGun> MakeRadioGuns(const std::vector<GunScores>& game,
                                    std::chrono::microseconds answerTime = std::chrono::milliseconds(5));

}  // namespace sim
