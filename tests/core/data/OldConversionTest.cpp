#include "core/data/OldConversion.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeOldDatabases.h"
#include "tests/support/Thrown.h"

namespace {

using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

class NoEngine : public DatabaseEngine {
 public:
  std::unique_ptr<Database> OpenDatabase(const std::string& /*path*/) override { return nullptr; }
};

NotTakenOver ValueInRow(int number) {
  return {.What = NotTakenOver::OneValue,
          .Name = "Photograph",
          .InTable = "Members",
          .InRow = std::to_string(number) + " (ContactID 9)"};
}

class OldConversion : public testing::TestWithParam<Language> {
 protected:
  OldConversion() {
    disk.AddFolder("/data");
    old.OldPaths = {"/data/members.mdb"};
    old.Report = {40, {}, "/data/members.mdb.jet"};
  }

  void Convert() {
    ConvertOldDatabase({"/data/members.mdb", "Members", "/program/members_default.mdb"},
                       {engine, old, disk, boxes, copies, strings});
  }

  bool IsEnglish() const { return GetParam() == Language::English; }

  std::string ReasonOf(const OldDatabaseRefused& refusal) {
    old.Run = [&refusal](const OldDatabase&, ConversionSteps&) { throw refusal; };
    const Thrown thrown = ThrownBy([this] { Convert(); });
    EXPECT_EQ(thrown.Number, 3343);
    EXPECT_THAT(boxes.Boxes, IsEmpty());
    return thrown.Text;
  }

