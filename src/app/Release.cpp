#include "app/Release.h"

#include <string_view>

#include "app/Version.h"

std::string ReleaseText() {
  constexpr std::string_view package = TESSARINE_PACKAGE_VERSION;
  return package.empty() ? VersionText : VersionText + (" (" + std::string(package) + ")");
}
