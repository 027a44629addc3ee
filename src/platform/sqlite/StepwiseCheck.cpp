#include "platform/sqlite/StepwiseCheck.h"

#include <chrono>

#include "platform/sqlite/SqliteError.h"

namespace {

constexpr std::chrono::milliseconds TimeOfAStep(10);  // a slow disk may take that for a few rows

/// `text` between two of `quote`, which are doubled in it.
std::string Quoted(const std::string& text, char quote) {
  std::string quoted(1, quote);
  for (const char letter : text) {
    quoted.append(letter == quote ? 2 : 1, letter);
  }
  return quoted.append(1, quote);
}

std::string QuotedName(const std::string& name) {
  return Quoted(name, '"');
}

std::string QuotedText(const std::string& text) {
  return Quoted(text, '\'');
}

std::vector<std::vector<std::string>> TextsOf(SqliteConnection& connection, const std::string& sql) {
  std::vector<std::vector<std::string>> rows;
  SqliteStatement statement(connection, sql);
  while (statement.Step()) {
    std::vector<std::string>& row = rows.emplace_back();
    for (std::size_t column = 0; column < statement.ColumnCount(); ++column) {
      row.push_back(statement.Text(static_cast<int>(column)));
    }
  }
  return rows;
}

bool IsWithRowids(SqliteConnection& connection, const std::string& table) {
  return TextsOf(connection, "SELECT name FROM pragma_table_list(" + QuotedText(table) +
                                 ") WHERE schema = 'main' AND NOT wr")
             .size() == 1;
}

/// The condition that row r has what an index holds of row e. What it holds of expressions is left out.
std::string EqualColumns(SqliteConnection& connection, const std::string& index) {
  std::string equal;
  for (const auto& column : TextsOf(connection, "SELECT name FROM pragma_index_xinfo(" + QuotedText(index) +
                                                    ") WHERE \"key\" AND cid >= 0")) {
    const std::string name = QuotedName(column[0]);
    equal.append(equal.empty() ? "r." : " AND r.").append(name).append(" IS e.").append(name);
  }
  return equal;
}

}  // namespace

StepwiseCheck::StepwiseCheck(const std::string& path) : connection_(path, std::chrono::milliseconds(0)) {
  ListWalks();
}

void StepwiseCheck::ListWalks() {
  for (const auto& row :
       TextsOf(connection_, "SELECT name FROM sqlite_schema WHERE type = 'table' AND rootpage > 0")) {
    ListWalksOf(row[0]);
  }
}

void StepwiseCheck::ListWalksOf(const std::string& table) {
  const std::string from = QuotedName(table);
  std::string itself = " NOT INDEXED";
  std::string sameRow = "r._rowid_ IS e._rowid_";
  std::vector<std::string> indexes;
  const bool hasRowids = IsWithRowids(connection_, table);
  // An index of some of the rows only is left out: it would have to be asked for those.
  for (const auto& index : TextsOf(connection_, "SELECT name, origin FROM pragma_index_list(" +
                                                    QuotedText(table) + ") WHERE NOT partial")) {
    if (!hasRowids && index[1] == "pk") {  // it is the table
      itself = " INDEXED BY " + QuotedName(index[0]);
      sameRow = EqualColumns(connection_, index[0]);
    } else {
      indexes.push_back(index[0]);
    }
  }
  walks_.push_back({"SELECT * FROM " + from + itself});
  for (const std::string& index : indexes) {
    std::string sql = "SELECT EXISTS (SELECT 1 FROM ";
    sql.append(from).append(" AS r").append(itself).append(" WHERE ").append(sameRow);
    const std::string equal = EqualColumns(connection_, index);
    sql.append(equal.empty() ? "" : " AND ").append(equal).append(") FROM ").append(from);
    walks_.push_back({sql.append(" AS e INDEXED BY ").append(QuotedName(index)), true});
  }
}

bool StepwiseCheck::Step() {
  const auto end = std::chrono::steady_clock::now() + TimeOfAStep;
  while (walk_ < walks_.size()) {
    if (!rows_) {
      rows_ = SqliteStatement(connection_, walks_[walk_].Sql);
    }
    if (!NextRow()) {
      EndWalk();
    }
    if (std::chrono::steady_clock::now() >= end) {
      return false;
    }
  }
  return true;
}

bool StepwiseCheck::NextRow() {
  if (!rows_.Step()) {  // which reads the row with all that it holds
    return false;
  }
  ++rowsSeen_;
  if (walks_[walk_].OfIndex && rows_.Integer(0) != 1) {
    throw UnrecognizedFormat(connection_.Path());
  }
  return true;
}

void StepwiseCheck::EndWalk() {
  if (!walks_[walk_].OfIndex) {
    rowsOfTable_ = rowsSeen_;
  } else if (rowsSeen_ != rowsOfTable_) {
    throw UnrecognizedFormat(connection_.Path());
  }
  rows_ = SqliteStatement();
  rowsSeen_ = 0;
  ++walk_;
}
