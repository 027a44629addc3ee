#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <vector>

#include "devices/radio/XBeeFrames.h"

/// How far the fetching of a gun's scores has got.
enum class ScoreStatus : std::int16_t { Pending = 0, InProgress = 1, Failed = 2, Ok = 3 };

/// A gun that answered the search.
struct GunEntry {
  bool Present = false;
  XBeeAddress Address{};
  std::uint8_t WeaponType = 0;
  std::string PlayerName;  ///< team, two blanks, number
  std::int16_t PlayerID = 0;
  std::string Firmware;
  std::uint8_t Battery = 0;  ///< percent
  ::ScoreStatus ScoreStatus = ScoreStatus::Pending;

  bool operator==(const GunEntry&) const = default;
};

/// The guns, indexed by player id minus 32; the last entry is never used.
using GunTable = std::array<GunEntry, 225>;

/// How many guns can be found and their scores fetched: entries 0 to 223.
inline constexpr int GunCount = 224;

inline constexpr std::uint8_t FirstGunId = 32;

/// Name of the weapon with this code; "Unknown" if there is none.
std::string WeaponText(std::uint8_t code);

std::string StatusText(ScoreStatus status);

/// Percent, with the number form's leading blank: " 85%".
std::string BatteryText(std::uint8_t percent);

/// A row of the list: player, firmware, battery, weapon, status.
using GunRow = std::array<std::string, 5>;

GunRow RowOf(const GunEntry& gun);

/// Indexes of the guns that the list shows: those present from 0 to `maxPlayerId` inclusive.
std::vector<int> ListedGuns(const GunTable& guns, std::int16_t maxPlayerId);

/// True if guns answered up to the last id of a search that left ids out, or beyond it: there may be more.
bool AnsweredUpToEdge(const GunTable& guns, std::int16_t maxPlayerId);
