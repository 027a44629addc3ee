#pragma once

#include <deque>
#include <functional>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "platform/FileDialog.h"

/// Records every call and answers it from a script; cancels when the script has run out.
class FakeFileDialog : public FileDialog {
 public:
  struct Call {
    bool Save = false;
    std::string Filter;
    std::string Name;
    std::string Folder = {};
    std::string Title = {};
    bool OfFolder = false;

    bool operator==(const Call&) const = default;
  };

  /// All calls so far.
  std::vector<Call> Calls;

  /// Paths that the operator will choose, in order; std::nullopt is Cancel.
  std::deque<std::optional<std::string>> Answers;

  /// Called while a dialog is open.
  std::function<void()> WhileOpen;

  std::optional<std::string> ShowOpen(const FileRequest& request) override { return Ask(false, request); }
  std::optional<std::string> ShowSave(const FileRequest& request) override { return Ask(true, request); }
  std::optional<std::string> ShowFolder(const FileRequest& request) override {
    return Ask(false, request, true);
  }

 private:
  std::optional<std::string> Ask(bool save, const FileRequest& request, bool ofFolder = false) {
    Calls.push_back({save, request.Filter, request.Name, request.Folder, request.Title, ofFolder});
    if (const auto whileOpen = WhileOpen) {
      whileOpen();
    }
    if (Answers.empty()) {
      return std::nullopt;
    }
    std::optional<std::string> answer = std::move(Answers.front());
    Answers.pop_front();
    return answer;
  }
};
