#pragma once

#include <array>
#include <cstdint>
#include <vector>

namespace sim {

/// What one shooter did to the reporting gun.
struct Hit {
  std::uint8_t Shooter = 0;  ///< player id, 32 to 255
  std::uint16_t Amount = 0;  ///< damage points

  bool operator==(const Hit&) const = default;
};

/// What a gun hands to the base unit after a game. Plausible words stay below 32768: the software in the
/// field reads them as signed.
struct GunScores {
  std::uint8_t PlayerId = 32;  ///< 32 to 255
  std::uint16_t ShotCount = 0;
  std::uint16_t HealCount = 0;
  std::uint16_t AmmoAddCount = 0;
  std::uint16_t AdminKillCount = 0;
  std::uint16_t DeathCount = 0;
  std::uint16_t RespawnCount = 0;
  std::uint16_t ExplosiveDamage = 0;  ///< points taken
  std::uint16_t RadiationDamage = 0;  ///< points taken
  std::uint16_t StunCount = 0;
  std::array<std::uint8_t, 8> ButtonId{};  ///< membership button, family code first, CRC last; zeros for none
  std::uint16_t RemainingHealth = 0;
  std::uint16_t RemainingClips = 0;
  std::uint16_t RemainingAmmo = 0;
  std::uint16_t SecondaryDamage = 0;  ///< points per hit
  std::uint16_t PrimaryDamage = 0;    ///< points per hit
  std::uint16_t RunCounter = 0;       ///< minutes
  std::uint8_t PowerCheatFlag = 0;
  std::vector<Hit> Hits;  ///< at most 255, one for each shooter

  bool operator==(const GunScores&) const = default;
};

}  // namespace sim
