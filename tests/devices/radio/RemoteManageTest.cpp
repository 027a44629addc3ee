#include "devices/radio/RemoteManage.h"

#include <gmock/gmock.h>

#include <QGroupBox>
#include <QRadioButton>

#include "tests/devices/radio/RemoteWindow.h"
#include "tests/support/CaredFor.h"
#include "tests/support/OnScreen.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::Pair;

TEST_P(RemoteWindow, OpensIdleAndEmpty) {
  EXPECT_EQ(window.windowTitle(), QStringLiteral("Remote Management"));
  EXPECT_EQ(TextOf("StatusLabel"), "Idle");
  EXPECT_EQ(TextOf("Label1"), "Players Found:");
  EXPECT_EQ(TextOf("PlayerCountLabel"), " 0");
  EXPECT_EQ(Find<QGroupBox>(window, "Frame1").title(), QStringLiteral("Max PlayerID"));
  EXPECT_TRUE(Find<QRadioButton>(window, "Guns128").isChecked());
  EXPECT_EQ(Find<QRadioButton>(window, "Guns128").text(), QStringLiteral("128"));
  EXPECT_EQ(Find<QRadioButton>(window, "Guns224").text(), QStringLiteral("224"));
  EXPECT_EQ(Find<QPushButton>(window, "SearchGunsButton").text(), QStringLiteral("Search for Guns"));
  EXPECT_EQ(Find<QPushButton>(window, "GetScoresButton").text(), QStringLiteral("Get Scores"));
  EXPECT_EQ(Find<QPushButton>(window, "Close").text(), QStringLiteral("Close"));
  EXPECT_EQ(List().rowCount(), 0);
  EXPECT_THAT(Port.Log, IsEmpty());
}

TEST_P(RemoteWindow, HasAColumnForEachThingAGunTells) {
  std::vector<std::string> headers;
  for (int column = 0; column < List().columnCount(); ++column) {
    headers.push_back(List().headerData(column, Qt::Horizontal).toString().toStdString());
  }
  EXPECT_THAT(headers,
              ElementsAre(Strings.Text(104), "Firmware Version", "Battery Level", "Weapon Type", "Status"));
}

TEST_P(RemoteWindow, SharesTheListsWidthAmongItsColumns) {
  window.resize(900, 600);
  QCoreApplication::processEvents();
  const auto& list = Find<QTableView>(window, "DataList");
  const int width = list.viewport()->width();
  for (int column = 0; column < 4; ++column) {
    EXPECT_EQ(list.columnWidth(column), width / 5);
  }
  EXPECT_EQ(list.columnWidth(4), static_cast<int>(width / 5.1));
}

TEST_P(RemoteWindow, CutsNoTextInSmallOrLargeLetters) {
  guns = {33, 159};
  silent = 33;
  for (const int points : {9, 14}) {
    const FontOfSize letters(points);
    RemoteManage sized({Port, Line, Events, Boxes, Time, Strings, game}, nullptr);
    sized.show();
    ::Press(sized, "SearchGunsButton");
    bool looked = false;
    Meanwhile(20, [&] {
      looked = true;
      const auto& list = Find<QTableView>(sized, "DataList");
      EXPECT_EQ(list.model()->index(0, 4).data().toString(), QStringLiteral("Scores In Progress"));
      for (int column = 0; column < 5; ++column) {
        EXPECT_LE(list.sizeHintForIndex(list.model()->index(0, column)).width(), list.columnWidth(column))
            << points << ' ' << column;
      }
      ExpectHeadersFit(sized);
    });
    ::Press(sized, "GetScoresButton");
    EXPECT_TRUE(looked);
  }
}

TEST_P(RemoteWindow, ShowsSmallerLettersInANarrowWindow) {
  const auto letters = [this] { return Find<QTableView>(window, "DataList").font().pointSizeF(); };
  window.resize(1300, 600);
  QCoreApplication::processEvents();
  const double wide = letters();
  EXPECT_DOUBLE_EQ(wide, 1.25 * window.font().pointSizeF());
  window.resize(window.minimumSizeHint().width(), 600);
  QCoreApplication::processEvents();
  EXPECT_LT(letters(), wide);
  EXPECT_GE(letters(), 0.85 * window.font().pointSizeF());
}

