#include <QAccessible>

#include "core/data/FieldValue.h"
#include "tests/missions/Editor.h"
#include "tests/support/Captions.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

TEST_F(Editor, OpensLockedOnTheFirstMission) {
  Open([this] {
    EXPECT_THAT(Entries(), ElementsAre("One", "Two", "Three"));
    EXPECT_EQ(List().currentRow(), 0);
    EXPECT_EQ(ShownName(), "One");
    EXPECT_EQ(ShownDescription(), "First text");
    EXPECT_EQ(Line("RespawnPenalty").text(), QStringLiteral("2.5"));
    EXPECT_EQ(Line("HealPenalty").text(), QStringLiteral("0"));
    EXPECT_EQ(Line("GameDuration").text(), QStringLiteral("10 minutes"));
    EXPECT_EQ(Line("PrimaryPoints1").text(), QStringLiteral("7"));
    EXPECT_EQ(EditCaption(), "Edit");
    EXPECT_TRUE(Locked());
    for (const char* name : {"RespawnPenalty", "HealPenalty", "GameDuration", "TeamRatio", "PrimaryPoints0",
                             "SecondaryPoints1", "PrimaryPoints2"}) {
      EXPECT_TRUE(Line(name).isReadOnly()) << name;
    }
    for (const char* name : {"PrimaryObjectiveDescription0", "SecondaryObjectiveDescription2"}) {
      EXPECT_TRUE(Memo(name).isReadOnly()) << name;
    }
  });
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(Editor, ShowsByTheirBackgroundWhetherEntriesCanBeChanged) {
  Open([this] {
    const auto background = [](QWidget& entry) {
      const QImage image = entry.grab().toImage();
      return image.pixelColor(image.width() - 8, image.height() / 2);
    };
    for (QWidget* entry : std::initializer_list<QWidget*>{&Line("GameDuration"), &Memo("Description")}) {
      EXPECT_EQ(background(*entry), window->palette().color(QPalette::Window));
    }
    Press("Edit");
    for (QWidget* entry : std::initializer_list<QWidget*>{&Line("GameDuration"), &Memo("Description")}) {
      EXPECT_EQ(background(*entry), window->palette().color(QPalette::Base));
    }
  });
}

TEST_F(Editor, ShowsTheMissionThatIsClicked) {
  Open([this] {
    QTest::mouseClick(List().viewport(), Qt::LeftButton, {}, List().visualItemRect(List().item(1)).center());
    EXPECT_EQ(ShownName(), "Two");
    EXPECT_EQ(ShownDescription(), "Second text");
    QTest::keyClick(&List(), Qt::Key_Down);
    EXPECT_EQ(ShownName(), "Three");
  });
}

TEST_F(Editor, ReplacesWhatWasTypedWhenTheSameMissionIsClicked) {
  Open([this] {
    Press("Edit");
    Describe("typed and not saved");
    QTest::mouseClick(List().viewport(), Qt::LeftButton, {}, List().visualItemRect(List().item(0)).center());
    EXPECT_EQ(ShownDescription(), "First text");
    EXPECT_FALSE(Locked());
  });
}

TEST_F(Editor, ShowsTheMissionThatAScreenReaderSelects) {
  Open([this] {
    QAccessibleInterface* list = QAccessible::queryAccessibleInterface(&List());
    list->child(2)->actionInterface()->doAction(QAccessibleActionInterface::toggleAction());
    EXPECT_EQ(ShownName(), "Three");
    EXPECT_EQ(List().currentRow(), 2);
    Press("Edit");
    Describe("New third text");
    Press("Save");
  });
  EXPECT_EQ(Stored("MissionDescription", "Three"), "New third text");
  EXPECT_EQ(Stored("MissionDescription", "One"), "First text");
}

TEST_F(Editor, ShowsNothingOfAMissionThatIsGone) {
  Open([this] {
    venue.ChangeDatabase("scenarios.mdb", "DELETE FROM Table1 WHERE ID = 5");
    List().setCurrentRow(1);
    EXPECT_EQ(ShownName(), "");
    EXPECT_EQ(ShownDescription(), "");
    EXPECT_EQ(Line("RespawnPenalty").text(), QStringLiteral("0"));
    EXPECT_EQ(Line("SecondaryPoints2").text(), QStringLiteral("0"));
    EXPECT_EQ(Line("GameDuration").text(), QString());
  });
}

TEST_F(Editor, UnlocksForEditingAndStaysSoOnTheNextMission) {
  Open([this] {
    Press("Edit");
    EXPECT_EQ(EditCaption(), "Editing");
    EXPECT_FALSE(Locked());
    EXPECT_FALSE(Line("PrimaryPoints2").isReadOnly());
    Press("Edit");
    EXPECT_EQ(EditCaption(), "Editing");
    Describe("typed and not saved");
    List().setCurrentRow(1);
    EXPECT_EQ(ShownDescription(), "Second text");
    EXPECT_FALSE(Locked());
  });
  EXPECT_EQ(Stored("MissionDescription", "One"), "First text");
}

TEST_F(Editor, NamesItsObjectiveBoxesToScreenReaders) {
  Open([this] {
    const auto text = [](QWidget& box, QAccessible::Text kind) {
      return QAccessible::queryAccessibleInterface(&box)->text(kind).toStdString();
    };
    const auto name = [&](QWidget& box) { return text(box, QAccessible::Name); };
    const auto description = [&](QWidget& box) { return text(box, QAccessible::Description); };
    for (const std::string set : {"0", "1", "2"}) {
      EXPECT_EQ(name(Memo("PrimaryObjectiveDescription" + set)), "Primary  Objective");
      EXPECT_EQ(name(Memo("SecondaryObjectiveDescription" + set)), "Secondary Objective");
      EXPECT_EQ(name(Line("PrimaryPoints" + set)), "Victory points");
      EXPECT_EQ(name(Line("SecondaryPoints" + set)), "Victory points");
      EXPECT_EQ(description(Line("PrimaryPoints" + set)), "Primary  Objective");
      EXPECT_EQ(description(Line("SecondaryPoints" + set)), "Secondary Objective");
    }
  });
}

TEST_F(Editor, BringsTheTabsObjectivesToTheFront) {
  Open([this] {
    auto& tabs = ::Find<QTabBar>(*window, "ObjectivesTab");
    const auto front = [this] {
      std::string sets;
      for (const char* set : {"0", "1", "2"}) {
        const bool visible = Memo(std::string("PrimaryObjectiveDescription") + set).isVisible();
        EXPECT_EQ(Memo(std::string("SecondaryObjectiveDescription") + set).isVisible(), visible);
        EXPECT_EQ(Line(std::string("PrimaryPoints") + set).isVisible(), visible);
        EXPECT_EQ(Line(std::string("SecondaryPoints") + set).isVisible(), visible);
        sets += visible ? set : "";
      }
      return sets;
    };
    EXPECT_EQ(front(), "0");
    EXPECT_EQ(tabs.tabText(1), QStringLiteral("Team B"));
    for (int tab = 2; tab >= 0; --tab) {
      QTest::mouseClick(&tabs, Qt::LeftButton, {}, tabs.tabRect(tab).center());
      EXPECT_EQ(front(), std::to_string(tab));
      const auto* label = window->findChild<QLabel*>(QStringLiteral("Label3"));
      EXPECT_EQ(label->buddy(), &Line("SecondaryPoints" + std::to_string(tab)));
    }
  });
}

TEST_F(Editor, LabelsTheBoxesOfTheTabInFrontAndLeadsTheTabKeyThroughThem) {
  Open([this] {
    Show(*window);
    auto& tabs = ::Find<QTabBar>(*window, "ObjectivesTab");
    for (int tab = 0; tab < 3; ++tab) {
      tabs.setCurrentIndex(tab);
      const std::string set = std::to_string(tab);
      const std::pair<const char*, std::string> boxes[] = {{"Label4", "PrimaryObjectiveDescription" + set},
                                                           {"Label1", "PrimaryPoints" + set},
                                                           {"Label5", "SecondaryObjectiveDescription" + set},
                                                           {"Label3", "SecondaryPoints" + set}};
      tabs.setFocus();
      for (const auto& [label, box] : boxes) {
        EXPECT_EQ(::Find<QLabel>(*window, label).buddy(), &::Find<QWidget>(*window, box)) << box;
        ::Type(*window, Qt::Key_Tab);
        EXPECT_EQ(window->focusWidget()->objectName().toStdString(), box);
      }
      ::Type(*window, Qt::Key_Tab);
      EXPECT_EQ(window->focusWidget()->objectName(), QStringLiteral("SelectExit"));
    }
  });
}

TEST_F(Editor, DeletesTheSelectedMission) {
  Open([this] {
    List().setCurrentRow(1);
    Press("Delete");
    EXPECT_THAT(Entries(), ElementsAre("One", "Three"));
    EXPECT_EQ(List().currentRow(), 0);
    EXPECT_EQ(ShownName(), "One");
  });
  EXPECT_THAT(venue.Boxes.Boxes,
              ElementsAre(FakeMessageBoxes::Box{"This will delete the current Mission. Are you sure?",
                                                "Confirm Delete", BoxIcon::Question, BoxButtons::OkCancel}));
  EXPECT_THAT(Names(), ElementsAre("One", "Three"));
}

TEST_F(Editor, DeletesNothingOnCancel) {
  venue.Boxes.Answers = {BoxAnswer::Cancel};
  Open([this] { Press("Delete"); });
  EXPECT_THAT(Names(), ElementsAre("One", "Two", "Three"));
}

TEST_F(Editor, DeletingDoesNotUnlockOrLock) {
  Open([this] {
    Press("Delete");
    EXPECT_TRUE(Locked());
    Press("Edit");
    Press("Delete");
    EXPECT_FALSE(Locked());
  });
}

TEST_F(Editor, DeletesNoOtherMissionInPlaceOfOneThatIsGone) {
  Open([this] {
    venue.ChangeDatabase("scenarios.mdb", "DELETE FROM Table1 WHERE ID = 5");
    List().setCurrentRow(1);
    Press("Delete");
    EXPECT_THAT(Entries(), ElementsAre("One", "Three"));
  });
  EXPECT_THAT(Names(), ElementsAre("One", "Three"));
}

TEST_F(Editor, AsksBeforeItLeavesWhileEditing) {
  venue.Boxes.Answers = {BoxAnswer::No};
  Open([this] {
    Press("Edit");
    Describe("never saved");
    Press("SelectExit");
    EXPECT_FALSE(window->isVisible());
  });
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(NotSaved()));
  EXPECT_EQ(Stored("MissionDescription", "One"), "First text");
}

