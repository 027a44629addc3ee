#include "archive/history/MemberHistoryWindow.h"

#include <QLabel>
#include <QLineEdit>
#include <QProgressBar>
#include <QTabWidget>

#include "archive/history/HistoryChart.h"
#include "charts/ChartTable.h"
#include "platform/qt/QtEventPump.h"
#include "tests/archive/history/HistoryWindows.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/support/CaredFor.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

class HistoryWindow : public HistoryWindows {
 protected:
  MemberHistoryWindow& Open(std::int32_t member = 0, Language language = Language::English) {
    texts = std::make_unique<StringTable>(language);
    window = std::make_unique<MemberHistoryWindow>(
        MemberHistoryWindow::Parts{.Archive = [this]() -> Sql& { return AskedArchive(); },
                                   .Forgetting = {.Engine = engine,
                                                  .Disk = disk,
                                                  .DbMembers = *MembersDatabase,
                                                  .Strings = *texts,
                                                  .UserDataFolder = Folder.Path()},
                                   .Boxes = boxes,
                                   .Events = events,
                                   .Elapsed = clock,
                                   .NotToKeep = [this](const GamePersons& persons) { notToKeep = persons; }},
        member, nullptr);
    Show(*window);
    return *window;
  }

  std::string Label(const std::string& name) const {
    return Find<QLabel>(*window, name).text().toStdString();
  }
  std::vector<std::string> Cells(const std::string& table, int row) const {
    return CellsOf(*window, table, row);
  }
  void Choose(int row) const {
    Find<QAbstractItemView>(*window, "MemberTable")
        .setCurrentIndex(Find<QAbstractItemView>(*window, "MemberTable").model()->index(row, 0));
  }

  /// Runs what is to happen in the middle of the command.
  class Pump : public QtEventPump {
   public:
    std::function<void()> OnEvents;
    void DoEvents() override {
      if (OnEvents) {
        OnEvents();
      }
      QtEventPump::DoEvents();
    }
  };

  Pump events;
  FakeEventPump clock;
  GamePersons notToKeep;
  std::unique_ptr<StringTable> texts;
  std::unique_ptr<MemberHistoryWindow> window;
};

TEST_F(HistoryWindow, ListsTheMembersOfTheArchive) {
  Open();
  EXPECT_THAT(Cells("MemberTable", 0), ElementsAre("Bo Ray \"Mole\"", "5"));
  EXPECT_THAT(Cells("MemberTable", 1), ElementsAre("Cy Fox", "6"));
  EXPECT_EQ(Label("MemberLabel"), "Bo Ray \"Mole\" (5)");
  Choose(1);
  EXPECT_EQ(Label("MemberLabel"), "Cy Fox (6)");
}

TEST_F(HistoryWindow, ShowsTheGamesTheLatestFirst) {
  Open();
  ASSERT_EQ(RowsOf(*window, "SessionTable"), 5);
  const std::vector<std::string> latest = Cells("SessionTable", 0);
  EXPECT_THAT(latest[0], HasSubstr("2026"));
  EXPECT_EQ(latest[1], "Capture <the> Flag");
  EXPECT_EQ(latest[2], "1 of 3");
  EXPECT_EQ(latest[3], "500");
  EXPECT_EQ(latest[4], "200.0");
  EXPECT_EQ(latest[5], "25.00%");
  EXPECT_EQ(latest[6], "120");
  EXPECT_EQ(latest[7], "");
  EXPECT_EQ(Cells("SessionTable", 4)[7], "Yes");
  EXPECT_EQ(Cells("SessionTable", 4)[4], "100.0");
}

TEST_F(HistoryWindow, ShowsTheMonths) {
  Open();
  ASSERT_EQ(RowsOf(*window, "MonthTable"), 2);
  EXPECT_THAT(Cells("MonthTable", 0), ElementsAre("2026-11", "3", "200.0", "500", "25.00%", "360"));
  EXPECT_THAT(Cells("MonthTable", 1), ElementsAre("2026-09", "2", "200.0", "300", "25.00%", "240"));
}