TEST_P(RemoteWindow, ListsTheGunsThatAnswer) {
  guns = {33, 40};
  Press("SearchGunsButton");
  ASSERT_EQ(List().rowCount(), 2);
  EXPECT_THAT(Row(0), ElementsAre(Red() + "  1", " 2. 5", " 85%", "Pistol 1", "Scores Pending"));
  EXPECT_THAT(Row(1), ElementsAre(Red() + "  8", " 2. 5", " 85%", "Pistol 1", "Scores Pending"));
  EXPECT_EQ(TextOf("PlayerCountLabel"), " 2");
  EXPECT_EQ(TextOf("StatusLabel"), "Idle");
}

TEST_P(RemoteWindow, TriesAsManyIdsAsAreChosen) {
  Press("SearchGunsButton");
  EXPECT_EQ(Frames.size(), 256U);
  Frames.clear();
  QTest::mouseClick(&Find<QRadioButton>(window, "Guns224"), Qt::LeftButton, {}, QPoint(8, 8));
  Press("SearchGunsButton");
  EXPECT_EQ(Frames.size(), 448U);
}

TEST_P(RemoteWindow, ListsNoGunAboveTheLargestIdThatWasTried) {
  OnPacket = [this](const Bytes& packet) {
    if (packet[1] == 40) {
      Arrive(3, Joined({Received(1, SearchAnswer(160)), Received(2, SearchAnswer(161))}));
    }
  };
  Press("SearchGunsButton");
  EXPECT_EQ(List().rowCount(), 1);
  EXPECT_EQ(TextOf("PlayerCountLabel"), " 2");
}

TEST_P(RemoteWindow, KeepsRowsInTheOrderOfIds) {
  OnPacket = [this](const Bytes& packet) {
    if (packet[1] == 40) {
      Arrive(3, Joined({Received(1, SearchAnswer(50)), Received(2, SearchAnswer(35)),
                        Received(3, SearchAnswer(42))}));
    }
  };
  Press("SearchGunsButton");
  EXPECT_THAT(Column(0), ElementsAre(Red() + "  3", Red() + "  10", Red() + "  18"));
}

TEST_P(RemoteWindow, EmptiesTheListAsASearchBegins) {
  guns = {33, 40};
  Press("SearchGunsButton");
  ASSERT_EQ(List().rowCount(), 2);
  guns = {};
  bool looked = false;
  Meanwhile(3, [&] {
    looked = true;
    EXPECT_EQ(List().rowCount(), 0);
  });
  Press("SearchGunsButton");
  EXPECT_TRUE(looked);
  EXPECT_EQ(List().rowCount(), 0);
}

TEST_P(RemoteWindow, ShowsHowASearchGoes) {
  guns = {33};
  int looks = 0;
  Meanwhile(131 * 12 - 3, [&] {
    ++looks;
    EXPECT_EQ(TextOf("StatusLabel"), "Searching...");
    EXPECT_EQ(TextOf("PlayerCountLabel"), " 1");
    EXPECT_EQ(TextOf("ProgressLabel"),
              GetParam() == Language::English ? "Pass 2 of 2, ID 35" : "第 2 轮，共 2 轮，ID 35");
    EXPECT_TRUE(Find<QLabel>(window, "ProgressLabel").isVisible());
    EXPECT_EQ(Find<QProgressBar>(window, "Progress").value(), 131);
    EXPECT_EQ(Find<QProgressBar>(window, "Progress").maximum(), 256);
    ASSERT_NE(QGuiApplication::overrideCursor(), nullptr);
    EXPECT_EQ(QGuiApplication::overrideCursor()->shape(), Qt::WaitCursor);
    EXPECT_TRUE(Find<QPushButton>(window, "SearchGunsButton").isEnabled());
    EXPECT_TRUE(Find<QPushButton>(window, "GetScoresButton").isEnabled());
  });
  Press("SearchGunsButton");
  EXPECT_EQ(looks, 1);
  ExpectUsable();
}

