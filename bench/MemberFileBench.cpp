#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <functional>
#include <sstream>
#include <string>
#include <vector>

#include "bench/Goals.h"
#include "members/MemberExport.h"
#include "members/MemberImport.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/sqlite/SqliteDatabase.h"

namespace {

constexpr int ManyMembers = 100'000;

/// The files used by one run of this benchmark.
class Scratch {
 public:
  Scratch() {
    std::string pattern = (std::filesystem::temp_directory_path() / "tessarine-bench-XXXXXX").string();
    path_ = mkdtemp(pattern.data());
  }
  ~Scratch() { std::filesystem::remove_all(path_); }
  Scratch(const Scratch&) = delete;
  Scratch& operator=(const Scratch&) = delete;

  std::string operator/(const std::string& name) const { return path_ / name; }

 private:
  std::filesystem::path path_;
};

void RunTool(const std::string& command) {
  if (std::system(command.c_str()) != 0) {
    std::fprintf(stderr, "%s\n", command.c_str());
    std::abort();
  }
}

std::string SchemaOfMembers() {
  std::stringstream text;
  text << std::ifstream(TESSARINE_RESOURCES "/members_default.sql").rdbuf();
  return text.str();
}

/// Members with all their details, as an export writes them.
std::string ManyMembersAsCsv() {
  CsvWriter writer;
  for (const MemberColumn& column : MemberColumns) {
    writer.Text(column.Name);
  }
  writer.EndRow();
  for (int member = 1; member <= ManyMembers; ++member) {
    const std::string number = std::to_string(member);
    std::string button = "AB00000000000000";
    button.replace(button.size() - number.size(), number.size(), number);
    writer.Number(std::int64_t{member});
    for (const std::string& text :
         {button, "First" + number, "Last" + number, "Nick" + number, std::string("Red Dragons"),
          std::string("1990-12-10"), number + ", High Street", std::string("Cardiff"), "CF" + number,
          "member" + number + "@example.org", "029 " + number, std::string("2020-01-02 18:30:00"),
          std::string("2026-11-20 20:15:00")}) {
      writer.Text(text);
    }
    writer.Number(std::int64_t{12});
    for (const double figure : {1234.5, 4321.0, 102.88, 360.08, 3.5}) {
      writer.Number(figure);
    }
    writer.Number(std::int64_t{1});
    writer.Number(0.318);
    writer.Number(0.0);
    writer.EndRow();
  }
  return writer.Take();
}

double SecondsOf(const std::function<void()>& run) {
  const auto start = std::chrono::steady_clock::now();
  run();
  return std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
}

/// The longest time in which a window would not have been asked whether to go on.
class Breaks {
 public:
  bool Note() {
    const auto now = std::chrono::steady_clock::now();
    longest_ = std::max(longest_, std::chrono::duration<double, std::micro>(now - last_).count());
    last_ = now;
    return true;
  }
  GoOn Noting() {
    return [this](double /*done*/) { return Note(); };
  }

  /// In microseconds.
  double Longest() const { return longest_; }

 private:
  std::chrono::steady_clock::time_point last_ = std::chrono::steady_clock::now();
  double longest_ = 0;
};

/// From the file to the durable rows, with the dry run. Returns the longest break, in microseconds.
double ImportFile(const std::string& csv, const std::string& database, RowFate fate) {
  SqliteEngine engine;
  const auto members = engine.OpenDatabase(database);
  Breaks breaks;
  MemberImport import(LinuxFiles().Read(csv), *members, "2026-11-23 10:00:00");
  breaks.Note();
  ImportChoices choices;
  choices.Use.Columns = MemberImport::Match(import.Columns());
  choices.Use.History = true;
  choices.Same = SameMember::Update;
  if (!import.FindDateOrder(choices.Use, breaks.Noting())) {
    std::abort();
  }
  const std::optional<ImportPlan> plan = import.Plan(choices, breaks.Noting());
  if (!plan || plan->Count(fate) != ManyMembers || !import.Write(choices, *plan, breaks.Noting())) {
    std::abort();
  }
  breaks.Note();
  return breaks.Longest();
}

/// The longest break of a backup copy, as an import makes one first, in microseconds.
double CopyBefore(const std::string& database) {
  SqliteEngine engine;
  const auto members = engine.OpenDatabase(database);
  Breaks breaks;
  if (!members->CopyInSteps(database + ".copy", [&breaks] { return breaks.Note(); })) {
    std::abort();
  }
  breaks.Note();
  return breaks.Longest();
}

}  // namespace

/// bench-member-files: the import of 100,000 members against the database's own tool.
int main() {
  const Scratch scratch;
  const std::string csv = scratch / "members.csv";
  LinuxFiles().Write(csv, ManyMembersAsCsv());
  const std::string schema = scratch / "schema.sql";
  const std::string plainSchema = scratch / "plain.sql";
  LinuxFiles().Write(schema, SchemaOfMembers());
  // The tool fills all columns of a table, so its table has no photo.
  LinuxFiles().Write(plainSchema, SchemaOfMembers() +
                                      "\nALTER TABLE Members DROP COLUMN Photograph;"
                                      "\nALTER TABLE Members DROP COLUMN PhotographLength;\n");
  const std::string database = scratch / "members.mdb";
  const std::string plain = scratch / "plain.db";
  std::vector<double> own;
  std::vector<double> tool;
  std::vector<double> breaks;
  std::vector<double> copies;
  std::vector<double> changes;
  constexpr int runs = 3;
  const std::string make = "sqlite3 '" + database + "' < '" + schema + "'";
  const std::string makePlain = "sqlite3 '" + plain + "' < '" + plainSchema + "'";
  const std::string import = "sqlite3 '" + plain + "' '.mode csv' '.import --skip 1 \"" + csv + "\" Members'";
  for (int run = 0; run < runs; ++run) {
    std::filesystem::remove(database);
    std::filesystem::remove(plain);
    RunTool(make);
    RunTool(makePlain);
    own.push_back(SecondsOf([&] { breaks.push_back(ImportFile(csv, database, RowFate::New)); }));
    tool.push_back(SecondsOf([&] { RunTool(import); }));
    copies.push_back(CopyBefore(database));
    RunTool("sqlite3 '" + database + "' \"UPDATE Members SET City = 'Elsewhere'\"");
    changes.push_back(ImportFile(csv, database, RowFate::Changed));
  }
  constexpr double microseconds = 1e6;
  constexpr double goal = 3;
  constexpr double longestBreak = 100'000;
  bool met = ReportGoal("import of 100,000 members / sqlite3 .import", Median(own) / Median(tool), goal,
                        TimesText(Median(own) * microseconds, Median(tool) * microseconds));
  const auto within = [](const char* name, const std::vector<double>& times) {
    return ReportGoal(name, Median(times) / longestBreak, 1, TimesText(Median(times), longestBreak));
  };
  met &= within("longest break of it / 100 ms", breaks);
  met &= within("  of the backup copy before it / 100 ms", copies);
  met &= within("  of an import that changes all of them / 100 ms", changes);
  return met ? 0 : 1;
}