TEST_F(Editor, AsksByEscapeAsByItsButton) {
  venue.Boxes.Answers = {BoxAnswer::Yes};
  Open([this] {
    Press("Edit");
    Describe("saved by Escape");
    QTest::keyClick(&Memo("Description"), Qt::Key_Escape);
    EXPECT_FALSE(window->isVisible());
  });
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(NotSaved(), Saved()));
  EXPECT_EQ(Stored("MissionDescription", "One"), "saved by Escape");
}

TEST_F(Editor, LeavesByEscapeWithoutAQuestionWhileLocked) {
  Open([this] {
    QTest::keyClick(&List(), Qt::Key_Escape);
    EXPECT_FALSE(window->isVisible());
  });
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(Editor, LeavesTheRowsOnTheFirst) {
  Open([this] {
    List().setCurrentRow(1);
    Press("SelectExit");
  });
  EXPECT_EQ(TextOf(rows->Fields("MissionName")), "One");
}

TEST_F(Editor, SavesOnTheWayOutWhenToldTo) {
  Open([this] {
    Press("Edit");
    Describe("saved at last");
    Press("SelectExit");
    EXPECT_FALSE(window->isVisible());
  });
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(NotSaved(), Saved()));
  EXPECT_EQ(Stored("MissionDescription", "One"), "saved at last");
}

