#include <gmock/gmock.h>

#include "core/gamefile/GameFile.h"
#include "tests/archive/past/PastGamesVenue.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

TEST_F(WindowOfPastGames, BeginsWithTheLatestMonthAndItsLatestGame) {
  KeepFour();
  Open();
  EXPECT_THAT(Column("MonthTable", 0), ElementsAre("All games", "2026-11", "2026-10", "Deleted"));
  EXPECT_THAT(Column("MonthTable", 1), ElementsAre("4", "3", "1", ""));
  EXPECT_EQ(Months().currentIndex().row(), 1);
  EXPECT_THAT(Listed(), ElementsAre("400", "300", "200"));
  EXPECT_EQ(Games().currentIndex().row(), 0);
  EXPECT_THAT(Board(), ElementsAre("Blue  7: Mole", "Red  0"));
  EXPECT_THAT(Get<QLabel>("BoardLabel").text().toStdString(), HasSubstr(", None"));
  EXPECT_EQ(window->focusWidget(), &Games());
  EXPECT_EQ(Status(), "");
}

TEST_F(WindowOfPastGames, SaysSoWithoutAnyGameAndMakesNoArchive) {
  Open();
  EXPECT_EQ(Status(), venue.Strings.Text(OwnText::PastNone));
  for (const char* button : {"Open", "SaveFile", "Charts", "Export", "Delete"}) {
    EXPECT_FALSE(Enabled(button)) << button;
  }
  EXPECT_FALSE(std::filesystem::exists(ArchivePath()));
}

TEST_F(WindowOfPastGames, ShowsTheBoardOfTheGameThatTheArrowKeysReach) {
  KeepFour();
  Open();
  Type(*window, Qt::Key_Down);
  EXPECT_THAT(Board(), ElementsAre("Blue  7: Fox", "Red  0"));
  Type(*window, Qt::Key_Down);
  EXPECT_THAT(Board(), ElementsAre("Blue  7: Mole", "Red  0"));
}

TEST_F(WindowOfPastGames, ListsTheMonthThatIsChosen) {
  KeepFour();
  Open();
  Months().selectRow(2);
  EXPECT_THAT(Listed(), ElementsAre("100"));
  Months().selectRow(0);
  EXPECT_THAT(Listed(), ElementsAre("400", "300", "200", "100"));
}

TEST_F(WindowOfPastGames, FindsGamesByMissionMemberGunAndPeriod) {
  KeepFour();
  Open();
  auto& mission = Get<QComboBox>("SearchMission");
  mission.setCurrentIndex(mission.findText(QStringLiteral("Flag")));
  Press("Search");
  EXPECT_EQ(Months().currentIndex().row(), 0);
  EXPECT_THAT(Listed(), ElementsAre("300", "200"));
  Get<QLineEdit>("SearchMember").setText(QStringLiteral("Mo"));
  Press("Search");
  EXPECT_THAT(Listed(), ElementsAre("200"));
  Press("ShowAll");
  EXPECT_EQ(Get<QLineEdit>("SearchMember").text(), QString());
  EXPECT_THAT(Listed(), ElementsAre("400", "300", "200", "100"));
  Get<QLineEdit>("SearchFrom").setText(QStringLiteral("20/11/2026"));
  Get<QLineEdit>("SearchUntil").setText(QStringLiteral("21/11/2026"));
  QTest::keyClick(&Get<QLineEdit>("SearchUntil"), Qt::Key_Return);
  EXPECT_THAT(Listed(), ElementsAre("300", "200"));
  Press("ShowAll");
  Get<QComboBox>("SearchTeam").setCurrentIndex(2);
  Get<QSpinBox>("SearchNumber").setValue(7);
  Press("Search");
  EXPECT_EQ(Listed().size(), 4U);
  Get<QSpinBox>("SearchNumber").setValue(8);
  Press("Search");
  EXPECT_THAT(Listed(), IsEmpty());
  EXPECT_EQ(Status(), venue.Strings.Text(OwnText::PastNothingFound));
  EXPECT_THAT(Board(), IsEmpty());
}

TEST_F(WindowOfPastGames, SearchesOneMonthIfThatIsChosenAfterwards) {
  KeepFour();
  Open();
  Get<QLineEdit>("SearchMember").setText(QStringLiteral("Mo"));
  Press("Search");
  EXPECT_THAT(Listed(), ElementsAre("400", "200", "100"));
  Months().selectRow(1);
  EXPECT_THAT(Listed(), ElementsAre("400", "200"));
}

TEST_F(WindowOfPastGames, TellsOfEntriesThatMakeNoSense) {
  KeepFour();
  Open();
  Get<QLineEdit>("SearchFrom").setText(QStringLiteral("soon"));
  Press("Search");
  EXPECT_EQ(Status(), "soon is no date. Write it like " + venue.Time.ShortDate() + ".");
  EXPECT_EQ(window->focusWidget(), &Get<QLineEdit>("SearchFrom"));
  Get<QLineEdit>("SearchFrom").clear();
  Get<QLineEdit>("SearchMember").setText(QStringLiteral("Zed"));
  Press("Search");
  EXPECT_EQ(Status(), "No member has a name that begins with Zed.");
  EXPECT_EQ(Listed().size(), 3U);
}

