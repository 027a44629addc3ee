#include "board/MissionResultEntry.h"

#include <gmock/gmock.h>

#include <QCheckBox>
#include <QEnterEvent>
#include <QLabel>

#include "tests/support/Announcements.h"
#include "tests/support/Captions.h"
#include "tests/support/CaredFor.h"
#include "tests/support/Contrast.h"
#include "tests/support/OnScreen.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

using testing::ElementsAre;

class Results : public testing::Test {
 protected:
  Results() {
    venue.PutDefaultFiles();
    venue.ChangeDatabase(
        "scenarios.mdb",
        "DELETE FROM Table1; INSERT INTO Table1 (ID, MissionName, PrimaryObjectivePointsA, "
        "PrimaryObjectivePointsB, SecondaryObjectivePointsC, PrimaryObjectiveDescriptionA, "
        "SecondaryObjectiveDescriptionC) VALUES (1, 'Test', 100, 20, 3, 'Hold the well' || char(13, 10) "
        "|| 'to the end', 'Run')");
    venue.Start();
    venue.LoadGame(GameFile(PlayerOf(1) + PlayerOf(40) + PlayerOf(70)));
    venue.ActiveMission().setCurrentIndex(2);
  }

  /// Opens the window, does `act` in it and presses OK; by `close` it goes by its close box instead.
  void Open(const std::function<void()>& act, bool close = false) {
    const WhileModal<MissionResultEntry> open([&](MissionResultEntry& opened) {
      window = &opened;
      act();
      if (close) {
        opened.close();
      } else {
        ::Press(opened, "OK");
      }
    });
    venue.Trigger("mnuMissionResults");
    EXPECT_EQ(open.Runs(), 1);
  }

  QCheckBox& Box(const std::string& name) { return ::Find<QCheckBox>(*window, name); }
  QComboBox& Team(const std::string& name) { return ::Find<QComboBox>(*window, name); }

  /// Soldiering of Red 0, Blue 7 and Yellow 5.
  std::vector<int> Scores() {
    std::vector<int> scores;
    for (const char* player : {"Red  0", "Blue  7", "Yellow  5"}) {
      for (int row = 0; row < 3; ++row) {
        if (venue.Row("ScoreDisplay", row)[1] == player) {
          scores.push_back(std::stoi(venue.Row("ScoreDisplay", row)[2]));
        }
      }
    }
    return scores;
  }

  Venue venue;
  MissionResultEntry* window = nullptr;
};

TEST_F(Results, AreEnteredOnlyForAMission) {
  for (const auto& [entry, enabled] : {std::pair{2, true}, {1, false}, {2, true}, {0, false}}) {
    venue.ActiveMission().setCurrentIndex(entry);
    EXPECT_EQ(venue.Find<QAction>("mnuMissionResults").isEnabled(), enabled) << entry;
  }
}

TEST_F(Results, StartAsNothingCompletedByRedBlueAndYellow) {
  Open([this] {
    for (const char* box : {"PrimaryCompleted1", "PrimaryCompleted2", "PrimaryCompleted3",
                            "SecondaryCompleted1", "SecondaryCompleted2", "SecondaryCompleted3"}) {
      EXPECT_FALSE(Box(box).isChecked()) << box;
    }
    EXPECT_EQ(Team("TeamA").currentText(), QStringLiteral("Red"));
    EXPECT_EQ(Team("TeamB").currentText(), QStringLiteral("Blue"));
    EXPECT_EQ(Team("TeamC").currentText(), QStringLiteral("Yellow"));
    EXPECT_EQ(Team("TeamB").count(), 3);
    EXPECT_EQ(window->windowTitle(), QStringLiteral("Mission Results"));
    EXPECT_EQ(
        ::Find<QLabel>(*window, "Label1").text(),
        QStringLiteral("Hold the mouse over an objective to  see a description of what the objective is."));
  });
}

