#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <string>
#include <utility>

#include "platform/Files.h"
#include "platform/OldDatabases.h"
#include "platform/jet/ConversionBusyTimeout.h"
#include "platform/linux/KeptProgram.h"

/// Converts Jet files to SQLite. A separate program reads them, since a damaged file can hang or crash the
/// library.
class JetConverter : public OldDatabases {
 public:
  static constexpr std::chrono::milliseconds LongestSilence = std::chrono::seconds(20);

  /// `reader` is the path of tessarine-jet-reader, which is used as it is now, whatever replaces it; one that
  /// writes nothing for `silence` is taken to have hung. `onProgress` is called at least 20 times a second,
  /// with the number of rows read so far.
  JetConverter(
      Files& disk, std::string reader, std::chrono::milliseconds silence = LongestSilence,
      std::function<void(std::int64_t rows)> onProgress = [](std::int64_t) {})
      : disk_(disk), reader_(std::move(reader)), silence_(silence), onProgress_(std::move(onProgress)) {}

  /// Sets how long it waits for another program's lock.
  void SetLockWait(std::chrono::milliseconds wait) { lockWait_ = wait; }

  bool IsOld(const std::string& path) const override;
  OldDatabaseReport Convert(const OldDatabase& old, ConversionSteps& steps) override;

 private:
  OldDatabaseReport ReadInto(const std::string& newFile, const OldDatabase& old,
                             ConversionSteps& steps) const;
  OldDatabaseReport MakeAndReplace(const OldDatabase& old, ConversionSteps& steps);
  bool Join(const std::string& newFile, const OldDatabase& old, ConversionSteps& steps) const;

  Files& disk_;
  KeptProgram reader_;
  std::chrono::milliseconds silence_;
  std::function<void(std::int64_t rows)> onProgress_;
  std::chrono::milliseconds lockWait_ = ConversionBusyTimeout;
};

/// Path of tessarine-jet-reader beside the running program.
std::string JetReaderPath();
