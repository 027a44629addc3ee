#include <sys/resource.h>

#include <algorithm>
#include <array>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <map>
#include <random>

#include "tests/soak/Options.h"
#include "tests/soak/kills/Life.h"
#include "tests/support/TemporaryFolder.h"

namespace {

using SteadyClock = std::chrono::steady_clock;

constexpr const char* Usage =
    "usage: soak-kills --seconds N [--kills M] [--seed S] [--only WORK] [--lie lost|doubled|damaged|crash]\n"
    "Kills processes in the midst of their work for N seconds, or M times if that is sooner, and looks each\n"
    "time whether all that they had reported is there, once and whole. --lie makes them do wrong on purpose, "
    "to show that it is noticed.\n";

struct Options {
  double Seconds = 0;
  int Kills = 0;  ///< 0 for any number
  unsigned Seed = std::random_device()();
  std::string Only;
  Lie Lies = Lie::None;
};

Lie LieNamed(const std::string& name) {
  static const std::map<std::string, Lie> lies = {
      {"lost", Lie::Lost}, {"doubled", Lie::Doubled}, {"damaged", Lie::Damaged}, {"crash", Lie::Crash}};
  return lies.at(name);
}

Options OptionsIn(int argc, char** argv) {
  Options options;
  ReadOptions(
      argc, argv,
      {{"--seconds", [&](const std::string& value) { options.Seconds = std::stod(value); }},
       {"--kills", [&](const std::string& value) { options.Kills = std::stoi(value); }},
       {"--seed", [&](const std::string& value) { options.Seed = static_cast<unsigned>(std::stoul(value)); }},
       {"--only", [&](const std::string& value) { options.Only = value; }},
       {"--lie", [&](const std::string& value) { options.Lies = LieNamed(value); }}},
      Usage, [&] { return options.Seconds > 0; });
  return options;
}

/// A work with its folder, and how it went.
struct Job {
  std::unique_ptr<::Work> Work;
  std::unique_ptr<TemporaryFolder> Folder{};
  int Done = 0;
  std::chrono::duration<double> Spent{0};
  int Kills = 0;
  long Steps = 0;
};

class Soak {
 public:
  explicit Soak(const Options& options) : options_(options), random_(options.Seed) {
    const WorkSources sources{std::filesystem::read_symlink("/proc/self/exe").parent_path(),
                              TESSARINE_OLD_FILES};
    for (auto* make : {MakeCommitWork, MakeMissionWork, MakePhotoWork, MakeGameFileWork, MakeConversionWork,
                       MakeSheetWork, MakeRestoreWork, MakeKeepWork, MakeTakeOverSteps}) {
      if (std::unique_ptr<Work> work = make(sources);
          work && (options.Only.empty() || work->Name() == options.Only)) {
        jobs_.push_back({.Work = std::move(work)});
      }
    }
    hasOldFiles_ = std::filesystem::exists(sources.OldFiles / "members.mdb");
  }

  bool Run() {
    const SteadyClock::time_point end =
        SteadyClock::now() +
        std::chrono::duration_cast<SteadyClock::duration>(std::chrono::duration<double>(options_.Seconds));
    while (SteadyClock::now() < end && !jobs_.empty() && !HasKilledEnough()) {
      KillOnce(end, *std::min_element(jobs_.begin(), jobs_.end(), [](const Job& one, const Job& other) {
                 return one.Spent / one.Work->Share() < other.Spent / other.Work->Share();
               }));
    }
    return Tell();
  }

 private:
  void KillOnce(SteadyClock::time_point end, Job& job) {
    const SteadyClock::time_point start = SteadyClock::now();
    if (!job.Folder || job.Done >= job.Work->MostSteps()) {
      job.Folder = std::make_unique<TemporaryFolder>();
      job.Done = 0;
      job.Work->Prepare(job.Folder->Path());
    }
    const auto longest =
        std::chrono::duration_cast<std::chrono::microseconds>(std::min<SteadyClock::duration>(
            job.Work->LongestLife(), std::max(end - SteadyClock::now(), SteadyClock::duration(1000))));
    const std::chrono::microseconds time(std::uniform_int_distribution<long>(0, longest.count())(random_));
    const Life life = LiveAndDie(*job.Work, job.Folder->Path(), job.Done, time, options_.Lies);
    job.Kills += life.Killed ? 1 : 0;
    job.Steps += life.Reported - job.Done;
    job.Done = life.Found;
    ++results_[static_cast<std::size_t>(life.What)];
    if (life.What != Life::Fine) {
      std::printf("kills: %s, killed after %ld us (seed %u): %.600s\n", job.Work->Name().c_str(),
                  time.count(), options_.Seed, life.Reason.c_str());
      job.Folder.reset();
    }
    job.Spent += SteadyClock::now() - start;
  }

  bool HasKilledEnough() const {
    int kills = 0;
    for (const Job& job : jobs_) {
      kills += job.Kills;
    }
    return options_.Kills > 0 && kills >= options_.Kills;
  }

  /// Tells how it went; true if all is well.
  bool Tell() const {
    int kills = 0;
    long steps = 0;
    std::string each;
    for (const Job& job : jobs_) {
      kills += job.Kills;
      steps += job.Steps;
      each += job.Work->Name() + " " + std::to_string(job.Kills) + ", ";
    }
    if (!hasOldFiles_) {
      each += "conversions not run, ";
    }
    const auto count = [this](Life::Result result) { return results_[static_cast<std::size_t>(result)]; };
    const int losses = count(Life::Lost) + count(Life::Doubled) + count(Life::Damaged);
    std::printf(
        "kills: %d tries, %d losses, %d crashes, %d hangs (%s%ld steps acknowledged, %d lost, %d doubled, "
        "%d damaged)\n",
        kills, losses, count(Life::Crashed), count(Life::Hung), each.c_str(), steps, count(Life::Lost),
        count(Life::Doubled), count(Life::Damaged));
    return kills > 0 && steps > 0 && losses + count(Life::Crashed) + count(Life::Hung) == 0;
  }

  const Options options_;
  std::mt19937 random_;
  std::vector<Job> jobs_;
  bool hasOldFiles_ = false;
  std::array<int, 6> results_{};
};

}  // namespace

int main(int argc, char** argv) {
  return Soak(OptionsIn(argc, argv)).Run() ? 0 : 1;
}
