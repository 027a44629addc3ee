#pragma once

#include <string>
#include <vector>

#include "platform/OldDatabases.h"

/// Answers the questions of a conversion, and keeps what they were about.
class ConversionAnswers : public ConversionSteps {
 public:
  bool Answer = true;
  std::vector<NotTakenOver> Unread;  ///< of the last GoOnWithout
  std::int64_t InterimRows = 0;      ///< of the last AddInterimRows
  std::string FailBeforeReplacing;   ///< when it is not empty, BeforeReplacing fails with this text
  int StopAt = 0;                    ///< the question of KeepOn that is answered with false; 0 for none
  int Asked = 0;                     ///< questions of KeepOn

  bool GoOnWithout(const std::vector<NotTakenOver>& values) override {
    Unread = values;
    return Answer;
  }
  bool AddInterimRows(std::int64_t rows) override {
    InterimRows = rows;
    return Answer;
  }
  bool KeepOn() override { return ++Asked != StopAt; }
  void BeforeReplacing(const OldDatabaseReport& /*report*/) override {
    if (!FailBeforeReplacing.empty()) {
      throw RuntimeError(Fault::DiskFull, FailBeforeReplacing);
    }
  }
};
