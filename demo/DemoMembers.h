#pragma once

#include <string>
#include <vector>

#include "demo/Portrait.h"
#include "members/MemberDetails.h"

/// A regular player of the demo's venue.
struct DemoMember {
  MemberDetails Details;
  PortraitLook Look;
  std::string DateJoined;  ///< "YYYY-MM-DD HH:MM:SS"
  int DaysSincePlayed = 0;
  int Games = 0;
  int DamagePerGame = 0;
  int SoldieringPerGame = 0;
  double Accuracy = 0;  ///< fraction, on average

  /// First and last name, with one blank in between.
  std::string FullName() const;
  /// The nickname, or the full name of a member who has none: what stands on the board.
  std::string ShownName() const;
};

/// The dozen of them; no two have the same name.
const std::vector<DemoMember>& DemoMembers();
