#include "archive/GameArchive.h"

#include <string_view>

#include "archive/Entries.h"
#include "archive/GameInputs.h"
#include "archive/GuestRows.h"
#include "core/gamefile/GameFile.h"
#include "core/text/Filled.h"
#include "platform/RuntimeError.h"
#include "platform/Sql.h"

namespace {

/// How the sqlite3 tool is to make the file: a plain one, which its owner writes and all read.
constexpr std::int64_t FileMode = 0100644;

constexpr std::size_t BytesInMegabyte = std::size_t{1} << 20U;

}  // namespace

std::int64_t GameArchive::Keep(const GameState& state) {
  const PackedState packed = Pack(state);
  const KnownMembers::Marks marks = known_.Read(MembersIn(state.Game));
  known_.RaiseCounterAbove(marks);
  WriteScope scope(archive_);
  Sql& sql = archive_.Statements();
  const std::int64_t gameId = InsertGame(sql, state, packed.Hash);
  WritePlayers(sql, gameId, state.Game);
  WriteFile({gameId, 0, EntryName(state.Played, gameId, 0)}, packed, state.Played);
  known_.Note(marks);
  scope.Commit();
  return gameId;
}

bool GameArchive::KeepAgain(std::int64_t gameId, const GameState& state, FormerState former) {
  const PackedState packed = Pack(state);
  const KnownMembers::Marks marks = known_.Read(MembersIn(state.Game));
  known_.RaiseCounterAbove(marks);
  WriteScope scope(archive_);
  Sql& sql = archive_.Statements();
  std::optional<std::string> played;
  std::string formerHash;
  sql.Query("SELECT Played, InputsHash FROM Games WHERE GameID = $1 AND Deleted IS NULL", {gameId},
            [&](const SqlRow& row) {
              played = row.Text(0);
              formerHash = row.Text(1);
            });
  if (!played) {
    return false;
  }
  UpdateGame(sql, gameId, state, packed.Hash);
  if (former == FormerState::KeptToo && formerHash != packed.Hash) {
    SetFormerFileAside(gameId, *played);
  }
  WritePlayers(sql, gameId, state.Game);
  WriteFile({gameId, 0, EntryName(*played, gameId, 0)}, packed, *played);
  known_.Note(marks);
  scope.Commit();
  return true;
}

std::string GameArchive::FileOf(std::int64_t gameId, std::int64_t state) {
  const std::vector<StoredFile> files =
      FilesWhere("GameFiles.GameID = $1 AND GameFiles.State = $2", {gameId, state});
  if (files.empty()) {
    throw NoFile(gameId);
  }
  return ReadFile(files.front().Name);
}

PastGame GameArchive::Read(std::int64_t gameId, std::int64_t state) {
  const std::vector<StoredFile> files =
      FilesWhere("GameFiles.GameID = $1 AND GameFiles.State = $2", {gameId, state});
  if (files.empty()) {
    throw NoFile(gameId);
  }
  PastGame past(strings_);
  past.GameId = gameId;
  past.State = state;
  archive_.Statements().Query(
      "SELECT Played, DamageFactor, DeathFactor, HealFactor, AmmoFactor, AccuracyFactor, FriendlyFireFactor "
      "FROM Games WHERE GameID = $1",
      {gameId}, [&past](const SqlRow& row) {
        past.Played = row.Text(0);
        past.Factors = {.Damage = row.Real(1),
                        .Death = row.Real(2),
                        .Heal = row.Real(3),
                        .Ammo = row.Real(4),
                        .Accuracy = row.Real(5),
                        .FriendlyFire = row.Real(6)};
      });
  past.Guests = GuestNamesOf(archive_, gameId);
  past.Mission = ReadGame(files.front().Name, past.Game);
  past.Game.DataPresent = true;
  try {
    CompleteScores(past.Game);
  } catch (const RuntimeError&) {
    throw Damaged(files.front().Name);  // such sums were never on a board
  }
  return past;
}

int GameArchive::Delete(const std::vector<std::int64_t>& games, const std::string& now) {
  WriteScope scope(archive_);
  std::int64_t deleted = 0;
  for (const std::int64_t game : games) {
    deleted += archive_.Statements().Change(
        "UPDATE Games SET Deleted = $1 WHERE GameID = $2 AND Deleted IS NULL", {now, game});
  }
  scope.Commit();
  return static_cast<int>(deleted);
}

int GameArchive::RemoveDeleted(const std::string& before, int most) {
  Sql& sql = archive_.Statements();
  std::vector<std::int64_t> games;
  sql.Query("SELECT GameID FROM Games WHERE Deleted < $1 LIMIT $2", {before, std::int64_t{most}},
            [&games](const SqlRow& row) { games.push_back(row.Integer(0)); });
  if (games.empty()) {
    return 0;
  }
  WriteScope scope(archive_);
  for (const std::int64_t game : games) {
    DeleteGame(sql, game);
  }
  scope.Commit();
  return static_cast<int>(games.size());
}

