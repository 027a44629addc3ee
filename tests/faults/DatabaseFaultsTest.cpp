#include <gtest/gtest.h>

#include <chrono>
#include <memory>
#include <string>

#include "core/data/Backups.h"
#include "core/data/Photo.h"
#include "core/text/StringTable.h"
#include "members/MemberCursor.h"
#include "missions/MissionRecord.h"
#include "platform/linux/LinuxFiles.h"
#include "platform/sqlite/SqliteDatabase.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/faults/FaultLoop.h"
#include "tests/support/DatabaseContents.h"
#include "tests/support/MadeDatabase.h"

namespace {

/// On one database, which is open.
class OnDatabase : public FaultyOperation {
 public:
  OnDatabase(const std::string& name, const std::string& bytes) : Path(*this / name) {
    WriteFile(Path, bytes);
    Opened = SqliteEngine(std::chrono::milliseconds(0)).OpenDatabase(Path);
  }

  std::string State() const override { return WholeContents(Path); }
  bool Fits(const FileFault& fault, const std::string& call, const Thrown& told) const override {
    return DatabaseFaultFits(fault, call, told, Path);
  }

  const std::string Path;
  std::unique_ptr<Database> Opened;
};

/// On the missions "One" and "Two".
class OnMissions : public OnDatabase {
 public:
  OnMissions() : OnDatabase("scenarios.mdb", Bytes()), Rows(Opened->OpenRecordset("Table1")) {}

  static const std::string& Bytes() {
    static const std::string bytes =
        MadeDatabase("scenarios",
                     "DELETE FROM Table1; INSERT INTO Table1 (ID, MissionName, MissionDescription) VALUES "
                     "(3, 'One', 'First text'), (5, 'Two', 'Second text')");
    return bytes;
  }

  std::unique_ptr<Recordset> Rows;
};

MissionRecord NewMission() {
  MissionRecord mission;
  mission.Name = "New";
  mission.Description = std::string(800, 'd');
  mission.RespawnPenalty = "2.5";
  mission.Objectives[1].PrimaryPoints = "7";
  return mission;
}

struct MissionAdded : OnMissions {
  void Act() override {
    if (Rows->EditMode() != EditMode::Add) {  // still pending after a failure
      Rows->AddNew();
    }
    WriteMission(*Rows, NewMission());
    Rows->Update();
  }
};

struct MissionChanged : OnMissions {
  void Act() override {
    Rows->FindFirst("ID= 5");
    Rows->Edit();
    WriteMission(*Rows, NewMission());
    Rows->Update();
  }
};

struct MissionDeleted : OnMissions {
  void Act() override {
    Rows->FindFirst("ID= 5");
    Rows->Delete();
  }
};

/// On the members 1 to 40; number 2 has a photograph of some pages.
class OnMembers : public OnDatabase {
 public:
  OnMembers() : OnDatabase("members.mdb", Bytes()) {}

  static const std::string& Bytes() {
    static const std::string bytes = MadeDatabase(
        "members",
        "WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < 40) "
        "INSERT INTO Members (ContactID, FirstName, LastName) SELECT i, 'First' || i, 'Last' || i FROM n; "
        "UPDATE Members SET PhotographLength = 20000, Photograph = zeroblob(20000) WHERE ContactID = 2");
    return bytes;
  }
};

/// Controls without a window.
struct Controls final : BoundControls {
  void ShowRow(Recordset& rows) override { Details = ReadDetails(rows); }
  void ShowNoRow() override { Details = {}; }
  MemberDetails Entered() const override { return Details; }
  void RowChanged() override {}

  MemberDetails Details;
};

class InMembersWindow : public OnMembers {
 public:
  InMembersWindow() { Cursor.WalkTo(2); }

  Controls Shown;
  MemberCursor Cursor{*Opened, Shown};
};

struct MemberEdited : InMembersWindow {
  void Act() override {
    Shown.Details.FirstName = "Zoe";
    Shown.Details.City = "Other";
    Cursor.WriteBack();
  }
};

struct MemberAdded : InMembersWindow {
  void Act() override { Cursor.AddMember("2013-05-21 14:30:05"); }

  /// Behind the insertion the new row is read and shown, which can fail by itself.
  bool CanFailWhenDone() const override { return true; }
};

struct MemberDeleted : InMembersWindow {
  void Act() override { Cursor.Delete(); }
  bool CanFailWhenDone() const override { return true; }
};

struct PhotographChanged : InMembersWindow {
  PhotographChanged() { WriteFile(*this / "photo.jpg", std::string(30'000, 'p')); }

  void Act() override {
    Boxes.Boxes.clear();
    Recordset& rows = Cursor.Rows();
    try {
      rows.Edit();
      StorePhoto(*this / "photo.jpg", rows, "Photograph", "PhotographLength", Disk, Boxes);
      rows.Update();
    } catch (const RuntimeError&) {
      if (rows.EditMode() != EditMode::None) {
        rows.CancelUpdate();
      }
      throw;
    }
    if (!Boxes.Boxes.empty()) {
      throw RuntimeError(Fault::PathAccess, Boxes.Boxes.back().Text);
    }
  }

  bool Fits(const FileFault& fault, const std::string& call, const Thrown& told) const override {
    return told.Number == Fault::PathAccess ? told.Text == "Path/File access error: " + *this / "photo.jpg"
                                            : InMembersWindow::Fits(fault, call, told);
  }

  LinuxFiles Disk;
  FakeMessageBoxes Boxes;
};

/// The first change of a run, before which a backup is made.
struct ChangeWithBackup : OnMembers {
  ChangeWithBackup() { Copies.Guard(*Opened, Path); }

  void Act() override {
    Rows->Edit();
    Rows->SetField("NickName", std::string("Mole"));
    Rows->Update();
  }

  /// Every copy is whole and older than the change; a copy that is missing was told.
  void Check() const override {
    int copies = 0;
    for (const std::string& name : Disk.FileNames(*this / "backups")) {
      if (name.ends_with("143005.mdb")) {
        ++copies;
        EXPECT_EQ(WholeContents(*this / "backups/" + name), before_);
      }
    }
    EXPECT_LE(copies, 1);
  }

  LinuxFiles Disk;
  FakeClock Time;
  StringTable Strings{Language::English};
  Backups Copies{*this / "backups", Disk, Time, Strings};
  std::unique_ptr<Recordset> Rows = Opened->OpenRecordset("Members");

 private:
  const std::string before_ = State();
};

template <typename Operation>
class DatabaseUnderFaults : public testing::Test {};

using DatabaseOperations = testing::Types<MissionAdded, MissionChanged, MissionDeleted, MemberEdited,
                                          MemberAdded, MemberDeleted, PhotographChanged, ChangeWithBackup>;
TYPED_TEST_SUITE(DatabaseUnderFaults, DatabaseOperations);

TYPED_TEST(DatabaseUnderFaults, HoldsTheOldRowsOrTheNewAndTheNextTryWorks) {
  const FaultRun run = FailAtEveryCall<TypeParam>();
  EXPECT_NE(run.Before, run.After);
  EXPECT_GT(run.Failures, 50);
}

}  // namespace
