#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <string>
#include <vector>

#include "bench/Goals.h"
#include "bench/ManyMembers.h"
#include "platform/jet/JetConverter.h"
#include "platform/linux/LinuxFiles.h"

namespace {

using Clock = std::chrono::steady_clock;

double MicrosecondsSince(Clock::time_point start) {
  return std::chrono::duration<double, std::micro>(Clock::now() - start).count();
}

/// Time that mdb-export takes on the same table.
double Export(const std::string& file, const std::string& csv) {
  const std::string command = "exec mdb-export -b hex '" + file + "' Members > '" + csv + "'";
  const auto start = Clock::now();
  if (std::system(command.c_str()) != 0) {
    std::fprintf(stderr, "mdb-export failed\n");
    std::exit(1);
  }
  return MicrosecondsSince(start);
}

class NothingLeftOut : public ConversionSteps {
 public:
  bool GoOnWithout(const std::vector<NotTakenOver>& /*values*/) override { return false; }
  bool AddInterimRows(std::int64_t /*rows*/) override { return false; }
  void BeforeReplacing(const OldDatabaseReport& /*report*/) override {}
};

double Convert(const std::string& file, const std::string& folder) {
  const std::string copy = folder + "/members.mdb";
  std::filesystem::copy_file(file, copy, std::filesystem::copy_options::overwrite_existing);
  std::filesystem::permissions(copy, std::filesystem::perms::owner_write, std::filesystem::perm_options::add);
  LinuxFiles disk;
  JetConverter converter(disk, JetReaderPath());
  NothingLeftOut steps;
  const auto start = Clock::now();
  converter.Convert({copy, "Members", TESSARINE_PROGRAM_FOLDER "/members_default.mdb", ""}, steps);
  const double time = MicrosecondsSince(start);
  std::filesystem::remove(copy + ".jet");
  return time;
}

/// Measures both by turns, `runs` times.
bool Compare(const std::string& name, const std::string& file, const std::string& folder, int runs,
             double goal) {
  std::vector<double> conversions;
  std::vector<double> exports;
  for (int run = 0; run < runs; ++run) {
    conversions.push_back(Convert(file, folder));
    exports.push_back(Export(file, folder + "/members.csv"));
  }
  const double conversion = Median(conversions);
  const double exported = Median(exports);
  return ReportGoal(name, conversion / exported, goal, TimesText(conversion, exported));
}

}  // namespace

/// bench-conversion: needs a members file from an old installation. The large file has its rows without
/// photographs many times.
int main() {
  const std::string file = TESSARINE_OLD_FILES "/members.mdb";
  if (!std::filesystem::exists(file)) {
    std::printf("conversion of an old file: not measured, there is no %s\n", file.c_str());
    return 0;
  }
  std::string folder = (std::filesystem::temp_directory_path() / "tessarine-bench-XXXXXX").string();
  if (mkdtemp(folder.data()) == nullptr) {
    return 2;
  }
  const std::string many = folder + "/many.mdb";
  constexpr std::uint32_t manyRows = 100'000;
  if (!MakeManyMembers(file, many, manyRows)) {
    std::fprintf(stderr, "no file of many members can be made of %s\n", file.c_str());
    return 2;
  }
  bool met = Compare("conversion of an old file / mdb-export to CSV", file, folder, 25, 2);
  met &= Compare("conversion of 100,000 old rows / mdb-export to CSV", many, folder, 7, 1.5);
  std::filesystem::remove_all(folder);
  return met ? 0 : 1;
}
