#pragma once

#include <cstdint>
#include <optional>
#include <set>

#include "archive/GamesPass.h"
#include "core/text/StringTable.h"
#include "platform/Database.h"

/// Cuts the numbers of members that belong to somebody else now from all games and their files. To be done at
/// start, and whenever the member table has become another one. One that is not done to its end is gone on
/// with by the next check: games that were kept since it began name those who have the numbers now.
///
/// All operations throw RuntimeError as the databases do.
class MemberCheck {
 public:
  /// The archive with the members to whom it is compared.
  struct Parts {
    Database& Archive;
    Database& Members;
    const StringTable& Strings;
  };

  /// Finds the numbers, and has the member table give out numbers above all that the archive knows.
  explicit MemberCheck(const Parts& parts) : MemberCheck(parts.Archive, Begin(parts)) {}

  const std::set<std::int32_t>& Strangers() const { return pass_.Persons().Numbers; }
  /// Those of them that no earlier check had found: until now nobody can have meant who has them now.
  const std::set<std::int32_t>& NewStrangers() const { return new_; }

  /// Cuts them from some games, with one look at each. True if there is more to do.
  bool Step(const Parts& parts);

  /// From 0 to 1.
  double Done() const { return pass_.Done(); }
  /// How many games so far no longer name a member, deleted ones included.
  int Games() const { return pass_.Games(); }

 private:
  struct Begun {
    GamesPass::Ranges Ranges;
    std::set<std::int32_t> New;
  };

  static Begun Begin(const Parts& parts);
  MemberCheck(Database& archive, const Begun& begun);
  void Finish(const Parts& parts);

  GamesPass pass_;
  std::set<std::int32_t> new_;
};
