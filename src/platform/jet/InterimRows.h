#pragma once

#include <cstdint>
#include <string>

#include "platform/OldDatabases.h"
#include "platform/jet/ConversionBusyTimeout.h"
#include "platform/sqlite/SqliteConnection.h"

/// The rows that were entered into the interim file while the old one could not be used. Rows that the empty
/// database already has are not among them.
class InterimRows {
 public:
  /// `newFile` is the converted file. Throws RuntimeError if the interim file cannot be read.
  InterimRows(const std::string& newFile, const OldDatabase& old,
              std::chrono::milliseconds lockWait = ConversionBusyTimeout);

  std::int64_t Count() const { return count_; }

  /// Adds them to the new file; one whose key is taken gets a new one.
  void Join();

 private:
  SqliteConnection connection_;
  std::string tableName_;
  std::string table_;    ///< in brackets
  std::string key_;      ///< its column
  std::string columns_;  ///< all others, in brackets
  std::int64_t count_ = 0;
};
