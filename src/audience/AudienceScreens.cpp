#include "audience/AudienceScreens.h"

#include <algorithm>

AudienceSpot SpotOn(const std::vector<AudienceScreen>& screens, const std::string& wanted,
                    const std::string& held) {
  const auto isFree = [&screens](const std::string& name) {
    return std::ranges::any_of(
        screens, [&name](const AudienceScreen& each) { return each.Name == name && !each.IsOperators; });
  };
  if (!held.empty()) {
    return {isFree(held) ? AudienceSpot::Kind::Screen : AudienceSpot::Kind::Nowhere, held};
  }
  if (!wanted.empty() && isFree(wanted)) {
    return {AudienceSpot::Kind::Screen, wanted};
  }
  const bool isOperators = std::ranges::any_of(
      screens, [&wanted](const AudienceScreen& each) { return each.Name == wanted && each.IsOperators; });
  const auto other = std::ranges::find(screens, false, &AudienceScreen::IsOperators);
  if (isOperators || other == screens.end()) {
    return {};
  }
  return {AudienceSpot::Kind::Screen, other->Name};
}
