#include "charts/GameCharts.h"

#include <gmock/gmock.h>

#include <QClipboard>
#include <QLabel>
#include <QTabWidget>

#include "charts/ChartTable.h"
#include "charts/HitMap.h"
#include "charts/ScoreChart.h"
#include "tests/charts/ChartGames.h"
#include "tests/charts/Pointer.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/Announcements.h"
#include "tests/support/Controls.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using Box = FakeMessageBoxes::Box;

class ShownCharts : public testing::TestWithParam<Language> {
 protected:
  ShownCharts() {
    Add(Red0, 350);
    Add(Red1, -40);
    Add(Blue0, 30);
    game.Players(Blue0).HitByPlayer(Red0) = 350;
    game.Players(Red0).HitByPlayer(Red1) = 40;
    game.Players(Red0).HitByPlayer(Blue0) = 30;
    disk.AddFolder("/pictures");
    window.ShowGame(Chart());
    Show(window);
  }

  void Add(int index, std::int32_t soldiering) {
    game.Players(index).Active = true;
    game.Players(index).TotalDamage = soldiering;
    game.Players(index).Soldiering = soldiering;
  }

  ChartGame Chart() const {
    ChartGame chart = ChartOf(game);
    chart.Title = "Bridge, 21/11/2026";
    chart.FileName = "2026-11-21 2015 Bridge";
    return chart;
  }

  void ShowScores() { Find<QTabWidget>(window, "Charts").setCurrentIndex(1); }
  std::string Told() const { return Find<QLabel>(window, "TellLabel").text().toStdString(); }

  const StringTable strings{GetParam()};
  Game game{strings};
  FakeMessageBoxes boxes;
  FakeFileDialog dialog;
  FakeFiles disk;
  GameCharts window{{.Strings = strings, .Boxes = boxes, .CommonDialog1 = dialog, .Disk = disk}};
};

class ShownChartsInEnglish : public ShownCharts {};

std::vector<std::string> CellsOf(const QAbstractItemModel& model, int row) {
  std::vector<std::string> cells;
  for (int column = 0; column < model.columnCount(); ++column) {
    cells.push_back(model.index(row, column).data().toString().toStdString());
  }
  return cells;
}

TEST_P(ShownChartsInEnglish, HaveTablesBesideThem) {
  const QAbstractItemModel& hits = *Find<ChartTable>(window, "HitTable").model();
  ASSERT_EQ(hits.rowCount(), 3);
  EXPECT_THAT(CellsOf(hits, 0), ElementsAre("Red  0", "Blue  0", "350", ""));
  EXPECT_THAT(CellsOf(hits, 1), ElementsAre("Red  1", "Red  0", "40", "Yes"));
  const QAbstractItemModel& scores = *Find<ChartTable>(window, "ScoreTable").model();
  ASSERT_EQ(scores.rowCount(), 3);
  EXPECT_THAT(CellsOf(scores, 0), ElementsAre("Red  0", "350", "350", "0"));
  EXPECT_THAT(CellsOf(scores, 2), ElementsAre("Red  1", "-40", "0", "-40"));
  EXPECT_EQ(scores.headerData(3, Qt::Horizontal).toString(), QStringLiteral("Hits on own team"));
}

TEST_P(ShownCharts, CopyTheirTablesAsText) {
  auto& table = Find<ChartTable>(window, "HitTable");
  table.setFocus();
  table.clearSelection();
  QTest::keyClick(&table, Qt::Key_C, Qt::ControlModifier);
  const std::string all = QGuiApplication::clipboard()->text().toStdString();
  EXPECT_EQ(std::count(all.begin(), all.end(), '\n'), 4);
  EXPECT_THAT(all, HasSubstr(game.DisplayName(Red0) + "\t" + game.DisplayName(Blue0) + "\t350\t"));
  table.selectRow(1);
  QTest::keyClick(&table, Qt::Key_C, Qt::ControlModifier);
  const std::string row = QGuiApplication::clipboard()->text().toStdString();
  EXPECT_EQ(std::count(row.begin(), row.end(), '\n'), 2);
  EXPECT_THAT(row, HasSubstr("\t40\t" + strings.Text(OwnText::OwnTeamYes)));
}

