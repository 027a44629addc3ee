#include "devices/radio/GunTable.h"

#include <algorithm>
#include <cstddef>

#include "core/text/NumberForms.h"

std::string WeaponText(std::uint8_t code) {
  static constexpr std::array firstNames = {"Target",    "Pistol 1",  "Shotgun 1", "SMG 1",    "P90",
                                            "Assault 1", "Assault 2", "Sniper 1",  "SAW 1",    "SAW 2",
                                            "Kids",      "SciFi 1",   "SciFi 2",   "Sniper 3", "Sniper 4",
                                            "Shotgun 2", "Pistol 2",  "Vintorez"};
  static constexpr std::array namesFrom100 = {"Target", "HMG 1",    "M134A", "M134B",   "RPG",
                                              "LMG 1",  "Sniper 2", "MG34",  "Sniper 5"};
  constexpr std::size_t hundred = 100;
  if (code < firstNames.size()) {
    return firstNames[code];
  }
  if (code >= hundred && code - hundred < namesFrom100.size()) {
    return namesFrom100[code - hundred];
  }
  return "Unknown";
}

std::string StatusText(ScoreStatus status) {
  switch (status) {
    case ScoreStatus::Pending:
      return "Scores Pending";
    case ScoreStatus::InProgress:
      return "Scores In Progress";
    case ScoreStatus::Failed:
      return "Scores Failed";
    case ScoreStatus::Ok:
      return "Scores OK";
  }
  return {};
}

std::string BatteryText(std::uint8_t percent) {
  return Str(percent) + "%";
}

GunRow RowOf(const GunEntry& gun) {
  return {gun.PlayerName, gun.Firmware, BatteryText(gun.Battery), WeaponText(gun.WeaponType),
          StatusText(gun.ScoreStatus)};
}

std::vector<int> ListedGuns(const GunTable& guns, std::int16_t maxPlayerId) {
  std::vector<int> listed;
  const int last = std::min<int>(maxPlayerId, static_cast<int>(guns.size()) - 1);
  for (int index = 0; index <= last; ++index) {
    if (guns[static_cast<std::size_t>(index)].Present) {
      listed.push_back(index);
    }
  }
  return listed;
}

bool AnsweredUpToEdge(const GunTable& guns, std::int16_t maxPlayerId) {
  return maxPlayerId < GunCount && std::any_of(guns.begin() + maxPlayerId - 1, guns.end(),
                                               [](const GunEntry& gun) { return gun.Present; });
}
