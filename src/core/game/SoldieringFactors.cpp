#include "core/game/SoldieringFactors.h"

#include <array>
#include <string>

namespace {

struct FactorSetting {
  const Setting& In;
  double SoldieringFactors::*Factor;
};

/// In the order in which they are written to the file.
constexpr std::array<FactorSetting, 6> FactorSettings = {{
    {Keys::TotalDamage, &SoldieringFactors::Damage},
    {Keys::Respawns, &SoldieringFactors::Death},
    {Keys::Heals, &SoldieringFactors::Heal},
    {Keys::AmmoAdds, &SoldieringFactors::Ammo},
    {Keys::Accuracy, &SoldieringFactors::Accuracy},
    {Keys::FriendlyFire, &SoldieringFactors::FriendlyFire},
}};

}  // namespace

SoldieringFactors ReadSoldieringFactors(const IniReader& ini) {
  SoldieringFactors factors;
  for (const FactorSetting& setting : FactorSettings) {
    factors.*setting.Factor = ToDouble(ini.ReadIni(setting.In));
  }
  return factors;
}

void WriteSoldieringFactors(IniReader& ini, const SoldieringFactors& factors) {
  IniReader::Values values;
  for (const FactorSetting& setting : FactorSettings) {
    values.emplace_back(setting.In.Key, Str(factors.*setting.Factor));
  }
  ini.WriteIni(FactorSettings.front().In.Section, values);
}
