#include "tests/missions/Editor.h"
#include "tests/support/Announcements.h"
#include "tests/support/Contrast.h"

namespace {

using testing::IsEmpty;

/// What the editor says beside its entries.
class EditorNotes : public Editor {
 protected:
  /// Text of a note; empty if it is hidden.
  std::string Note(const std::string& name) {
    const auto& label = ::Find<QLabel>(*window, name);
    return label.isVisible() ? label.text().toStdString() : "";
  }
  std::string Count() { return Note("DescriptionCount"); }
};

TEST_F(EditorNotes, CountTheDescriptionAsItIsSaved) {
  Open([this] {
    EXPECT_EQ(Count(), "10 / 1000");  // "First text"
    Press("Edit");
    Describe("Two\nlines");
    EXPECT_EQ(Count(), "10 / 1000");  // the line break is two characters
    Describe("守住水井");
    EXPECT_EQ(Count(), "4 / 1000");
    Describe(std::string(1001, 'x'));
    EXPECT_EQ(Count(), "1001 / 1000");
    EXPECT_TRUE(::Find<QLabel>(*window, "DescriptionCount").font().bold());
    Describe("");
    EXPECT_EQ(Count(), "0 / 1000");
    EXPECT_FALSE(::Find<QLabel>(*window, "DescriptionCount").font().bold());
  });
}

TEST_F(EditorNotes, FollowTheMissionThatIsShown) {
  Open([this] {
    List().setCurrentRow(1);
    EXPECT_EQ(Count(), "11 / 1000");
  });
}

TEST_F(EditorNotes, TellWhichCharactersASaveLoses) {
  Open([this] {
    Press("Edit");
    Describe(std::string(509, '.'));
    EXPECT_EQ(Note("DescriptionNote"), "");
    EXPECT_THAT(Memo("Description").extraSelections(), IsEmpty());
    Describe(std::string(400, '.') + "\n" + std::string(107, '.') + "Xyz");
    EXPECT_EQ(Note("DescriptionNote"), "Saving loses character 510: ........[X]yz");
    ASSERT_EQ(Memo("Description").extraSelections().size(), 1);
    EXPECT_EQ(Memo("Description").extraSelections().first().cursor.selectedText(), QStringLiteral("X"));
    Describe(std::string(800, '.'));
    EXPECT_EQ(Note("DescriptionNote"),
              "Saving loses character 510: ........[.]........\nSaving loses character 766: "
              "........[.]........");
    EXPECT_EQ(Memo("Description").extraSelections().size(), 2);
  });
}

TEST_F(EditorNotes, TellTheTruthAboutWhatASaveLoses) {
  Open([this] {
    Press("Edit");
    Describe(std::string(509, 'a') + "X" + std::string(255, 'b') + "Y" + "end");
    EXPECT_EQ(Note("DescriptionNote"),
              "Saving loses character 510: aaaaaaaa[X]bbbbbbbb\nSaving loses character 766: bbbbbbbb[Y]end");
    Press("Save");
    List().setCurrentRow(0);
    EXPECT_EQ(ShownDescription(), std::string(509, 'a') + std::string(255, 'b') + "end");
  });
}

TEST_F(EditorNotes, MarkPenaltiesThatAreSavedAsAnotherNumber) {
  Open([this] {
    EXPECT_EQ(Note("RespawnNote"), "");
    Press("Edit");
    Type("RespawnPenalty", "ten");
    EXPECT_EQ(Note("RespawnNote"), "Saved as 0");
    EXPECT_EQ(Note("HealNote"), "");
    Type("RespawnPenalty", "1,5");
    EXPECT_EQ(Note("RespawnNote"), "Saved as 1");
    Type("RespawnPenalty", "0");
    EXPECT_EQ(Note("RespawnNote"), "");
    Type("HealPenalty", "");
    EXPECT_EQ(Note("HealNote"), "Saved as 0");
    Press("Save");
    EXPECT_EQ(Stored("HealPenalty", "One"), "0.0");
    List().setCurrentRow(0);
    EXPECT_EQ(Note("HealNote"), "");
  });
}

TEST_F(EditorNotes, MarkEmptyPointsAndTheirTab) {
  Open([this] {
    Press("Edit");
    const auto& tabs = ::Find<QTabBar>(*window, "ObjectivesTab");
    Type("PrimaryPoints0", "");
    EXPECT_EQ(Note("PrimaryNote"), "Saved as 0");
    EXPECT_EQ(Note("SecondaryNote"), "");
    EXPECT_FALSE(tabs.tabIcon(0).isNull());
    EXPECT_TRUE(tabs.tabIcon(1).isNull());
    ::Find<QTabBar>(*window, "ObjectivesTab").setCurrentIndex(1);
    EXPECT_EQ(Note("PrimaryNote"), "");
    EXPECT_FALSE(tabs.tabIcon(0).isNull());
    Type("SecondaryPoints1", "");
    EXPECT_EQ(Note("SecondaryNote"), "Saved as 0");
    Type("SecondaryPoints1", "5");
    EXPECT_EQ(Note("SecondaryNote"), "");
    EXPECT_TRUE(tabs.tabIcon(1).isNull());
    EXPECT_EQ(tabs.tabText(0), QStringLiteral("Team A"));
  });
}

TEST_F(EditorNotes, AreToldByScreenReadersWithTheirEntries) {
  Open([this] {
    Press("Edit");
    Describe(std::string(510, '.'));
    Type("RespawnPenalty", "ten");
    Type("SecondaryPoints0", "");
    const auto told = [this](const char* entry) {
      return ::Find<QWidget>(*window, entry).accessibleDescription().toStdString();
    };
    EXPECT_EQ(told("Description"), "\n" + Note("DescriptionNote"));
    EXPECT_EQ(told("RespawnPenalty"), "\nSaved as 0");
    EXPECT_EQ(told("HealPenalty"), "");
    EXPECT_EQ(told("PrimaryPoints0"), "Primary  Objective");
    EXPECT_EQ(told("SecondaryPoints0"), "Secondary Objective\nSaved as 0");
    Type("RespawnPenalty", "10");
    EXPECT_EQ(told("RespawnPenalty"), "");
  });
}

TEST_F(EditorNotes, AreSaidByScreenReadersWhenTheyAppear) {
  Open([this] {
    Press("Edit");
    const Announcements announced;
    Type("RespawnPenalty", "ten");
    EXPECT_THAT(announced.Heard(), testing::ElementsAre(QStringLiteral("RespawnNote")));
    Describe(std::string(509, '.'));
    QTest::keyClicks(&Memo("Description"), QStringLiteral("and on"));
    EXPECT_THAT(announced.Heard(),
                testing::ElementsAre(QStringLiteral("RespawnNote"), QStringLiteral("DescriptionNote")));
  });
}

TEST_F(EditorNotes, AreReadableOnLightAndDarkDesktops) {
  const auto expectReadable = [this] {
    Press("Edit");
    Describe(std::string(800, '.'));
    Type("HealPenalty", "");
    Type("PrimaryPoints0", "");
    for (const char* note : {"DescriptionCount", "DescriptionNote", "HealNote", "PrimaryNote"}) {
      EXPECT_GE(PaintedContrast(::Find<QLabel>(*window, note)), LeastContrast) << note;
    }
    const QTextCharFormat lost = Memo("Description").extraSelections().first().format;
    EXPECT_GE(Contrast(lost.foreground().color().rgb(), lost.background().color().rgb()), LeastContrast);
    EXPECT_TRUE(lost.fontStrikeOut());  // not by colour alone
  };
  Open(expectReadable);
  const DarkDesktop dark;
  Open(expectReadable);
}

TEST_F(EditorNotes, AreInChineseToo) {
  const StringTable strings(Language::SimplifiedChinese);
  Scenarios chinese(*database, *rows, venue.Boxes, strings, nullptr);
  ::Find<QLineEdit>(chinese, "HealPenalty").clear();
  EXPECT_EQ(::Find<QLabel>(chinese, "HealNote").text(), QStringLiteral("将保存为 0"));
}

}  // namespace