TEST_F(Results, HaveTheirCaptions) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    Venue place(language);
    place.Start();
    place.ActiveMission().setCurrentIndex(2);
    const bool english = language == Language::English;
    const WhileModal<MissionResultEntry> open([english](MissionResultEntry& opened) {
      const auto in = [english](const char* text, const char* chinese) {
        return std::string(english ? text : chinese);
      };
      EXPECT_EQ(opened.windowTitle().toStdString(), in("Mission Results", "任务结果"));
      const std::string primary = in("Primary Completed", "主要目标已完成");
      const std::string secondary = in("Secondary Completed", "次要目标已完成");
      ExpectCaptions(opened, {{"Frame1", in("Team A Objectives", "A 队目标")},
                              {"Frame2", in("Team B Objectives", "B 队目标")},
                              {"Frame3", in("Team C Objectives", "C 队目标")},
                              {"PrimaryCompleted1", primary},
                              {"PrimaryCompleted2", primary},
                              {"PrimaryCompleted3", primary},
                              {"SecondaryCompleted1", secondary},
                              {"SecondaryCompleted2", secondary},
                              {"SecondaryCompleted3", secondary},
                              {"Label2", in("Team", "队伍")},
                              {"Label3", in("Team", "队伍")},
                              {"Label4", in("Team", "队伍")},
                              {"OK", in("OK", "确定")}});
      ExpectLabels(
          opened,
          {{"TeamA", in("Team", "队伍")}, {"TeamB", in("Team", "队伍")}, {"TeamC", in("Team", "队伍")}});
      opened.close();
    });
    place.Trigger("mnuMissionResults");
    EXPECT_EQ(open.Runs(), 1);
  }
}

TEST_F(Results, PayTheTeamOfTheSet) {
  Open([this] { Box("PrimaryCompleted2").setChecked(true); });
  EXPECT_THAT(Scores(), ElementsAre(0, 20, 0));
  Open([this] {
    EXPECT_TRUE(Box("PrimaryCompleted2").isChecked());
    Box("SecondaryCompleted3").setChecked(true);
  });
  EXPECT_THAT(Scores(), ElementsAre(0, 20, 3));
}

TEST_F(Results, OfTwoSetsMayBelongToOneTeam) {
  Open([this] {
    Team("TeamB").setCurrentText(QStringLiteral("Red"));
    Box("PrimaryCompleted1").setChecked(true);
    Box("PrimaryCompleted2").setChecked(true);
  });
  EXPECT_THAT(Scores(), ElementsAre(120, 0, 0));
}

TEST_F(Results, StayAsTheyWereWhenTheWindowIsClosedByItsBox) {
  Open([this] { Box("PrimaryCompleted1").setChecked(true); });
  Open(
      [this] {
        Box("PrimaryCompleted1").setChecked(false);
        Team("TeamA").setCurrentIndex(2);
      },
      true);
  EXPECT_THAT(Scores(), ElementsAre(100, 0, 0));
}

TEST_F(Results, ScoreTheGameAnewHoweverTheWindowIsClosed) {
  Open([this] { Box("PrimaryCompleted1").setChecked(true); });
  ASSERT_THAT(Scores(), ElementsAre(100, 0, 0));
  venue.ChangeDatabase("scenarios.mdb", "UPDATE Table1 SET PrimaryObjectivePointsA = 70");
  Open([] {}, true);
  EXPECT_THAT(Scores(), ElementsAre(70, 0, 0));
  venue.ChangeDatabase("scenarios.mdb", "UPDATE Table1 SET PrimaryObjectivePointsA = 60");
  Open([] {});
  EXPECT_THAT(Scores(), ElementsAre(60, 0, 0));
}

TEST_F(Results, AreTakenByEscapeAsByOk) {
  const WhileModal<MissionResultEntry> open([](MissionResultEntry& opened) {
    auto& box = ::Find<QCheckBox>(opened, "PrimaryCompleted2");
    box.setChecked(true);
    QTest::keyClick(&box, Qt::Key_Escape);
    EXPECT_FALSE(opened.isVisible());
  });
  venue.Trigger("mnuMissionResults");
  EXPECT_EQ(open.Runs(), 1);
  EXPECT_THAT(Scores(), ElementsAre(0, 20, 0));
}

