#pragma once

#include <cstdint>
#include <string>

#include "core/text/StringTable.h"
#include "platform/Files.h"

/// Game files, logs and copies come first: the archive writes only while so many bytes stay free.
inline constexpr std::uint64_t LeastFreeSpace = std::uint64_t{32} << 20U;

/// To be called before anything is written into the archive of that folder. Throws RuntimeError 61 if less of
/// its disk is free than is to be left to other files.
void CheckSpaceForGames(const Files& disk, const std::string& userDataFolder, const StringTable& strings);
