#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <string>
#include <utility>

#include "platform/OldDatabases.h"

/// Converts Jet files to SQLite. A separate program reads them, since a damaged file can hang or crash the
/// library.
class JetConverter : public OldDatabases {
 public:
  static constexpr std::chrono::milliseconds LongestSilence = std::chrono::seconds(20);

  /// `reader` is the path of tessarine-jet-reader; one that writes nothing for `silence` is taken to have
  /// hung. `onRows` is called repeatedly with the number of rows read so far.
  explicit JetConverter(
      std::string reader, std::chrono::milliseconds silence = LongestSilence,
      std::function<void(std::int64_t rows)> onRows = [](std::int64_t) {})
      : reader_(std::move(reader)), silence_(silence), onRows_(std::move(onRows)) {}

  bool IsOld(const std::string& path) const override;
  OldDatabaseReport Convert(const std::string& path, const std::string& table,
                            const std::string& emptyDatabase) override;

 private:
  OldDatabaseReport ReadInto(const std::string& newFile, const std::string& path,
                             const std::string& table) const;

  std::string reader_;
  std::chrono::milliseconds silence_;
  std::function<void(std::int64_t rows)> onRows_;
};

/// Path of tessarine-jet-reader beside the running program.
std::string JetReaderPath();
