#pragma once

#include <chrono>
#include <string>

#include "platform/OldDatabases.h"

/// Turns Jet files into the databases that this program uses now. A program beside the main one reads them.
class JetConverter : public OldDatabases {
 public:
  /// `reader` is the path of tessarine-jet-reader. A reader that is silent for `silence` has hung.
  explicit JetConverter(std::string reader, std::chrono::milliseconds silence = std::chrono::seconds(20))
      : reader_(std::move(reader)), silence_(silence) {}

  bool IsOld(const std::string& path) const override;
  OldDatabaseReport Convert(const std::string& path, const std::string& table,
                            const std::string& emptyDatabase) override;

 private:
  OldDatabaseReport ReadInto(const std::string& newFile, const std::string& path,
                             const std::string& table) const;

  std::string reader_;
  std::chrono::milliseconds silence_;
};

/// Path of tessarine-jet-reader beside the running program.
std::string JetReaderPath();
