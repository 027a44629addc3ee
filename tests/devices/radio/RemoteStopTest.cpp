#include <gmock/gmock.h>

#include <QIcon>
#include <QRadioButton>

#include "tests/devices/radio/RemoteWindow.h"
#include "tests/support/Announcements.h"
#include "tests/support/Contrast.h"
#include "ui/TeamColours.h"

// What the window adds: a button that stops a run, the colours of the teams, and a hint.

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class StoppedRemote : public RemoteWindow {
 protected:
  QPushButton& Stop() { return Find<QPushButton>(window, "Stop"); }
  std::string Hint() const {
    const auto& label = Find<QLabel>(window, "Hint");
    return label.isVisible() ? label.text().toStdString() : "";
  }
  std::string In(const char* english, const char* chinese) const {
    return GetParam() == Language::English ? english : chinese;
  }
  bool IsInColourOf(int row, int team) const {
    const auto badge = List().index(row, 0).data(Qt::DecorationRole).value<QIcon>();
    return badge.cacheKey() == TeamBadge(team).cacheKey();
  }
};

TEST_P(StoppedRemote, OffersToStopOnlyWhileItWorks) {
  EXPECT_FALSE(Stop().isVisible());
  bool looked = false;
  Meanwhile(100, [&] {
    looked = true;
    EXPECT_TRUE(Stop().isVisible());
    EXPECT_EQ(Stop().text().toStdString(), Strings.Text(OwnText::Stop));
  });
  Press("SearchGunsButton");
  EXPECT_TRUE(looked);
  EXPECT_FALSE(Stop().isVisible());
  EXPECT_EQ(Hint(), "");
}

TEST_P(StoppedRemote, StopsASearchAndKeepsWhatItFound) {
  guns = {33, 40, 100};
  Meanwhile(12 * 20, [this] { Press("Stop"); });
  Press("SearchGunsButton");
  EXPECT_THAT(Column(0), ElementsAre(Red() + "  1", Red() + "  8"));
  EXPECT_LT(Frames.size(), 30U);
  EXPECT_EQ(TextOf("StatusLabel"), "Idle");
  EXPECT_EQ(Hint(), In("Search stopped. Guns found: 2", "搜索已停止。已找到 2 支枪。"));
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  ExpectUsable();
  EXPECT_EQ(Hint(), "");
}

TEST_P(StoppedRemote, StopsAFetchWhichCanGoOnLater) {
  guns = {33, 40, 41};
  silent = 40;
  Press("SearchGunsButton");
  Meanwhile(500, [this] { Press("Stop"); });
  Press("GetScoresButton");
  EXPECT_THAT(Column(4), ElementsAre("Scores OK", "Scores Failed", "Scores Pending"));
  EXPECT_EQ(TextOf("StatusLabel"), "Idle");
  EXPECT_EQ(Hint(),
            In("Stopped. Scores fetched from 1 of 3 guns.", "已停止。已获取 1 支枪的成绩，共 3 支。"));
  silent = 0;
  Press("GetScoresButton");
  EXPECT_THAT(Column(4), ElementsAre("Scores OK", "Scores OK", "Scores OK"));
  EXPECT_EQ(TextOf("StatusLabel"), "Done");
  EXPECT_EQ(Hint(), "");
  ExpectUsable();
}

TEST_P(StoppedRemote, GivesTheKeyboardBackAfterAStop) {
  ::Show(window);
  Meanwhile(100, [this] {
    Stop().setFocus();
    QTest::keyClick(&Stop(), Qt::Key_Space);
  });
  Press("SearchGunsButton");
  EXPECT_TRUE(Find<QTableView>(window, "DataList").hasFocus());
}

TEST_P(StoppedRemote, StopsOnlyTheRunThatIsOn) {
  guns = {33};
  Meanwhile(100, [this] { Press("Stop"); });
  Press("SearchGunsButton");
  Press("SearchGunsButton");
  EXPECT_EQ(List().rowCount(), 1);
  EXPECT_EQ(Hint(), "");
}

TEST_P(StoppedRemote, KeepsTheHintOfTheLaterRun) {
  guns = {33};
  silent = 33;
  Meanwhile(100, [this] { Press("GetScoresButton"); });
  Meanwhile(200, [this] { Press("Stop"); });
  Press("SearchGunsButton");
  EXPECT_EQ(Hint(),
            In("Stopped. Scores fetched from 0 of 1 guns.", "已停止。已获取 0 支枪的成绩，共 1 支。"));
}

TEST_P(StoppedRemote, ShowsTheTeamOfEachGun) {
  guns = {33, 70, 100, 130};
  Press("SearchGunsButton");
  ASSERT_EQ(List().rowCount(), 4);
  EXPECT_TRUE(IsInColourOf(0, 1));
  EXPECT_TRUE(IsInColourOf(1, 2));
  EXPECT_TRUE(IsInColourOf(2, 3));
  EXPECT_TRUE(IsInColourOf(3, 1));
  EXPECT_FALSE(IsInColourOf(0, 2));
}

TEST_P(StoppedRemote, HintsAtMoreGunsBeyondTheRange) {
  const std::string hint =
      In("Guns answered up to the edge of this range. Choose 224 and search again: there may be more.",
         "应答的枪已到达所选范围的边缘。请选择 224 后重新搜索，可能还有更多的枪。");
  guns = {158};
  Press("SearchGunsButton");
  EXPECT_EQ(Hint(), "");
  guns = {159};
  Press("SearchGunsButton");
  EXPECT_EQ(Hint(), hint);
  Find<QRadioButton>(window, "Guns224").setChecked(true);
  Press("SearchGunsButton");
  EXPECT_EQ(Hint(), "");
}

TEST_P(StoppedRemote, AnnouncesItsHint) {
  guns = {159};
  const Announcements announced;
  Press("SearchGunsButton");
  EXPECT_THAT(announced.Heard(), ElementsAre(QStringLiteral("Hint")));
  Meanwhile(100, [this] { Press("Stop"); });
  Press("SearchGunsButton");
  EXPECT_THAT(announced.Heard(), ElementsAre(QStringLiteral("Hint"), QStringLiteral("Hint")));
}

TEST_P(StoppedRemote, HasAHintThatIsReadableOnLightAndDarkDesktops) {
  guns = {159};
  Press("SearchGunsButton");
  EXPECT_GE(PaintedContrast(Find<QLabel>(window, "Hint")), LeastContrast);
  const DarkDesktop dark;
  EXPECT_GE(PaintedContrast(Find<QLabel>(window, "Hint")), LeastContrast);
}

INSTANTIATE_TEST_SUITE_P(Languages, StoppedRemote,
                         testing::Values(Language::English, Language::SimplifiedChinese),
                         [](const auto& language) {
                           return language.param == Language::English ? "English" : "Chinese";
                         });

}  // namespace
