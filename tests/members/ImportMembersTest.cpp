#include "members/ImportMembers.h"

#include <QCheckBox>
#include <QRadioButton>
#include <QTableWidget>

#include "platform/RuntimeError.h"
#include "tests/members/MemberFiles.h"
#include "tests/support/CaredFor.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

const std::string TwoNewMembers =
    "First name,Last name,Date of birth\nAda,Byron,1990-12-10\nBo,Li,2001-01-02\n";

class ImportWindow : public MemberFiles {
 protected:
  /// Opens the window on a file of these contents and waits for the end of its check.
  void Open(const std::string& csv, Language language = Language::English) {
    strings = std::make_unique<StringTable>(language);
    window = std::make_unique<ImportMembers>(
        ImportMembers::Parts{*database, venue.Boxes, events, venue.Time, *strings,
                             [this](const KeepOn& keepOn) {
                               ++copies;
                               if (copyFails) {
                                 throw RuntimeError(Fault::DiskFull);
                               }
                               if (stopsCopy) {
                                 ::Press(*window, "Stop");
                               }
                               return keepOn();
                             }},
        "/home/x/list.csv", csv, nullptr);
    Show(*window);
    AwaitCheck();
  }

  void AwaitCheck() {
    ASSERT_TRUE(QTest::qWaitFor([this] { return State() != "Looking at the file..." && State() != ""; }));
    QCoreApplication::processEvents();
  }

  std::string State() const { return LabelText(*window, "State"); }
  bool MayImport() const { return Find<QPushButton>(*window, "Import").isEnabled(); }
  void PressImport() { ::Press(*window, "Import"); }

  /// A column of the preview, from the top.
  std::vector<std::string> Preview(int column) const {
    const QAbstractItemModel& model = *Find<QAbstractItemView>(*window, "PlannedRows").model();
    std::vector<std::string> cells;
    for (int row = 0; row < model.rowCount(); ++row) {
      cells.push_back(model.index(row, column).data().toString().toStdString());
    }
    return cells;
  }

  std::string Use(int column) const {
    return Find<QComboBox>(*window, "Use" + std::to_string(column)).currentText().toStdString();
  }

  /// Changes a choice and waits for the check that follows.
  void ChooseAndWait(const std::string& list, int entry) {
    Find<QLabel>(*window, "State").clear();
    Choose(*window, list, entry);
    AwaitCheck();
  }

  std::unique_ptr<StringTable> strings;
  std::unique_ptr<ImportMembers> window;
  int copies = 0;
  bool stopsCopy = false;
  bool copyFails = false;
};

TEST_F(ImportWindow, ShowsWhatTheImportWillDo) {
  Open(TwoNewMembers + "Rhys,Morgan,1961-04-12\nX,Y,1.1.1\n");
  EXPECT_EQ(LabelText(*window, "ColumnsLabel"), "Columns of list.csv:");
  EXPECT_THAT((std::vector{Use(0), Use(1), Use(2)}), ElementsAre("First name", "Last name", "Date of birth"));
  EXPECT_THAT(Preview(0), ElementsAre("2", "3", "4", "5"));
  EXPECT_THAT(Preview(1), ElementsAre("Ada Byron", "Bo Li", "Rhys Morgan", "X Y"));
  EXPECT_THAT(Preview(2),
              ElementsAre("New", "New", "Skipped, is there already",
                          "Refused: Date of birth is no date, or not in this order of day and month"));
  EXPECT_EQ(State(), "2 new, 0 changed, 0 unchanged, 1 skipped, 1 refused");
  EXPECT_TRUE(MayImport());
  Choose(*window, "Shown", 5);
  EXPECT_THAT(Preview(0), ElementsAre("5"));
  EXPECT_EQ(Query("SELECT count(*) FROM Members"), "4");
}

