#include "core/game/SoldieringFactors.h"

#include <array>
#include <string>

#include "core/text/NumberForms.h"

namespace {

constexpr const char* Section = "soldiering_calc";

struct FactorKey {
  const char* Key;
  double SoldieringFactors::*Factor;
};

/// In the order in which they are written to the file.
constexpr std::array<FactorKey, 6> FactorKeys = {{
    {"total_damage", &SoldieringFactors::Damage},
    {"respawns", &SoldieringFactors::Death},
    {"heals", &SoldieringFactors::Heal},
    {"ammo_adds", &SoldieringFactors::Ammo},
    {"accuracy", &SoldieringFactors::Accuracy},
    {"friendly_fire_factor", &SoldieringFactors::FriendlyFire},
}};

}  // namespace

SoldieringFactors ReadSoldieringFactors(const IniReader& ini) {
  SoldieringFactors factors;
  for (const FactorKey& entry : FactorKeys) {
    double& factor = factors.*entry.Factor;
    factor = ToDouble(ini.ReadIni(Section, entry.Key, Str(factor)));
  }
  return factors;
}

void WriteSoldieringFactors(IniReader& ini, const SoldieringFactors& factors) {
  IniReader::Values values;
  for (const FactorKey& entry : FactorKeys) {
    values.emplace_back(entry.Key, Str(factors.*entry.Factor));
  }
  ini.WriteIni(Section, values);
}
