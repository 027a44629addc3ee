#pragma once

#include <functional>
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
  std::string Failure;  ///< if not empty, every conversion fails with this text
  std::function<void(const OldDatabase&, ConversionSteps&)> Run;  ///< asks, or fails
  std::vector<std::string> Converted;                             ///< "path table empty" of each call

  bool IsOld(const std::string& path) const override { return OldPaths.count(path) != 0; }

  OldDatabaseReport Convert(const OldDatabase& old, ConversionSteps& steps) override {
    Converted.push_back(old.Path + " " + old.Table + " " + old.EmptyPath);
    if (!Failure.empty()) {
      throw RuntimeError(Fault::UnrecognizedDatabase, Failure);
    }
    if (Run) {
      Run(old, steps);
    }
    steps.BeforeReplacing(Report);
    OldPaths.erase(old.Path);
    return Report;
  }
};
