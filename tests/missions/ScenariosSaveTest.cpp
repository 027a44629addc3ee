#include <sys/resource.h>

#include <csignal>

#include "tests/missions/Editor.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

/// Another program with an open write transaction on a database.
class Writer {
 public:
  explicit Writer(const std::string& path) : connection_(path) { connection_.Execute("BEGIN EXCLUSIVE"); }
  ~Writer() { connection_.Execute("ROLLBACK"); }
  Writer(const Writer&) = delete;
  Writer& operator=(const Writer&) = delete;

 private:
  OtherConnection connection_;
};

/// Simulates a full disk: while it exists, no file of this process can grow.
class FullDisk {
 public:
  explicit FullDisk(rlim_t bytes) {
    std::signal(SIGXFSZ, SIG_IGN);
    getrlimit(RLIMIT_FSIZE, &before_);
    const rlimit full{bytes, before_.rlim_max};
    setrlimit(RLIMIT_FSIZE, &full);
  }
  ~FullDisk() {
    setrlimit(RLIMIT_FSIZE, &before_);
    std::signal(SIGXFSZ, SIG_DFL);
  }
  FullDisk(const FullDisk&) = delete;
  FullDisk& operator=(const FullDisk&) = delete;

 private:
  rlimit before_{};
};

TEST_F(Editor, SavesWhatWasTyped) {
  Open([this] {
    Press("Edit");
    Describe("What to do.\nAnd how.");
    Type("RespawnPenalty", "4.5");
    Type("HealPenalty", "1");
    Type("GameDuration", "60 minutes");
    Type("TeamRatio", "2 : 1");
    Memo("PrimaryObjectiveDescription0").setPlainText(QStringLiteral("Hold the well"));
    Type("PrimaryPoints0", "50");
    Type("SecondaryPoints2", "-5");
    Press("Save");
    EXPECT_TRUE(Locked());
    EXPECT_EQ(EditCaption(), "Edit");
  });
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Saved()));
  EXPECT_EQ(Stored("MissionDescription", "One"), "What to do.\r\nAnd how.");
  EXPECT_EQ(Stored("RespawnPenalty", "One"), "4.5");
  EXPECT_EQ(Stored("HealPenalty", "One"), "1.0");
  EXPECT_EQ(Stored("GameDuration", "One"), "60 minutes");
  EXPECT_EQ(Stored("TeamRatio", "One"), "2 : 1");
  EXPECT_EQ(Stored("PrimaryObjectiveDescriptionA", "One"), "Hold the well");
  EXPECT_EQ(Stored("PrimaryObjectivePointsA", "One"), "50");
  EXPECT_EQ(Stored("SecondaryObjectivePointsC", "One"), "-5");
  EXPECT_EQ(Stored("ID", "One"), "3");
}

TEST_F(Editor, KeepsBlanksOfEveryKindAsTheyWereTyped) {
  const std::string typed = " a\u00A0b\u2009c\u202Fd\u3000e\tf \u00A0";
  Open([&] {
    Press("Edit");
    Describe(typed + "\n" + typed);
    for (const char* box : {"PrimaryObjectiveDescription0", "SecondaryObjectiveDescription2"}) {
      Memo(box).setPlainText(QString::fromStdString(typed));
    }
    Type("GameDuration", typed);
    Type("TeamRatio", typed);
    Press("Save");
  });
  EXPECT_EQ(Stored("MissionDescription", "One"), typed + "\r\n" + typed);
  for (const char* column :
       {"PrimaryObjectiveDescriptionA", "SecondaryObjectiveDescriptionC", "GameDuration", "TeamRatio"}) {
    EXPECT_EQ(Stored(column, "One"), typed) << column;
  }
}

TEST_F(Editor, StoresEveryLineBreakAsCarriageReturnAndLineFeed) {
  Open([this] {
    Press("Edit");
    Describe("");
    QPlainTextEdit& box = Memo("Description");
    QTest::keyClicks(&box, QStringLiteral("one"));
    QTest::keyClick(&box, Qt::Key_Return);
    QTest::keyClicks(&box, QStringLiteral("two"));
    QTest::keyClick(&box, Qt::Key_Return, Qt::ShiftModifier);
    QTest::keyClicks(&box, QStringLiteral("three"));
    Press("Save");
  });
  EXPECT_EQ(Stored("MissionDescription", "One"), "one\r\ntwo\r\nthree");
}

