#pragma once

#include <string>

/// The version as the About window shows it, with that of the package where there is one: another text for
/// each release.
std::string ReleaseText();
