#pragma once

#include <string>

#include "exports/ExportedGame.h"

inline constexpr const char* GameJsonFormat = "tessarine-games";
/// Raised when a reader of the former version would go wrong; new keys alone do not raise it.
inline constexpr int GameJsonVersion = 1;

/// The games with their players and hits: an object with the keys `format`, `version` and `games`.
std::string GamesJson(const ExportedGames& games, const PersonalData& personal);
