#include "platform/sqlite/SqliteConnection.h"

#include <array>
#include <cerrno>
#include <filesystem>
#include <memory>
#include <new>
#include <string_view>

#include <fcntl.h>
#include <sqlite3.h>
#include <sys/stat.h>
#include <unistd.h>

#include "platform/RuntimeError.h"
#include "platform/sqlite/JetLike.h"
#include "platform/sqlite/LikeRange.h"
#include "platform/sqlite/SqliteError.h"
#include "platform/sqlite/SqliteTable.h"

namespace {

std::string_view TextOf(sqlite3_value* value) {
  const auto* text = reinterpret_cast<const char*>(sqlite3_value_text(value));
  return text == nullptr ? std::string_view() : std::string_view(text, sqlite3_value_bytes(value));
}

void DeletePattern(void* pattern) {
  delete static_cast<JetPattern*>(pattern);
}

// SQLite calls this as like(Y, X) for "X LIKE Y".
void Like(sqlite3_context* context, int, sqlite3_value** arguments) {
  if (sqlite3_value_type(arguments[0]) == SQLITE_NULL || sqlite3_value_type(arguments[1]) == SQLITE_NULL) {
    sqlite3_result_null(context);
    return;
  }
  try {
    // A constant pattern is compiled once for all rows.
    const auto* kept = static_cast<const JetPattern*>(sqlite3_get_auxdata(context, 0));
    if (kept != nullptr) {
      sqlite3_result_int(context, kept->Matches(TextOf(arguments[1])));
      return;
    }
    auto pattern = std::make_unique<JetPattern>(TextOf(arguments[0]));
    sqlite3_result_int(context, pattern->Matches(TextOf(arguments[1])));
    sqlite3_set_auxdata(context, 0, pattern.release(), DeletePattern);
  } catch (const RuntimeError& error) {
    sqlite3_result_error(context, error.what(), -1);
    sqlite3_result_error_code(context, SqliteInvalidPattern);
  } catch (const std::bad_alloc&) {
    sqlite3_result_error_nomem(context);
  }
}

// Uses stat and does not open the file: closing any descriptor of a database file would drop the locks that
// this process holds on it through other connections.
void CheckFile(const std::string& path) {
  constexpr off_t smallestDatabase = 512;
  struct stat info {};
  if (stat(path.c_str(), &info) != 0) {
    if (errno == ENOENT || errno == ENOTDIR) {
      throw RuntimeError(Fault::DatabaseNotFound, "Could not find file '" + path + "'.");
    }
    throw CannotOpen(path);
  }
  if (!S_ISREG(info.st_mode)) {
    throw RuntimeError(Fault::DatabaseCannotOpen, "Cannot open the file '" + path + "'. It is no file.");
  }
  // An empty file would pass for a database without tables.
  if (info.st_size < smallestDatabase) {
    throw UnrecognizedFormat(path);
  }
}

std::string KeyQuery(const SqliteTable& table, const std::string& condition, SqliteConnection::Order order) {
  const std::string keys = "SELECT rowid FROM [" + table.Name() + "] WHERE (";
  const bool ordered = order == SqliteConnection::Order::Table;
  std::string query;
  if (!ordered) {
    for (const std::string& alternative : LikeAlternatives(table, condition)) {
      query.append(query.empty() ? "" : " UNION ALL ").append(keys).append(alternative).append(")");
    }
  }
  if (!query.empty()) {
    return query;
  }
  // The line break ends a comment in the condition, which would otherwise hide the closing bracket. The plus
  // keeps SQLite from scanning the whole table for its order where an index would find the rows.
  return keys + WithLikeRanges(table, condition) + "\n)" + (ordered ? " ORDER BY +rowid" : "");
}

}  // namespace

SqliteConnection::SqliteConnection(const std::string& path, std::chrono::milliseconds busyTimeout)
    : path_(path) {
  CheckFile(path);
  constexpr int flags =
      SQLITE_OPEN_READWRITE | SQLITE_OPEN_NOMUTEX | SQLITE_OPEN_PRIVATECACHE | SQLITE_OPEN_EXRESCODE;
  try {
    if (sqlite3_open_v2(path.c_str(), &handle_, flags, nullptr) != SQLITE_OK) {
      Fail();
    }
    folder_ = std::filesystem::path(sqlite3_db_filename(handle_, "main")).parent_path();
    CheckWritable();
    Configure(busyTimeout);
  } catch (...) {
    sqlite3_close_v2(handle_);
    throw;
  }
}

