#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

class Sql;

/// Bytes of a long binary column.
using Blob = std::vector<std::uint8_t>;

/// A column's value; std::monostate is NULL. Texts are UTF-8.
using Value = std::variant<std::monostate, std::int64_t, double, std::string, Blob>;

enum class EditMode { None, InProgress, Add };

/// A cursor over rows whose keys were fixed when it was opened (a dynaset): it sees changed values in those
/// rows, but not rows added later by others; a row added through this cursor joins at the end. A row is read
/// when the cursor reaches it. A new cursor is on the first row, or at both ends if there are no rows.
///
/// All operations throw RuntimeError: 3021 without a current row, 3265 for an unknown column, 3167 if the
/// current row was deleted by someone else, 3020 for a write without AddNew or Edit, 3421 for a value that
/// the column refuses, other 3xxx for errors of the database file (locked, read-only, damaged, full).
class Recordset {
 public:
  virtual ~Recordset() = default;

  /// MoveFirst and MoveLast do not fail on an empty set. MoveNext from the last row reaches Eof, MovePrevious
  /// from the first row Bof; another such move throws 3021.
  virtual void MoveFirst() = 0;
  virtual void MoveNext() = 0;
  virtual void MovePrevious() = 0;
  virtual void MoveLast() = 0;
  /// Moves to the row at `position`, counted from 0, without reading those before it. Throws RuntimeError
  /// 3021 if there is no such row.
  virtual void MoveTo(int position) = 0;
  virtual bool Eof() const = 0;
  virtual bool Bof() const = 0;

  /// Number of rows, and position of the current one, counted from 0; -1 without a current row.
  virtual int RecordCount() const = 0;
  virtual int AbsolutePosition() const = 0;

  /// Moves to the first row for which `criterion`, an SQL condition, is true; if there is none, sets NoMatch
  /// and does not move. Throws RuntimeError 3077 for a malformed criterion.
  virtual void FindFirst(const std::string& criterion) = 0;
  virtual bool NoMatch() const = 0;

  /// Same result as MoveFirst, then MoveNext until `column` equals `value` (texts exactly) or Eof, but uses
  /// an index if the table has one. True if such a row was found; otherwise the cursor is at Eof.
  virtual bool WalkTo(const std::string& column, const Value& value) = 0;

  /// Value of a column of the current row, or of the pending one after AddNew or Edit. Long binary columns
  /// are read by GetChunk. The reference is valid until the next operation.
  virtual const Value& Fields(std::string_view column) = 0;

  virtual void AddNew() = 0;
  virtual void Edit() = 0;
  virtual void SetField(std::string_view column, Value value) = 0;

  /// Writes the pending row; it is durable when this returns. A failure leaves the old row in the file and
  /// the edit pending, so trying again is safe. After AddNew the cursor stays where it was.
  virtual void Update() = 0;
  virtual void CancelUpdate() = 0;
  virtual ::EditMode EditMode() const = 0;

  /// Deletes the current row. There is no current row until the cursor is moved.
  virtual void Delete() = 0;

  /// Up to `count` bytes of a long binary column from `offset` (counted from 0); fewer at its end, none for
  /// NULL.
  virtual Blob GetChunk(std::string_view column, std::size_t offset, std::size_t count) = 0;

  /// Adds bytes to a long binary column of the pending row; the first call after Edit or AddNew replaces the
  /// old bytes.
  virtual void AppendChunk(std::string_view column, const Blob& bytes) = 0;
};

/// Asked now and then in the middle of a long operation; may process events, but must leave the database
/// alone and must not throw. False stops the operation.
using KeepOn = std::function<bool()>;

/// A copy of a database that is being made in steps. Between them the database may be used in any way. What
/// is written through the same Database meanwhile is in the copy too; a change by anyone else begins it anew.
/// Once all is copied, the copy itself is looked through in further steps.
class StepwiseCopy {
 public:
  virtual ~StepwiseCopy() = default;

  /// Copies and flushes up to a megabyte, or looks through the copy for some milliseconds. True once it is
  /// whole, durable and found sound; then there is no further step. While another program has the file locked
  /// no step copies.
  /// Throws RuntimeError 3xxx like a write, and 3343 if the copy is damaged, as the database then is too.
  virtual bool Step() = 0;
};

/// One open database file.
class Database {
 public:
  virtual ~Database() = default;

  /// Opens a dynaset on a table name or on a query "SELECT * FROM table [WHERE ...]". In a query, LIKE
  /// follows Jet: case-insensitive, `*` any text, `?` one character, `#` one digit, `[a-z]` and `[!a-z]`
  /// sets. Throws RuntimeError 3078 if there is no such table, 3075 for a malformed query. The database must
  /// outlive the recordset.
  virtual std::unique_ptr<Recordset> OpenRecordset(const std::string& source) = 0;

  /// Statements on this database, for what no recordset can express (platform/Sql.h). They see and share the
  /// groups of reads and writes below.
  virtual Sql& Statements() = 0;

  /// The numbers that the database gives to new rows of `table` are above `number` from now on; durable.
  /// Does nothing if they are already. Throws RuntimeError 3000 for a table without such a counter.
  virtual void RaiseCounter(const std::string& table, std::int64_t number) = 0;

