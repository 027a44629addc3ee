#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <vector>

#include "archive/GameArchive.h"
#include "archive/GamePersons.h"
#include "platform/Database.h"

/// A walk over all games of an archive, deleted ones included, that looks for persons in their rows and in
/// the files of all their states. It is done in many short steps, between which the archive may be used;
/// games that are kept meanwhile are left alone. The latest games come first.
class GamesPass {
 public:
  using Task = GameArchive::Task;

  /// Numbers of games, both included.
  struct Range {
    std::int64_t First = 1;
    std::int64_t Last = 0;
  };
  using Ranges = std::map<std::int32_t, Range>;  ///< of members' numbers

  /// Reads the archive.
  GamesPass(Database& archive, GamePersons persons, Task task);
  /// Looks for each number in its own games only.
  GamesPass(Database& archive, Task task, const Ranges& ranges);

  /// Looks into some games, each whole; what it writes is durable on return. True if there is more to do.
  /// Both are of the archive of the constructor. Throws RuntimeError as they do; the step can be
  /// repeated then. `beforeCommit` is called within the group of writes, with the highest number of a game
  /// that is still to be looked at.
  bool Step(Database& archive, GameArchive games,
            const std::function<void(std::int64_t)>& beforeCommit = nullptr);

  /// From 0 to 1.
  double Done() const;
  /// How many games so far named one of the persons.
  int Games() const { return found_; }
  const GamePersons& Persons() const { return persons_; }

 private:
  void ReadCandidates(Sql& sql);
  bool LookInto(std::int64_t game, GameArchive& games) const;

  const GamePersons persons_;
  const Task task_;
  const Ranges ranges_ = {};
  Range common_;  ///< the games of all ranges
  std::int64_t highest_ = 0;
  std::int64_t next_ = 0;  ///< the highest number that is still to be looked at
  std::vector<std::int64_t> candidates_;
  int found_ = 0;
};
