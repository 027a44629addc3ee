#pragma once

#include <cstdint>
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

  /// Reads the archive.
  GamesPass(Database& archive, GamePersons persons, Task task);

  /// Looks into some games, each whole; what it writes is durable on return. True if there is more to do.
  /// Both are of the archive of the constructor. Throws RuntimeError as they do; the step can be
  /// repeated then.
  bool Step(Database& archive, GameArchive games);

  /// From 0 to 1.
  double Done() const;
  /// How many games so far named one of the persons.
  int Games() const { return found_; }
  const GamePersons& Persons() const { return persons_; }

 private:
  void ReadCandidates(Sql& sql);

  const GamePersons persons_;
  const Task task_;
  std::int64_t highest_ = 0;
  std::int64_t next_ = 0;  ///< the highest number that is still to be looked at
  std::vector<std::int64_t> candidates_;
  int found_ = 0;
};
