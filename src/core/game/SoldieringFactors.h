#pragma once

#include "core/data/IniReader.h"
#include "core/data/SettingsTable.h"
#include "core/text/NumberForms.h"

/// What one unit of each quantity adds to a player's soldiering score. FriendlyFire weights damage done to
/// one's own team.
struct SoldieringFactors {
  double Damage = ToDouble(Keys::TotalDamage.Default);
  double Death = ToDouble(Keys::Respawns.Default);
  double Heal = ToDouble(Keys::Heals.Default);
  double Ammo = ToDouble(Keys::AmmoAdds.Default);
  double Accuracy = ToDouble(Keys::Accuracy.Default);
  double FriendlyFire = ToDouble(Keys::FriendlyFire.Default);
};

/// A missing key has its default. Throws RuntimeError 13 for a text that is not a number, 6 for a number that
/// is too large.
SoldieringFactors ReadSoldieringFactors(const IniReader& ini);

/// Writes all six factors, replacing the file once; a failure is not reported.
void WriteSoldieringFactors(IniReader& ini, const SoldieringFactors& factors);
