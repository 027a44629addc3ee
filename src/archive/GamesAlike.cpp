// How the archive tells that a game is one that it has.

#include <algorithm>
#include <string_view>

#include "archive/Entries.h"
#include "archive/GameArchive.h"
#include "archive/GameInputs.h"
#include "core/gamefile/GameFile.h"
#include "platform/RuntimeError.h"
#include "platform/Sql.h"

namespace {

std::string ConditionOf(GameArchive::Among among) {
  return among == GameArchive::Among::Deleted ? "Games.Deleted IS NOT NULL" : "Games.Deleted IS NULL";
}

/// True if the file of that name says in its first lines that its game has another date text. Unpacking them
/// takes a small part of the time that the whole file does.
bool SaysAnotherDate(Sql& archive, const std::string& name, const std::string& date) {
  constexpr std::int64_t headerLength = 4096;
  constexpr std::string_view opening = "<GameDate>";
  bool isAnother = false;
  archive.Query("SELECT substr(data, 1, $2), length(data) <> sz FROM sqlar WHERE name = $1",
                {name, headerLength}, [&](const SqlRow& row) {
                  const std::string header =
                      BeginningOf(row.Bytes(0), row.Integer(1) != 0, std::size_t{headerLength});
                  const std::size_t place = header.find(opening);
                  const std::size_t end = header.find('<', place + opening.size());
                  if (place == std::string::npos || end == std::string::npos) {
                    return;
                  }
                  const std::size_t first = place + opening.size();
                  const std::string_view said = std::string_view(header).substr(first, end - first);
                  // One that is empty or escaped reads otherwise than it stands there.
                  isAnother = !said.empty() && said.find('&') == std::string_view::npos && said != date;
                });
  return isAnother;
}

}  // namespace

std::optional<std::int64_t> GameArchive::Find(const Game& game, const std::string& missionName) {
  const std::optional<FoundState> found = FindState(game, missionName);
  return found ? std::optional(found->GameId) : std::nullopt;
}

std::optional<GameArchive::FoundState> GameArchive::FindState(const Game& game,
                                                              const std::string& missionName, Among among) {
  const std::string inputs = GameInputs(game, missionName);
  const std::vector<StoredFile> files =
      FilesWhere("GameFiles.InputsHash = $1 AND " + ConditionOf(among), {GameInputsHash(inputs)});
  // Most are just as they were kept, and need not be read for that.
  const auto same =
      std::ranges::find_if(files, [&](const StoredFile& file) { return IsFileOf(file, game, missionName); });
  if (same != files.end()) {
    return FoundState{same->GameId, same->State};
  }
  return FirstOf(files, [&inputs](const Game& kept, const std::string& mission) {
    return GameInputs(kept, mission) == inputs;
  });
}

bool GameArchive::IsFileOf(const StoredFile& file, const Game& game, const std::string& mission) {
  try {
    const Entry entry = ReadEntry(file.Name);
    EntryComparison comparison(entry.Data, entry.Size);
    WriteGameFile(game, mission, [&comparison](std::string_view piece) { comparison.Add(piece); });
    return comparison.IsEqual();
  } catch (const RuntimeError& error) {
    if (error.Number() != Fault::InvalidFileFormat) {
      throw;
    }
    return false;  // it cannot be this game any more
  }
}

std::optional<GameArchive::FoundState> GameArchive::FindAlike(const Game& game,
                                                              const std::string& missionName,
                                                              const std::string& played, Among among,
                                                              const std::function<void()>& breathe) {
  const std::vector<StoredFile> files = FilesOfDay(played, game, missionName, among);
  if (files.empty()) {
    return std::nullopt;
  }
  const std::string inputs = InputsOfAnybody(game, missionName);
  return FirstOf(files, [&](const Game& kept, const std::string& mission) {
    if (breathe) {
      breathe();
    }
    return InputsOfAnybody(kept, mission) == inputs;
  });
}

std::vector<GameArchive::StoredFile> GameArchive::FilesOfDay(const std::string& played, const Game& game,
                                                             const std::string& mission, Among among) {
  constexpr std::size_t dayLength = 10;
  const std::string day = played.substr(0, dayLength);
  std::int64_t players = 0;
  std::int64_t shots = 0;
  for (const Player& player : game.Players) {
    players += player.Active ? 1 : 0;
    shots += player.Active ? player.ShotCount : 0;
  }
  std::vector<StoredFile> files;
  // Joined so, the day's games are looked up first, however many files there are. Scores do not count: they
  // are made of other factors by then.
  archive_.Statements().Query(
      "SELECT GameFiles.GameID, GameFiles.State, GameFiles.Name FROM Games CROSS JOIN GameFiles "
      "WHERE GameFiles.GameID = Games.GameID AND Games.Played >= $1 AND Games.Played <= $2 AND "
      "(GameFiles.State > 0 OR (Games.DateText = $3 AND Games.Mission = $4 AND Games.Players = $5 AND "
      "(SELECT sum(Shots) FROM GamePlayers WHERE GamePlayers.GameID = Games.GameID) = $6)) AND " +
          ConditionOf(among) + " ORDER BY GameFiles.GameID, GameFiles.State",
      {day, day + " 24", game.GameDate, mission, players, shots}, [&files](const SqlRow& row) {
        files.push_back({row.Integer(0), row.Integer(1), row.Text(2)});
      });
  std::erase_if(files, [&](const StoredFile& file) {
    return file.State > 0 && SaysAnotherDate(archive_.Statements(), file.Name, game.GameDate);
  });
  return files;
}

std::optional<GameArchive::FoundState> GameArchive::FirstOf(const std::vector<StoredFile>& files,
                                                            const IsSame& isSame) {
  const auto found = std::ranges::find_if(files, [&](const StoredFile& file) {
    Game game(strings_);
    try {
      const std::string mission = ReadGame(file.Name, game);
      return isSame(game, mission);
    } catch (const RuntimeError& error) {
      if (error.Number() != Fault::InvalidFileFormat) {
        throw;
      }
      return false;  // it cannot be this game any more
    }
  });
  return found == files.end() ? std::nullopt : std::optional(FoundState{found->GameId, found->State});
}

std::string GameArchive::PlayedOf(std::int64_t gameId) {
  return PlayedIn(archive_.Statements(), gameId);
}

int GameArchive::BringBack(const std::vector<std::int64_t>& games) {
  WriteScope scope(archive_);
  std::int64_t back = 0;
  for (const std::int64_t game : games) {
    if (!StandsElsewhere(game)) {
      back += archive_.Statements().Change(
          "UPDATE Games SET Deleted = NULL WHERE GameID = $1 AND Deleted IS NOT NULL", {game});
    }
  }
  scope.Commit();
  return static_cast<int>(back);
}

bool GameArchive::StandsElsewhere(std::int64_t gameId) {
  Game game(strings_);
  std::string mission;
  std::string played;
  archive_.Statements().Query("SELECT Played FROM Games WHERE GameID = $1 AND Deleted IS NOT NULL", {gameId},
                              [&played](const SqlRow& row) { played = row.Text(0); });
  const std::vector<StoredFile> files = FilesWhere("GameFiles.GameID = $1 AND GameFiles.State = 0", {gameId});
  if (played.empty() || files.empty()) {
    return false;
  }
  try {
    mission = ReadGame(files.front().Name, game);
  } catch (const RuntimeError& error) {
    if (error.Number() != Fault::InvalidFileFormat) {
      throw;
    }
    return false;  // nobody can tell any more
  }
  return FindState(game, mission) || FindAlike(game, mission, played);
}