void SqliteConnection::Configure(std::chrono::milliseconds busyTimeout) {
  sqlite3_busy_timeout(handle_, static_cast<int>(busyTimeout.count()));
  if (sqlite3_create_function_v2(handle_, "like", 2, SQLITE_UTF8 | SQLITE_DETERMINISTIC, nullptr, Like,
                                 nullptr, nullptr, nullptr) != SQLITE_OK) {
    Fail();
  }
  // This first read fails on a file that is not a database, is truncated or has a damaged schema.
  Execute("SELECT count(*) FROM sqlite_master");
  CheckWholePages();
  // EXTRA also makes the deletion of the journal durable; without it a power failure just after a commit
  // could bring back the journal, and with it the old rows.
  Execute("PRAGMA synchronous = EXTRA");
}

// SQLite goes on read-only with a file that could not be opened for writing, whatever the reason. It is not
// to be the mode of a whole run because of a fault that has passed.
void SqliteConnection::CheckWritable() {
  if (sqlite3_db_readonly(handle_, "main") == 1 &&
      faccessat(AT_FDCWD, path_.c_str(), W_OK, AT_EACCESS) == 0) {
    throw CannotOpen(path_);
  }
}

// A file truncated within its last page opens without error and would fail only when that page is read.
void SqliteConnection::CheckWholePages() {
  SqliteStatement pageSize(*this, "PRAGMA page_size");
  struct stat info {};
  if (pageSize.Step() && stat(path_.c_str(), &info) == 0 && info.st_size % pageSize.Integer(0) != 0) {
    throw UnrecognizedFormat(path_);
  }
}

SqliteConnection::~SqliteConnection() {
  dataVersion_ = SqliteStatement();
  sqlite3_close_v2(handle_);
}

SqliteStatement SqliteConnection::PrepareSearch(const SqliteTable& table, const std::string& condition,
                                                Order order, int syntaxError) {
  const std::string sql = KeyQuery(table, condition, order);
  sqlite3_stmt* prepared = nullptr;
  const char* tail = nullptr;
  const int result =
      sqlite3_prepare_v2(handle_, sql.c_str(), static_cast<int>(sql.size() + 1), &prepared, &tail);
  SqliteStatement statement(*this, prepared);
  if (result != SQLITE_OK && (result & 0xFF) != SQLITE_ERROR) {
    Fail();
  }
  // Text after a semicolon would be a second statement, and parameters would have no values.
  const bool whole = result == SQLITE_OK && tail == sql.c_str() + sql.size();
  if (!whole || sqlite3_bind_parameter_count(prepared) != 0) {
    Rollback();
    throw RuntimeError(syntaxError, "Syntax error in query expression '" + condition + "'.");
  }
  return statement;
}

void SqliteConnection::EndRead() noexcept {
  if (--readers_ == 0) {
    Rollback();
  }
}

void SqliteConnection::PrepareRead() {
  if (readers_ > 0 && sqlite3_get_autocommit(handle_) != 0) {
    Execute("BEGIN");
    if (!dataVersion_) {
      dataVersion_ = SqliteStatement(*this, "PRAGMA data_version");
    }
    dataVersion_.Step();
    const std::int64_t version = dataVersion_.Integer(0);
    dataVersion_.Reset();
    if (version != versionRead_) {
      versionRead_ = version;
      LeaveState();
    }
  }
}

void SqliteConnection::Rollback() noexcept {
  if (!writing_) {
    Undo();
  }
}

void SqliteConnection::Undo() noexcept {
  if (sqlite3_get_autocommit(handle_) == 0) {
    sqlite3_exec(handle_, "ROLLBACK", nullptr, nullptr, nullptr);
  }
}

void SqliteConnection::PrepareChange() {
  const bool canChange = sqlite3_db_readonly(handle_, "main") == 0;
  if (canChange && beforeChange_ && beforeChange_()) {
    beforeChange_ = nullptr;
  }
}

// A journal beside the file would be taken for the new file's by whoever opens that next. With the lock held
// none can come: one that a crash left has been rolled back by then, and only an emptied one may be there.
void SqliteConnection::HoldWriters() {
  Rollback();
  if (sqlite3_db_readonly(handle_, "main") == 1) {
    throw RuntimeError(Fault::DatabaseReadOnly, "Cannot update. Database or object is read-only: " + path_);
  }
  Execute("PRAGMA journal_mode = DELETE");
  Execute("BEGIN IMMEDIATE");
  const char* const journal = sqlite3_filename_journal(sqlite3_db_filename(handle_, "main"));
  if (unlink(journal) != 0 && errno != ENOENT) {
    Undo();
    throw RuntimeError(Fault::DatabaseDiskError, "Disk error: " + path_);
  }
  writing_ = true;
  LeaveState();
}

void SqliteConnection::ReleaseWriters() noexcept {
  writing_ = false;
  Undo();
  LeaveState();
}

void SqliteConnection::Execute(const char* sql) {
  if (sqlite3_exec(handle_, sql, nullptr, nullptr, nullptr) != SQLITE_OK) {
    Fail();
  }
}

std::int64_t SqliteConnection::LastInsertedKey() const {
  return sqlite3_last_insert_rowid(handle_);
}