class EditorCaptions : public testing::TestWithParam<Language> {
 protected:
  std::string In(const char* english, const char* chinese) const {
    return GetParam() == Language::English ? english : chinese;
  }
};

TEST_P(EditorCaptions, AreThoseOfTheStringTable) {
  DataSite venue(GetParam());
  venue.PutDefaultFiles();
  const std::unique_ptr<Database> database = venue.Databases.OpenDatabase(venue.DataFile("scenarios.mdb"));
  const std::unique_ptr<Recordset> rows = database->OpenRecordset("Table1");
  const Scenarios window(*database, *rows, venue.Boxes, venue.Strings, nullptr);
  EXPECT_EQ(window.windowTitle().toStdString(), In("Mission Setup", "任务设置"));
  ExpectCaptions(window, {{"Frame1", In("Mission Selection", "任务选择")},
                          {"Frame2", In("Mission Details", "任务详情")},
                          {"Frame5", In("Penalties", "惩罚")},
                          {"General", In("General", "常规")},
                          {"NewButton", In("New", "新建")},
                          {"Edit", "Edit"},
                          {"Save", In("Save", "保存")},
                          {"Delete", In("Delete", "删除")},
                          {"SelectExit", In("OK", "确定")}});
  ExpectLabels(window, {{"RespawnPenalty", In("Respawn", "重生")},
                        {"HealPenalty", In("Heal", "治疗")},
                        {"GameDuration", In("Game Duration", "比赛时长")},
                        {"TeamRatio", In("Team Ratio", "队伍比例")},
                        {"PrimaryObjectiveDescription0", In("Primary  Objective", "主要目标")},
                        {"PrimaryPoints0", In("Victory points", "胜利分")},
                        {"SecondaryObjectiveDescription0", In("Secondary Objective", "次要目标")},
                        {"SecondaryPoints0", In("Victory points", "胜利分")}});
  const auto& tabs = ::Find<QTabBar>(window, "ObjectivesTab");
  ASSERT_EQ(tabs.count(), 3);
  EXPECT_EQ(tabs.tabText(0).toStdString(), In("Team A", "A 队"));
  EXPECT_EQ(tabs.tabText(1).toStdString(), In("Team B", "B 队"));
  EXPECT_EQ(tabs.tabText(2).toStdString(), In("Team C", "C 队"));
}

