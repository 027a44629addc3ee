#pragma once

#include <optional>
#include <string>
#include <vector>

#include "platform/Programs.h"
#include "platform/RuntimeError.h"

/// Records what is started.
class FakePrograms : public Programs {
 public:
  /// The words of each program that was started.
  std::vector<std::vector<std::string>> Started;

  /// If set, every start throws this.
  std::optional<RuntimeError> Failure;

  void Start(const std::vector<std::string>& words) override {
    if (words.empty()) {
      throw RuntimeError(Fault::InvalidProcedureCall);
    }
    if (Failure) {
      throw *Failure;
    }
    Started.push_back(words);
  }
};