TEST_F(ImportWindow, ImportsAfterACopyAndTellsSo) {
  Open(TwoNewMembers);
  PressImport();
  EXPECT_EQ(copies, 1);
  EXPECT_EQ(Query("SELECT count(*) FROM Members"), "6");
  EXPECT_TRUE(window->HasImported());
  EXPECT_FALSE(window->isVisible());
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_THAT(venue.Boxes.Boxes[0].Text, HasSubstr("2 members were added and 0 changed."));
}

TEST_F(ImportWindow, ImportsNothingWithoutACopy) {
  copyFails = true;
  Open(TwoNewMembers);
  PressImport();
  EXPECT_EQ(Query("SELECT count(*) FROM Members"), "4");
  EXPECT_FALSE(window->HasImported());
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_THAT(venue.Boxes.Boxes[0].Text, HasSubstr("no backup copy could be made"));
  EXPECT_TRUE(MayImport());
}

TEST_F(ImportWindow, ImportsNothingWhenItIsStoppedDuringTheCopy) {
  stopsCopy = true;
  Open(TwoNewMembers);
  PressImport();
  EXPECT_EQ(copies, 1);
  EXPECT_EQ(Query("SELECT count(*) FROM Members"), "4");
  EXPECT_FALSE(window->HasImported());
  EXPECT_EQ(State(), "Import stopped. No member was changed.");
  EXPECT_TRUE(MayImport());
  stopsCopy = false;
  PressImport();
  EXPECT_TRUE(window->HasImported());
}

TEST_F(ImportWindow, ImportsNothingWhenAnotherProgramHoldsTheFile) {
  Open(TwoNewMembers);
  OtherConnection other(venue.DataFile("members.mdb"));
  other.Execute("BEGIN IMMEDIATE");
  PressImport();
  EXPECT_FALSE(window->HasImported());
  EXPECT_EQ(State(), "Import stopped. No member was changed.");
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_THAT(venue.Boxes.Boxes[0].Text, HasSubstr("Run-time error '3050'"));
  other.Execute("ROLLBACK");
  Find<QLabel>(*window, "State").clear();
  ::Press(*window, "CheckAgain");
  AwaitCheck();
  EXPECT_TRUE(MayImport());
}

TEST_F(ImportWindow, LooksAnewAfterEachChoice) {
  Open("First name,Last name,Town\nSean,O'Brien,Cork\n");
  EXPECT_EQ(State(), "0 new, 0 changed, 0 unchanged, 1 skipped, 0 refused");
  EXPECT_FALSE(MayImport());
  ChooseAndWait("Same", 1);
  EXPECT_THAT(Preview(2), ElementsAre("Changed: City"));
  ChooseAndWait("Use2", 0);
  EXPECT_THAT(Preview(2), ElementsAre("Unchanged"));
  ChooseAndWait("Use2", 6);
  EXPECT_THAT(Preview(2), ElementsAre("Changed: Clan"));
  ChooseAndWait("Same", 2);
  EXPECT_THAT(Preview(2), ElementsAre("New"));
  EXPECT_TRUE(MayImport());
}

TEST_F(ImportWindow, TakesTheHistoryOnlyByATick) {
  Open("FirstName,LastName,Birthdate,TotalGamesPlayed\nRhys,Morgan,1961-04-12,8\n");
  EXPECT_FALSE(Find<QCheckBox>(*window, "History").isChecked());
  ChooseAndWait("Same", 1);
  EXPECT_THAT(Preview(2), ElementsAre("Unchanged"));
  Find<QLabel>(*window, "State").clear();
  Find<QCheckBox>(*window, "History").click();
  AwaitCheck();
  EXPECT_THAT(Preview(2), ElementsAre("Changed: Games played"));
}

TEST_F(ImportWindow, DoesNotTakeTwoColumnsForOne) {
  Open("First name,Last name,Other\nAda,Byron,x\n");
  ChooseAndWait("Use2", 4);
  EXPECT_EQ(State(), "Two columns go to Last name. Choose one of them.");
  EXPECT_FALSE(MayImport());
}