TEST_P(ShownChartsInEnglish, TellACellInTheStatusTextAndAloud) {
  auto& map = Find<HitMap>(window, "Map");
  map.setFocus();
  const Announcements aloud;
  QTest::keyClick(&map, Qt::Key_Down);
  EXPECT_EQ(Told(), "Red  1 hit Red  0 of their own team: damage 40");
  EXPECT_THAT(aloud.Heard(), ElementsAre(QStringLiteral("TellLabel")));
  EXPECT_EQ(Find<ChartTable>(window, "HitTable").currentIndex().row(), 1);
  EXPECT_FALSE(Find<ChartTable>(window, "HitTable").selectionModel()->hasSelection());
  MovePointer(map, map.PlaceOf({0, 2}).center());
  EXPECT_EQ(Told(), "Red  0 hit Blue  0: damage 350");
  EXPECT_EQ(aloud.Heard().size(), 1U);
}

TEST_P(ShownChartsInEnglish, FollowTheirTables) {
  auto& hits = Find<ChartTable>(window, "HitTable");
  hits.setFocus();
  hits.selectRow(0);
  QTest::keyClick(&hits, Qt::Key_Down);
  EXPECT_EQ(Find<HitMap>(window, "Map").Cell(), (HitCell{1, 0}));
  EXPECT_EQ(Told(), "Red  1 hit Red  0 of their own team: damage 40");
  ShowScores();
  EXPECT_EQ(Told(), "");
  auto& scores = Find<ChartTable>(window, "ScoreTable");
  scores.setFocus();
  scores.selectRow(1);
  QTest::keyClick(&scores, Qt::Key_Down);
  EXPECT_EQ(Find<ScoreChart>(window, "Bars").Place(), 2);
  EXPECT_EQ(Told(), "Red  1: Soldiering -40 = Hits on own team -40");
}

TEST_P(ShownChartsInEnglish, TellTheNewFiguresOfTheSameCellAfterAChange) {
  auto& map = Find<HitMap>(window, "Map");
  map.setFocus();
  QTest::keyClick(&map, Qt::Key_End);
  ASSERT_EQ(Told(), "Red  0 hit Blue  0: damage 350");
  game.Players(Blue0).HitByPlayer(Red0) = 351;
  const Announcements aloud;
  window.ShowGame(Chart());
  EXPECT_EQ(Told(), "Red  0 hit Blue  0: damage 351");
  EXPECT_TRUE(aloud.Heard().empty());
}

TEST_P(ShownCharts, SayAFriendlySentenceWithoutPlayers) {
  const auto isVisible = [this](const char* name) { return Find<QWidget>(window, name).isVisible(); };
  EXPECT_FALSE(isVisible("EmptyLabel"));
  game.Clear();
  window.ShowGame(Chart());
  EXPECT_TRUE(isVisible("EmptyLabel"));
  EXPECT_EQ(Find<QLabel>(window, "EmptyLabel").text().toStdString(), strings.Text(OwnText::NothingToChart));
  EXPECT_FALSE(isVisible("Charts"));
  EXPECT_FALSE(Find<QPushButton>(window, "SavePicture").isEnabled());
}

TEST_P(ShownCharts, AreSavedAsPictures) {
  for (const OwnText chart : {OwnText::WhoHitWhom, OwnText::ScoreOrigins}) {
    const std::string file = "/pictures/" + strings.Text(chart) + ".png";
    dialog.Answers = {file};
    Press(window, "SavePicture");
    EXPECT_EQ(dialog.Calls.back().Name, "2026-11-21 2015 Bridge " + strings.Text(chart) + ".png");
    EXPECT_THAT(dialog.Calls.back().Filter, HasSubstr("*.png"));
    ASSERT_TRUE(disk.FileExists(file));
    QImage picture;
    ASSERT_TRUE(picture.loadFromData(QByteArray::fromStdString(disk.Read(file)), "PNG"));
    EXPECT_GT(picture.width(), 200);
    EXPECT_EQ(picture.pixelColor(2, 2), QColor(Qt::white));
    EXPECT_THAT(Told(), HasSubstr(file));
    ShowScores();
  }
  EXPECT_TRUE(boxes.Boxes.empty());
  EXPECT_EQ(dialog.Calls.back().Folder, "/pictures");
}

