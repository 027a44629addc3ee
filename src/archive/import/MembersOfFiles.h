#pragma once

#include <cstdint>
#include <map>
#include <string>

#include "core/game/Game.h"
#include "platform/Database.h"

/// Whose member numbers stand in imported files.
enum class FilesOf {
  OtherTable,  ///< perhaps another venue's: a number counts only with its button
  ThisTable    ///< the numbers are taken as they stand
};

/// Gives the players of imported files their members. In files of another table a number counts only if the
/// member with it has the player's button; else the member with that button it is, else none.
///
/// All operations throw RuntimeError as the member table does.
class MembersOfFiles {
 public:
  /// `members` must outlive this object.
  MembersOfFiles(Database& members, FilesOf table) : members_(members), table_(table) {}

  void Settle(Game& game);

 private:
  bool Has(std::int32_t number, const std::string& button);
  /// The first member with this button; 0 if there is none.
  std::int32_t OwnerOf(const std::string& button);

  Database& members_;
  const FilesOf table_;
  std::map<std::string, std::int32_t> owners_;  ///< of the buttons that were looked up
};
