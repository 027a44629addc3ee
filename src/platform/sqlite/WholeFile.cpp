#include "platform/sqlite/WholeFile.h"

#include <fcntl.h>
#include <sqlite3.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <memory>
#include <optional>
#include <utility>
#include <vector>

#include "platform/RuntimeError.h"
#include "platform/sqlite/SqliteConnection.h"
#include "platform/sqlite/SqliteError.h"
#include "platform/sqlite/SqliteStatement.h"
#include "platform/sqlite/StepwiseCheck.h"

namespace {

constexpr int PagesOfAStep = 256;
constexpr int InstructionsOfAStep = 20000;
constexpr int InstructionsOfRewriting = 200;  // each may copy a whole game file
constexpr off_t BytesOfAFlush = off_t{2} << 20;

using Handle = std::unique_ptr<sqlite3, decltype(&sqlite3_close)>;

/// The file of the open database; nullptr if there is none.
sqlite3_file* OpenFile(sqlite3* database) {
  sqlite3_file* file = nullptr;
  const bool isOpen = sqlite3_file_control(database, "main", SQLITE_FCNTL_FILE_POINTER, &file) == SQLITE_OK &&
                      file != nullptr && file->pMethods != nullptr;
  return isOpen ? file : nullptr;
}

/// Asks during a statement whether to keep on, as long as it exists.
class StatementWatch {
 public:
  StatementWatch(sqlite3* database, const KeepOn& keepOn, int instructions = InstructionsOfAStep)
      : database_(database), keepOn_(keepOn) {
    if (keepOn_) {
      sqlite3_progress_handler(database_, instructions, Ask, this);
    }
  }
  ~StatementWatch() { sqlite3_progress_handler(database_, 0, nullptr, nullptr); }
  StatementWatch(const StatementWatch&) = delete;
  StatementWatch& operator=(const StatementWatch&) = delete;

  bool Stopped() const { return stopped_; }

 private:
  static int Ask(void* watch) {
    auto& self = *static_cast<StatementWatch*>(watch);
    self.stopped_ = self.stopped_ || !self.keepOn_();
    return self.stopped_ ? 1 : 0;
  }

  sqlite3* database_;
  const KeepOn& keepOn_;
  bool stopped_ = false;
};

/// Flushes a file while it is written, so that no flush takes long.
class GrowingFile {
 public:
  explicit GrowingFile(std::string path) : path_(std::move(path)) {}

  void FlushIfGrown() {
    struct stat info {};
    if (stat(path_.c_str(), &info) == 0 && info.st_size - flushed_ >= BytesOfAFlush) {
      Flush();
      flushed_ = info.st_size;
    }
  }
  /// False if the disk fails.
  bool Flush() const {
    const int file = open(path_.c_str(), O_RDONLY | O_CLOEXEC);
    const bool isFlushed = file >= 0 && fdatasync(file) == 0;
    if (file >= 0) {
      close(file);
    }
    return isFlushed;
  }

 private:
  const std::string path_;
  off_t flushed_ = 0;
};

std::string QuotedText(const std::string& text) {
  std::string quoted = "'";
  for (const char character : text) {
    quoted.append(character == '\'' ? 2 : 1, character);
  }
  return quoted.append("'");
}

class SqliteStepwiseCopy : public StepwiseCopy {
 public:
  SqliteStepwiseCopy(SqliteConnection& source, std::string path)
      : path_(std::move(path)), copy_(OpenCopy(path_), sqlite3_close) {
    backup_ = sqlite3_backup_init(copy_.get(), "main", source.Handle(), "main");
    if (backup_ == nullptr) {
      throw SqliteError(copy_.get(), path_);
    }
  }
  ~SqliteStepwiseCopy() override { sqlite3_backup_finish(backup_); }
  SqliteStepwiseCopy(const SqliteStepwiseCopy&) = delete;
  SqliteStepwiseCopy& operator=(const SqliteStepwiseCopy&) = delete;

  bool Step() override {
    if (check_) {
      return check_->Step();
    }
    if (Advance(WhenLocked::TryAgain)) {
      copy_.reset();
      check_.emplace(path_);
    }
    return false;
  }

  enum class WhenLocked { TryAgain, Fail };
  bool Advance(WhenLocked whenLocked) {
    switch (sqlite3_backup_step(backup_, PagesOfAStep)) {
      case SQLITE_DONE:
        Finish();
        // A file that keeps a log would have its copy keep one too.
        sqlite3_exec(copy_.get(), "PRAGMA journal_mode = DELETE", nullptr, nullptr, nullptr);
        return true;
      case SQLITE_OK:
        Flush();
        return false;
      case SQLITE_BUSY:
      case SQLITE_LOCKED:
        if (whenLocked == WhenLocked::TryAgain) {
          return false;
        }
        break;
      default:
        break;
    }
    Finish();
    throw RuntimeError(Fault::DatabaseDiskError, "Disk error: " + path_);
  }

