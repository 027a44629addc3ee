#pragma once

#include <cstdint>
#include <map>
#include <set>

#include "archive/KnownMembers.h"
#include "platform/Database.h"

/// The games in which a number stands for somebody else than its present owner.
struct PendingCut {
  std::int64_t First = 1;  ///< GameID
  std::int64_t Last = 0;   ///< GameID; below First if there are none
  MemberMark Owner;        ///< who has the number now, and is named by later games
};

/// The numbers that are still to be cut from games, as the archive keeps them until that is done. The table
/// is made when it is first needed.
///
/// All operations throw RuntimeError as the database does.
class PendingCuts {
 public:
  using Cuts = std::map<std::int32_t, PendingCut>;

  /// `archive` must outlive this object.
  explicit PendingCuts(Database& archive) : archive_(archive) {}

  /// Without the games that are done.
  Cuts Read();
  /// In place of all that were there with these numbers; nothing of them is done.
  void Write(const Cuts& cuts);
  /// The games above `game` are done. To be called within the group of writes that did them.
  void NoteDone(std::int64_t game);
  void Drop(const std::set<std::int32_t>& numbers);

 private:
  bool HasTable();

  Database& archive_;
};
