#include "takeover/TakenRows.h"

#include <cstdint>
#include <functional>
#include <limits>
#include <variant>
#include <vector>

#include "core/text/Filled.h"
#include "platform/RuntimeError.h"
#include "platform/Sql.h"

namespace {

/// What a column holds, beside NULL.
enum class Holds { Numbers, Texts, Anything };

struct TypedColumn {
  std::string Name;
  Holds Kind;
};

/// Ends a query whose result is no longer wanted.
struct QueryStopped {};

std::string ListOf(const std::vector<std::string>& names) {
  std::string list;
  for (const std::string& name : names) {
    list.append(list.empty() ? "" : ", ").append(name);
  }
  return list;
}

std::string ParametersOf(std::size_t count) {
  std::string list;
  for (std::size_t number = 1; number <= count; ++number) {
    list.append(list.empty() ? "$" : ", $").append(std::to_string(number));
  }
  return list;
}

bool IsNumber(const Value& value) {
  return std::holds_alternative<std::int64_t>(value) || std::holds_alternative<double>(value);
}

/// A row that is never kept shows how the table stores a number: where it becomes a text, the column is one
/// of texts. Columns of numbers have a number as their default.
std::vector<TypedColumn> ColumnsOf(Database& into, const std::string& table) {
  const std::vector<std::string> names = into.ColumnNames(table);
  const WriteScope neverKept(into);
  Sql& sql = into.Statements();
  const std::int64_t row = sql.Insert("INSERT INTO " + table + " DEFAULT VALUES RETURNING " + names[0], {});
  std::vector<TypedColumn> columns;
  sql.Query(
      "SELECT " + ListOf(names) + " FROM " + table + " WHERE " + names[0] + " = $1", {row},
      [&](const SqlRow& values) {
        for (std::size_t column = 0; column < names.size(); ++column) {
          columns.push_back({names[column], IsNumber(values[column]) ? Holds::Numbers : Holds::Anything});
        }
      });
  for (TypedColumn& column : columns) {
    if (column.Kind == Holds::Anything) {
      sql.Change("UPDATE " + table + " SET " + column.Name + " = 1 WHERE " + names[0] + " = $1", {row});
      sql.Query("SELECT " + column.Name + " FROM " + table + " WHERE " + names[0] + " = $1", {row},
                [&column](const SqlRow& values) {
                  column.Kind =
                      std::holds_alternative<std::string>(values[0]) ? Holds::Texts : Holds::Anything;
                });
    }
  }
  return columns;
}

bool Fits(const Value& value, Holds kind) {
  if (std::holds_alternative<std::monostate>(value)) {
    return true;  // where it may not be, the table has refused it
  }
  switch (kind) {
    case Holds::Numbers:
      return IsNumber(value);
    case Holds::Texts:
      return std::holds_alternative<std::string>(value);
    case Holds::Anything:
      break;
  }
  return true;
}

class RowsTaken {
 public:
  RowsTaken(Database& into, const std::string& table, const StringTable& strings, const KeepOn& keepOn)
      : into_(into), table_(table), strings_(strings), keepOn_(keepOn), columns_(ColumnsOf(into, table)) {}

  /// Throws QueryStopped.
  void CopyFrom(Database& from) {
    std::vector<std::string> names;
    for (const TypedColumn& column : columns_) {
      names.push_back(column.Name);
    }
    const std::string insert =
        "INSERT INTO " + table_ + " (" + ListOf(names) + ") VALUES (" + ParametersOf(names.size()) + ")";
    ForEachRow(from, names, [&](const SqlRow& row) {
      SqlValues values;
      for (std::size_t column = 0; column < names.size(); ++column) {
        values.push_back(row[column]);
      }
      if (row.IsNull(0)) {
        Refuse(names[0]);
      }
      Insert(insert, values);
    });
  }

  /// What was stored is not always what was given: a text of digits becomes a number, others do not. Throws
  /// QueryStopped.
  void CheckTypes() {
    std::vector<std::string> names;
    std::vector<Holds> kinds;
    for (const TypedColumn& column : columns_) {
      if (column.Kind != Holds::Anything) {
        names.push_back(column.Name);
        kinds.push_back(column.Kind);
      }
    }
    ForEachRow(into_, names, [&](const SqlRow& row) {
      for (std::size_t column = 0; column < names.size(); ++column) {
        if (!Fits(row[column], kinds[column])) {
          Refuse(names[column]);
        }
      }
    });
  }

 private:
  void ForEachRow(Database& database, const std::vector<std::string>& names,
                  const std::function<void(const SqlRow&)>& act) {
    number_ = 0;
    database.Statements().Query("SELECT " + ListOf(names) + " FROM " + table_, {}, [&](const SqlRow& row) {
      ++number_;
      if (!keepOn_()) {
        throw QueryStopped();
      }
      act(row);
    });
  }

  void Insert(const std::string& statement, const SqlValues& values) {
    constexpr std::size_t bytesOfAFlush = std::size_t{1} << 20U;
    try {
      into_.Statements().Change(statement, values);
    } catch (const RuntimeError& error) {
      if (error.Number() == Fault::DatabaseDiskFull || error.Number() == Fault::DatabaseDiskError) {
        throw;
      }
      Refuse(error.what());
    }
    for (const Value& value : values) {
      const auto* bytes = std::get_if<Blob>(&value);
      unflushed_ += bytes != nullptr ? bytes->size() : sizeof(Value);
    }
    if (unflushed_ > bytesOfAFlush) {
      into_.FlushGroup();
      unflushed_ = 0;
    }
  }

  [[noreturn]] void Refuse(const std::string& reason) const {
    throw RuntimeError(Fault::TypeMismatch, Filled(strings_.Text(OwnText::TakeOverBadRow),
                                                   {std::to_string(number_), table_, reason}));
  }

  Database& into_;
  const std::string table_;
  const StringTable& strings_;
  const KeepOn& keepOn_;
  const std::vector<TypedColumn> columns_;
  std::int64_t number_ = 0;  ///< of the row that is being read, from 1
  std::size_t unflushed_ = 0;
};

/// The highest number that the file has ever given to a row; 0 if it does not tell one that can be used.
std::int64_t CounterOf(Database& from, const std::string& table) {
  try {
    const std::int64_t counter =
        WholeNumber(from.Statements(), "SELECT max(seq) FROM sqlite_sequence WHERE name = $1", {table});
    return counter <= std::numeric_limits<std::int32_t>::max() ? counter : 0;
  } catch (const RuntimeError&) {
    return 0;
  }
}

}  // namespace

bool TakeRows(Database& from, Database& into, const std::string& table, const StringTable& strings,
              const KeepOn& keepOn) {
  RowsTaken rows(into, table, strings, keepOn);
  try {
    WriteScope group(into);
    into.Statements().Change("DELETE FROM " + table, {});
    rows.CopyFrom(from);
    rows.CheckTypes();
    group.Commit();
  } catch (const QueryStopped&) {
    return false;
  }
  into.RaiseCounter(table, CounterOf(from, table));
  return true;
}
