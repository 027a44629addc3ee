#include "tests/soak/kills/DatabaseState.h"
#include "tests/soak/kills/Desk.h"
#include "tests/soak/kills/Work.h"
#include "tests/support/TemporaryFolder.h"

namespace {

constexpr std::string_view MembersFile = "members.mdb";

/// Its one step is the start with a members file of an old installation.
class ConversionWork : public Work {
 public:
  explicit ConversionWork(WorkSources sources)
      : sources_(std::move(sources)), oldBytes_(BytesOf(sources_.OldFiles / MembersFile)) {}

  std::string Name() const override { return "conversions"; }
  std::chrono::milliseconds LongestLife() const override { return longestLife_; }
  int MostSteps() const override { return 1; }

  void Prepare(const std::filesystem::path& folder) override {
    if (converted_.empty()) {
      const TemporaryFolder reference;
      Fill(reference.Path());
      const auto start = std::chrono::steady_clock::now();
      Convert(reference.Path());
      // The slower the machine, the longer a conversion; beyond its end a kill would meet nothing.
      longestLife_ = std::chrono::ceil<std::chrono::milliseconds>(std::chrono::steady_clock::now() - start);
      converted_ = StateIn(reference.Path());
    }
    Fill(folder);
  }

  void Run(const std::filesystem::path& folder, int first,
           const std::function<void(int step)>& report) override {
    if (first == 1) {
      Convert(folder);
      report(1);
    }
  }

  std::string StateAfter(int steps) override { return steps == 0 ? "old" : converted_; }

  std::string StateIn(const std::filesystem::path& folder) override {
    const std::filesystem::path file = folder / MembersFile;
    if (BytesOf(file) == oldBytes_) {
      return "old";
    }
    if (BytesOf(file.string() + ".jet") != oldBytes_) {
      throw std::runtime_error("the old file was not kept in " + folder.string());
    }
    return RowsOf(file,
                  "SELECT ContactID || ' ' || ifnull(FirstName, '') || ' ' || ifnull(LastName, '') || ' ' || "
                  "ifnull(DallasID, '') || ' ' || TotalGamesPlayed || ' ' || TotalDamage || ' ' || "
                  "ifnull(PhotographLength, 0) || ' ' || digest(Photograph) FROM Members ORDER BY ContactID");
  }

 private:
  void Fill(const std::filesystem::path& folder) const {
    PutDefaultDatabases(sources_, folder);
    std::filesystem::copy_file(sources_.OldFiles / MembersFile, folder / MembersFile,
                               std::filesystem::copy_options::overwrite_existing);
    std::filesystem::permissions(folder / MembersFile, std::filesystem::perms::owner_write,
                                 std::filesystem::perm_options::add);
  }

  void Convert(const std::filesystem::path& folder) const {
    const Desk desk(sources_, folder, "Database status");
  }

  WorkSources sources_;
  std::string oldBytes_;
  std::string converted_;
  std::chrono::milliseconds longestLife_{0};
};

}  // namespace

std::unique_ptr<Work> MakeConversionWork(const WorkSources& sources) {
  return std::filesystem::exists(sources.OldFiles / MembersFile) ? std::make_unique<ConversionWork>(sources)
                                                                 : nullptr;
}