TEST_F(Editor, StandsOnTheLastMissionAfterAnySave) {
  Open([this] {
    Press("Save");
    EXPECT_EQ(List().currentRow(), 2);
    EXPECT_EQ(ShownName(), "Three");
  });
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Saved()));
}

TEST_F(Editor, MakesEmptyPointsZeroAndReadsEmptyPenaltiesAsZero) {
  Open([this] {
    Press("Edit");
    Type("RespawnPenalty", "");
    Type("PrimaryPoints1", "");
    std::string pointsAtSave;
    std::string penaltyAtSave;
    venue.Boxes.WhileOpen = [&](const FakeMessageBoxes::Box&) {
      List().setCurrentRow(0);
      pointsAtSave = Line("PrimaryPoints1").text().toStdString();
      penaltyAtSave = Line("RespawnPenalty").text().toStdString();
    };
    Press("Save");
    venue.Boxes.WhileOpen = nullptr;
    EXPECT_EQ(pointsAtSave, "0");
    EXPECT_EQ(penaltyAtSave, "0");
  });
  EXPECT_EQ(Stored("PrimaryObjectivePointsB", "One"), "0");
  EXPECT_EQ(Stored("RespawnPenalty", "One"), "0.0");
}

TEST_F(Editor, AbortsTheSaveOfWhatIsTooLongOrEmpty) {
  const std::vector<std::pair<std::function<void()>, std::string>> faults = {
      {[this] { Describe(std::string(1001, 'x')); },
       "Mission Description is too long, maximum is 1000 characters. Save aborted."},
      {[this] { Describe(""); }, "Mission Description cannot be empty. Save aborted."},
      {[this] { Memo("SecondaryObjectiveDescription2").setPlainText(QString(256, QLatin1Char('x'))); },
       "A Mission Objective is too long, maximum is 255 characters. Save aborted."},
  };
  for (const auto& [type, text] : faults) {
    venue.Boxes.Boxes.clear();
    const auto& typeFault = type;
    Open([&] {
      Press("Edit");
      typeFault();
      Press("Save");
      EXPECT_FALSE(Locked());
      EXPECT_EQ(List().currentRow(), 0);
    });
    EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(EntryError(text)));
    EXPECT_EQ(Stored("MissionDescription", "One"), "First text");
  }
}

TEST_F(Editor, Accepts1000CharactersAnd255InAnObjective) {
  Open([this] {
    Press("Edit");
    Memo("Description").setPlainText(QString(1000, QChar(0x6218)));
    Memo("PrimaryObjectiveDescription1").setPlainText(QString(255, QChar(0x6218)));
    Press("Save");
  });
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(Saved()));
  EXPECT_EQ(Stored("length(MissionDescription4)", "One"), "234");
  EXPECT_EQ(Stored("length(PrimaryObjectiveDescriptionB)", "One"), "255");
}

TEST_F(Editor, PresetsTheNameOfANewMission) {
  Open([this] {
    const WhileModal<MissionNameEntry> entry([](MissionNameEntry& asked) {
      EXPECT_EQ(::Find<QLineEdit>(asked, "MissionEntry").text(), QStringLiteral("New Mission"));
      EXPECT_EQ(::Find<QLabel>(asked, "Label1").text(), QStringLiteral("Enter new mission name"));
      EXPECT_EQ(asked.windowTitle(), QStringLiteral("New Mission"));
      QTest::keyClick(&::Find<QLineEdit>(asked, "MissionEntry"), Qt::Key_Return);
    });
    Press("NewButton");
    EXPECT_EQ(ShownName(), "New Mission");
  });
}

