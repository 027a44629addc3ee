#include "platform/jet/InterimRows.h"

#include "platform/RuntimeError.h"
#include "platform/sqlite/SqliteStatement.h"
#include "platform/sqlite/SqliteTable.h"

namespace {

void Attach(SqliteConnection& connection, const Value& path, const std::string& name) {
  SqliteStatement attach(connection, "ATTACH ?1 AS " + name);
  attach.Bind(1, path);
  attach.Step();
}

std::int64_t RowsOf(SqliteConnection& connection, const std::string& table) {
  SqliteStatement count(connection, "SELECT count(*) FROM " + table);
  count.Step();
  return count.Integer(0);
}

}  // namespace

InterimRows::InterimRows(const std::string& newFile, const OldDatabase& old,
                         std::chrono::milliseconds lockWait)
    : connection_(newFile, lockWait) {
  const SqliteTable table(connection_, old.Table);
  tableName_ = table.Name();
  table_ = "[" + tableName_ + "]";
  for (const SqliteColumn& column : table.Columns()) {
    if (column.IsKey) {
      key_ = "[" + column.Name + "]";
    } else {
      columns_ += (columns_.empty() ? "[" : ", [") + column.Name + "]";
    }
  }
  if (key_.empty()) {
    return;
  }
  Attach(connection_, old.InterimPath, "Interim");
  Attach(connection_, old.EmptyPath, "Empty");
  const std::string all = "SELECT " + key_ + ", " + columns_ + " FROM ";
  connection_.Execute(
      ("CREATE TEMP TABLE Entered AS " + all + "Interim." + table_ + " EXCEPT " + all + "Empty." + table_)
          .c_str());
  connection_.Execute("DETACH Interim");
  connection_.Execute("DETACH Empty");
  count_ = RowsOf(connection_, "temp.Entered");
}

void InterimRows::Join() {
  const std::int64_t before = RowsOf(connection_, "main." + table_);
  WriteTransaction transaction(connection_);
  const std::string isTaken = key_ + " IN (SELECT " + key_ + " FROM main." + table_ + ")";
  const auto add = [this](const std::string& key, const std::string& from) {
    connection_.Execute(("INSERT INTO main." + table_ + " (" + key_ + ", " + columns_ + ") SELECT " + key +
                         ", " + columns_ + " FROM " + from + " ORDER BY " + key_)
                            .c_str());
  };
  connection_.Execute(("CREATE TEMP TABLE Renumbered AS SELECT * FROM Entered WHERE " + isTaken).c_str());
  // First those that keep their keys, so that no new key takes one of theirs.
  add(key_, "temp.Entered WHERE NOT " + isTaken);
  add("NULL", "temp.Renumbered");
  transaction.Written().Write(tableName_, connection_.LastInsertedKey());
  transaction.Commit();
  if (RowsOf(connection_, "main." + table_) != before + count_) {
    throw RuntimeError(Fault::DatabaseDiskError, "The rows of the interim file could not be added.");
  }
}