  NoEngine engine;
  FakeOldDatabases old;
  FakeFiles disk;
  FakeMessageBoxes boxes;
  FakeClock clock;
  StringTable strings{GetParam()};
  Backups copies{"/data/backups", disk, clock, strings};
};

TEST_P(OldConversion, AsksBeforeItLeavesValuesOut) {
  bool answer = true;
  old.Run = [&answer](const OldDatabase&, ConversionSteps& steps) {
    answer = steps.GoOnWithout({ValueInRow(3)});
  };
  boxes.Answers = {BoxAnswer::No};
  Convert();
  EXPECT_FALSE(answer);
  EXPECT_EQ(boxes.Boxes.front(),
            (FakeMessageBoxes::Box{
                IsEnglish() ? "The old database /data/members.mdb holds values that cannot be read whole:\n\n"
                              "table Members, row 3 (ContactID 9), column Photograph\n\n"
                              "Convert it without them? No leaves it as it is."
                            : "旧数据库 /data/members.mdb 中有无法完整读取的值：\n\n"
                              "表 Members，第 3 (ContactID 9) 行，列 Photograph\n\n"
                              "是否不转换这些值而继续？选“否”则该文件保持原样。",
                "Database status", BoxIcon::Question, BoxButtons::YesNo}));
  boxes.Answers = {BoxAnswer::Yes};
  Convert();
  EXPECT_TRUE(answer);
}

TEST_P(OldConversion, OffersTheRowsOfTheFreshDatabase) {
  bool answer = false;
  old.Run = [&answer](const OldDatabase& database, ConversionSteps& steps) {
    EXPECT_EQ(database.InterimPath, "/data/members-new.mdb");
    answer = steps.AddInterimRows(3);
  };
  boxes.Answers = {BoxAnswer::Yes};
  Convert();
  EXPECT_TRUE(answer);
  EXPECT_EQ(
      boxes.Boxes.front(),
      (FakeMessageBoxes::Box{
          IsEnglish() ? "The old database /data/members.mdb can be converted now. While it could not be "
                        "used, 3 rows were entered into /data/members-new.mdb. Add them to it? No leaves "
                        "them there."
                      : "旧数据库 /data/members.mdb 现在可以转换。在它无法使用期间，有 3 行录入了 "
                        "/data/members-new.mdb。是否将其合并进来？选“否”则它们留在原处。",
          "Database status", BoxIcon::Question, BoxButtons::YesNo}));
}

TEST_P(OldConversion, KeepsTheListBeforeItsBoxOpens) {
  old.Report.NotTaken = {{NotTakenOver::MissingColumn, "Clan"}};
  std::string kept;
  boxes.WhileOpen = [&](const FakeMessageBoxes::Box&) { kept = disk.Contents().at("/data/members.mdb.txt"); };
  Convert();
  EXPECT_EQ(kept, boxes.Boxes.front().Text + "\n");
  EXPECT_THAT(kept, EndsWith(IsEnglish() ? "\ncolumn Clan, which the old file lacks (now empty or 0)\n"
                                         : "\n列 Clan，旧文件中没有（现为空或 0）\n"));
}

TEST_P(OldConversion, KeepsTheListOfAnEarlierOne) {
  disk.Put("/data/members.mdb.txt", "earlier\n");
  old.Report.NotTaken = {{NotTakenOver::Column, "Shoe size"}};
  Convert();
  EXPECT_EQ(disk.Contents().at("/data/members.mdb.txt"), "earlier\n\n" + boxes.Boxes.front().Text + "\n");
}

TEST_P(OldConversion, KeepsNoListOfNothing) {
  Convert();
  EXPECT_THAT(disk.Replaced, IsEmpty());
}

TEST_P(OldConversion, ShowsTenLinesAndKeepsAll) {
  for (int row = 1; row <= 300; ++row) {
    old.Report.NotTaken.push_back(ValueInRow(row));
  }
  Convert();
  const std::string text = boxes.Boxes.front().Text;
  EXPECT_THAT(text, HasSubstr(IsEnglish() ? "row 10 (" : "第 10 ("));
  EXPECT_THAT(text, Not(HasSubstr(IsEnglish() ? "row 11 (" : "第 11 (")));
  EXPECT_THAT(text, EndsWith(IsEnglish() ? "\n... and 290 more\n\nThe whole list is in /data/members.mdb.txt."
                                         : "\n……以及其他 290 项\n\n完整列表保存在 /data/members.mdb.txt。"));
  EXPECT_LE(std::count(text.begin(), text.end(), '\n'), 16);
  EXPECT_THAT(disk.Contents().at("/data/members.mdb.txt"),
              EndsWith(IsEnglish() ? "row 300 (ContactID 9), column Photograph\n"
                                   : "第 300 (ContactID 9) 行，列 Photograph\n"));
}

TEST_P(OldConversion, HasTenLinesInItsQuestionToo) {
  old.Run = [](const OldDatabase&, ConversionSteps& steps) {
    steps.GoOnWithout(std::vector<NotTakenOver>(300, ValueInRow(1)));
  };
  Convert();
  EXPECT_THAT(boxes.Boxes.front().Text,
              HasSubstr(IsEnglish() ? "\n... and 290 more\n" : "\n……以及其他 290 项\n"));
}

TEST_P(OldConversion, AlwaysHasAReason) {
  EXPECT_EQ(ReasonOf(OldDatabaseRefused()),
            IsEnglish() ? "It is damaged or cut short." : "该文件已损坏或不完整。");
  EXPECT_EQ(ReasonOf(OldDatabaseRefused("Disk full: x")),
            IsEnglish() ? "It cannot be taken over: Disk full: x" : "无法转换其中的内容：Disk full: x");
  EXPECT_EQ(ReasonOf(OldDatabaseRefused("")),
            IsEnglish() ? "It is damaged or cut short." : "该文件已损坏或不完整。");
  EXPECT_EQ(ReasonOf(OldDatabaseRefused({{NotTakenOver::TableRows, "Members", 3, 40}})),
            IsEnglish() ? "It cannot be taken over: table Members (3/40 rows)"
                        : "无法转换其中的内容：表 Members（3/40 行）");
  EXPECT_EQ(ReasonOf(OldDatabaseRefused({ValueInRow(2)})),
            IsEnglish() ? "It cannot be taken over: table Members, row 2 (ContactID 9), column Photograph"
                        : "无法转换其中的内容：表 Members，第 2 (ContactID 9) 行，列 Photograph");
}

INSTANTIATE_TEST_SUITE_P(Languages, OldConversion,
                         testing::Values(Language::English, Language::SimplifiedChinese));

}  // namespace
