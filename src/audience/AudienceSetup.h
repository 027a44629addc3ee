#pragma once

#include <string>

#include "core/data/IniReader.h"

/// What the operator has set for the audience board.
struct AudienceSetup {
  std::string Screen;   ///< its name; empty for the second one
  double Metres = 5;    ///< to those who read it from farthest away, 1 to 50
  double Inches = 0;    ///< diagonal of the screen, 10 to 300; 0 for what the screen says of itself
  int Seconds = 8;      ///< that a page stays, 3 to 60
  std::string Venue;    ///< name of the venue
  std::string Picture;  ///< path of a picture file
  bool Follows = true;  ///< games are shown by themselves once their scores are in

  bool operator==(const AudienceSetup&) const = default;
};

namespace AudienceLimits {
inline constexpr double LeastMetres = 1;
inline constexpr double MostMetres = 50;
inline constexpr double LeastInches = 10;
inline constexpr double MostInches = 300;
inline constexpr int LeastSeconds = 3;
inline constexpr int MostSeconds = 60;
}  // namespace AudienceLimits

/// Numbers outside their ranges count as the nearest within, and what is no number as the default.
AudienceSetup ReadAudienceSetup(const IniReader& ini);

/// Writes what differs between the two.
void WriteAudienceSetup(IniReader& ini, const AudienceSetup& before, const AudienceSetup& now);