TEST_F(WindowOfPastGames, HasGunsOfATeamOnly) {
  Open();
  EXPECT_FALSE(Get<QSpinBox>("SearchNumber").isEnabled());
  Get<QComboBox>("SearchTeam").setCurrentIndex(3);
  EXPECT_TRUE(Get<QSpinBox>("SearchNumber").isEnabled());
  EXPECT_EQ(Get<QSpinBox>("SearchNumber").maximum(), 31);
  Get<QComboBox>("SearchTeam").setCurrentIndex(1);
  EXPECT_EQ(Get<QSpinBox>("SearchNumber").maximum(), 95);
}

TEST_F(WindowOfPastGames, TellsInItsLineWhatCannotBeReadAndTriesAgain) {
  KeepFour();
  Lock([this] { Open(); });
  EXPECT_THAT(Status(), HasSubstr("That did not work: "));
  EXPECT_THAT(Listed(), IsEmpty());
  Press("Search");
  EXPECT_EQ(Listed().size(), 4U);
  EXPECT_EQ(Status(), "");
  EXPECT_EQ(Get<QComboBox>("SearchMission").count(), 3);
  Lock([this] { Games().selectRow(2); });
  EXPECT_THAT(Status(), HasSubstr("That did not work: "));
  EXPECT_THAT(Board(), IsEmpty());
  EXPECT_FALSE(Enabled("Open"));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(WindowOfPastGames, TellsARowThatCannotBeReadInItsLine) {
  KeepFour();
  Open();
  OtherConnection(ArchivePath()).Execute("ALTER TABLE GameFiles RENAME TO Elsewhere");
  Months().selectRow(2);
  QTest::qWait(0);
  EXPECT_THAT(Status(), HasSubstr("That did not work: "));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(WindowOfPastGames, TellsAGameWhoseFileIsDamaged) {
  KeepFour();
  OtherConnection(ArchivePath()).Execute("UPDATE sqlar SET data = x'00'");
  Open();
  EXPECT_EQ(Listed().size(), 3U);
  EXPECT_THAT(Board(), IsEmpty());
  EXPECT_THAT(Status(), HasSubstr("2026-11-22/2000-000004.game.xml"));
  EXPECT_FALSE(Enabled("Open"));
  EXPECT_TRUE(Enabled("Delete"));
}

TEST_F(WindowOfPastGames, TellsOfAnArchiveThatCannotBeUsed) {
  WriteFile(ArchivePath(), "no database");
  Open();
  EXPECT_EQ(Status(), venue.Strings.Text(OwnText::PastNone));
  WriteFile(venue.Folder / "games-new.mdb", MadeDatabase("games"));
  Keep("2026-11-22 20:00:00", "None", 400);
  access.Close();
  Open();
  EXPECT_EQ(Listed().size(), 1U);
  EXPECT_THAT(Status(), HasSubstr(ArchivePath()));
}

TEST_F(WindowOfPastGames, CopiesItsListsAsText) {
  KeepFour();
  Open();
  Games().setFocus();
  QTest::keyClick(&Games(), Qt::Key_C, Qt::ControlModifier);
  const QString text = QApplication::clipboard()->text();
  EXPECT_TRUE(text.startsWith(QStringLiteral("Time\tMission\tPlayers\tRed\t")));
  EXPECT_TRUE(text.contains(QStringLiteral("Mole, 400")));
  EXPECT_EQ(Status(), "Rows copied: 1");
  auto& board = Get<QTableView>("BoardTable");
  board.setFocus();
  QTest::keyClick(&board, Qt::Key_C, Qt::ControlModifier);
  EXPECT_TRUE(QApplication::clipboard()->text().contains(QStringLiteral("Blue  7: Mole\t 400")));
  EXPECT_EQ(Status(), "Rows copied: 2");
}

TEST_F(WindowOfPastGames, ClosesByEscape) {
  KeepFour();
  Open();
  Type(*window, Qt::Key_Escape);
  EXPECT_FALSE(window->isVisible());
  EXPECT_FALSE(window->Chosen());
}

TEST_F(WindowOfPastGames, NamesItsControlsInBothLanguages) {
  KeepFour();
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    Open(language);
    EXPECT_EQ(window->windowTitle().toStdString(), strings->Text(OwnText::PastGamesTitle));
    EXPECT_EQ(Get<QPushButton>("Open").text().toStdString(), strings->Text(OwnText::PastOpen));
    for (const char* name : {"SearchFrom", "SearchUntil", "SearchMission", "SearchMember", "SearchTeam",
                             "MonthTable", "GameTable", "State", "BoardTable"}) {
      const auto labels = window->findChildren<QLabel*>();
      EXPECT_TRUE(std::any_of(labels.begin(), labels.end(), [name](const QLabel* label) {
        return label->buddy() != nullptr && label->buddy()->objectName() == QLatin1String(name) &&
               !label->text().isEmpty();
      })) << name;
    }
    EXPECT_FALSE(Get<QSpinBox>("SearchNumber").accessibleName().isEmpty());
  }
}

}  // namespace
