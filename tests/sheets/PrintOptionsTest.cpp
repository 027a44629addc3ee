#include "sheets/PrintOptions.h"

#include <gmock/gmock.h>

#include <QCheckBox>
#include <QComboBox>
#include <QGroupBox>
#include <QLabel>
#include <QProgressBar>
#include <QRadioButton>

#include "sheets/SheetProgressWindow.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/Captions.h"
#include "tests/support/CaredFor.h"
#include "tests/support/Controls.h"

namespace {

using testing::ElementsAre;

class PrintOptionsWindow : public testing::TestWithParam<Language> {
 protected:
  void Choose(const char* option) { Find<QRadioButton>(window, option).click(); }
  void SetIndex(const char* list, int index) { Find<QComboBox>(window, list).setCurrentIndex(index); }
  /// Of the three lists; each one's label must be in agreement.
  std::vector<bool> Enabled() const {
    std::vector<bool> enabled;
    for (const auto& [list, label] :
         {std::pair{"TeamID", "TeamLabel"}, {"PlayerID", "PlayerLabel"}, {"TeamID2", "TeamLabel2"}}) {
      enabled.push_back(Find<QComboBox>(window, list).isEnabled());
      EXPECT_EQ(Find<QLabel>(window, label).isEnabled(), enabled.back()) << label;
    }
    return enabled;
  }

