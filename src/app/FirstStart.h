#pragma once

#include <optional>
#include <string>
#include <vector>

#include "core/text/StringTable.h"
#include "platform/linux/Instance.h"

/// The steps of a start that come before the first window: what the words behind the program's name ask for,
/// and whether another program of this user's data runs already.
class FirstStart {
 public:
  explicit FirstStart(const StringTable& strings) : strings_(strings) {}

  /// Answers `words`, and passes a game's file on if another program runs. Returns this process's exit code
  /// if that was all, else nothing: then this program is the only one on its data while this object lives.
  std::optional<int> Begin(const std::vector<std::string>& words);

  /// The game to load, an absolute path; empty for none.
  const std::string& File() const { return file_; }

  /// Why the program does not start, where a double click can lead to that, so that the operator is to be
  /// told in a window too; empty if nothing.
  const std::string& Obstacle() const { return obstacle_; }

  /// See Instance.
  int Listener() const { return instance_ ? instance_->Listener() : -1; }

 private:
  int Refuse(const std::string& text, int exitCode) const;
  /// Refuses, and has it told in a window too.
  int Bar(const std::string& text, int exitCode);

  const StringTable& strings_;
  std::optional<Instance> instance_;
  std::string file_;
  std::string obstacle_;
};

/// Where the programs on this data folder meet.
InstancePlace InstancePlaceOf(const std::string& runtimeFolder, const std::string& dataFolder);
