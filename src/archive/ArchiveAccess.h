#pragma once

#include <cstdint>
#include <memory>
#include <string>

#include "archive/ArchiveFile.h"
#include "archive/ArchiveQueries.h"
#include "archive/GameArchive.h"
#include "archive/PastGame.h"
#include "core/game/PublicName.h"
#include "core/game/Session.h"

/// The archive of games for windows and commands that look into it. It has a connection of its own beside the
/// keeper's, so it may be used at any time on the program's one thread.
///
/// All operations throw RuntimeError as OpenArchive, Sql and GameArchive do.
class ArchiveAccess {
 public:
  /// All must outlive this object.
  struct Parts {
    ::Session& Session;  ///< open, whenever the archive is used
    Files& Disk;
    DatabaseEngine& Engine;  ///< should not wait long for a locked file
    const StringTable& Strings;
    std::string UserDataFolder;
    std::string ProgramFolder;
  };

  explicit ArchiveAccess(Parts parts);
  ~ArchiveAccess();
  ArchiveAccess(const ArchiveAccess&) = delete;
  ArchiveAccess& operator=(const ArchiveAccess&) = delete;

  /// Statements on the archive. As long as there is no archive, queries have no rows and changes change
  /// nothing. Valid until Close.
  Sql& Statements();
  ArchiveQueries Queries() { return ArchiveQueries(Statements()); }

  /// The archive itself, whose file is made if there is none. Valid until Close or until the session's
  /// databases are opened anew; make it for each use.
  GameArchive Archive();
  /// Its database, for groups of reads and writes.
  Database& File();

  /// To be called before something is written into the archive. Throws RuntimeError 61 if too little of the
  /// disk is free.
  void CheckSpace() const;

  /// A game as it was kept, deleted ones too. Throws RuntimeError 53 if there is no such game or state, 321
  /// if its file is damaged.
  PastGame Read(std::int64_t gameId, std::int64_t state = 0);

  /// The guest name of a player at record `index` in this game; empty without one.
  std::string GuestNameOf(std::int64_t gameId, int index);

  /// True if the archive's rows have names of guests. Valid until a first name is written.
  bool HasNamesOfGuests();

  /// The public names of members as they are now, looked up by number without a box.
  NickNames Names() const;

  /// The archive's file that could not be used, so that another one beside it is; empty if none.
  const std::string& Unusable() const { return file_.Unusable; }

  /// Lets go of the file. What is asked next opens it anew, or the one that has taken its place.
  void Close();

 private:
  class NoStatements;

  bool Exists() const;

  const Parts parts_;
  std::unique_ptr<NoStatements> none_;
  ArchiveFile file_;
};