TEST_F(HistoryWindow, TellsTheBestsAndTheLifetimeFigures) {
  SetLifetime(4, 500);
  Open();
  EXPECT_THAT(Label("BestLabel"), HasSubstr("Best soldiering: 500 ("));
  EXPECT_THAT(Label("BestLabel"), HasSubstr("Best accuracy: 25.00% ("));
  EXPECT_THAT(Label("BestLabel"), HasSubstr("Most damage: 120 ("));
  EXPECT_THAT(Label("LifetimeLabel"), HasSubstr("Lifetime figures: games 4, soldiering 500.\n"));
  EXPECT_THAT(Label("LifetimeLabel"), HasSubstr("Not committed, so not in the lifetime figures: games 1"));
}

TEST_F(HistoryWindow, GoesFromTheChartToTheRow) {
  Open();
  auto& curve = Find<HistoryChart>(*window, "Curve");
  curve.setFocus(Qt::OtherFocusReason);
  Type(*window, Qt::Key_Home);
  EXPECT_EQ(Find<ChartTable>(*window, "SessionTable").currentIndex().row(), 4);
  EXPECT_THAT(Label("TellLabel"), HasSubstr("soldiering 100, mean so far 100.0, place 1 of 3"));
  Find<ChartTable>(*window, "SessionTable").setFocus(Qt::OtherFocusReason);
  Type(*window, Qt::Key_Up);
  EXPECT_EQ(curve.Place(), 1);
}

TEST_F(HistoryWindow, FindsAMemberByNameNumberAndButton) {
  Open();
  auto& entry = Find<QLineEdit>(*window, "FindEntry");
  entry.setText(QStringLiteral("fox"));
  EXPECT_EQ(RowsOf(*window, "MemberTable"), 1);
  EXPECT_EQ(Label("MemberLabel"), "Cy Fox (6)");
  entry.setText(QStringLiteral("bb00"));
  EXPECT_EQ(Label("MemberLabel"), "Bo Ray \"Mole\" (5)");
  entry.setText(QStringLiteral("nobody"));
  EXPECT_EQ(RowsOf(*window, "MemberTable"), 0);
  EXPECT_EQ(Label("MemberLabel"), "");
  EXPECT_FALSE(Find<QPushButton>(*window, "ForgetButton").isEnabled());
}

TEST_F(HistoryWindow, OpensAtAMember) {
  Open(6);
  EXPECT_EQ(Label("MemberLabel"), "Cy Fox (6)");
}

TEST_F(HistoryWindow, OpensAtAMemberWhoNeverPlayed) {
  InMembers("INSERT INTO Members (ContactID, FirstName, LastName) VALUES (9, 'Di', 'New')");
  Open(9);
  EXPECT_EQ(Label("MemberLabel"), "Di New (9)");
  EXPECT_EQ(Label("TellLabel"), "No past game names this member.");
  EXPECT_EQ(RowsOf(*window, "SessionTable"), 0);
}

TEST_F(HistoryWindow, ShowsWhoIsNoMemberAnyMore) {
  InMembers("DELETE FROM Members WHERE ContactID = 5");
  Open(5);
  EXPECT_EQ(Label("MemberLabel"), "no longer a member (5)");
  EXPECT_EQ(RowsOf(*window, "SessionTable"), 5);
  EXPECT_THAT(Label("LifetimeLabel"), HasSubstr("not in the member table any more"));
}

TEST_F(HistoryWindow, ForgetsAMemberAfterAQuestion) {
  Open();
  boxes.Answers = {BoxAnswer::No, BoxAnswer::Yes};
  ::Press(*window, "ForgetButton");
  ASSERT_EQ(boxes.Boxes.size(), 1U);
  EXPECT_THAT(boxes.Boxes[0].Text, HasSubstr("Past games that name Bo Ray \"Mole\" (5): 5\n"));
  EXPECT_EQ(boxes.Boxes[0].Buttons, BoxButtons::YesNo);
  EXPECT_EQ(Query("SELECT count(*) FROM GamePlayers WHERE MemberID = 5"), "5");
  ::Press(*window, "ForgetButton");
  EXPECT_EQ(boxes.Boxes.size(), 2U);
  EXPECT_EQ(Query("SELECT count(*) FROM GamePlayers WHERE MemberID = 5"), "0");
  EXPECT_EQ(RowsOf(*window, "MemberTable"), 1);
  EXPECT_EQ(Label("MemberLabel"), "Cy Fox (6)");
  EXPECT_EQ(Label("TellLabel"),
            "Forgotten: Bo Ray \"Mole\" (5). Past games that no longer name this member: 5");
  EXPECT_TRUE(notToKeep.Include(5, ""));
  EXPECT_TRUE(notToKeep.Include(0, BosButton));
  EXPECT_FALSE(Find<QPushButton>(*window, "StopButton").isEnabled());
  EXPECT_FALSE(Find<QProgressBar>(*window, "ForgetProgress").isVisible());
}

