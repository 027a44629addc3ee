#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

/// Bytes of a long binary column.
using Blob = std::vector<std::uint8_t>;

/// A column's value; std::monostate is NULL. Texts are UTF-8.
using Value = std::variant<std::monostate, std::int64_t, double, std::string, Blob>;

enum class EditMode { None, InProgress, Add };

/// A cursor over rows whose keys were fixed when it was opened (a dynaset): changed values of those rows are
/// seen, rows added later by others are not; a row added through this cursor joins at the end. A row is read
/// when the cursor comes to it. Opening stands on the first row, or at both ends when there is none.
///
/// All operations throw RuntimeError: 3021 without a current row, 3265 for a column that is not there, 3167
/// when the current row was deleted by someone else, 3020 for a write without AddNew or Edit, 3421 for a
/// value the column refuses, other 3xxx for what the database file reports (locked, read-only, damaged,
/// full).
class Recordset {
 public:
  virtual ~Recordset() = default;

  /// MoveFirst and MoveLast on an empty set go to its ends without a fault. MoveNext past the last row
  /// reaches Eof, MovePrevious before the first one Bof; from there they throw 3021.
  virtual void MoveFirst() = 0;
  virtual void MoveNext() = 0;
  virtual void MovePrevious() = 0;
  virtual void MoveLast() = 0;
  virtual bool Eof() const = 0;
  virtual bool Bof() const = 0;

  /// Rows in the set, and the place of the current one, counted from 0; -1 without a current row.
  virtual int RecordCount() const = 0;
  virtual int AbsolutePosition() const = 0;

  /// Moves to the first row that `criterion` (the text of an SQL condition) holds for; else sets NoMatch and
  /// stays. Throws RuntimeError 3077 for a criterion that cannot be read.
  virtual void FindFirst(const std::string& criterion) = 0;
  virtual bool NoMatch() const = 0;

  /// As MoveFirst, then MoveNext until `column` equals `value` (texts to the letter) or Eof, but through an
  /// index where the table has one. True when such a row was found; else the cursor stands at Eof.
  virtual bool WalkTo(const std::string& column, const Value& value) = 0;

  /// Value of a column of the current row, or of the pending one after AddNew or Edit. Long binary columns
  /// are read by GetChunk. The reference holds until the next operation.
  virtual const Value& Fields(std::string_view column) = 0;

  virtual void AddNew() = 0;
  virtual void Edit() = 0;
  virtual void SetField(std::string_view column, Value value) = 0;

  /// Writes the pending row; it is durable when this returns. A failure leaves the old row in the file and
  /// the edit pending. After AddNew the cursor stays where it was.
  virtual void Update() = 0;
  virtual void CancelUpdate() = 0;
  virtual ::EditMode EditMode() const = 0;

  /// Deletes the current row. The cursor then stands on no row until it is moved.
  virtual void Delete() = 0;

  /// Up to `count` bytes of a long binary column from `offset` (counted from 0); fewer at its end, none for
  /// NULL.
  virtual Blob GetChunk(std::string_view column, std::size_t offset, std::size_t count) = 0;

  /// Adds bytes to a long binary column of the pending row; the first call after Edit or AddNew replaces the
  /// old bytes.
  virtual void AppendChunk(std::string_view column, const Blob& bytes) = 0;
};

/// One open database file.
class Database {
 public:
  virtual ~Database() = default;

  /// Opens a dynaset on a table's name or on a query "SELECT * FROM table [WHERE ...]". In a query, LIKE
  /// follows Jet: no case, `*` any text, `?` one character, `#` one digit, `[a-z]` and `[!a-z]` sets. Throws
  /// RuntimeError 3078 when there is no such table, 3075 for a query that cannot be read. The database must
  /// outlive the recordset.
  virtual std::unique_ptr<Recordset> OpenRecordset(const std::string& source) = 0;

  /// A group of reads from here to the matching EndRead takes the file's lock once instead of once for each
  /// read; groups nest. Use ReadScope.
  virtual void BeginRead() {}
  virtual void EndRead() noexcept {}

  /// All writes from BeginTrans to CommitTrans reach the file together, with one wait for the disk. Reads
  /// through this database see them at once. CommitTrans makes them durable; when it or a write among them
  /// throws, or Rollback comes first, the file keeps the old rows of all of them. Use WriteScope.
  virtual void BeginTrans() = 0;
  virtual void CommitTrans() = 0;
  virtual void Rollback() noexcept = 0;

  /// Runs `action` before each change through this database until it returns true. It may read, not write,
  /// through this database, and must not throw.
  virtual void BeforeChange(std::function<bool()> action) = 0;

  /// Writes what the file holds to a new file at `path`, whose bytes are durable on return. Others can read
  /// and write meanwhile. A failure may leave a part of the new file. Throws RuntimeError 3xxx as writing
  /// does.
  virtual void CopyTo(const std::string& path) = 0;
};

/// Makes many reads of a database cheap as long as it lives. While it holds the lock no other program, and no
/// other Database on the same file, can write: theirs wait and then fail with 3050. So do not wait for the
/// operator inside. Where a box must be shown because a row was not there, it may: FindFirst without a match,
/// WalkTo without a row and every failed read or write let go of the lock, and the next read takes it again.
/// Writes through this database work inside, each durable as ever; they let go of the lock too.
class ReadScope {
 public:
  explicit ReadScope(Database& database) : database_(database) { database_.BeginRead(); }
  ~ReadScope() { database_.EndRead(); }
  ReadScope(const ReadScope&) = delete;
  ReadScope& operator=(const ReadScope&) = delete;

 private:
  Database& database_;
};

/// Writes that reach the file together when Commit returns, or not at all. Others can neither read nor write
/// the file when it comes to Commit, so do not wait for the operator inside.
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

class DatabaseEngine {
 public:
  virtual ~DatabaseEngine() = default;

  /// Opens an existing file. Throws RuntimeError 3024 when it is missing, 3343 when it is no database or
  /// damaged, 3051 when it cannot be opened, 3050 when it is locked; the text names the file.
  virtual std::unique_ptr<Database> OpenDatabase(const std::string& path) = 0;
};
