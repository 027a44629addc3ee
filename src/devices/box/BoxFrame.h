#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

/// Types of utility boxes; the index is the code that is sent.
inline constexpr std::array<std::string_view, 9> BoxTypes = {"Medic",        "Ammo",      "Respawn Any",
                                                             "Repair",       "Multi",     "Respawn Dead",
                                                             "Multi-Player", "Dom. (IR)", "Dom. (iBtn)"};

/// What the operator entered for a box. The numbers are texts until they are sent.
struct BoxEntries {
  int BoxType = 0;   ///< index in BoxTypes
  int TeamList = 0;  ///< 0 for all teams, else the team
  std::string PointsPerAct = "0";
  std::string RechargePoints = "0";
  std::string ActivationAmount = "0";
  std::string AutoModeTime = "0";  ///< in units of 10 s
  bool Destroyable = false;

  bool operator==(const BoxEntries&) const = default;
};

/// The configuration frame for a box. Throws RuntimeError 13 for a text that is no number, 6 for a number
/// that is no byte once rounded and for an index outside its list.
std::array<std::uint8_t, 10> BoxFrame(const BoxEntries& entries);
