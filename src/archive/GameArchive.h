#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "archive/GamePersons.h"
#include "archive/GameRows.h"
#include "archive/KnownMembers.h"
#include "archive/PastGame.h"
#include "core/game/Game.h"
#include "core/text/StringTable.h"
#include "platform/Database.h"
#include "platform/RuntimeError.h"
#include "platform/Sql.h"

/// Whether the state of a game that the archive has stays as a further file when a later one is kept.
enum class FormerState { Replaced, KeptToo };

/// All games that were played, each with its figures, its players and its file. A game is kept whole or not
/// at all, and is durable once it is kept.
///
/// All operations throw RuntimeError as the databases do: 3026 disk full, 3027 read-only, 3050 locked, 3343
/// damaged; 321 for a game file that cannot be packed or unpacked, in the operator's language.
class GameArchive {
 public:
  /// All must outlive this object.
  GameArchive(Database& archive, Database& members, const StringTable& strings)
      : archive_(archive), known_(archive, members), strings_(strings) {}

  /// Adds a game, and returns its number.
  std::int64_t Keep(const GameState& state);

  /// Keeps a later state of a game. What is then its figures and its file is this one; time and source stay.
  /// A former state with equal inputs is never kept too. Returns false, with nothing changed, if the archive
  /// no longer has the game, or has it among the deleted ones.
  bool KeepAgain(std::int64_t gameId, const GameState& state, FormerState former);

  /// The number of the game that has, or once had, the same inputs as this one; none if there is no such
  /// game. Deleted games do not count.
  std::optional<std::int64_t> Find(const Game& game, const std::string& missionName);

  /// Which games to look among.
  enum class Among { Listed, Deleted };

  /// One of the states of a game. State 0 is the last one; earlier ones count from 1, the first.
  struct FoundState {
    std::int64_t GameId;
    std::int64_t State;
  };

  /// Find, with the state that has these inputs.
  std::optional<FoundState> FindState(const Game& game, const std::string& missionName,
                                      Among among = Among::Listed);

  /// The state of a game of the day of `played` ("YYYY-MM-DD HH:MM:SS") that is this game but for who its
  /// players are and which of them are committed. `breathe` is called between files that take their time.
  std::optional<FoundState> FindAlike(const Game& game, const std::string& missionName,
                                      const std::string& played, Among among = Among::Listed,
                                      const std::function<void()>& breathe = {});

  /// When a game was played; empty if there is no such game, or it is deleted.
  std::string PlayedOf(std::int64_t gameId);

  /// A game with the figures that it was kept with, deleted ones too. Throws RuntimeError 53 if there is no
  /// such game or state.
  PastGame Read(std::int64_t gameId, std::int64_t state = 0);

  /// Games that the operator no longer wants. They are in no answer until they are brought back. `now` is the
  /// local time, "YYYY-MM-DD HH:MM:SS". Returns how many were there.
  int Delete(const std::vector<std::int64_t>& games, const std::string& now);
  /// Undoes Delete, but not where the same game is there in another's place by now: that one and the deleted
  /// one stay as they are. Returns how many are back.
  int BringBack(const std::vector<std::int64_t>& games);
  /// Removes at most `most` of the games that were deleted before that local time, with their files. Returns
  /// how many.
  int RemoveDeleted(const std::string& before, int most);

  /// The bytes of the game's file. An earlier state counts from 1, the first; 0 is the last state. Throws
  /// RuntimeError 53 if there is no such file.
  std::string FileOf(std::int64_t gameId, std::int64_t state = 0);

  /// How many earlier states of the game have files.
  std::int64_t EarlierStates(std::int64_t gameId);

  /// Whether persons are only looked for in games or taken out of them too.
  enum class Task { Look, TakeOut };

  /// True if the rows or the file of any state of a game name one of the persons. What is taken out can still
  /// be in unused parts of the archive's file, until Database::RewriteTo. Use GamesPass.
  bool LookForPersons(std::int64_t gameId, const GamePersons& persons, Task task);

  KnownMembers& Known() { return known_; }

 private:
  struct StoredFile {
    std::int64_t GameId;
    std::int64_t State;
    std::string Name;
  };

  /// A state as the archive stores it.
  struct PackedState {
    Blob Data;
    std::int64_t Size;  ///< of the bytes in it
    std::string Hash;
  };

  /// An entry as it is stored.
  struct Entry {
    Blob Data;
    std::int64_t Size = -1;  ///< of the bytes in it, as it says
  };

  PackedState Pack(const GameState& state) const;
  void WriteFile(const StoredFile& file, const PackedState& packed, const std::string& played);
  /// Makes an earlier state of the last one; it has no last state then.
  void SetFormerFileAside(std::int64_t gameId, const std::string& played);
  std::vector<StoredFile> FilesWhere(const std::string& condition, const SqlValues& values);
  Entry ReadEntry(const std::string& name);
  std::string ReadFile(const std::string& name);
  /// Returns the name of the mission.
  std::string ReadGame(const std::string& name, Game& game);
  /// True if the file is to the byte what the game gives, its figures included.
  bool IsFileOf(const StoredFile& file, const Game& game, const std::string& mission);
  /// The first of these files whose game and mission `isSame` is true for.
  using IsSame = std::function<bool(const Game& game, const std::string& mission)>;
  std::optional<FoundState> FirstOf(const std::vector<StoredFile>& files, const IsSame& isSame);
  /// The files of that day that may hold the game: last states with its summary, and all earlier states.
  std::vector<StoredFile> FilesOfDay(const std::string& played, const Game& game, const std::string& mission,
                                     Among among);
  bool StandsElsewhere(std::int64_t gameId);
  bool LookIntoFile(const StoredFile& file, const GamePersons& persons, Task task);
  bool LookIntoRows(std::int64_t gameId, const GamePersons& persons, Task task);
  RuntimeError NoFile(std::int64_t gameId) const;
  RuntimeError Damaged(const std::string& name) const;
  RuntimeError TooLarge(const std::string& name) const;

  Database& archive_;
  KnownMembers known_;
  const StringTable& strings_;
};