std::int64_t GameArchive::EarlierStates(std::int64_t gameId) {
  return WholeNumber(archive_.Statements(), "SELECT max(State) FROM GameFiles WHERE GameID = $1", {gameId});
}

GameArchive::PackedState GameArchive::Pack(const GameState& state) const {
  Packer packer;
  WriteGameFile(state.Game, state.Mission, [&packer](std::string_view piece) { packer.Add(piece); });
  if (packer.Size() > LargestEntry) {
    throw TooLarge(EntryName(state.Played, 0, 0));
  }
  PackedState packed{packer.Finish(), static_cast<std::int64_t>(packer.Size()),
                     GameInputsHash(GameInputs(state.Game, state.Mission))};
  if (packed.Data.size() >= packer.Size()) {
    packed.Data = Packed(WriteGameFile(state.Game, state.Mission));
  }
  return packed;
}

void GameArchive::WriteFile(const StoredFile& file, const PackedState& packed, const std::string& played) {
  Sql& sql = archive_.Statements();
  sql.Change(
      "INSERT INTO sqlar (name, mode, mtime, sz, data) VALUES ($1, $2, $3, $4, $5) "
      "ON CONFLICT (name) DO UPDATE SET mtime = $3, sz = $4, data = $5",
      {file.Name, FileMode, SecondsOf(played), packed.Size, packed.Data});
  sql.Change(
      "INSERT INTO GameFiles (GameID, State, Name, InputsHash) VALUES ($1, $2, $3, $4) "
      "ON CONFLICT (GameID, State) DO UPDATE SET Name = $3, InputsHash = $4",
      {file.GameId, file.State, file.Name, packed.Hash});
}

void GameArchive::SetFormerFileAside(std::int64_t gameId, const std::string& played) {
  Sql& sql = archive_.Statements();
  const std::int64_t state = EarlierStates(gameId) + 1;
  const std::string name = EntryName(played, gameId, state);
  sql.Change("UPDATE sqlar SET name = $1 WHERE name = $2", {name, EntryName(played, gameId, 0)});
  sql.Change("UPDATE GameFiles SET State = $1, Name = $2 WHERE GameID = $3 AND State = 0",
             {state, name, gameId});
}

std::vector<GameArchive::StoredFile> GameArchive::FilesWhere(const std::string& condition,
                                                             const SqlValues& values) {
  std::vector<StoredFile> files;
  archive_.Statements().Query(
      "SELECT GameFiles.GameID, GameFiles.State, GameFiles.Name FROM GameFiles JOIN Games "
      "ON Games.GameID = GameFiles.GameID WHERE " +
          condition + " ORDER BY GameFiles.GameID, GameFiles.State",
      values, [&files](const SqlRow& row) {
        files.push_back({row.Integer(0), row.Integer(1), row.Text(2)});
      });
  return files;
}

GameArchive::Entry GameArchive::ReadEntry(const std::string& name) {
  Entry entry;
  bool isTooLarge = false;
  archive_.Statements().Query(
      "SELECT sz, length(data) > $2, CASE WHEN length(data) > $2 THEN NULL ELSE data END FROM sqlar "
      "WHERE name = $1",
      {name, std::int64_t{LargestEntry}}, [&](const SqlRow& row) {
        entry.Size = row.Integer(0);
        isTooLarge = row.Integer(1) != 0;
        entry.Data = row.Bytes(2);
      });
  if (isTooLarge) {
    throw TooLarge(name);
  }
  return entry;
}

std::string GameArchive::ReadFile(const std::string& name) {
  const Entry entry = ReadEntry(name);
  std::string bytes;
  switch (Unpack(entry.Data, entry.Size, bytes)) {
    case Unpacking::Done:
      return bytes;
    case Unpacking::TooLarge:
      throw TooLarge(name);
    case Unpacking::Damaged:
      break;
  }
  throw Damaged(name);
}

std::string GameArchive::ReadGame(const std::string& name, Game& game) {
  std::string mission;
  bool isGame = false;
  try {
    isGame = ReadGameFile(ReadFile(name), game, [&mission](const std::string& text) { mission = text; });
  } catch (const RuntimeError& error) {
    switch (error.Number()) {
      case Fault::TypeMismatch:
      case Fault::Overflow:
      case Fault::SubscriptOutOfRange:
        break;  // what a game file with wrong contents gives
      default:
        throw;
    }
  }
  if (!isGame) {
    throw Damaged(name);
  }
  return mission;
}

RuntimeError GameArchive::NoFile(std::int64_t gameId) const {
  return {Fault::FileNotFound, Filled(strings_.Text(OwnText::NoArchivedGame), {std::to_string(gameId)})};
}

RuntimeError GameArchive::Damaged(const std::string& name) const {
  return {Fault::InvalidFileFormat, Filled(strings_.Text(OwnText::ArchivedGameDamaged), {name})};
}

RuntimeError GameArchive::TooLarge(const std::string& name) const {
  return {Fault::InvalidFileFormat, Filled(strings_.Text(OwnText::ArchivedGameTooLarge),
                                           {name, std::to_string(LargestEntry / BytesInMegabyte)})};
}