TEST_F(HistoryWindow, StopsForgettingAndTellsWhatIsLeft) {
  Game.Players(Blue7).MemberIndex = 5;
  for (int i = 0; i < 600; ++i) {  // more than one look at the clock
    Archive->Keep(State());
  }
  Open();
  boxes.WhileOpen = [this](const FakeMessageBoxes::Box&) {
    events.OnEvents = [this] {
      EXPECT_TRUE(Find<QProgressBar>(*window, "ForgetProgress").isVisible());
      EXPECT_FALSE(Find<QPushButton>(*window, "ForgetButton").isEnabled());
      EXPECT_EQ(Label("TellLabel"), "Taking the member out of games.mdb...");
      ::Press(*window, "StopButton");
    };
  };
  boxes.Answers = {BoxAnswer::Yes};
  ::Press(*window, "ForgetButton");
  ASSERT_EQ(boxes.Boxes.size(), 2U);
  EXPECT_THAT(boxes.Boxes[1].Text, HasSubstr("games.mdb may still name the member"));
  EXPECT_THAT(boxes.Boxes[1].Text, HasSubstr("Forget This Member again does the rest."));
  EXPECT_EQ(Label("MemberLabel"), "Bo Ray \"Mole\" (5)");
  EXPECT_NE(Query("SELECT count(*) FROM GamePlayers WHERE MemberID = 5"), "0");
  events.OnEvents = nullptr;
  boxes.WhileOpen = nullptr;
  ::Press(*window, "ForgetButton");
  EXPECT_EQ(Query("SELECT count(*) FROM GamePlayers WHERE MemberID = 5"), "0");
  EXPECT_EQ(Label("MemberLabel"), "Cy Fox (6)");
}

TEST_F(HistoryWindow, TellsWhatCouldNotBeForgotten) {
  Open();
  OtherConnection other(ArchivePath());
  other.Execute("BEGIN IMMEDIATE");
  ::Press(*window, "ForgetButton");
  ASSERT_EQ(boxes.Boxes.size(), 2U);
  EXPECT_THAT(boxes.Boxes[1].Text, HasSubstr("games.mdb still names the member"));
  EXPECT_EQ(boxes.Boxes[1].Icon, BoxIcon::Exclamation);
  EXPECT_EQ(Label("MemberLabel"), "Bo Ray \"Mole\" (5)");
}

TEST_F(HistoryWindow, TellsAnArchiveThatCannotBeReadWithoutABox) {
  Failure = RuntimeError(Fault::UnrecognizedDatabase, "The archive is damaged.");
  Open();
  EXPECT_EQ(Label("TellLabel"), "The archive is damaged.");
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_FALSE(Find<QPushButton>(*window, "ForgetButton").isEnabled());
}

TEST_F(HistoryWindow, TellsAFailureBetweenTwoMembersWithoutABox) {
  Open();
  Failure = RuntimeError(Fault::DatabaseLocked, "The archive is locked.");
  Choose(1);
  EXPECT_EQ(Label("TellLabel"), "The archive is locked.");
  EXPECT_EQ(RowsOf(*window, "SessionTable"), 0);
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_FALSE(Find<QPushButton>(*window, "ForgetButton").isEnabled());
}

TEST_F(HistoryWindow, OfAnEmptyArchiveSaysSo) {
  InArchive("DELETE FROM KnownMembers");
  Open();
  EXPECT_EQ(Label("TellLabel"), "No past game names a member yet.");
}

TEST_F(HistoryWindow, ClosesByEscape) {
  Open();
  Type(*window, Qt::Key_Escape);
  EXPECT_FALSE(window->isVisible());
}

TEST_F(HistoryWindow, IsCaredForInBothLanguages) {
  SetLifetime(12, 500);
  Delete(1);
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    ExpectCaredFor(Open(0, language));
    Find<QTabWidget>(*window, "Tabs").setCurrentIndex(1);
    ExpectCaredFor(*window);
  }
}

}  // namespace
