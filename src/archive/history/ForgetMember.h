#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "core/text/StringTable.h"
#include "platform/Database.h"
#include "platform/Files.h"

/// How the forgetting of a member ended.
struct Forgotten {
  int Games = 0;  ///< of the archive in use that named the member
  /// What could not be done, a sentence for the operator each; empty if the member stands nowhere any more.
  std::vector<std::string> Failures = {};
};

/// Has the archive of games, and all copies of it, forget a member. The member table, the game on the board
/// and files that the operator saved are left alone.
class ForgetMember {
 public:
  /// All must outlive this object.
  struct Parts {
    DatabaseEngine& Engine;
    Files& Disk;
    Database& DbMembers;
    const StringTable& Strings;
    std::string UserDataFolder;
  };

  explicit ForgetMember(Parts parts) : parts_(std::move(parts)) {}

  /// Each file forgets the member whole or not at all, and is written anew then. One that fails is told and
  /// does not keep the others from it.
  Forgotten Forget(std::int32_t number) const;

 private:
  /// The archive, and the one that was begun beside it when it could not be used.
  std::vector<std::string> ArchivesInUse() const;
  int ForgetIn(const std::string& file, std::int32_t number, std::vector<std::string>& failures) const;

  const Parts parts_;
};

/// How many games of an archive name the member, deleted ones included. Throws RuntimeError as Sql does.
int GamesNaming(Sql& archive, std::int32_t number);
