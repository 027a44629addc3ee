#include "archive/history/RankingWindow.h"

#include <sys/stat.h>

#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QProgressBar>
#include <QSpinBox>

#include "tests/archive/history/HistoryWindows.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakePrograms.h"
#include "tests/support/CaredFor.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

class RankingsWindow : public HistoryWindows {
 protected:
  RankingWindow& Open(Language language = Language::English) {
    texts = std::make_unique<StringTable>(language);
    window = std::make_unique<RankingWindow>(
        RankingWindow::Parts{.Archive = [this]() -> Sql& { return AskedArchive(); },
                             .DbMembers = *MembersDatabase,
                             .Hides = {},
                             .Boxes = boxes,
                             .CommonDialog1 = dialog,
                             .Disk = disk,
                             .OtherPrograms = programs,
                             .Events = events,
                             .Strings = *texts,
                             .PrintedPage = Folder / "ranking.html"},
        nullptr);
    Show(*window);
    return *window;
  }

  void Choose(const std::string& box, const std::string& text) const {
    auto& combo = Find<QComboBox>(*window, box);
    combo.setCurrentIndex(combo.findText(QString::fromStdString(text)));
  }
  std::vector<std::string> Row(int row) const { return CellsOf(*window, "RankingTable", row); }
  int Rows() const { return RowsOf(*window, "RankingTable"); }
  std::string State() const { return Find<QLabel>(*window, "StateLabel").text().toStdString(); }
  static unsigned ModeOf(const std::string& path) {
    struct stat info {};
    return stat(path.c_str(), &info) == 0 ? info.st_mode & 0777U : 0U;
  }

  FakePrograms programs;
  FakeEventPump events;
  std::unique_ptr<StringTable> texts;
  std::unique_ptr<RankingWindow> window;
};

TEST_F(RankingsWindow, BeginsWithTheLatestMonth) {
  Open();
  EXPECT_EQ(Rows(), 2);
  EXPECT_THAT(Row(0), ElementsAre("1", "Mole", "3", "600", "200.0", "500", "25.00%"));
  EXPECT_THAT(Row(1), ElementsAre("2", "(no nickname)", "3", "120", "40.0", "40", ""));
}

TEST_F(RankingsWindow, IsReadyAgainAfterAYearWasRead) {
  Open();
  auto& period = Find<QComboBox>(*window, "Period");
  period.setFocus();
  Choose("Period", "2026");
  EXPECT_EQ(Rows(), 2);
  EXPECT_EQ(State(), "");
  EXPECT_TRUE(period.isEnabled());
  EXPECT_EQ(window->focusWidget(), &period);
  EXPECT_FALSE(Find<QProgressBar>(*window, "Progress").isVisible());
  EXPECT_FALSE(Find<QPushButton>(*window, "Stop").isVisible());
}

TEST_F(RankingsWindow, StopsAndSaysHowToGoOn) {
  InArchive(
      "WITH RECURSIVE n(i) AS (SELECT 100 UNION ALL SELECT i + 1 FROM n WHERE i < 20000) INSERT INTO Games "
      "SELECT i, '2026-' || printf('%02d', 1 + i % 11) || '-01 00:00:00', '', 'None', 'cable', 1, 2, 0, 0, "
      "0, "
      "0, 1, 1, 1, 1, 1, 1, 1, '', NULL FROM n");
  InArchive(
      "INSERT INTO GamePlayers SELECT GameID, p.value, 5, '', 1, 1, 1, 1, 1, 1, 1, 1, 1, 1, NULL FROM Games, "
      "json_each('[11,12,13,14,15,16,17,18,19,20]') p WHERE GameID >= 100");
  Open();
  events.At(std::chrono::milliseconds(0), [this] {
    EXPECT_TRUE(Find<QProgressBar>(*window, "Progress").isVisible());
    EXPECT_FALSE(Find<QComboBox>(*window, "Period").isEnabled());
    ::Press(*window, "Stop");
  });
  Choose("Period", "2026");
  EXPECT_EQ(Rows(), 0);
  EXPECT_EQ(State(), "Stopped. Choose a period or an order to make the ranking.");
  EXPECT_TRUE(Find<QComboBox>(*window, "Period").isEnabled());
  Choose("Order", "Mean soldiering");
  EXPECT_EQ(Rows(), 2);
}

