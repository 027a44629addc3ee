#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "core/game/Game.h"
#include "core/game/SoldieringFactors.h"
#include "platform/Sql.h"

/// How a game came onto the board.
enum class GameSource { Cable, Radio, File, Import };

/// A game as it is on the board, its scores calculated, and what the archive keeps beside its file.
struct GameState {
  const ::Game& Game;
  std::string Mission = {};  ///< name of the active mission
  std::string Played = {};   ///< local time, "YYYY-MM-DD HH:MM:SS"
  GameSource Source = GameSource::Cable;
  int Pulls = 1;  ///< how many times guns were read into it
  SoldieringFactors Factors = {};
};

/// Adds the game's row and returns its number.
std::int64_t InsertGame(Sql& sql, const GameState& state, const std::string& inputsHash);

/// Writes the game's row anew, but for the time and the source, which are those of its first state. Returns
/// false if there is no such game.
bool UpdateGame(Sql& sql, std::int64_t gameId, const GameState& state, const std::string& inputsHash);

/// Writes the rows of the game's players; names of guests stay in them.
void WritePlayers(Sql& sql, std::int64_t gameId, const ::Game& game);

/// Deletes all that the archive has of a game, its files too.
void DeleteGame(Sql& sql, std::int64_t gameId);

/// When the game was played; empty if the archive has no such game, or has deleted it.
std::string PlayedIn(Sql& sql, std::int64_t gameId);

/// The numbers of all members who play in the game, ascending, each once.
std::vector<std::int32_t> MembersIn(const ::Game& game);
