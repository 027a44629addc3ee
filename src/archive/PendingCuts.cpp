#include "archive/PendingCuts.h"

#include <algorithm>
#include <limits>

#include "platform/RuntimeError.h"
#include "platform/Sql.h"

namespace {

/// A row of no member: all games above its LastGameID are done.
constexpr std::int64_t DoneRow = 0;

void WriteCut(Sql& sql, std::int64_t number, const PendingCut& cut) {
  sql.Change(
      "INSERT INTO CutMembers (MemberID, FirstGameID, LastGameID, DallasID, Digest) "
      "VALUES ($1, $2, $3, $4, $5) ON CONFLICT (MemberID) DO UPDATE "
      "SET FirstGameID = $2, LastGameID = $3, DallasID = $4, Digest = $5",
      {number, cut.First, cut.Last, cut.Owner.DallasId, cut.Owner.Digest});
}

}  // namespace

PendingCuts::Cuts PendingCuts::Read() {
  Cuts cuts;
  if (!HasTable()) {
    return cuts;
  }
  std::int64_t left = std::numeric_limits<std::int64_t>::max();
  archive_.Statements().Query(
      "SELECT MemberID, FirstGameID, LastGameID, DallasID, Digest FROM CutMembers", {},
      [&](const SqlRow& row) {
        if (row.Integer(0) == DoneRow) {
          left = row.Integer(2);
        } else {
          cuts[static_cast<std::int32_t>(row.Integer(0))] = {
              .First = row.Integer(1), .Last = row.Integer(2), .Owner = {row.Text(3), row.Text(4)}};
        }
      });
  for (auto& [number, cut] : cuts) {
    cut.Last = std::min(cut.Last, left);
  }
  return cuts;
}

void PendingCuts::Write(const Cuts& cuts) {
  WriteScope scope(archive_);
  Sql& sql = archive_.Statements();
  if (!HasTable()) {
    sql.Change(
        "CREATE TABLE CutMembers (MemberID INTEGER PRIMARY KEY, FirstGameID INTEGER NOT NULL, "
        "LastGameID INTEGER NOT NULL, DallasID TEXT NOT NULL, Digest TEXT NOT NULL)",
        {});
  }
  sql.Change("DELETE FROM CutMembers WHERE MemberID = $1", {DoneRow});
  for (const auto& [number, cut] : cuts) {
    WriteCut(sql, number, cut);
  }
  scope.Commit();
}

void PendingCuts::NoteDone(std::int64_t game) {
  WriteCut(archive_.Statements(), DoneRow, {.First = 1, .Last = game, .Owner = {}});
}

void PendingCuts::Drop(const std::set<std::int32_t>& numbers) {
  if (!HasTable()) {
    return;
  }
  for (const std::int32_t number : numbers) {
    archive_.Statements().Change("DELETE FROM CutMembers WHERE MemberID = $1", {std::int64_t{number}});
  }
}

bool PendingCuts::HasTable() {
  try {
    archive_.ColumnNames("CutMembers");
    return true;
  } catch (const RuntimeError& error) {
    if (error.Number() != Fault::TableNotFound) {
      throw;
    }
    return false;
  }
}
