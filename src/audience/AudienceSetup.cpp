#include "audience/AudienceSetup.h"

#include <algorithm>
#include <cmath>
#include <optional>

#include "core/text/NumberForms.h"

using namespace AudienceLimits;

namespace {

double NumberAt(const IniReader& ini, const Setting& setting) {
  const std::optional<double> number = NumberIn(ini.ReadIni(setting));
  return number && std::isfinite(*number) ? *number : Val(setting.Default);
}

double InchesOf(double number) {
  return number <= 0 ? 0 : std::clamp(number, LeastInches, MostInches);
}

/// The values as the file holds them.
IniReader::Values ValuesOf(const AudienceSetup& setup) {
  return {{Keys::AudienceScreen.Key, setup.Screen},
          {Keys::AudienceDistance.Key, PlainDecimal(setup.Metres)},
          {Keys::AudienceDiagonal.Key, PlainDecimal(setup.Inches)},
          {Keys::AudienceSeconds.Key, std::to_string(setup.Seconds)},
          {Keys::AudienceVenue.Key, setup.Venue},
          {Keys::AudiencePicture.Key, setup.Picture},
          {Keys::AudienceFollow.Key, setup.Follows ? "1" : "0"}};
}

}  // namespace

AudienceSetup ReadAudienceSetup(const IniReader& ini) {
  AudienceSetup setup;
  setup.Screen = ini.ReadIni(Keys::AudienceScreen);
  setup.Metres = std::clamp(NumberAt(ini, Keys::AudienceDistance), LeastMetres, MostMetres);
  setup.Inches = InchesOf(NumberAt(ini, Keys::AudienceDiagonal));
  setup.Seconds = static_cast<int>(
      std::clamp<double>(std::round(NumberAt(ini, Keys::AudienceSeconds)), LeastSeconds, MostSeconds));
  setup.Venue = ini.ReadIni(Keys::AudienceVenue);
  setup.Picture = ini.ReadIni(Keys::AudiencePicture);
  setup.Follows = ini.ReadIni(Keys::AudienceFollow) != "0";
  return setup;
}

void WriteAudienceSetup(IniReader& ini, const AudienceSetup& before, const AudienceSetup& now) {
  const IniReader::Values old = ValuesOf(before);
  IniReader::Values changed;
  for (const auto& value : ValuesOf(now)) {
    if (std::ranges::find(old, value) == old.end()) {
      changed.push_back(value);
    }
  }
  if (!changed.empty()) {
    ini.WriteIni(Keys::AudienceScreen.Section, changed);
  }
}
