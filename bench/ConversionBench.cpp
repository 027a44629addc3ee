#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <vector>

#include "bench/Goals.h"
#include "platform/jet/JetConverter.h"

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

double Convert(const std::string& file, const std::string& folder) {
  const std::string copy = folder + "/members.mdb";
  std::filesystem::copy_file(file, copy, std::filesystem::copy_options::overwrite_existing);
  std::filesystem::permissions(copy, std::filesystem::perms::owner_write, std::filesystem::perm_options::add);
  JetConverter converter(JetReaderPath());
  const auto start = Clock::now();
  converter.Convert(copy, "Members", TESSARINE_PROGRAM_FOLDER "/members_default.mdb");
  const double time = MicrosecondsSince(start);
  std::filesystem::remove(copy + ".jet");
  return time;
}

}  // namespace

/// bench-conversion: needs a members file from an old installation.
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
  std::vector<double> conversions;
  std::vector<double> exports;
  for (int run = 0; run < 25; ++run) {
    conversions.push_back(Convert(file, folder));
    exports.push_back(Export(file, folder + "/members.csv"));
  }
  std::filesystem::remove_all(folder);
  const double conversion = Median(conversions);
  const double exported = Median(exports);
  return ReportGoal("conversion of an old file / mdb-export to CSV", conversion / exported, 2,
                    TimesText(conversion, exported))
             ? 0
             : 1;
}
