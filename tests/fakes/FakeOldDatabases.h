#pragma once

#include <set>
#include <string>
#include <vector>

#include "platform/OldDatabases.h"
#include "platform/RuntimeError.h"

/// Old files by path; converting one removes it from `OldPaths`.
class FakeOldDatabases : public OldDatabases {
 public:
  std::set<std::string> OldPaths;
  OldDatabaseReport Report;
  std::string Failure;                 ///< if not empty, every conversion fails with this text
  std::vector<std::string> Converted;  ///< "path table empty" of each call

  bool IsOld(const std::string& path) const override { return OldPaths.count(path) != 0; }

  OldDatabaseReport Convert(const std::string& path, const std::string& table,
                            const std::string& emptyDatabase) override {
    std::string call = path;
    call.append(" ").append(table).append(" ").append(emptyDatabase);
    Converted.push_back(call);
    if (!Failure.empty()) {
      throw RuntimeError(Fault::UnrecognizedDatabase, Failure);
    }
    OldPaths.erase(path);
    return Report;
  }
};