  StringTable strings{GetParam()};
  FakeMessageBoxes boxes;
  PrintOptions window{strings, boxes, nullptr};
};

TEST_P(PrintOptionsWindow, IsCaredFor) {
  Show(window);
  ExpectCaredFor(window);
  EXPECT_EQ(window.windowTitle().toStdString(), strings.Text(159));
  const std::pair<const char*, int> options[] = {{"PrintActive", 152},  {"PrintAll", 153},
                                                 {"PrintTeam", 154},    {"PrintOne", 155},
                                                 {"PrintPrinter", 156}, {"PrintFile", 157}};
  for (const auto& [name, number] : options) {
    EXPECT_EQ(Find<QRadioButton>(window, name).text().toStdString(), strings.Text(number));
  }
  const std::pair<const char*, int> frames[] = {{"Frame1", 149}, {"Frame2", 150}, {"Frame3", 151}};
  for (const auto& [name, number] : frames) {
    EXPECT_EQ(Find<QGroupBox>(window, name).title().toStdString(), strings.Text(number));
  }
  EXPECT_EQ(Find<QPushButton>(window, "OK").text().toStdString(), strings.Text(140));
  EXPECT_EQ(Find<QPushButton>(window, "Cancel").text().toStdString(), strings.Text(141));
  EXPECT_EQ(Find<QCheckBox>(window, "HideRank").text().toStdString(), strings.Text(158));
}

TEST_P(PrintOptionsWindow, HaveTheirCaptions) {
  const auto in = [](const char* english, const char* chinese) {
    return std::string(GetParam() == Language::English ? english : chinese);
  };
  EXPECT_EQ(window.windowTitle().toStdString(), in("Print Options", "打印选项"));
  ExpectCaptions(window,
                 {{"Frame1", in("Select sheets to print", "选择要打印的成绩单")},
                  {"Frame2", in("Output", "输出")},
                  {"Frame3", in("Options", "选项")},
                  {"PrintActive", in("Print score sheets for active players", "打印参赛玩家的成绩单")},
                  {"PrintAll", in("Print all score sheets", "打印全部成绩单")},
                  {"PrintTeam", in("Print sheets for Team", "打印指定队伍的成绩单")},
                  {"PrintOne", in("Print sheet for Player", "打印指定玩家的成绩单")},
                  {"PrintPrinter", in("Output to Printer", "输出到打印机")},
                  {"PrintFile", in("Output to Files", "输出到文件")},
                  {"HideRank", in("Hide Rank", "隐藏名次")},
                  {"OK", in("OK", "确定")},
                  {"Cancel", in("Cancel", "取消")}});
  ExpectLabels(
      window,
      {{"TeamID", in("Team", "队伍")}, {"TeamID2", in("Team", "队伍")}, {"PlayerID", in("Player", "玩家")}});
}

TEST_P(PrintOptionsWindow, OfferTeamsAndNumbers) {
  for (const char* list : {"TeamID", "TeamID2"}) {
    const auto& teams = Find<QComboBox>(window, list);
    ASSERT_EQ(teams.count(), 3);
    EXPECT_EQ(teams.itemText(2).toStdString(), strings.Text(116));
    EXPECT_EQ(teams.currentIndex(), 0);
  }
  const auto& numbers = Find<QComboBox>(window, "PlayerID");
  ASSERT_EQ(numbers.count(), 96);
  EXPECT_EQ(numbers.itemText(95), QStringLiteral(" 95"));
}

TEST_P(PrintOptionsWindow, EnableTheListsOfTheChosenOption) {
  EXPECT_TRUE(Find<QRadioButton>(window, "PrintActive").isChecked());
  EXPECT_TRUE(Find<QRadioButton>(window, "PrintPrinter").isChecked());
  EXPECT_THAT(Enabled(), ElementsAre(false, false, false));
  Choose("PrintOne");
  EXPECT_THAT(Enabled(), ElementsAre(true, true, false));
  Choose("PrintTeam");
  EXPECT_THAT(Enabled(), ElementsAre(false, false, true));
  Choose("PrintAll");
  EXPECT_THAT(Enabled(), ElementsAre(false, false, false));
}

TEST_P(PrintOptionsWindow, HandsBackWhatWasChosen) {
  window.show();
  Choose("PrintOne");
  SetIndex("TeamID", 1);
  SetIndex("PlayerID", 40);
  Choose("PrintFile");
  Find<QCheckBox>(window, "HideRank").click();
  Press(window, "OK");
  EXPECT_FALSE(window.isVisible());
  EXPECT_EQ(window.Choice().SheetSelection, 1);
  EXPECT_EQ(window.Choice().SelectedTeam, 2);
  EXPECT_EQ(window.Choice().SelectedNumber, 40);
  EXPECT_EQ(window.Choice().OutputTarget, 2);
  EXPECT_TRUE(window.Choice().RankHidden);
  Choose("PrintTeam");
  SetIndex("TeamID2", 0);
  Press(window, "OK");
  EXPECT_EQ(window.Choice().SheetSelection, 500);
  EXPECT_EQ(window.Choice().SelectedTeam, 1);
  Choose("PrintAll");
  Press(window, "OK");
  EXPECT_EQ(window.Choice().SheetSelection, 1000);
  Choose("PrintActive");
  Press(window, "OK");
  EXPECT_EQ(window.Choice().SheetSelection, 1001);
}

TEST_P(PrintOptionsWindow, WarnsOfANumberThatTheTeamDoesNotHaveAndCloses) {
  window.show();
  Choose("PrintOne");
  SetIndex("TeamID", 2);
  SetIndex("PlayerID", 40);
  Press(window, "OK");
  EXPECT_THAT(boxes.Boxes,
              ElementsAre(FakeMessageBoxes::Box{"Invalid player ID selected for this Team", "Tessarine",
                                                BoxIcon::Exclamation, BoxButtons::OkCancel}));
  EXPECT_FALSE(window.isVisible());
  EXPECT_EQ(window.Choice().SheetSelection, 1);
  EXPECT_EQ(window.Choice().OutputTarget, 0);
}

TEST_P(PrintOptionsWindow, ChoosesNothingAfterCancelOrEscape) {
  for (const bool byKey : {false, true}) {
    window.show();
    Press(window, "OK");
    ASSERT_EQ(window.Choice().SheetSelection, 1001);
    window.show();
    byKey ? QTest::keyClick(&window, Qt::Key_Escape) : Press(window, "Cancel");
    EXPECT_EQ(window.Choice().SheetSelection, 0);
    EXPECT_FALSE(window.isVisible());
  }
}

TEST_P(PrintOptionsWindow, OfTheProgressShowsSheetAndName) {
  SheetProgressWindow progress(strings, nullptr);
  progress.Open();
  EXPECT_TRUE(progress.isModal());
  EXPECT_EQ(progress.windowTitle().toStdString(), strings.Text(131));
  progress.ShowSheet(7, 224, "Red 6-Ann Lee");
  EXPECT_EQ(Find<QLabel>(progress, "PlayerLabel").text(), QStringLiteral("Red 6-Ann Lee"));
  EXPECT_EQ(Find<QProgressBar>(progress, "Progress").maximum(), 224);
  EXPECT_EQ(Find<QProgressBar>(progress, "Progress").value(), 6);
  const QString label = Find<QLabel>(progress, "SheetLabel").text();
  EXPECT_EQ(label, GetParam() == Language::English ? QStringLiteral("Sheet 7 of 224")
                                                   : QStringLiteral("第 7 张，共 224 张"));
  Show(progress);
  ExpectCaredFor(progress);
  progress.Close();
  EXPECT_FALSE(progress.isVisible());
}

TEST_P(PrintOptionsWindow, OfTheProgressHasABarThatBeginsEmptyInEachRun) {
  SheetProgressWindow progress(strings, nullptr);
  const auto& bar = Find<QProgressBar>(progress, "Progress");
  for (int run = 1; run <= 2; ++run) {
    progress.Open();
    EXPECT_EQ(bar.minimum(), bar.maximum());  // moving until the word processor has started
    EXPECT_EQ(Find<QLabel>(progress, "SheetLabel").text().toStdString(),
              strings.Text(OwnText::StartingWordProcessor));
    EXPECT_EQ(Find<QLabel>(progress, "PlayerLabel").text(), QString());
    EXPECT_TRUE(Find<QPushButton>(progress, "Stop").isEnabled());
    progress.ShowSheet(1, 3, "Red 0-Guest");
    EXPECT_EQ(bar.minimum(), 0);
    EXPECT_EQ(bar.maximum(), 3);
    EXPECT_EQ(bar.value(), 0);
    progress.ShowSheet(3, 3, "Red 2-Guest");
    EXPECT_EQ(bar.value(), 2);
    progress.reject();
    progress.Close();
  }
}

TEST_P(PrintOptionsWindow, OfTheProgressShowsAnHourglassButNotInTheBoxesAfterIt) {
  SheetProgressWindow progress(strings, nullptr);
  progress.Open();
  ASSERT_NE(QGuiApplication::overrideCursor(), nullptr);
  EXPECT_EQ(QGuiApplication::overrideCursor()->shape(), Qt::WaitCursor);
  progress.Close();
  EXPECT_EQ(QGuiApplication::overrideCursor(), nullptr);
}

TEST_P(PrintOptionsWindow, OfTheProgressStaysUntilTheSheetIsDone) {
  SheetProgressWindow progress(strings, nullptr);
  progress.Open();
  EXPECT_FALSE(progress.Stopped());
  Press(progress, "Stop");
  EXPECT_TRUE(progress.Stopped());
  EXPECT_TRUE(progress.isVisible());
  EXPECT_FALSE(Find<QPushButton>(progress, "Stop").isEnabled());
  const auto& label = Find<QLabel>(progress, "SheetLabel");
  EXPECT_EQ(label.text().toStdString(), strings.Text(OwnText::StoppingAfterThisSheet));
  progress.ShowSheet(1, 3, "Red 0-Guest");
  EXPECT_EQ(label.text().toStdString(), strings.Text(OwnText::StoppingAfterThisSheet));
  progress.Close();
  progress.Open();
  EXPECT_FALSE(progress.Stopped());
  progress.close();
  EXPECT_TRUE(progress.Stopped());
  EXPECT_TRUE(progress.isVisible());
}

INSTANTIATE_TEST_SUITE_P(InBoth, PrintOptionsWindow,
                         testing::Values(Language::English, Language::SimplifiedChinese));

}  // namespace
