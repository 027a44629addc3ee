#pragma once

#include <deque>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "platform/FileDialog.h"

/// Records every call and answers it from a script; cancels when the script has run out.
class FakeFileDialog : public FileDialog {
 public:
  struct Call {
    bool Save = false;
    std::string Filter;
    std::string FileName;

    bool operator==(const Call&) const = default;
  };

  /// All calls so far.
  std::vector<Call> Calls;

  /// Paths that the operator will choose, first one first; std::nullopt is Cancel.
  std::deque<std::optional<std::string>> Answers;

  /// Run while a dialog is open.
  std::function<void()> WhileOpen;

  std::string ShowOpen(const std::string& filter, const std::string& fileName) override {
    return Ask(false, filter, fileName);
  }
  std::string ShowSave(const std::string& filter, const std::string& fileName) override {
    return Ask(true, filter, fileName);
  }

 private:
  std::string Ask(bool save, const std::string& filter, const std::string& fileName) {
    Calls.push_back({save, filter, fileName});
    if (const auto whileOpen = WhileOpen) {
      whileOpen();
    }
    if (Answers.empty()) {
      return fileName;
    }
    const std::optional<std::string> answer = Answers.front();
    Answers.pop_front();
    return answer.value_or(fileName);
  }
};
