#include "platform/sqlite/SqliteDatabase.h"

#include <sqlite3.h>
#include <strings.h>

#include <cerrno>
#include <string_view>

#include "platform/RuntimeError.h"
#include "platform/sqlite/SqliteError.h"
#include "platform/sqlite/SqliteRecordset.h"

namespace {

constexpr std::string_view Blanks = " \t\r\n";

void SkipBlanks(std::string_view& text) {
  const std::size_t first = text.find_first_not_of(Blanks);
  text.remove_prefix(first == std::string_view::npos ? text.size() : first);
}

// Takes the next word, or the name between brackets.
std::string_view TakeWord(std::string_view& text) {
  SkipBlanks(text);
  if (text.starts_with('[')) {
    const std::size_t end = text.find(']');
    const std::string_view name =
        end == std::string_view::npos ? std::string_view() : text.substr(1, end - 1);
    text.remove_prefix(end == std::string_view::npos ? text.size() : end + 1);
    return name;
  }
  const std::string_view word = text.substr(0, text.find_first_of(" \t\r\n([*", 1));
  text.remove_prefix(word.size());
  return word;
}

bool TakeKeyword(std::string_view& text, std::string_view keyword) {
  std::string_view rest = text;
  const std::string_view word = TakeWord(rest);
  if (word.size() != keyword.size() || strncasecmp(word.data(), keyword.data(), word.size()) != 0) {
    return false;
  }
  text = rest;
  return true;
}

}  // namespace

std::unique_ptr<Recordset> SqliteDatabase::OpenRecordset(const std::string& source) {
  std::string_view rest = source;
  if (!TakeKeyword(rest, "SELECT")) {
    return std::make_unique<SqliteRecordset>(connection_, source, "");
  }
  const bool all = TakeKeyword(rest, "*") && TakeKeyword(rest, "FROM");
  const std::string table(TakeWord(rest));
  const bool limited = TakeKeyword(rest, "WHERE");
  SkipBlanks(rest);
  if (!all || table.empty() || limited == rest.empty()) {
    throw RuntimeError(Fault::QuerySyntax, "Syntax error in query '" + source + "'.");
  }
  return std::make_unique<SqliteRecordset>(connection_, table, std::string(rest));
}

void SqliteDatabase::RaiseCounter(const std::string& table, std::int64_t number) {
  // The counter has no row before the table's first one.
  const std::string highest = "SELECT max(seq) FROM sqlite_sequence WHERE name = $1";
  if (WholeNumber(statements_, highest, {table}) >= number) {
    return;
  }
  WriteTransaction transaction(connection_);
  if (statements_.Change("UPDATE sqlite_sequence SET seq = $1 WHERE name = $2", {number, table}) == 0) {
    statements_.Change("INSERT INTO sqlite_sequence (name, seq) VALUES ($1, $2)", {table, number});
  }
  transaction.Commit();
}

void SqliteDatabase::CommitTrans() {
  if (!group_) {
    throw RuntimeError(Fault::NoTransaction);
  }
  group_->Commit();
  group_.reset();
}

void SqliteDatabase::FlushGroup() {
  if (!group_) {
    return;
  }
  const int result = sqlite3_db_cacheflush(connection_.Handle());
  // The commit can still write what others who are reading keep it from writing now.
  if (result == SQLITE_BUSY) {
    return;
  }
  if (result != SQLITE_OK) {
    connection_.Fail();
  }
  if (!FlushFile(connection_.Handle())) {
    const RuntimeError failure = FlushError(connection_.Path(), errno);
    Rollback();
    throw failure;
  }
}

std::vector<std::string> SqliteDatabase::ColumnNames(const std::string& table) {
  const SqliteTable described(connection_, table);
  std::vector<std::string> names;
  for (const SqliteColumn& column : described.Columns()) {
    names.push_back(column.Name);
  }
  return names;
}

std::string SqliteDatabase::FilePath() const {
  return sqlite3_db_filename(connection_.Handle(), "main");
}

bool SqliteDatabase::HasMoved() const {
  int moved = 0;
  return sqlite3_file_control(connection_.Handle(), "main", SQLITE_FCNTL_HAS_MOVED, &moved) != SQLITE_OK ||
         moved != 0;
}

std::unique_ptr<Database> SqliteEngine::OpenDatabase(const std::string& path) {
  return std::make_unique<SqliteDatabase>(path, busyTimeout_);
}
