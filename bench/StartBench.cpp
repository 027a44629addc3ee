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

/// Whole-process figures of two programs that are run alternately, each with its argument (empty for none).
class Pair {
 public:
  struct Command {
    std::string Program;
    std::string Argument;
  };

  Pair(const Command& own, const Command& other) {
    constexpr int runs = 15;
    RunChild(own.Program, own.Argument);
    RunChild(other.Program, other.Argument);
    for (int i = 0; i < runs; ++i) {
      own_.Add(RunChild(own.Program, own.Argument));
      other_.Add(RunChild(other.Program, other.Argument));
    }
  }

  bool ReportTime(const char* name, double goal) const {
    return Report(name, goal, Median(own_.Times), Median(other_.Times), "ms");
  }
  bool ReportMemory(const char* name, double goal) const {
    return Report(name, goal, Median(own_.Memory), Median(other_.Memory), "MB");
  }

 private:
  struct Figures {
    void Add(const Run& run) {
      Times.push_back(run.Milliseconds);
      Memory.push_back(run.Megabytes);
    }
    std::vector<double> Times;
    std::vector<double> Memory;
  };

  static bool Report(const char* name, double goal, double own, double other, const char* unit) {
    char detail[64];
    std::snprintf(detail, sizeof detail, "%.1f %s to %.1f %s", own, unit, other, unit);
    return ReportGoal(name, own / other, goal, detail);
  }

  Figures own_;
  Figures other_;
};

/// A file with the fullest game, made in `folder`.
std::string FullestGame(const std::string& folder) {
  std::string file = folder + "/full.xml";
  FullGame full(0);
  full.CalculateScores();
  LinuxFiles().Replace(file, WriteGameFile(full.game, "None"));
  return file;
}

bool CompareWithEmptyWindow(const std::string& program, const std::string& empty, const std::string& game) {
  constexpr double goal = 2;
  const bool fast =
      Pair({program, {}}, {empty, {}}).ReportTime("start to a usable window / empty Qt window", goal);
  return Pair({program, game}, {empty, {}})
             .ReportMemory("peak memory with the fullest game / empty Qt window", goal) &&
         fast;
}

/// Compares with bench-main-window of another build, which is skipped where `former` is empty.
bool CompareWithFormer(const std::string& program, const std::string& former, const std::string& game) {
  constexpr double goal = 1.05;
  constexpr const char* start = "start, board and page off / former program";
  constexpr const char* memory = "peak memory with the fullest game / former program";
  if (former.empty()) {
    std::printf("%-52s skipped: no former build given\n%-52s skipped: no former build given\n", start,
                memory);
    return true;
  }
  const bool fast = Pair({program, {}}, {former, {}}).ReportTime(start, goal);
  return Pair({program, game}, {former, game}).ReportMemory(memory, goal) && fast;
}

}  // namespace

/// bench-start [FORMER]: XDG_DATA_HOME must name a folder with the program's data. FORMER is
/// bench-main-window of another build, with which this one is compared too.
int main(int argc, char** argv) {
  const char* const data = std::getenv("XDG_DATA_HOME");
  if (data == nullptr || argc > 2) {
    std::fprintf(stderr, "usage: XDG_DATA_HOME=FOLDER bench-start [FORMER]\n");
    return 2;
  }
  const std::filesystem::path bin = std::filesystem::canonical(argv[0]).parent_path();
  const std::string program = bin / "bench-main-window";
  const std::string game = FullestGame(data);
  bool met = CompareWithEmptyWindow(program, bin / "bench-empty-window", game);
  met &= CompareWithFormer(program, argc == 2 ? argv[1] : "", game);
  return met ? 0 : 1;
}