TEST_F(ImportWindow, AsksForTheOrderOfDatesWhereTheFileLeavesItOpen) {
  Open("First name,Last name,Date of birth\nAda,Byron,3/5/2001\n");
  EXPECT_EQ(State(), "The file does not settle the order. Please choose.");
  EXPECT_FALSE(MayImport());
  auto& monthFirst = Find<QRadioButton>(*window, "MonthFirst");
  EXPECT_TRUE(monthFirst.isEnabled());
  EXPECT_FALSE(monthFirst.isChecked() || Find<QRadioButton>(*window, "DayFirst").isChecked());
  Find<QLabel>(*window, "State").clear();
  monthFirst.click();
  AwaitCheck();
  EXPECT_TRUE(MayImport());
  PressImport();
  EXPECT_EQ(Query("SELECT Birthdate FROM Members WHERE FirstName = 'Ada'"), "2001-03-05 00:00:00");
}

TEST_F(ImportWindow, TakesTheOrderOfDatesFromTheFile) {
  Open("First name,Last name,Date of birth\nAda,Byron,3/5/2001\nBo,Li,5/23/2001\n");
  EXPECT_EQ(LabelText(*window, "DatesState"), "The date in line 3 settles the order.");
  EXPECT_TRUE(Find<QRadioButton>(*window, "MonthFirst").isChecked());
  EXPECT_FALSE(Find<QRadioButton>(*window, "MonthFirst").isEnabled());
  PressImport();
  EXPECT_EQ(Query("SELECT Birthdate FROM Members WHERE FirstName = 'Ada'"), "2001-03-05 00:00:00");
}

TEST_F(ImportWindow, DividesTheFileByAnotherSeparator) {
  Open("Ada;Byron,First name\n1;2,Bo\n");
  EXPECT_EQ(Find<QComboBox>(*window, "Separator").currentIndex(), 0);
  EXPECT_EQ(Find<QTableWidget>(*window, "FileColumns").item(0, 0)->text().toStdString(), "Ada;Byron");
  ChooseAndWait("Separator", 1);
  EXPECT_EQ(Find<QTableWidget>(*window, "FileColumns").item(0, 0)->text().toStdString(), "Ada");
}

TEST_F(ImportWindow, TellsTheLineOfAFileThatIsBroken) {
  Open("First name,Last name\nAda,\"Byron\nBo,Li\n");
  EXPECT_EQ(State(), "Line 2: a quotation mark is opened and never closed.");
  EXPECT_FALSE(MayImport());
}

TEST_F(ImportWindow, StopsInTheMiddleWithoutAChange) {
  std::string csv = "First name,Last name\n";
  for (int member = 0; member < 20000; ++member) {
    csv.append("A").append(std::to_string(member)).append(",B\n");
  }
  Open(csv);
  ASSERT_TRUE(QTest::qWaitFor([this] { return MayImport(); }));
  QTimer::singleShot(0, window.get(), [this] { ::Press(*window, "Stop"); });
  PressImport();
  EXPECT_EQ(State(), "Import stopped. No member was changed.");
  EXPECT_EQ(Query("SELECT count(*) FROM Members"), "4");
  EXPECT_TRUE(window->isVisible());
}

TEST_F(ImportWindow, ClosesInTheMiddleWithoutAChange) {
  std::string csv = "First name,Last name\n";
  for (int member = 0; member < 20000; ++member) {
    csv.append("A").append(std::to_string(member)).append(",B\n");
  }
  Open(csv);
  ASSERT_TRUE(QTest::qWaitFor([this] { return MayImport(); }));
  QTimer::singleShot(0, window.get(), [this] { window->close(); });
  PressImport();
  EXPECT_FALSE(window->isVisible());
  EXPECT_FALSE(window->HasImported());
  EXPECT_EQ(Query("SELECT count(*) FROM Members"), "4");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(ImportWindow, IsCaredForInBothLanguages) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    Open(TwoNewMembers, language);
    ExpectCaredFor(*window);
    EXPECT_EQ(window->windowTitle().toStdString(),
              language == Language::English ? "Import Members" : "导入会员");
  }
}

}  // namespace
