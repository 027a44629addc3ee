#pragma once

/// The version as the About window shows it.
inline constexpr const char* VersionText = "3.54 21-5-2013";
