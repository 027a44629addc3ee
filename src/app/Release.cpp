#include "app/Release.h"

#include <string_view>

#include "app/Version.h"

std::string ReleaseText() {
  // Its length is that of the macro: a package's version, or nothing.
  constexpr std::string_view package(TESSARINE_PACKAGE_VERSION, sizeof(TESSARINE_PACKAGE_VERSION) - 1);
  return package.empty() ? VersionText : VersionText + (" (" + std::string(package) + ")");
}