TEST_F(RankingsWindow, HasAllMonthsYearsAndAllTime) {
  Open();
  const auto& period = Find<QComboBox>(*window, "Period");
  std::vector<std::string> periods;
  for (int i = 0; i < period.count(); ++i) {
    periods.push_back(period.itemText(i).toStdString());
  }
  EXPECT_THAT(periods, ElementsAre("2026-11", "2026-09", "2026", "All time"));
  Choose("Period", "2026");
  EXPECT_EQ(Row(0)[3], "1000");
  InMembers("UPDATE Members SET TotalGamesPlayed = 30, TotalSoldiering = 9000 WHERE ContactID = 6");
  Choose("Period", "All time");
  EXPECT_EQ(Rows(), 1);
  EXPECT_THAT(Row(0), ElementsAre("1", "(no nickname)", "30", "9000", "300.0", "", "0.00%"));
  Choose("Order", "Best game");
  EXPECT_EQ(Row(0)[5], "40");
}

TEST_F(RankingsWindow, RanksByWhatIsChosen) {
  Open();
  Keep("2026-11-23 20:00:00", -900);
  Choose("Period", "2026-09");
  Choose("Period", "2026-11");
  EXPECT_EQ(Row(0)[1], "(no nickname)");
  Choose("Order", "Best game");
  EXPECT_EQ(Row(0)[1], "Mole");
  Find<QSpinBox>(*window, "LeastGames").setValue(5);
  EXPECT_EQ(Rows(), 0);
  EXPECT_EQ(State(), "Nobody played so many games in this period.");
  EXPECT_FALSE(Find<QPushButton>(*window, "ExportButton").isEnabled());
}

TEST_F(RankingsWindow, PrintsThroughTheBrowser) {
  Open();
  ::Press(*window, "PrintButton");
  EXPECT_THAT(programs.Started, ElementsAre(ElementsAre("xdg-open", Folder / "ranking.html")));
  const std::string page = ReadFile(Folder / "ranking.html");
  EXPECT_THAT(page, HasSubstr("Rankings - 2026-11 - Sum of soldiering"));
  EXPECT_THAT(page, HasSubstr("Mole"));
  EXPECT_THAT(page, Not(HasSubstr("Ray")));
  EXPECT_EQ(ModeOf(Folder / "ranking.html"), 0600U);
}

TEST_F(RankingsWindow, NamesPersonsOnlyWhereTickedEachTime) {
  Open();
  Find<QCheckBox>(*window, "FullNames").click();
  const std::string path = Folder / "ranking.csv";
  dialog.Answers = {path, Folder / "again.csv"};
  ::Press(*window, "ExportButton");
  EXPECT_THAT(dialog.Calls.at(0).Name, HasSubstr("Rankings - 2026-11 - Sum of soldiering.csv"));
  EXPECT_THAT(ReadFile(path), HasSubstr("1,Mole,Bo Ray,3,600"));
  EXPECT_EQ(ModeOf(path), 0600U);
  EXPECT_EQ(State(), "Saved: " + path);
  EXPECT_FALSE(Find<QCheckBox>(*window, "FullNames").isChecked());
  ::Press(*window, "ExportButton");
  EXPECT_THAT(ReadFile(Folder / "again.csv"), Not(HasSubstr("Bo Ray")));
}

TEST_F(RankingsWindow, AsksBeforeItReplacesAFile) {
  Open();
  const std::string path = Folder / "ranking.csv";
  WriteFile(path, "old");
  dialog.Answers = {path};
  boxes.Answers = {BoxAnswer::Cancel};
  Find<QCheckBox>(*window, "FullNames").click();
  ::Press(*window, "ExportButton");
  EXPECT_EQ(ReadFile(path), "old");
  EXPECT_EQ(boxes.Boxes.size(), 1U);
  EXPECT_TRUE(Find<QCheckBox>(*window, "FullNames").isChecked());
}

TEST_F(RankingsWindow, TellsAnArchiveThatCannotBeReadWithoutABox) {
  Open();
  Failure = RuntimeError(Fault::DatabaseLocked, "The archive is locked.");
  Choose("Period", "2026");
  EXPECT_EQ(State(), "The archive is locked.");
  EXPECT_EQ(Rows(), 0);
  Open();
  EXPECT_EQ(Find<QComboBox>(*window, "Period").count(), 1);
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(RankingsWindow, IsCaredForInBothLanguages) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    ExpectCaredFor(Open(language));
  }
}

}  // namespace
