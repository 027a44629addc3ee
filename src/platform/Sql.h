#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <variant>
#include <vector>

#include "platform/Database.h"
#include "platform/RuntimeError.h"

/// The values of $1, $2, ... in this order.
using SqlValues = std::vector<Value>;

/// A row of a query's result; columns count from 0. Valid until the next row.
class SqlRow {
 public:
  explicit SqlRow(const SqlValues& values) : values_(values) {}

  /// Throws RuntimeError 9 for a column that the row does not have.
  const Value& operator[](std::size_t column) const {
    if (column >= values_.size()) {
      throw RuntimeError(Fault::SubscriptOutOfRange);
    }
    return values_[column];
  }

  bool IsNull(std::size_t column) const { return std::holds_alternative<std::monostate>((*this)[column]); }

  /// 0 or empty for NULL. Each throws RuntimeError 3421 for a value of another type.
  std::int64_t Integer(std::size_t column) const { return Get<std::int64_t>(column); }
  std::string Text(std::size_t column) const { return Get<std::string>(column); }
  Blob Bytes(std::size_t column) const { return Get<Blob>(column); }

  /// Takes whole numbers too.
  double Real(std::size_t column) const {
    const auto* whole = std::get_if<std::int64_t>(&(*this)[column]);
    return whole != nullptr ? static_cast<double>(*whole) : Get<double>(column);
  }

 private:
  template <typename Type>
  Type Get(std::size_t column) const {
    if (const auto* value = std::get_if<Type>(&(*this)[column])) {
      return *value;
    }
    if (!IsNull(column)) {
      throw RuntimeError(Fault::DataConversion);
    }
    return {};
  }

  const SqlValues& values_;
};

/// Statements on a database, for what no recordset can express. They are written so that PostgreSQL would
/// understand them too: parameters are $1, $2, ..., each used at least once and in any order; no LIKE, which
/// follows Jet here.
///
/// All operations throw RuntimeError with the numbers that Recordset tells, and 3000 for an SQL error; 3075
/// for several statements in one text, for a statement of the other kind, and for parameters that do not
/// match the values.
class Sql {
 public:
  virtual ~Sql() = default;

  /// Calls `act` for each row of the result. It may run other queries, but must not change the database.
  virtual void Query(const std::string& statement, const SqlValues& values,
                     const std::function<void(const SqlRow& row)>& act) = 0;

  /// Runs a statement that changes rows, and returns how many it changed. It is durable on return unless a
  /// WriteScope is open on the database. In one, a failure undoes the whole group.
  virtual std::int64_t Change(const std::string& statement, const SqlValues& values) = 0;

  /// Runs an INSERT with RETURNING of one number, and returns that number. Otherwise as Change.
  virtual std::int64_t Insert(const std::string& statement, const SqlValues& values) = 0;
};

/// The first column of a query's last row, a whole number; 0 without a row.
inline std::int64_t WholeNumber(Sql& sql, const std::string& query, const SqlValues& values = {}) {
  std::int64_t number = 0;
  sql.Query(query, values, [&number](const SqlRow& row) { number = row.Integer(0); });
  return number;
}