 private:
  static sqlite3* OpenCopy(const std::string& path) {
    sqlite3* opened = nullptr;
    constexpr int flags = SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE | SQLITE_OPEN_NOMUTEX;
    if (sqlite3_open_v2(path.c_str(), &opened, flags, nullptr) != SQLITE_OK) {
      const Handle failed(opened, sqlite3_close);
      throw SqliteError(opened, path);
    }
    // Neither a journal nor a flush of all at once at the end: each step flushes its own.
    sqlite3_exec(opened, "PRAGMA journal_mode = OFF", nullptr, nullptr, nullptr);
    return opened;
  }

  void Finish() {
    if (sqlite3_backup_finish(std::exchange(backup_, nullptr)) != SQLITE_OK) {
      throw SqliteError(copy_.get(), path_);
    }
  }

  void Flush() {
    if (!FlushFile(copy_.get())) {
      throw FlushError(path_, errno);
    }
  }

  const std::string path_;
  Handle copy_;
  sqlite3_backup* backup_ = nullptr;
  std::optional<StepwiseCheck> check_;  ///< once all is copied
};

/// Reads the file once, so that a check, which asks nobody while it follows the pages of a table, finds them
/// all in memory. False if it was stopped. A failure is left to the check.
bool ReadInPieces(sqlite3* database, const KeepOn& keepOn) {
  constexpr sqlite3_int64 pieceBytes = sqlite3_int64{1} << 20U;
  sqlite3_file* const file = OpenFile(database);
  sqlite3_int64 bytes = 0;
  if (file == nullptr || file->pMethods->xFileSize(file, &bytes) != SQLITE_OK) {
    return true;
  }
  std::vector<char> piece(static_cast<std::size_t>(pieceBytes));
  for (sqlite3_int64 offset = 0; offset < bytes; offset += pieceBytes) {
    if (!keepOn()) {
      return false;
    }
    const auto count = static_cast<int>(std::min(pieceBytes, bytes - offset));
    // By the database's own handle: closing another one would drop its locks.
    if (file->pMethods->xRead(file, piece.data(), count, offset) != SQLITE_OK) {
      break;
    }
  }
  return true;
}

}  // namespace

std::unique_ptr<StepwiseCopy> BeginWholeCopy(SqliteConnection& connection, const std::string& path) {
  return std::make_unique<SqliteStepwiseCopy>(connection, path);
}

bool FlushFile(sqlite3* database) {
  sqlite3_file* const file = OpenFile(database);
  return file != nullptr &&
         file->pMethods->xSync(file, SQLITE_SYNC_NORMAL | SQLITE_SYNC_DATAONLY) == SQLITE_OK;
}

bool CopyWhole(SqliteConnection& connection, const std::string& path, const KeepOn& keepOn) {
  if (keepOn) {
    SqliteStepwiseCopy steps(connection, path);
    while (!steps.Advance(SqliteStepwiseCopy::WhenLocked::Fail)) {
      if (!keepOn()) {
        return false;
      }
    }
    return true;
  }
  sqlite3* opened = nullptr;
  constexpr int flags = SQLITE_OPEN_READWRITE | SQLITE_OPEN_CREATE | SQLITE_OPEN_NOMUTEX;
  int result = sqlite3_open_v2(path.c_str(), &opened, flags, nullptr);
  const Handle copy(opened, sqlite3_close);
  if (result == SQLITE_OK) {
    // A partial copy is of no use, so it needs no journal to be rolled back by.
    sqlite3_exec(opened, "PRAGMA journal_mode = OFF", nullptr, nullptr, nullptr);
    sqlite3_backup* backup = sqlite3_backup_init(opened, "main", connection.Handle(), "main");
    if (backup == nullptr) {
      throw SqliteError(opened, path);
    }
    sqlite3_backup_step(backup, -1);
    result = sqlite3_backup_finish(backup);
  }
  if (result == SQLITE_OK) {
    // A file that keeps a log would have its copy keep one too.
    sqlite3_exec(opened, "PRAGMA journal_mode = DELETE", nullptr, nullptr, nullptr);
    return true;
  }
  throw SqliteError(opened, path);
}

bool RewriteWhole(SqliteConnection& connection, const std::string& path, const KeepOn& keepOn) {
  connection.Rollback();
  GrowingFile file(path);
  const KeepOn step = [&] {
    file.FlushIfGrown();
    return !keepOn || keepOn();
  };
  const StatementWatch watch(connection.Handle(), step, InstructionsOfRewriting);
  try {
    connection.Execute(("VACUUM INTO " + QuotedText(path)).c_str());
  } catch (const RuntimeError&) {
    if (watch.Stopped()) {
      return false;
    }
    throw;
  }
  if (!step()) {
    return false;
  }
  if (!file.Flush()) {
    throw FlushError(path, errno);
  }
  return step();
}

bool CheckWhole(SqliteConnection& connection, const KeepOn& keepOn) {
  if (keepOn && !ReadInPieces(connection.Handle(), keepOn)) {
    return false;
  }
  const StatementWatch watch(connection.Handle(), keepOn);
  try {
    SqliteStatement check(connection, "PRAGMA integrity_check(1)");
    if (!check.Step() || check.Text(0) != "ok") {
      throw UnrecognizedFormat(connection.Path());
    }
  } catch (const RuntimeError&) {
    if (watch.Stopped()) {
      return false;
    }
    throw;
  }
  return true;
}