TEST_F(Editor, MakesNoMissionWithoutAName) {
  Open([this] {
    List().setCurrentRow(1);
    NewMission("Four", "Cancel");
    NewMission("");
    EXPECT_THAT(Entries(), ElementsAre("One", "Two", "Three"));
    EXPECT_EQ(List().currentRow(), 1);
    EXPECT_TRUE(Locked());
  });
  EXPECT_THAT(Names(), ElementsAre("One", "Two", "Three"));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(Editor, TakesANameTwice) {
  Open([this] { NewMission("One"); });
  EXPECT_THAT(Names(), ElementsAre("One", "Two", "Three", "One"));
}

TEST_F(Editor, TellsOfPointsThatAreNoNumber) {
  Open([this] {
    Press("Edit");
    Describe("new text");
    Type("SecondaryPoints0", "many");
    Press("Save");
    EXPECT_FALSE(Locked());
    EXPECT_EQ(Line("SecondaryPoints0").text(), QStringLiteral("many"));
    EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(SaveError()));
    EXPECT_EQ(Stored("MissionDescription", "One"), "First text");
    Type("SecondaryPoints0", "12");
    Press("Save");
  });
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(SaveError(), Saved()));
  EXPECT_EQ(Stored("SecondaryObjectivePointsA", "One"), "12");
}

TEST_F(Editor, OnALockedDatabaseKeepsTheOldRowAndStaysUsable) {
  Open([this] {
    Press("Edit");
    Describe("new text");
    {
      const Writer writer(venue.DataFile("scenarios.mdb"));
      Press("Save");
    }
    EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(SaveError()));
    EXPECT_EQ(Stored("MissionDescription", "One"), "First text");
    EXPECT_EQ(ShownDescription(), "new text");
    EXPECT_FALSE(Locked());
    Press("Save");
  });
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(SaveError(), Saved()));
  EXPECT_EQ(Stored("MissionDescription", "One"), "new text");
}

TEST_F(Editor, OnAFullDiskKeepsTheOldRowAndStaysUsable) {
  Open([this] {
    Press("Edit");
    Describe("new text");
    {
      const FullDisk full(512);
      Press("Save");
    }
    EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(SaveError()));
    EXPECT_EQ(Stored("MissionDescription", "One"), "First text");
    Press("Save");
  });
  EXPECT_EQ(Stored("MissionDescription", "One"), "new text");
}

TEST_F(Editor, AddsANewMissionAtTheSecondAttemptAndChangesNoOther) {
  Open([this] {
    {
      const Writer writer(venue.DataFile("scenarios.mdb"));
      NewMission("Four");
      EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(SaveError()));
    }
    EXPECT_EQ(ShownName(), "Four");
    EXPECT_FALSE(Locked());
    Press("Save");
    EXPECT_THAT(Entries(), ElementsAre("One", "Two", "Three", "Four"));
  });
  EXPECT_THAT(Names(), ElementsAre("One", "Two", "Three", "Four"));
  EXPECT_EQ(Stored("MissionDescription", "One"), "First text");
}

TEST_F(Editor, DoesNotDeleteFromALockedDatabase) {
  Open([this] {
    const Writer writer(venue.DataFile("scenarios.mdb"));
    Press("Delete");
    EXPECT_EQ(venue.Boxes.Boxes.back().Icon, BoxIcon::Critical);
  });
  EXPECT_THAT(Names(), ElementsAre("One", "Two", "Three"));
}

TEST_F(Editor, SavesNothingOverAnotherMissionWhenItsOwnIsGone) {
  Open([this] {
    venue.ChangeDatabase("scenarios.mdb", "DELETE FROM Table1 WHERE ID = 5");
    List().setCurrentRow(1);
    Press("Edit");
    Describe("typed");
    Press("Save");
    EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(SaveError()));
  });
  EXPECT_EQ(Stored("MissionDescription", "One"), "First text");
  EXPECT_EQ(Stored("MissionDescription", "Three"), "Third text");
}

TEST_F(Editor, SavesNothingOverAMissionThatCouldNotBeRead) {
  Open([this] {
    {
      OtherConnection other(venue.DataFile("scenarios.mdb"));
      other.Execute("BEGIN EXCLUSIVE");
      List().setCurrentRow(2);
      EXPECT_EQ(venue.Boxes.Boxes.size(), 1U);
    }
    EXPECT_EQ(List().currentRow(), -1);
    EXPECT_EQ(ShownName(), "");
    Press("Edit");
    Describe("New text");
    Press("Save");
    EXPECT_EQ(venue.Boxes.Boxes.back(), SaveError());
    EXPECT_THAT(Names(), ElementsAre("One", "Two", "Three"));
    List().setCurrentRow(2);
    EXPECT_EQ(ShownName(), "Three");
    EXPECT_EQ(ShownDescription(), "Third text");
  });
}

}  // namespace
