#pragma once

#include <cstdint>
#include <exception>
#include <string>
#include <utility>
#include <vector>

#include "platform/RuntimeError.h"

/// Something in an old file that the new one lacks or has in another form.
struct NotTakenOver {
  enum Kind {
    Table,          ///< that the new file has no place for
    Column,         ///< likewise
    TextsOfColumn,  ///< that are not numbers, in a column that is numeric in the new file; 0 there
    MissingColumn,  ///< that the old file lacks; the new one has the column's default in every row
    TableRows,      ///< some rows of the table, or all of them
    OneValue        ///< of one row
  };
  Kind What;
  std::string Name;          ///< of the table or column
  std::int64_t Rows = 0;     ///< of a table; for TableRows those that can be read
  std::int64_t Counted = 0;  ///< for TableRows: all that the table has
  std::string InTable = {};  ///< for OneValue
  std::string InRow = {};    ///< for OneValue: number of the row, counted from 1, with its key

  bool operator==(const NotTakenOver&) const = default;
};

/// What became of an old file.
struct OldDatabaseReport {
  /// Rows copied to the new file.
  std::int64_t Rows = 0;
  std::vector<NotTakenOver> NotTaken;
  /// Path where the old file was kept.
  std::string KeptAs;
};

/// RuntimeError 3343: an old file was not converted, and nothing has changed. Its text is for the log.
class OldDatabaseRefused : public RuntimeError {
 public:
  /// It is damaged.
  OldDatabaseRefused() : RuntimeError(Fault::UnrecognizedDatabase, "It is damaged.") {}

  /// These parts of it cannot be taken over.
  explicit OldDatabaseRefused(std::vector<NotTakenOver> parts)
      : RuntimeError(Fault::UnrecognizedDatabase, "It cannot be taken over: " + parts.front().Name),
        parts_(std::move(parts)) {}

  /// Something else failed, such as writing the new file.
  explicit OldDatabaseRefused(const std::string& failure)
      : RuntimeError(Fault::UnrecognizedDatabase, failure), failure_(failure) {}

  const std::vector<NotTakenOver>& Parts() const { return parts_; }
  const std::string& Failure() const { return failure_; }

 private:
  std::vector<NotTakenOver> parts_;
  std::string failure_;
};

/// An old file was not converted, since that was not wanted any more, and nothing has changed.
class OldDatabaseStopped : public std::exception {
 public:
  const char* what() const noexcept override { return "The conversion was stopped."; }
};

struct OldDatabase {
  std::string Path;
  std::string Table;        ///< whose rows are converted
  std::string EmptyPath;    ///< a file with that table; its own rows are ignored
  std::string InterimPath;  ///< what was used in place of the old file while it could not be; may be missing
};

/// What the converter asks and tells on its way.
class ConversionSteps {
 public:
  virtual ~ConversionSteps() = default;

  /// These values of the old file cannot be read whole. False to leave the file unconverted.
  virtual bool GoOnWithout(const std::vector<NotTakenOver>& values) = 0;

  /// The interim file has rows of its own. True to add them to the new file.
  virtual bool AddInterimRows(std::int64_t rows) = 0;

  /// Asked many times a second while the old file is read; false stops the conversion. May process events.
  virtual bool KeepOn() { return true; }

  /// True if the progress is shown by who answers KeepOn.
  virtual bool ShowsProgress() const { return false; }

  /// The new file is complete and is about to take the old one's place. May throw to prevent that.
  virtual void BeforeReplacing(const OldDatabaseReport& report) = 0;
};

/// Files of the database format that this program used before.
class OldDatabases {
 public:
  virtual ~OldDatabases() = default;

  /// True if the file starts like one of that format; false also if it cannot be read.
  virtual bool IsOld(const std::string& path) const = 0;

  /// Replaces the old file with a new one that has its rows; the old one is kept beside it under an unused
  /// name. Interim rows whose key is taken get a new one, and the interim file gets ".joined" behind its
  /// name. Throws OldDatabaseRefused, OldDatabaseStopped, and what `steps` throws; nothing has changed then.
  virtual OldDatabaseReport Convert(const OldDatabase& old, ConversionSteps& steps) = 0;
};
