#include "core/data/UserDatabase.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeOldDatabases.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class NoDatabase : public Database {
 public:
  std::unique_ptr<Recordset> OpenRecordset(const std::string& /*source*/) override { return nullptr; }
  Sql& Statements() override { throw RuntimeError(Fault::InternalError); }
  void RaiseCounter(const std::string& /*table*/, std::int64_t /*number*/) override {}
  void BeginTrans() override {}
  void CommitTrans() override {}
  void Rollback() noexcept override {}
  void FlushGroup() override {}
  void BeforeChange(std::function<bool()> action) override { BeforeChangeOf = std::move(action); }
  void CopyTo(const std::string& path) override { CopiedTo = path; }
  bool CopyInSteps(const std::string& path, const KeepOn& /*keepOn*/) override {
    CopiedTo = path;
    return true;
  }
  std::unique_ptr<StepwiseCopy> BeginCopy(const std::string& /*path*/) override { return nullptr; }
  bool CheckWhole(const KeepOn& /*keepOn*/) override { return true; }
  bool RewriteTo(const std::string& /*path*/, const KeepOn& /*keepOn*/) override { return true; }
  std::vector<std::string> ColumnNames(const std::string& /*table*/) override { return {}; }
  std::string Path() const override { return {}; }
  std::string FilePath() const override { return {}; }
  bool HasMoved() const override { return false; }
  void HoldWriters() override {}
  void ReleaseWriters() noexcept override {}

  std::function<bool()> BeforeChangeOf;
  std::string CopiedTo;
};

/// Opens any file that exists and is not listed as bad.
class ScriptedEngine : public DatabaseEngine {
 public:
  std::vector<std::string> Opened;
  std::string BadPath;
  int BadNumber = 3343;

  std::unique_ptr<Database> OpenDatabase(const std::string& path) override {
    if (path == BadPath) {
      throw RuntimeError(BadNumber, "Unrecognized database format.");
    }
    Opened.push_back(path);
    return std::make_unique<NoDatabase>();
  }
};

class Opening : public testing::Test {
 protected:
  Opening() {
    disk.Put("/data/members.mdb", "mine");
    disk.Put("/program/members_default.mdb", "fresh");
  }

  std::unique_ptr<Database> Open() { return Open(strings); }

  std::unique_ptr<Database> Open(const StringTable& texts) {
    return OpenUserDatabase({"/data/members.mdb", "Members", "/program/members_default.mdb"},
                            {engine, old, disk, boxes, copies, texts});
  }

  static FakeMessageBoxes::Box Question(const std::string& reason) {
    return {"The database /data/members.mdb cannot be used. " + reason +
                "\n\nIt stays as it is. Press OK to go on with a fresh database, /data/members-new.mdb, or "
                "Cancel to end "
                "the program.",
            "Database status", BoxIcon::Exclamation, BoxButtons::OkCancel};
  }

  ScriptedEngine engine;
  FakeOldDatabases old;
  FakeFiles disk;
  FakeMessageBoxes boxes;
  FakeClock clock;
  StringTable strings{Language::English};
  Backups copies{"/data/backups", disk, clock, strings};
};

