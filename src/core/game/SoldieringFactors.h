#pragma once

#include "core/data/IniReader.h"

/// What one point of each quantity adds to a player's soldiering score; FriendlyFire weighs damage to the own
/// team.
struct SoldieringFactors {
  double Damage = 1;
  double Death = -1;
  double Heal = -1;
  double Ammo = -1;
  double Accuracy = 1;
  double FriendlyFire = -1;
};

/// Section "soldiering_calc"; a missing key gives its default. Throws RuntimeError 13 for a text that is no
/// number, 6 for a number that is too large.
SoldieringFactors ReadSoldieringFactors(const IniReader& ini);

/// Writes all six factors in one replacement of the file; failure is not reported.
void WriteSoldieringFactors(IniReader& ini, const SoldieringFactors& factors);
