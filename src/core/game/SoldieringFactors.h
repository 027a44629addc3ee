#pragma once

#include "core/data/IniReader.h"

/// What one unit of each quantity adds to a player's soldiering score. FriendlyFire weights damage done to
/// one's own team.
struct SoldieringFactors {
  double Damage = 1;
  double Death = -1;
  double Heal = -1;
  double Ammo = -1;
  double Accuracy = 1;
  double FriendlyFire = -1;
};

/// Reads section "soldiering_calc"; a missing key has its default. Throws RuntimeError 13 for a text that is
/// not a number, 6 for a number that is too large.
SoldieringFactors ReadSoldieringFactors(const IniReader& ini);

/// Writes all six factors, replacing the file once; a failure is not reported.
void WriteSoldieringFactors(IniReader& ini, const SoldieringFactors& factors);
