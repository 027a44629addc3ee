#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <sys/wait.h>
#include <unistd.h>

#include <chrono>
#include <csignal>
#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <string>

#include "tests/support/FileSizeLimit.h"
#include "tests/support/OrdinaryUser.h"
#include "tests/support/TestDatabase.h"
#include "tests/support/Thrown.h"

namespace {

using std::chrono::milliseconds;
using std::chrono::steady_clock;
using testing::HasSubstr;

TEST(LockedFile, CannotBeOpenedAndSaysSoAfterTheTimeout) {
  const TestDatabase file;
  OtherConnection other(file.Path());
  other.Execute("BEGIN EXCLUSIVE");
  const auto begin = steady_clock::now();
  const Thrown thrown = ThrownBy([&] { SqliteEngine(milliseconds(50)).OpenDatabase(file.Path()); });
  EXPECT_EQ(thrown.Number, 3050);
  EXPECT_EQ(thrown.Text, "Could not lock file '" + file.Path() + "'.");
  EXPECT_GE(steady_clock::now() - begin, milliseconds(45));
  other.Execute("ROLLBACK");
  EXPECT_NO_THROW(SqliteEngine(milliseconds(50)).OpenDatabase(file.Path()));
}

TEST(LockedFile, CannotBeReadUntilTheOtherIsDone) {
  const TestDatabase file;
  file.AddMembers();
  const auto database = file.Open();
  const auto rows = database->OpenRecordset("Members");
  OtherConnection other(file.Path());
  other.Execute("BEGIN EXCLUSIVE");
  EXPECT_EQ(NumberThrownBy([&] { rows->Fields("FirstName"); }), 3050);
  EXPECT_EQ(NumberThrownBy([&] { rows->FindFirst("ContactID= 5"); }), 3050);
  other.Execute("COMMIT");
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Sean");
}

TEST(LockedFile, CannotBeWrittenAndKeepsTheEdit) {
  const TestDatabase file;
  file.AddMembers();
  const auto database = file.Open();
  const auto rows = database->OpenRecordset("Members");
  rows->Edit();
  rows->SetField("FirstName", "John");
  {
    OtherConnection other(file.Path());
    other.Execute("BEGIN IMMEDIATE");
    EXPECT_EQ(NumberThrownBy([&] { rows->Update(); }), 3050);
    EXPECT_EQ(rows->EditMode(), EditMode::InProgress);
  }
  rows->Update();
  EXPECT_EQ(file.Query("SELECT FirstName FROM Members WHERE ContactID = 1"), "John");
}

TEST(LockedFile, CannotBeCommittedWhileAnotherReads) {
  const TestDatabase file;
  file.AddMembers();
  const auto database = file.Open();
  const auto rows = database->OpenRecordset("Members");
  OtherConnection other(file.Path());
  other.Execute("BEGIN");
  ASSERT_EQ(other.Query("SELECT count(*) FROM Members"), "4");
  EXPECT_EQ(NumberThrownBy([&] { rows->Delete(); }), 3050);
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Sean");
  other.Execute("COMMIT");
  rows->Delete();
  EXPECT_EQ(file.Query("SELECT count(*) FROM Members"), "3");
}

TEST(ReadOnlyFile, CanBeReadButWritesAre3027) {
  const TestDatabase file;
  file.AddMembers();
  std::filesystem::permissions(file.Path(), std::filesystem::perms(0444));
  const OrdinaryUser user;
  const auto database = file.Open();
  const auto rows = database->OpenRecordset("Members");
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Sean");
  rows->Edit();
  rows->SetField("FirstName", "John");
  const Thrown thrown = ThrownBy([&] { rows->Update(); });
  EXPECT_EQ(thrown.Number, 3027);
  EXPECT_THAT(thrown.Text, HasSubstr("Cannot update. Database or object is read-only"));
  EXPECT_THAT(thrown.Text, HasSubstr(file.Path()));
  EXPECT_EQ(NumberThrownBy([&] { rows->Delete(); }), 3027);
  rows->AddNew();
  EXPECT_EQ(NumberThrownBy([&] { rows->Update(); }), 3027);
  EXPECT_EQ(file.Query("SELECT count(*) FROM Members WHERE FirstName = 'Sean'"), "1");
}

TEST(ReadOnlyFolder, CanBeReadButWritesAre3027) {
  const TestDatabase file;
  file.AddMembers();
  std::filesystem::permissions(file.Path(), std::filesystem::perms(0666));
  std::filesystem::permissions(file.Folder().Path(), std::filesystem::perms(0555));
  const OrdinaryUser user;
  const auto database = file.Open();
  const auto rows = database->OpenRecordset("Members");
  EXPECT_EQ(TextOf(*rows, "FirstName"), "Sean");
  EXPECT_EQ(NumberThrownBy([&] { rows->Delete(); }), 3027);
}

// Parameter: the file-size limit. The journal is written before the file grows, so the smaller limit fails
// there.
class FullDisk : public testing::TestWithParam<int> {};

TEST_P(FullDisk, Is3026AndLeavesTheOldRowAndTheEdit) {
  const TestDatabase file;
  file.AddMembers();
  file.Execute("UPDATE Members SET Photograph = X'AA' WHERE ContactID = 1");
  const auto database = file.Open();
  const auto rows = database->OpenRecordset("Members");
  rows->Edit();
  rows->AppendChunk("Photograph", Blob(200'000, 0x55));
  Thrown thrown;
  {
    const FileSizeLimit limit(GetParam());
    thrown = ThrownBy([&] { rows->Update(); });
  }
  EXPECT_EQ(thrown.Number, 3026);
  EXPECT_EQ(thrown.Text, "Not enough space on disk: " + file.Path());
  EXPECT_EQ(file.Query("SELECT hex(Photograph) FROM Members WHERE ContactID = 1"), "AA");
  EXPECT_EQ(file.Query("PRAGMA integrity_check"), "ok");
  EXPECT_EQ(rows->EditMode(), EditMode::InProgress);
  rows->Update();
  EXPECT_EQ(file.Query("SELECT length(Photograph) FROM Members WHERE ContactID = 1"), "200000");
}

INSTANTIATE_TEST_SUITE_P(JournalOrFile, FullDisk, testing::Values(1024, 40'960));

TEST(DamagedPage, FailsWith3343WhenItsRowIsRead) {
  const TestDatabase file;
  file.Execute(
      "WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < 5000) "
      "INSERT INTO Members (ContactID, FirstName) SELECT i, printf('%0200d', i) FROM n");
  const std::size_t page = 4096;
  std::string bytes = ReadFile(file.Path());
  // The leaf page with a row from the middle of the table.
  const std::size_t leaf = bytes.find(std::string(196, '0') + "2500") / page * page;
  ASSERT_LT(leaf, bytes.size());
  bytes.replace(leaf, page, std::string(page, '\xFF'));
  WriteFile(file.Path(), bytes);

  const auto database = file.Open();
  const auto rows = database->OpenRecordset("Members");
  EXPECT_EQ(TextOf(*rows, "FirstName"), std::string(199, '0') + "1");
  const Thrown thrown = ThrownBy([&] { rows->WalkTo("ContactID", std::int64_t{2500}); });
  EXPECT_EQ(thrown.Number, 3343);
  EXPECT_EQ(thrown.Text, "Unrecognized database format '" + file.Path() + "'.");
  EXPECT_TRUE(rows->WalkTo("ContactID", std::int64_t{5000}));
}

constexpr std::size_t PhotoSize = 60'000;

// The writer that will be killed: writes n = 1, 2, ... to three columns of row 1 in one update each, and
// reports each n once its update has returned.
[[noreturn]] void WriteForEver(const std::string& path, int reports) {
  try {
    const auto database = SqliteEngine().OpenDatabase(path);
    const auto rows = database->OpenRecordset("Members");
    for (std::int64_t n = IntegerOf(*rows, "TotalGamesPlayed") + 1;; ++n) {
      rows->Edit();
      rows->SetField("TotalGamesPlayed", n);
      rows->SetField("PhotographLength", n);
      rows->AppendChunk("Photograph", Blob(PhotoSize, static_cast<std::uint8_t>(n)));
      rows->Update();
      if (write(reports, &n, sizeof n) != sizeof n) {
        _exit(2);
      }
    }
  } catch (...) {
    _exit(3);
  }
}

// Waits until a writer has reported `writes` updates and kills it during the next one. Returns the last
// number reported by then.
std::int64_t KillAfter(int writes, const std::string& path) {
  int reports[2];
  if (pipe(reports) != 0) {
    throw std::runtime_error("no pipe");
  }
  const pid_t writer = fork();
  if (writer == 0) {
    close(reports[0]);
    WriteForEver(path, reports[1]);
  }
  close(reports[1]);
  std::int64_t last = -1;
  for (int i = 0; i < writes; ++i) {
    if (read(reports[0], &last, sizeof last) != sizeof last) {
      throw std::runtime_error("the writer failed");
    }
  }
  kill(writer, SIGKILL);
  waitpid(writer, nullptr, 0);
  while (read(reports[0], &last, sizeof last) == sizeof last) {
  }
  close(reports[0]);
  return last;
}

TEST(KilledWriter, LeavesTheOldOrTheNewRowAndEveryWriteThatWasDone) {
  const TestDatabase file;
  file.AddMembers();
  for (int round = 1; round <= 20; ++round) {
    const std::int64_t done = KillAfter(round % 4 + 1, file.Path());

    const auto database = file.Open();
    const auto rows = database->OpenRecordset("Members");
    const std::int64_t found = IntegerOf(*rows, "TotalGamesPlayed");
    EXPECT_GE(found, done);
    EXPECT_LE(found, done + 1);
    EXPECT_EQ(IntegerOf(*rows, "PhotographLength"), found);
    EXPECT_EQ(rows->GetChunk("Photograph", 0, PhotoSize + 1),
              Blob(PhotoSize, static_cast<std::uint8_t>(found)));
    EXPECT_EQ(file.Query("PRAGMA integrity_check"), "ok");
  }
}

}  // namespace