TEST_F(Opening, OfAFileOfTodayIsSilent) {
  EXPECT_NE(Open(), nullptr);
  EXPECT_THAT(engine.Opened, ElementsAre("/data/members.mdb"));
  EXPECT_THAT(old.Converted, IsEmpty());
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(Opening, ConvertsAnOldFileAndTellsWhatWasNotTaken) {
  old.OldPaths = {"/data/members.mdb"};
  old.Report = {
      40, {{NotTakenOver::Table, "Extras", 3}, {NotTakenOver::Column, "Shoe size"}}, "/data/members.mdb.jet"};
  EXPECT_NE(Open(), nullptr);
  EXPECT_THAT(old.Converted, ElementsAre("/data/members.mdb Members /program/members_default.mdb"));
  EXPECT_THAT(engine.Opened, ElementsAre("/data/members.mdb"));
  EXPECT_THAT(
      boxes.Boxes,
      ElementsAre(FakeMessageBoxes::Box{
          "The database of an old installation has been converted: /data/members.mdb, 40 rows. The old file "
          "is "
          "kept as /data/members.mdb.jet.\n\nNot taken over:\ntable Extras (3 rows)\ncolumn Shoe size",
          "Database status", BoxIcon::Information, BoxButtons::Ok}));
}

TEST_F(Opening, TellsInChineseToo) {
  const StringTable chinese(Language::SimplifiedChinese);
  old.OldPaths = {"/data/members.mdb"};
  old.Report = {40, {{NotTakenOver::TextsOfColumn, "Shoe size"}}, "/data/members.mdb.jet"};
  Open(chinese);
  old.OldPaths = {"/data/members.mdb"};
  old.Failure = "It is damaged.";
  Open(chinese);
  ASSERT_EQ(boxes.Boxes.size(), 2U);
  EXPECT_EQ(boxes.Boxes[0].Text,
            "旧安装的数据库已转换：/data/members.mdb，共 40 行。旧文件保留为 /data/members.mdb.jet。\n\n"
            "未转换的内容：\n列 Shoe size 中不是数字的文本（现为 0）");
  EXPECT_EQ(boxes.Boxes[1].Text,
            "无法使用数据库 /data/members.mdb。It is damaged.\n\n该文件将保持原样。按“确定”使用新的数据库 "
            "/data/members-new.mdb 继续，或按“取消”结束程序。");
}

TEST_F(Opening, HasTheFileCopiedBeforeItChanges) {
  const auto database = Open();
  auto& opened = dynamic_cast<NoDatabase&>(*database);
  ASSERT_TRUE(opened.BeforeChangeOf);
  opened.BeforeChangeOf();
  EXPECT_EQ(opened.CopiedTo, "/data/backups/members.part");
}

TEST_F(Opening, HasAFreshFileCopiedUnderItsOwnName) {
  engine.BadPath = "/data/members.mdb";
  const auto database = Open();
  auto& opened = dynamic_cast<NoDatabase&>(*database);
  opened.BeforeChangeOf();
  EXPECT_EQ(opened.CopiedTo, "/data/backups/members-new.part");
}

TEST_F(Opening, GoesOnWithAFreshFileBesideADamagedOne) {
  old.OldPaths = {"/data/members.mdb"};
  old.Failure = "It is damaged.";
  EXPECT_NE(Open(), nullptr);
  EXPECT_THAT(boxes.Boxes, ElementsAre(Question("It is damaged.")));
  EXPECT_THAT(engine.Opened, ElementsAre("/data/members-new.mdb"));
  EXPECT_EQ(disk.Contents().at("/data/members-new.mdb"), "fresh");
  EXPECT_EQ(disk.Contents().at("/data/members.mdb"), "mine");
}

TEST_F(Opening, UsesTheFreshFileOfTheLastTimeAgain) {
  engine.BadPath = "/data/members.mdb";
  disk.Put("/data/members-new.mdb", "with rows by now");
  EXPECT_NE(Open(), nullptr);
  EXPECT_THAT(boxes.Boxes, ElementsAre(Question("Unrecognized database format.")));
  EXPECT_EQ(disk.Contents().at("/data/members-new.mdb"), "with rows by now");
}

TEST_F(Opening, EndsOnCancelAndLeavesEverything) {
  engine.BadPath = "/data/members.mdb";
  boxes.Answers = {BoxAnswer::Cancel};
  EXPECT_EQ(Open(), nullptr);
  EXPECT_THAT(disk.Replaced, IsEmpty());
  EXPECT_THAT(engine.Opened, IsEmpty());
}

TEST_F(Opening, PassesOtherFailuresOn) {
  engine.BadPath = "/data/members.mdb";
  engine.BadNumber = 3050;
  EXPECT_EQ(NumberThrownBy([this] { Open(); }), 3050);
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

}  // namespace