std::int64_t SqliteConnection::ChangedRows() const {
  return sqlite3_changes64(handle_);
}

void SqliteConnection::Fail(int systemError) {
  try {
    throw SqliteError(handle_, path_, systemError);
  } catch (...) {  // std::bad_alloc as well
    Undo();
    throw;
  }
}

// SQLite can report a commit as failed that is in the file: it commits by deleting the journal, and what
// comes after that can fail too. Told as a failure, the change would be entered a second time.
void SqliteConnection::Commit() {
  if (sqlite3_get_autocommit(handle_) != 0) {
    throw RuntimeError(Fault::NoTransaction);  // rolled back by a fault in one of the writes
  }
  if (!written_.AreAllTold()) {
    counterBefore_ = ChangeCounter();
  }
  errno = 0;
  const int result = sqlite3_exec(handle_, "COMMIT", nullptr, nullptr, nullptr);
  if (result == SQLITE_OK) {
    return;
  }
  try {
    Fail(errno);
  } catch (...) {
    if (!HoldsWhatWasWritten(result)) {
      throw;
    }
  }
  FlushFolder();
}

bool SqliteConnection::HoldsWhatWasWritten(int commitResult) {
  if ((commitResult & 0xFF) == SQLITE_BUSY) {
    return false;  // another program's lock, which is found before anything is written
  }
  try {
    if (!written_.AreIn(*this) || (!written_.AreAllTold() && !HasNewCounter())) {
      return false;
    }
    // SQLite takes a journal that it cannot see for one that is not there, and then reads rows that the next
    // one who sees it takes back.
    struct stat info {};
    if (stat(sqlite3_filename_journal(sqlite3_db_filename(handle_, "main")), &info) != 0 && errno == ENOENT) {
      return true;
    }
  } catch (...) {  // the file cannot be asked now
  }
  // These faults come from steps after the deletion of the journal: the flush of its folder, and giving up
  // the lock or all of it but the right to read. With any other the journal is still there, and the next one
  // who reads the file puts the old rows back.
  return commitResult == SQLITE_IOERR_DIR_FSYNC || commitResult == SQLITE_IOERR_UNLOCK ||
         commitResult == SQLITE_IOERR_RDLOCK;
}

// For rows that are not known one by one: every commit raises the counter in the file's header.
bool SqliteConnection::HasNewCounter() {
  Execute("SELECT count(*) FROM sqlite_master");  // puts the old rows and the old counter back from a journal
  return ChangeCounter() != counterBefore_;
}

// Through SQLite's own descriptor: closing another one would drop the locks on the file.
std::uint32_t SqliteConnection::ChangeCounter() const {
  constexpr sqlite3_int64 place = 24;
  std::array<std::uint8_t, 4> bytes{};
  sqlite3_file* file = nullptr;
  if (sqlite3_file_control(handle_, "main", SQLITE_FCNTL_FILE_POINTER, &file) != SQLITE_OK ||
      file == nullptr || file->pMethods == nullptr ||
      file->pMethods->xRead(file, bytes.data(), static_cast<int>(bytes.size()), place) != SQLITE_OK) {
    throw RuntimeError(Fault::DatabaseDiskError, "Disk error: " + path_);
  }
  std::uint32_t counter = 0;
  for (const std::uint8_t byte : bytes) {
    counter = counter << 8U | byte;
  }
  return counter;
}

// Makes the deletion of the journal durable where SQLite failed to. Should it fail again, the change is still
// whole and in the file, and only a power failure before the next flush could undo it; that is no reason to
// have it entered twice, and the next write will tell of a disk that is about to die.
void SqliteConnection::FlushFolder() noexcept {
  const int descriptor = open(folder_.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
  if (descriptor < 0) {
    return;
  }
  if (fsync(descriptor) != 0 && errno == EINVAL) {
    // This file system cannot flush a folder and would refuse each time. Leave it out then, which is SQLite's
    // own default, and all that such a file system has to give.
    sqlite3_exec(handle_, "PRAGMA synchronous = FULL", nullptr, nullptr, nullptr);
  }
  close(descriptor);
}

WriteTransaction::WriteTransaction(SqliteConnection& connection)
    : connection_(connection), isPart_(connection.writing_) {
  connection.LeaveState();
  if (!isPart_) {
    connection.Rollback();
    connection.PrepareChange();
    connection.Execute("BEGIN IMMEDIATE");
    connection.writing_ = true;
    connection.written_.Clear();
  } else if (sqlite3_get_autocommit(connection.Handle()) != 0) {
    throw RuntimeError(Fault::NoTransaction);
  }
}

WriteTransaction::~WriteTransaction() {
  if (!isPart_) {
    connection_.writing_ = false;
    connection_.written_.Clear();
    connection_.Rollback();
    connection_.LeaveState();
  }
}

void WriteTransaction::Commit() {
  if (!isPart_) {
    connection_.Commit();
  }
}
