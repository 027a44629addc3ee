#include "archive/GuestRows.h"

#include <algorithm>

#include "core/game/PublicName.h"
#include "platform/Sql.h"

namespace {

std::string NameIn(const GuestList::Names& names, int index) {
  const auto found = names.find(index);
  return found == names.end() ? std::string() : CleanName(found->second);
}

/// What makes `now` of `before`; an empty name is taken away.
GuestList::Names ChangesOf(const GuestList::Names& before, const GuestList::Names& now) {
  GuestList::Names changes;
  for (const GuestList::Names* names : {&before, &now}) {
    for (const auto& [index, name] : *names) {
      if (NameIn(before, index) != NameIn(now, index)) {
        changes[index] = NameIn(now, index);
      }
    }
  }
  return changes;
}

void WriteGuestNames(Database& archive, std::int64_t gameId, const GuestList::Names& changes) {
  WriteScope scope(archive);
  Sql& sql = archive.Statements();
  if (!HasGuestNames(archive)) {
    sql.Change("ALTER TABLE GamePlayers ADD COLUMN GuestName TEXT", {});
  }
  for (const auto& [index, name] : changes) {
    sql.Change("UPDATE GamePlayers SET GuestName = $1 WHERE GameID = $2 AND PlayerIndex = $3",
               {name.empty() ? Value() : Value(name), gameId, std::int64_t{index}});
  }
  scope.Commit();
}

}  // namespace

bool HasGuestNames(Database& archive) {
  const std::vector<std::string> columns = archive.ColumnNames("GamePlayers");
  return std::ranges::find(columns, "GuestName") != columns.end();
}

GuestList::Names GuestNamesOf(Database& archive, std::int64_t gameId) {
  GuestList::Names names;
  if (HasGuestNames(archive)) {
    archive.Statements().Query(
        "SELECT PlayerIndex, GuestName FROM GamePlayers WHERE GameID = $1 AND GuestName IS NOT NULL",
        {gameId}, [&names](const SqlRow& row) { names[static_cast<int>(row.Integer(0))] = row.Text(1); });
  }
  return names;
}

void ForgetGuestNames(Database& archive, std::int64_t gameId, const std::vector<std::int64_t>& players) {
  if (!HasGuestNames(archive)) {
    return;
  }
  for (const std::int64_t player : players) {
    archive.Statements().Change(
        "UPDATE GamePlayers SET GuestName = NULL WHERE GameID = $1 AND PlayerIndex = $2", {gameId, player});
  }
}

bool KeptGuests::HaveChanged(std::int64_t gameId) const {
  return guests_ != nullptr && guests_->All() != Before(gameId);
}

void KeptGuests::Keep(Database& archive, std::int64_t gameId) {
  GuestList::Names changes = ChangesOf(Before(gameId), guests_->All());
  const GuestList::Names there = GuestNamesOf(archive, gameId);
  std::erase_if(changes,
                [&there](const auto& change) { return NameIn(there, change.first) == change.second; });
  if (!changes.empty()) {
    WriteGuestNames(archive, gameId, changes);
  }
  kept_ = guests_->All();
  game_ = gameId;
}
