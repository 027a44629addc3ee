#include "platform/sqlite/SqliteError.h"

#include <cerrno>
#include <new>

#include <sqlite3.h>

namespace {

bool IsNoSpace(int systemError) {
  return systemError == ENOSPC || systemError == EDQUOT || systemError == EFBIG;
}

/// errno of the last call on the database file that failed; 0 for none.
int FileErrorOf(sqlite3* database) {
  int error = 0;
  sqlite3_file_control(database, "main", SQLITE_FCNTL_LAST_ERRNO, &error);
  return error;
}

// SQLite reports a full disk as such only for ENOSPC on a write. A quota or file-size limit comes as an I/O
// error, and so does a full disk that shows at a flush; the cause is kept with the file, or in errno if it
// hit the journal. The file's note may be of an earlier failure, so it does not count against a plain EIO.
bool NoSpaceLeft(sqlite3* database, int code, int systemError) {
  if (code != SQLITE_IOERR) {
    return code == SQLITE_FULL;
  }
  const int lastError = systemError != 0 ? systemError : sqlite3_system_errno(database);
  return IsNoSpace(lastError) || (lastError != EIO && IsNoSpace(FileErrorOf(database)));
}

// SQLite calls a page damaged that the disk could not read.
bool IsUnreadable(sqlite3* database, int code) {
  const int error = FileErrorOf(database);
  return code == SQLITE_CORRUPT && (error == EIO || error == ENXIO);
}

RuntimeError ConstraintError(int extendedCode, const std::string& message) {
  switch (extendedCode) {
    case SQLITE_CONSTRAINT_NOTNULL:
      return {Fault::ValueRequired, "You must enter a value in this field (" + message + ")."};
    case SQLITE_CONSTRAINT_UNIQUE:
    case SQLITE_CONSTRAINT_PRIMARYKEY:
    case SQLITE_CONSTRAINT_ROWID:
      return {Fault::DuplicateKey, "The change would create duplicate values (" + message + ")."};
    case SQLITE_CONSTRAINT_DATATYPE:
      return {Fault::DataConversion, "Data type conversion error."};
    default:
      return {Fault::ValueProhibited,
              "One or more values are prohibited by the validation rule (" + message + ")."};
  }
}

}  // namespace

RuntimeError CannotOpen(const std::string& path) {
  return {Fault::DatabaseCannotOpen,
          "Cannot open the file '" + path + "'. You may lack the permission for it."};
}

RuntimeError UnrecognizedFormat(const std::string& path) {
  return {Fault::UnrecognizedDatabase, "Unrecognized database format '" + path + "'."};
}

RuntimeError FlushError(const std::string& path, int systemError) {
  return IsNoSpace(systemError) ? RuntimeError(Fault::DatabaseDiskFull, "Not enough space on disk: " + path)
                                : RuntimeError(Fault::DatabaseDiskError, "Disk error: " + path);
}

RuntimeError SqliteError(sqlite3* database, const std::string& path, int systemError) {
  const int extendedCode = sqlite3_extended_errcode(database);
  const int code = extendedCode & 0xFF;
  const std::string message = sqlite3_errmsg(database);
  if (extendedCode == SqliteInvalidPattern) {
    return {Fault::InvalidPattern, message};
  }
  if (NoSpaceLeft(database, code, systemError)) {
    return {Fault::DatabaseDiskFull, "Not enough space on disk: " + path};
  }
  RuntimeError diskError(Fault::DatabaseDiskError, "Disk error: " + path);
  if (IsUnreadable(database, code)) {
    return diskError;
  }
  switch (code) {
    case SQLITE_NOMEM:
      throw std::bad_alloc();
    case SQLITE_BUSY:
    case SQLITE_LOCKED:
      return {Fault::DatabaseLocked, "Could not lock file '" + path + "'."};
    case SQLITE_READONLY:
      return {Fault::DatabaseReadOnly, "Cannot update. Database or object is read-only: " + path};
    case SQLITE_IOERR:
      return diskError;
    case SQLITE_CANTOPEN:
    case SQLITE_PERM:
    case SQLITE_AUTH:
      return CannotOpen(path);
    case SQLITE_CORRUPT:
    case SQLITE_NOTADB:
      return UnrecognizedFormat(path);
    case SQLITE_CONSTRAINT:
      return ConstraintError(extendedCode, message);
    case SQLITE_MISMATCH:
    case SQLITE_TOOBIG:
      return {Fault::DataConversion, "Data type conversion error."};
    default:
      return {Fault::DatabaseError, "Database error: " + message + " (" + path + ")"};
  }
}