TEST_F(Results, StayTickedForTheNextGame) {
  Open([this] {
    Box("PrimaryCompleted1").setChecked(true);
    Box("SecondaryCompleted2").setChecked(true);
  });
  venue.Trigger("mnuClearScores");
  Open([this] {
    EXPECT_TRUE(Box("PrimaryCompleted1").isChecked());
    EXPECT_FALSE(Box("SecondaryCompleted1").isChecked());
    EXPECT_FALSE(Box("PrimaryCompleted2").isChecked());
    EXPECT_TRUE(Box("SecondaryCompleted2").isChecked());
  });
}

TEST_F(Results, ShowTheFirstLineOfEachObjective) {
  Open([this] {
    EXPECT_EQ(Box("PrimaryCompleted1").toolTip(), QStringLiteral("Hold the well"));
    EXPECT_EQ(Box("SecondaryCompleted3").toolTip(), QStringLiteral("Run"));
    EXPECT_EQ(Box("PrimaryCompleted2").toolTip(), QString());
    Show(*window);
    QApplication::setActiveWindow(window);
    auto& text = ::Find<QLabel>(*window, "ObjectiveText");
    Box("PrimaryCompleted1").setFocus();
    EXPECT_EQ(text.text(), QStringLiteral("Hold the well"));
    Box("PrimaryCompleted2").setFocus();
    EXPECT_EQ(text.text(), QString());
    QEnterEvent mouse(QPointF(1, 1), QPointF(1, 1), QPointF(1, 1));
    QApplication::sendEvent(&Box("SecondaryCompleted3"), &mouse);
    EXPECT_EQ(text.text(), QStringLiteral("Run"));
  });
}

TEST_F(Results, OfAMissionThatIsGoneHaveNoObjectives) {
  venue.ChangeDatabase("scenarios.mdb", "DELETE FROM Table1");
  venue.Boxes.Boxes.clear();
  Open([this] { EXPECT_EQ(Box("PrimaryCompleted1").toolTip(), QString()); });
  ASSERT_FALSE(venue.Boxes.Boxes.empty());
  EXPECT_EQ(venue.Boxes.Boxes[0].Text, "Could not locate selected Mission in Mission Database");
}

TEST_F(Results, TakeATeamThatIsNoneOfTheThreeFromAFile) {
  venue.LoadGame(
      "<GameData><GameHeader><MissionName>Test</MissionName><Team><Name>Green</Name>"
      "<PrimaryObjectiveAchieved>1</PrimaryObjectiveAchieved>"
      "<SecondryObjectiveAchieved>0</SecondryObjectiveAchieved></Team></GameHeader></GameData>");
  Open([this] { EXPECT_EQ(Team("TeamA").currentIndex(), -1); });
}

TEST_F(Results, ShowEachObjectiveWithItsPoints) {
  Open([this] {
    const auto text = [this](const char* label) {
      return ::Find<QLabel>(*window, label).text().toStdString();
    };
    EXPECT_EQ(text("PrimaryObjective1"), "Hold the well\n100 points");
    EXPECT_EQ(text("SecondaryObjective3"), "Run\n3 points");
    EXPECT_EQ(text("PrimaryObjective2"), "20 points");
    EXPECT_EQ(text("SecondaryObjective1"), "0 points");
  });
}

TEST_F(Results, AddUpThePointsOfEachTeamWhileTheyAreEntered) {
  Open([this] {
    const auto sums = [this] {
      std::vector<std::string> texts;
      for (const char* label : {"TeamSum1", "TeamSum2", "TeamSum3"}) {
        texts.push_back(::Find<QLabel>(*window, label).text().toStdString());
      }
      return texts;
    };
    EXPECT_THAT(sums(), ElementsAre("Red: 0", "Blue: 0", "Yellow: 0"));
    Box("PrimaryCompleted1").setChecked(true);
    Box("PrimaryCompleted2").setChecked(true);
    Box("SecondaryCompleted3").setChecked(true);
    EXPECT_THAT(sums(), ElementsAre("Red: 100", "Blue: 20", "Yellow: 3"));
    Team("TeamB").setCurrentIndex(0);
    EXPECT_THAT(sums(), ElementsAre("Red: 120", "Blue: 0", "Yellow: 3"));
    Box("PrimaryCompleted1").setChecked(false);
    EXPECT_THAT(sums(), ElementsAre("Red: 20", "Blue: 0", "Yellow: 3"));
  });
  EXPECT_THAT(Scores(), ElementsAre(20, 0, 3));
}

