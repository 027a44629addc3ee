#include "platform/sqlite/SqliteStatement.h"

#include <new>
#include <utility>

#include <sqlite3.h>

#include "platform/sqlite/SqliteConnection.h"

SqliteStatement::SqliteStatement(SqliteConnection& connection, const std::string& sql)
    : connection_(&connection) {
  if (sqlite3_prepare_v2(connection.Handle(), sql.c_str(), -1, &statement_, nullptr) != SQLITE_OK) {
    connection.Fail();
  }
}

SqliteStatement::SqliteStatement(SqliteConnection& connection, sqlite3_stmt* statement)
    : connection_(&connection), statement_(statement) {}

SqliteStatement::~SqliteStatement() {
  sqlite3_finalize(statement_);
}

SqliteStatement::SqliteStatement(SqliteStatement&& other) noexcept
    : connection_(other.connection_), statement_(std::exchange(other.statement_, nullptr)) {}

SqliteStatement& SqliteStatement::operator=(SqliteStatement&& other) noexcept {
  std::swap(connection_, other.connection_);
  std::swap(statement_, other.statement_);
  return *this;
}

void SqliteStatement::Bind(int parameter, std::int64_t value) {
  Reset();
  sqlite3_bind_int64(statement_, parameter, value);
}

void SqliteStatement::Bind(int parameter, const Value& value) {
  Reset();
  int result = SQLITE_OK;
  if (const auto* integer = std::get_if<std::int64_t>(&value)) {
    result = sqlite3_bind_int64(statement_, parameter, *integer);
  } else if (const auto* real = std::get_if<double>(&value)) {
    result = sqlite3_bind_double(statement_, parameter, *real);
  } else if (const auto* text = std::get_if<std::string>(&value)) {
    result =
        sqlite3_bind_text64(statement_, parameter, text->data(), text->size(), SQLITE_STATIC, SQLITE_UTF8);
  } else if (const auto* blob = std::get_if<Blob>(&value)) {
    // An empty vector's data() may be null, which would bind NULL.
    result = blob->empty()
                 ? sqlite3_bind_zeroblob(statement_, parameter, 0)
                 : sqlite3_bind_blob64(statement_, parameter, blob->data(), blob->size(), SQLITE_STATIC);
  } else {
    result = sqlite3_bind_null(statement_, parameter);
  }
  if (result != SQLITE_OK) {
    connection_->Fail();
  }
}

int SqliteStatement::ParameterCount() const {
  return sqlite3_bind_parameter_count(statement_);
}

const char* SqliteStatement::ParameterName(int parameter) const {
  return sqlite3_bind_parameter_name(statement_, parameter);
}

void SqliteStatement::ForgetValues() {
  Reset();
  sqlite3_clear_bindings(statement_);
}

bool SqliteStatement::ReadsOnly() const {
  return sqlite3_stmt_readonly(statement_) != 0;
}

std::size_t SqliteStatement::ColumnCount() const {
  return static_cast<std::size_t>(sqlite3_column_count(statement_));
}

bool SqliteStatement::Step() {
  const int result = sqlite3_step(statement_);
  if (result == SQLITE_ROW) {
    return true;
  }
  if (result != SQLITE_DONE) {
    sqlite3_reset(statement_);
    connection_->Fail();
  }
  sqlite3_reset(statement_);
  return false;
}

void SqliteStatement::Reset() {
  sqlite3_reset(statement_);
}

std::int64_t SqliteStatement::Integer(int column) const {
  return sqlite3_column_int64(statement_, column);
}

std::string SqliteStatement::Text(int column) const {
  const auto* text = reinterpret_cast<const char*>(sqlite3_column_text(statement_, column));
  return text == nullptr ? std::string() : std::string(text, sqlite3_column_bytes(statement_, column));
}

void SqliteStatement::Read(int column, Value& value) const {
  switch (sqlite3_column_type(statement_, column)) {
    case SQLITE_INTEGER:
      value = sqlite3_column_int64(statement_, column);
      break;
    case SQLITE_FLOAT:
      value = sqlite3_column_double(statement_, column);
      break;
    case SQLITE_TEXT: {
      const auto* text = reinterpret_cast<const char*>(sqlite3_column_text(statement_, column));
      if (text == nullptr) {
        throw std::bad_alloc();
      }
      const auto size = static_cast<std::size_t>(sqlite3_column_bytes(statement_, column));
      if (auto* held = std::get_if<std::string>(&value)) {
        held->assign(text, size);
      } else {
        value.emplace<std::string>(text, size);
      }
      break;
    }
    case SQLITE_BLOB: {
      const auto* bytes = static_cast<const std::uint8_t*>(sqlite3_column_blob(statement_, column));
      value.emplace<Blob>(bytes, bytes + sqlite3_column_bytes(statement_, column));
      break;
    }
    default:
      value = std::monostate();
      break;
  }
}
