#pragma once

#include <chrono>
#include <filesystem>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

/// Work that is done step by step, by a process that is killed at some instant. What it leaves after `n`
/// steps depends on `n` alone, so whoever looks afterwards can tell what is lost, doubled or damaged.
class Work {
 public:
  virtual ~Work() = default;

  virtual std::string Name() const = 0;

  /// The process is killed at a random instant of this time from its start.
  virtual std::chrono::milliseconds LongestLife() const { return std::chrono::milliseconds(200); }

  /// A share of the time that all works have.
  virtual int Share() const { return 10; }

  /// After this many steps it begins anew in a fresh folder, so that files stay small.
  virtual int MostSteps() const { return 400; }

  /// Fills a folder in which no step has been done.
  virtual void Prepare(const std::filesystem::path& folder) = 0;

  /// Does the steps `first`, `first` + 1, ... in the folder, and reports each one once it is safe. Runs in a
  /// process of its own and ends only with that, unless there are no further steps.
  virtual void Run(const std::filesystem::path& folder, int first,
                   const std::function<void(int step)>& report) = 0;

  /// What the folder must hold after `steps` steps, and what it holds. Throws std::exception, with the
  /// reason, if a file is damaged.
  virtual std::string StateAfter(int steps) = 0;
  virtual std::string StateIn(const std::filesystem::path& folder) = 0;
};

/// Where the works find the files and programs that come with the program, and an old installation's files.
struct WorkSources {
  std::filesystem::path ProgramFolder;
  std::filesystem::path OldFiles;  ///< need not exist
};

std::unique_ptr<Work> MakeCommitWork(const WorkSources& sources);
std::unique_ptr<Work> MakeMissionWork(const WorkSources& sources);
std::unique_ptr<Work> MakePhotoWork(const WorkSources& sources);
std::unique_ptr<Work> MakeGameFileWork(const WorkSources& sources);
/// Null without the files of an old installation.
std::unique_ptr<Work> MakeConversionWork(const WorkSources& sources);
std::unique_ptr<Work> MakeSheetWork(const WorkSources& sources);
std::unique_ptr<Work> MakeRestoreWork(const WorkSources& sources);
std::unique_ptr<Work> MakeKeepWork(const WorkSources& sources);
std::unique_ptr<Work> MakeTakeOverSteps(const WorkSources& sources);