TEST_P(EditorCaptions, OfANewMissionAreThoseOfTheStringTable) {
  const StringTable strings(GetParam());
  const MissionNameEntry window(strings, nullptr);
  EXPECT_EQ(window.windowTitle().toStdString(), In("New Mission", "新任务"));
  ExpectCaptions(window, {{"OK", In("OK", "确定")}, {"Cancel", In("Cancel", "取消")}});
  ExpectLabels(window, {{"MissionEntry", In("Enter new mission name", "请输入新任务的名称")}});
  EXPECT_EQ(CaptionOf(::Find<QLineEdit>(window, "MissionEntry")), In("New Mission", "新任务"));
}

INSTANTIATE_TEST_SUITE_P(Languages, EditorCaptions,
                         testing::Values(Language::English, Language::SimplifiedChinese),
                         [](const auto& language) {
                           return language.param == Language::English ? "English" : "SimplifiedChinese";
                         });

class ChineseEditor : public testing::Test {};

TEST_F(ChineseEditor, TakesItsCaptionsFromTheStringTable) {
  DataSite venue(Language::SimplifiedChinese);
  venue.PutDefaultFiles();
  const std::unique_ptr<Database> database = venue.Databases.OpenDatabase(venue.DataFile("scenarios.mdb"));
  const std::unique_ptr<Recordset> rows = database->OpenRecordset("Table1");
  const WhileModal<Scenarios> open([&venue](Scenarios& window) {
    const auto text = [&venue](int number) { return QString::fromStdString(venue.Strings.Text(number)); };
    EXPECT_EQ(window.windowTitle(), text(180));
    for (const auto& [label, number] : {std::pair{"Label2", 190},
                                        {"Label6", 191},
                                        {"Label4", 192},
                                        {"Label1", 193},
                                        {"Label3", 193},
                                        {"Label5", 194},
                                        {"Label7", 196},
                                        {"Label8", 197}}) {
      EXPECT_EQ(::Find<QLabel>(window, label).text(), text(number)) << label;
    }
    for (const auto& [button, number] :
         {std::pair{"NewButton", 185}, {"Save", 187}, {"Delete", 188}, {"SelectExit", 140}}) {
      EXPECT_EQ(::Find<QPushButton>(window, button).text(), text(number)) << button;
    }
    window.close();
  });
  Scenarios(*database, *rows, venue.Boxes, venue.Strings, nullptr).exec();
  EXPECT_EQ(open.Runs(), 1);
}

}  // namespace