TEST_F(Results, AddUpPointsAsTheScoreTakesThem) {
  venue.ChangeDatabase("scenarios.mdb",
                       "UPDATE Table1 SET PrimaryObjectivePointsA = 0.4, SecondaryObjectivePointsA = 0.4, "
                       "PrimaryObjectivePointsB = 3000000000");
  Open([this] {
    for (const char* box : {"PrimaryCompleted1", "SecondaryCompleted1", "PrimaryCompleted2"}) {
      Box(box).setChecked(true);
    }
    EXPECT_EQ(::Find<QLabel>(*window, "PrimaryObjective1").text(),
              QStringLiteral("Hold the well\n0.4 points"));
    EXPECT_EQ(::Find<QLabel>(*window, "TeamSum1").text(), QStringLiteral("Red: 0"));  // each is rounded
    EXPECT_EQ(::Find<QLabel>(*window, "TeamSum2").text(),
              QStringLiteral("Blue: -"));  // more than a score holds
    Box("PrimaryCompleted2").setChecked(false);
  });
  EXPECT_THAT(Scores(), ElementsAre(0, 0, 0));
}

TEST_F(Results, AnnounceTheSumsThatChange) {
  Open([this] {
    Show(*window);
    const Announcements announced;
    Box("PrimaryCompleted2").setChecked(true);
    EXPECT_THAT(announced.Heard(), ElementsAre(QStringLiteral("TeamSum2")));
    Team("TeamB").setCurrentIndex(0);
    EXPECT_THAT(announced.Heard(), ElementsAre(QStringLiteral("TeamSum2"), QStringLiteral("TeamSum1"),
                                               QStringLiteral("TeamSum2")));
  });
}

TEST_F(Results, ShowObjectivesWithoutPointsIfTheseCannotBeRead) {
  venue.ChangeDatabase(
      "scenarios.mdb",
      "PRAGMA ignore_check_constraints = ON; UPDATE Table1 SET PrimaryObjectivePointsB = 'many'");
  Open([this] {
    EXPECT_EQ(::Find<QLabel>(*window, "PrimaryObjective1").text(), QStringLiteral("Hold the well"));
    EXPECT_EQ(::Find<QLabel>(*window, "PrimaryObjective2").text(), QString());
    EXPECT_FALSE(::Find<QWidget>(*window, "PointsFrame").isVisible());
  });
}

TEST_F(Results, ShowObjectivesWholeInSmallAndLargeLetters) {
  venue.ChangeDatabase("scenarios.mdb",
                       "UPDATE Table1 SET PrimaryObjectiveDescriptionB = 'Keep the reactor silent until the "
                       "final horn and bring the plan of the halls to the gate'");
  QScreen& screen = ScreenNamed("laptop");
  venue.Window->setScreen(&screen);
  venue.Window->move(screen.geometry().topLeft());
  for (const int points : {9, 14}) {
    const FontOfSize letters(points);
    Open([this] {
      Show(*window);
      ExpectCaptionsFit(*window);
      EXPECT_LE(window->minimumSizeHint().width(), 1024);
    });
  }
}

TEST_F(Results, AreReadableOnLightAndDarkDesktops) {
  const auto expectReadable = [this] {
    Show(*window);
    for (const char* label : {"PrimaryObjective1", "SecondaryObjective3", "PointsCaption", "TeamSum1"}) {
      EXPECT_GE(PaintedContrast(::Find<QLabel>(*window, label)), LeastContrast) << label;
    }
  };
  Open(expectReadable);
  const DarkDesktop dark;
  Open(expectReadable);
}

TEST_F(Results, ShowNoPointsForAMissionThatIsGone) {
  venue.ChangeDatabase("scenarios.mdb", "DELETE FROM Table1");
  Open([this] {
    EXPECT_FALSE(::Find<QWidget>(*window, "PointsFrame").isVisible());
    EXPECT_EQ(::Find<QLabel>(*window, "PrimaryObjective1").text(), QString());
  });
}

}  // namespace