TEST_P(RemoteWindow, FetchesTheScoresOfTheListedGuns) {
  guns = {33, 40};
  silent = 40;
  Press("SearchGunsButton");
  bool looked = false;
  Meanwhile(500, [&] {
    looked = true;
    EXPECT_EQ(TextOf("StatusLabel"), "Getting Scores...");
    EXPECT_EQ(TextOf("ProgressLabel"), GetParam() == Language::English ? "Gun 2 of 2" : "第 2 支枪，共 2 支");
    EXPECT_THAT(Column(4), ElementsAre("Scores OK", "Scores In Progress"));
  });
  Press("GetScoresButton");
  EXPECT_TRUE(looked);
  EXPECT_THAT(Column(4), ElementsAre("Scores OK", "Scores Failed"));
  EXPECT_EQ(TextOf("StatusLabel"), "Done");
  EXPECT_TRUE(game.Players(2).Active);
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  ExpectUsable();
}

TEST_P(RemoteWindow, MarksFailedRowsAndShowsTheBattery) {
  guns = {33, 40, 41};
  silent = 40;
  Press("SearchGunsButton");
  Press("GetScoresButton");
  const auto background = [this](int row) {
    return List().index(row, 0).data(Qt::BackgroundRole).value<QColor>();
  };
  EXPECT_NE(background(0), background(1));
  EXPECT_EQ(background(0), background(2));
  for (const int column : {2, 4}) {
    EXPECT_FALSE(List().index(0, column).data(Qt::DecorationRole).value<QPixmap>().isNull());
  }
}

TEST_P(RemoteWindow, OfAnEmptyListIsDoneAtOnce) {
  Press("GetScoresButton");
  EXPECT_EQ(TextOf("StatusLabel"), "Done");
  EXPECT_THAT(Port.Log, ElementsAre("Open /dev/ttyS0 57600,N,8,1", "Close"));
  ExpectUsable();
}

TEST_P(RemoteWindow, IsDrivenByTheKeyboard) {
  window.activateWindow();
  ASSERT_TRUE(QTest::qWaitForWindowActive(&window));
  Find<QPushButton>(window, "GetScoresButton").setFocus();
  QTest::keyClick(&Find<QPushButton>(window, "GetScoresButton"), Qt::Key_Return);
  EXPECT_EQ(TextOf("StatusLabel"), "Done");
  Find<QRadioButton>(window, "Guns128").setFocus();
  QTest::keyClick(&Find<QRadioButton>(window, "Guns128"), Qt::Key_Right);
  EXPECT_TRUE(Find<QRadioButton>(window, "Guns224").isChecked());
  QTest::keyClick(&window, Qt::Key_Return);
  EXPECT_EQ(Frames.size(), 448U);
}

TEST_P(RemoteWindow, TellsOfHowManyGunsPresentTheScoresAreThere) {
  guns = {33, 40, 41};
  silent = 40;
  Press("SearchGunsButton");
  EXPECT_THAT(counts, IsEmpty());
  Press("GetScoresButton");
  EXPECT_THAT(counts, ElementsAre(Pair(0, 3), Pair(1, 3), Pair(1, 3), Pair(1, 3), Pair(1, 3), Pair(2, 3)));
  EXPECT_EQ(fetchesEnded, 1);
  counts.clear();
  silent = 0;
  Press("GetScoresButton");
  EXPECT_THAT(counts, ElementsAre(Pair(2, 3), Pair(3, 3)));
  EXPECT_EQ(fetchesEnded, 2);
}

TEST_P(RemoteWindow, TellsTheEndOfAFetchThatFails) {
  guns = {33};
  Press("SearchGunsButton");
  Port.FailNextOpen(8002);
  Press("GetScoresButton");
  EXPECT_EQ(fetchesEnded, 1);
  EXPECT_FALSE(Boxes.Boxes.empty());
}

TEST_P(RemoteWindow, IsCaredFor) {
  guns = {33, 40};
  Press("SearchGunsButton");
  ExpectCaredFor(window);
  Meanwhile(100, [this] { ExpectCaredFor(window); });
  Press("SearchGunsButton");
}

INSTANTIATE_TEST_SUITE_P(Languages, RemoteWindow,
                         testing::Values(Language::English, Language::SimplifiedChinese),
                         [](const auto& language) {
                           return language.param == Language::English ? "English" : "Chinese";
                         });

}  // namespace