TEST_P(ShownCharts, AreNotSavedByCancel) {
  Press(window, "SavePicture");
  EXPECT_EQ(dialog.Calls.size(), 1U);
  EXPECT_TRUE(disk.Replaced.empty());
  EXPECT_TRUE(boxes.Boxes.empty());
}

TEST_P(ShownChartsInEnglish, ReplaceAPictureOnlyAfterAQuestion) {
  disk.Put("/pictures/a.png", "older");
  dialog.Answers = {"/pictures/a.png", "/pictures/a.png"};
  boxes.Answers = {BoxAnswer::Cancel, BoxAnswer::Ok};
  Press(window, "SavePicture");
  EXPECT_THAT(boxes.Boxes, ElementsAre(Box{"a.png exists already. Replace it?", "Game Charts",
                                           BoxIcon::Question, BoxButtons::OkCancel}));
  EXPECT_EQ(disk.Read("/pictures/a.png"), "older");
  Press(window, "SavePicture");
  EXPECT_NE(disk.Read("/pictures/a.png"), "older");
}

TEST_P(ShownChartsInEnglish, HaveNoColumnOfOwnTeamsInAFreeForAll) {
  ChartGame chart = Chart();
  chart.FreeForAll = true;
  window.ShowGame(chart);
  const QAbstractItemModel& hits = *Find<ChartTable>(window, "HitTable").model();
  EXPECT_THAT(CellsOf(hits, 1), ElementsAre("Red  1", "Red  0", "40"));
  window.ShowGame(Chart());
  EXPECT_EQ(hits.columnCount(), 4);
}

TEST_P(ShownCharts, SaveNothingWhereThePictureWouldBeTooLarge) {
  ChartGame chart = Chart();
  chart.Title = std::string(40'000, 'W');
  window.ShowGame(chart);
  QFont huge = window.font();
  huge.setPixelSize(2000);
  Find<HitMap>(window, "Map").setFont(huge);
  disk.Put("/pictures/a.png", "older");
  dialog.Answers = {"/pictures/a.png"};
  boxes.Answers = {BoxAnswer::Ok, BoxAnswer::Ok};
  Press(window, "SavePicture");
  ASSERT_EQ(boxes.Boxes.size(), 2U);
  EXPECT_THAT(boxes.Boxes[1].Text, HasSubstr(strings.Text(OwnText::PictureTooLarge)));
  EXPECT_EQ(boxes.Boxes[1].Icon, BoxIcon::Exclamation);
  EXPECT_TRUE(disk.Replaced.empty());
  EXPECT_EQ(disk.Read("/pictures/a.png"), "older");
}

TEST_P(ShownChartsInEnglish, TellWhyAPictureWasNotSaved) {
  dialog.Answers = {"/pictures/a.png"};
  disk.FailReplace("/pictures/a.png", RuntimeError(Fault::DiskFull, "Disk full: /pictures/a.png"));
  Press(window, "SavePicture");
  EXPECT_THAT(boxes.Boxes, ElementsAre(Box{"The picture was not saved. Disk full: /pictures/a.png",
                                           "Game Charts", BoxIcon::Exclamation, BoxButtons::Ok}));
  EXPECT_FALSE(disk.FileExists("/pictures/a.png"));
  EXPECT_EQ(Told(), "");
  EXPECT_TRUE(window.isVisible());
}

TEST_P(ShownCharts, CloseByTheKeyboardAndTheButton) {
  QTest::keyClick(&window, Qt::Key_Escape);
  EXPECT_FALSE(window.isVisible());
  Show(window);
  Press(window, "Close");
  EXPECT_FALSE(window.isVisible());
}

INSTANTIATE_TEST_SUITE_P(Languages, ShownCharts,
                         testing::Values(Language::English, Language::SimplifiedChinese),
                         [](const auto& language) {
                           return language.param == Language::English ? "English" : "SimplifiedChinese";
                         });
INSTANTIATE_TEST_SUITE_P(Language, ShownChartsInEnglish, testing::Values(Language::English),
                         [](const auto& /*language*/) { return "English"; });

}  // namespace