  /// The reads from here to the matching EndRead take the file's lock once for the group instead of once per
  /// read. Groups nest. Use ReadScope.
  virtual void BeginRead() {}
  virtual void EndRead() noexcept {}

  /// All writes from BeginTrans to CommitTrans are committed together, with one wait for the disk. Reads
  /// through this database see them at once. CommitTrans makes them durable; if it or one of the writes
  /// throws, or Rollback is called first, all the old rows are kept. It never throws when the file holds the
  /// new ones. Use WriteScope.
  virtual void BeginTrans() = 0;
  virtual void CommitTrans() = 0;
  virtual void Rollback() noexcept = 0;

  /// Flushes what the open group has written so far, so that its commit takes less long. The group is as open
  /// as before, and nobody else can read the file until it ends. Throws RuntimeError 3xxx like a write.
  virtual void FlushGroup() = 0;

  /// Runs `action` before each change through this database until it returns true. It may read through this
  /// database but not write, and must not throw.
  virtual void BeforeChange(std::function<bool()> action) = 0;

  /// Copies the file's contents to a new file at `path`, which is durable on return. Others can read and
  /// write meanwhile. A failure may leave a partial file. Throws RuntimeError 3xxx like a write.
  virtual void CopyTo(const std::string& path) = 0;

  /// The same in steps. False if it was stopped. A change to the file by another program begins it anew.
  virtual bool CopyInSteps(const std::string& path, const KeepOn& keepOn) = 0;

  /// Begins such a copy in a new file at `path`, which is partial until the last step. It must end before the
  /// database does. Throws RuntimeError 3xxx like a write.
  virtual std::unique_ptr<StepwiseCopy> BeginCopy(const std::string& path) = 0;

  /// Looks through the whole file. False if it was stopped. Throws RuntimeError 3343 for a damaged file.
  virtual bool CheckWhole(const KeepOn& keepOn) = 0;

  /// Writes all rows anew to a new file at `path`, in which nothing stays of rows that were deleted or
  /// changed; durable on return. False if it was stopped: the file is partial then, as after a failure.
  /// Throws RuntimeError 3xxx like a write. May not be called within a group.
  virtual bool RewriteTo(const std::string& path, const KeepOn& keepOn) = 0;

  /// Names of a table's columns, in its order. Throws RuntimeError 3078 if there is no such table.
  virtual std::vector<std::string> ColumnNames(const std::string& table) = 0;

  /// Path by which the file was opened, and that of the file itself, behind symbolic links.
  virtual std::string Path() const = 0;
  virtual std::string FilePath() const = 0;

  /// True if the file has been deleted, renamed or replaced since it was opened, or cannot be asked for.
  virtual bool HasMoved() const = 0;

  /// Keeps all others from writing until ReleaseWriters, so that another file can be put in the place of this
  /// one: no journal stands beside it meanwhile. Only reads by another Database object are allowed. Throws
  /// RuntimeError 3xxx like a write. Use WritersHeld.
  virtual void HoldWriters() = 0;
  virtual void ReleaseWriters() noexcept = 0;
};

/// Makes many reads of a database cheap while it exists. It holds the lock, so other programs, and other
/// Database objects on the same file, cannot write: they wait and then fail with 3050. So do not wait for the
/// operator inside, with one exception: a box about a missing row may be shown, since FindFirst without a
/// match, WalkTo without a row and every failed read or write release the lock until the next read. Writes
/// through this database are allowed inside and durable as usual; they release the lock too.
class ReadScope {
 public:
  explicit ReadScope(Database& database) : database_(database) { database_.BeginRead(); }
  ~ReadScope() { database_.EndRead(); }
  ReadScope(const ReadScope&) = delete;
  ReadScope& operator=(const ReadScope&) = delete;

 private:
  Database& database_;
};

/// Writes that are committed together, or not at all. Others cannot write the file meanwhile, nor read it
/// during Commit, so do not wait for the operator inside.
class WriteScope {
 public:
  explicit WriteScope(Database& database) : database_(database) { database_.BeginTrans(); }
  ~WriteScope() { database_.Rollback(); }
  WriteScope(const WriteScope&) = delete;
  WriteScope& operator=(const WriteScope&) = delete;

  void Commit() { database_.CommitTrans(); }

 private:
  Database& database_;
};

/// Keeps others from writing a database while it exists.
class WritersHeld {
 public:
  explicit WritersHeld(Database& database) : database_(database) { database_.HoldWriters(); }
  ~WritersHeld() { database_.ReleaseWriters(); }
  WritersHeld(const WritersHeld&) = delete;
  WritersHeld& operator=(const WritersHeld&) = delete;

 private:
  Database& database_;
};

class DatabaseEngine {
 public:
  virtual ~DatabaseEngine() = default;

  /// Opens an existing file. Throws RuntimeError 3024 if it is missing, 3343 if it is damaged or not a
  /// database, 3051 if it cannot be opened, 3050 if it is locked; the text names the file.
  virtual std::unique_ptr<Database> OpenDatabase(const std::string& path) = 0;
};
