#include <spawn.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <string>
#include <vector>

#include "bench/FullGame.h"
#include "bench/Goals.h"
#include "core/gamefile/GameFile.h"
#include "platform/linux/LinuxFiles.h"

namespace {

struct Run {
  double Milliseconds;
  double Megabytes;  ///< peak memory
};

Run RunChild(const std::string& program, const std::string& argument) {
  std::vector<char*> arguments = {const_cast<char*>(program.c_str())};
  if (!argument.empty()) {
    arguments.push_back(const_cast<char*>(argument.c_str()));
  }
  arguments.push_back(nullptr);
  const auto start = std::chrono::steady_clock::now();
  pid_t child = 0;
  if (posix_spawn(&child, program.c_str(), nullptr, nullptr, arguments.data(), environ) != 0) {
    std::perror(program.c_str());
    std::exit(1);
  }
  int status = 0;
  rusage usage{};
  wait4(child, &status, 0, &usage);
  if (status != 0) {
    std::fprintf(stderr, "%s failed\n", program.c_str());
    std::exit(1);
  }
  return {std::chrono::duration<double, std::milli>(std::chrono::steady_clock::now() - start).count(),
          static_cast<double>(usage.ru_maxrss) / 1024};
}

/// Whole-process figures of two programs that are run alternately.
class Pair {
 public:
  Pair(const std::string& program, const std::string& argument, const std::string& empty) {
    constexpr int runs = 15;
    RunChild(program, argument);
    RunChild(empty, "");
    for (int i = 0; i < runs; ++i) {
      const Run own = RunChild(program, argument);
      const Run bare = RunChild(empty, "");
      times_.push_back(own.Milliseconds);
      bareTimes_.push_back(bare.Milliseconds);
      memory_.push_back(own.Megabytes);
      bareMemory_.push_back(bare.Megabytes);
    }
  }

  bool ReportTime(const char* name) const { return Report(name, times_, bareTimes_, "ms"); }
  bool ReportMemory(const char* name) const { return Report(name, memory_, bareMemory_, "MB"); }

 private:
  static bool Report(const char* name, const std::vector<double>& own, const std::vector<double>& bare,
                     const char* unit) {
    char detail[64];
    std::snprintf(detail, sizeof detail, "%.1f %s to %.1f %s", Median(own), unit, Median(bare), unit);
    return ReportGoal(name, Median(own) / Median(bare), 2, detail);
  }

  std::vector<double> times_;
  std::vector<double> bareTimes_;
  std::vector<double> memory_;
  std::vector<double> bareMemory_;
};

}  // namespace

/// bench-start: XDG_DATA_HOME must name a folder with the program's data.
int main(int /*argc*/, char** argv) {
  const char* const data = std::getenv("XDG_DATA_HOME");
  if (data == nullptr) {
    std::fprintf(stderr, "XDG_DATA_HOME names no folder\n");
    return 2;
  }
  const std::filesystem::path bin = std::filesystem::canonical(argv[0]).parent_path();
  const std::string empty = bin / "bench-empty-window";
  const std::string program = bin / "bench-main-window";
  const std::string file = std::string(data) + "/full.xml";
  FullGame full(0);
  full.CalculateScores();
  LinuxFiles().Replace(file, WriteGameFile(full.game, "None"));
  bool met = Pair(program, "", empty).ReportTime("start to a usable window / empty Qt window");
  met &= Pair(program, file, empty).ReportMemory("peak memory with the fullest game / empty Qt window");
  return met ? 0 : 1;
}
