#include "platform/sqlite/SqliteSql.h"

#include <sqlite3.h>

#include <charconv>
#include <string_view>
#include <utility>

#include "platform/RuntimeError.h"

namespace {

/// More than any part of the program uses in turns.
constexpr std::size_t MostPrepared = 64;

RuntimeError Refused(const std::string& reason, const std::string& statement) {
  return {Fault::QuerySyntax, reason + " in query '" + statement + "'."};
}

/// The place among the values, counted from 0, of a parameter called "$1" and so on; `none` if it has another
/// name.
std::size_t PlaceOf(const char* name, std::size_t none) {
  const std::string_view digits = name == nullptr ? std::string_view() : std::string_view(name).substr(1);
  std::size_t number = 0;
  const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), number);
  const bool isNumber = error == std::errc() && end == digits.data() + digits.size();
  return isNumber && *name == '$' && number > 0 ? number - 1 : none;
}

void ReadRow(const SqliteStatement& statement, SqlValues& values) {
  for (std::size_t column = 0; column < values.size(); ++column) {
    statement.Read(static_cast<int>(column), values[column]);
  }
}

}  // namespace

void SqliteSql::Query(const std::string& statement, const SqlValues& values,
                      const std::function<void(const SqlRow& row)>& act) {
  connection_.PrepareRead();
  SqliteStatement query = Take(statement, values, Kind::Reads);
  SqlValues row(query.ColumnCount());
  while (query.Step()) {
    ReadRow(query, row);
    act(SqlRow(row));
  }
  Keep(statement, std::move(query));
}

std::int64_t SqliteSql::Change(const std::string& statement, const SqlValues& values) {
  WriteTransaction transaction(connection_);
  SqliteStatement change = Take(statement, values, Kind::Changes);
  transaction.Written().WriteUntold();
  while (change.Step()) {
  }
  const std::int64_t changed = connection_.ChangedRows();
  Keep(statement, std::move(change));
  transaction.Commit();
  return changed;
}

std::int64_t SqliteSql::Insert(const std::string& statement, const SqlValues& values) {
  WriteTransaction transaction(connection_);
  SqliteStatement insertion = Take(statement, values, Kind::Changes);
  if (insertion.ColumnCount() != 1) {
    throw Refused("One number must be returned", statement);
  }
  transaction.Written().WriteUntold();
  std::int64_t number = 0;
  while (insertion.Step()) {
    number = insertion.Integer(0);
  }
  Keep(statement, std::move(insertion));
  transaction.Commit();
  return number;
}

SqliteStatement SqliteSql::Take(const std::string& text, const SqlValues& values, Kind kind) {
  auto kept = prepared_.extract(text);
  SqliteStatement statement = kept ? std::move(kept.mapped()) : Prepare(text);
  if (statement.ReadsOnly() != (kind == Kind::Reads)) {
    throw Refused(kind == Kind::Reads ? "A change" : "No change", text);
  }
  std::vector<bool> used(values.size());
  for (int parameter = 1; parameter <= statement.ParameterCount(); ++parameter) {
    const std::size_t place = PlaceOf(statement.ParameterName(parameter), values.size());
    if (place >= values.size()) {
      throw Refused("A parameter without a value", text);
    }
    statement.Bind(parameter, values[place]);
    used[place] = true;
  }
  for (const bool isUsed : used) {
    if (!isUsed) {
      throw Refused("A value without a parameter", text);
    }
  }
  return statement;
}

SqliteStatement SqliteSql::Prepare(const std::string& text) {
  sqlite3_stmt* prepared = nullptr;
  const char* tail = nullptr;
  const int size = static_cast<int>(text.size() + 1);
  const int result = sqlite3_prepare_v3(connection_.Handle(), text.c_str(), size, SQLITE_PREPARE_PERSISTENT,
                                        &prepared, &tail);
  SqliteStatement statement(connection_, prepared);
  if (result != SQLITE_OK) {
    connection_.Fail();
  }
  if (prepared == nullptr || *tail != '\0') {
    throw Refused(prepared == nullptr ? "No statement" : "Several statements", text);
  }
  return statement;
}

void SqliteSql::Keep(const std::string& text, SqliteStatement statement) {
  if (prepared_.size() >= MostPrepared) {
    prepared_.clear();
  }
  statement.ForgetValues();
  prepared_.insert_or_assign(text, std::move(statement));
}
