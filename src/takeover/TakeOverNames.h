#pragma once

#include <cstdint>
#include <string>

/// The files of the data folder that are taken over, beside the databases.
inline constexpr const char* TemplateName = "score_card.doc";
inline constexpr const char* SettingsName = "tessarine.ini";

/// Copies and new files leave this to games and settings.
inline constexpr std::uint64_t RoomAfterTakeOver = std::uint64_t{32} << 20U;

/// "members.mdb" of "/home/x/members.mdb".
inline std::string FileNameIn(const std::string& path) {
  return path.substr(path.rfind('/') + 1);
}
