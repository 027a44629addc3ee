// What the archive does about persons in its games: numbers that changed hands, and members to be forgotten.

#include "archive/GameArchive.h"
#include "archive/GuestRows.h"
#include "core/game/DallasId.h"
#include "platform/RuntimeError.h"
#include "platform/Sql.h"

bool GameArchive::LookForPersons(std::int64_t gameId, const GamePersons& persons, Task task) {
  bool isIn = false;
  for (const StoredFile& file : FilesWhere("GameFiles.GameID = $1", {gameId})) {
    isIn = LookIntoFile(file, persons, task) || isIn;
  }
  return LookIntoRows(gameId, persons, task) || isIn;
}

bool GameArchive::LookIntoRows(std::int64_t gameId, const GamePersons& persons, Task task) {
  Sql& sql = archive_.Statements();
  std::vector<std::int64_t> players;
  sql.Query("SELECT PlayerIndex, MemberID, DallasID FROM GamePlayers WHERE GameID = $1", {gameId},
            [&](const SqlRow& row) {
              if (persons.Include(static_cast<std::int32_t>(row.Integer(1)), row.Text(2))) {
                players.push_back(row.Integer(0));
              }
            });
  if (task == Task::TakeOut) {
    for (const std::int64_t player : players) {
      sql.Change("UPDATE GamePlayers SET MemberID = 0 WHERE GameID = $1 AND PlayerIndex = $2",
                 {gameId, player});
      if (persons.TakesButtons) {
        sql.Change("UPDATE GamePlayers SET DallasID = $3 WHERE GameID = $1 AND PlayerIndex = $2",
                   {gameId, player, std::string(NoDallasId)});
      }
    }
    if (persons.TakesButtons && !players.empty()) {
      ForgetGuestNames(archive_, gameId, players);
    }
  }
  return !players.empty();
}

bool GameArchive::LookIntoFile(const StoredFile& file, const GamePersons& persons, Task task) {
  Game game(strings_);
  GameState state{.Game = game};
  try {
    state.Mission = ReadGame(file.Name, game);
  } catch (const RuntimeError& error) {
    if (error.Number() != Fault::InvalidFileFormat) {
      throw;
    }
    return false;  // nobody can read the number either
  }
  if (!persons.TakeFrom(game)) {
    return false;
  }
  if (task == Task::Look) {
    return true;
  }
  Sql& sql = archive_.Statements();
  const PackedState packed = Pack(state);
  sql.Query("SELECT Played FROM Games WHERE GameID = $1", {file.GameId},
            [&state](const SqlRow& row) { state.Played = row.Text(0); });
  WriteFile(file, packed, state.Played);
  if (file.State == 0) {
    sql.Change("UPDATE Games SET InputsHash = $1 WHERE GameID = $2", {packed.Hash, file.GameId});
  }
  return true;
}
