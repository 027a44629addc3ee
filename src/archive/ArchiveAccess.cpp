#include "archive/ArchiveAccess.h"

#include <utility>

#include "archive/ArchiveRoom.h"
#include "archive/GuestRows.h"
#include "core/text/Filled.h"

/// Those of an archive without games.
class ArchiveAccess::NoStatements : public Sql {
 public:
  void Query(const std::string& /*statement*/, const SqlValues& /*values*/,
             const std::function<void(const SqlRow&)>& /*act*/) override {}
  std::int64_t Change(const std::string& /*statement*/, const SqlValues& /*values*/) override { return 0; }
  std::int64_t Insert(const std::string& /*statement*/, const SqlValues& /*values*/) override {
    throw RuntimeError(Fault::DatabaseError);
  }
};

ArchiveAccess::ArchiveAccess(Parts parts)
    : parts_(std::move(parts)), none_(std::make_unique<NoStatements>()) {}

ArchiveAccess::~ArchiveAccess() = default;

Sql& ArchiveAccess::Statements() {
  return Exists() ? File().Statements() : *none_;
}

Database& ArchiveAccess::File() {
  if (!file_.Open || file_.Open->HasMoved()) {
    Close();
    file_ = OpenArchive(parts_.Engine, parts_.Disk, parts_.UserDataFolder,
                        parts_.ProgramFolder + "/games_default.mdb");
  }
  return *file_.Open;
}

GameArchive ArchiveAccess::Archive() {
  return {File(), parts_.Session.DbMembers(), parts_.Strings};
}

void ArchiveAccess::CheckSpace() const {
  CheckSpaceForGames(parts_.Disk, parts_.UserDataFolder, parts_.Strings);
}

PastGame ArchiveAccess::Read(std::int64_t gameId, std::int64_t state) {
  if (!Exists()) {
    throw RuntimeError(Fault::FileNotFound,
                       Filled(parts_.Strings.Text(OwnText::NoArchivedGame), {std::to_string(gameId)}));
  }
  return Archive().Read(gameId, state);
}

std::string ArchiveAccess::GuestNameOf(std::int64_t gameId, int index) {
  std::string name;
  if (HasNamesOfGuests()) {
    Statements().Query("SELECT GuestName FROM GamePlayers WHERE GameID = $1 AND PlayerIndex = $2",
                       {gameId, std::int64_t{index}},
                       [&name](const SqlRow& row) { name = CleanName(row.Text(0)); });
  }
  return name;
}

bool ArchiveAccess::HasNamesOfGuests() {
  return Exists() && HasGuestNames(File());
}

NickNames ArchiveAccess::Names() const {
  return
      [&session = parts_.Session](std::int32_t contactId) { return session.Members().NickNameOf(contactId); };
}

void ArchiveAccess::Close() {
  file_ = {};
}

bool ArchiveAccess::Exists() const {
  return ArchiveExists(parts_.Disk, parts_.UserDataFolder);
}
