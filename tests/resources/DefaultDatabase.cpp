#include "tests/resources/DefaultDatabase.h"

#include <memory>
#include <stdexcept>

#include "tests/resources/DefaultFile.h"

namespace {

using Connection = std::unique_ptr<sqlite3, decltype(&sqlite3_close)>;
using Statement = std::unique_ptr<sqlite3_stmt, decltype(&sqlite3_finalize)>;

Connection Open(const std::string& path, int flags) {
  sqlite3* connection = nullptr;
  const int result = sqlite3_open_v2(path.c_str(), &connection, flags, nullptr);
  Connection owner(connection, &sqlite3_close);
  if (result != SQLITE_OK) {
    throw std::runtime_error(path + ": " + sqlite3_errmsg(connection));
  }
  return owner;
}

}  // namespace

DefaultDatabase::DefaultDatabase(const std::string& name) {
  const Connection file = Open(DefaultFile(name).string(), SQLITE_OPEN_READONLY);
  Connection copy = Open(":memory:", SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE);
  sqlite3_backup* backup = sqlite3_backup_init(copy.get(), "main", file.get(), "main");
  const int copied = backup != nullptr ? sqlite3_backup_step(backup, -1) : SQLITE_ERROR;
  sqlite3_backup_finish(backup);
  if (copied != SQLITE_DONE) {
    throw std::runtime_error(name + " cannot be copied");
  }
  connection_ = copy.release();
}

DefaultDatabase::~DefaultDatabase() {
  sqlite3_close(connection_);
}

bool DefaultDatabase::Run(const std::string& sql) {
  return sqlite3_exec(connection_, sql.c_str(), nullptr, nullptr, nullptr) == SQLITE_OK;
}

std::vector<std::string> DefaultDatabase::Column(const std::string& sql, int column) {
  sqlite3_stmt* prepared = nullptr;
  sqlite3_prepare_v2(connection_, sql.c_str(), -1, &prepared, nullptr);
  const Statement statement(prepared, &sqlite3_finalize);
  std::vector<std::string> values;
  int result = SQLITE_ERROR;
  while (prepared != nullptr && (result = sqlite3_step(prepared)) == SQLITE_ROW) {
    const auto* text = static_cast<const char*>(sqlite3_column_blob(prepared, column));
    const bool isNull = sqlite3_column_type(prepared, column) == SQLITE_NULL;
    const auto size = static_cast<std::size_t>(sqlite3_column_bytes(prepared, column));
    values.push_back(isNull ? "NULL" : size == 0 ? "" : std::string(text, size));
  }
  if (result != SQLITE_DONE) {
    throw std::runtime_error(sql + ": " + sqlite3_errmsg(connection_));
  }
  return values;
}

std::string DefaultDatabase::Single(const std::string& sql) {
  const std::vector<std::string> values = Column(sql);
  if (values.size() != 1) {
    throw std::runtime_error(sql + ": " + std::to_string(values.size()) + " rows");
  }
  return values.front();
}

std::string DefaultDatabase::Plan(const std::string& sql) {
  constexpr int detail = 3;
  return Column("EXPLAIN QUERY PLAN " + sql, detail).at(0);
}
