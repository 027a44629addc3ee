#include <gmock/gmock.h>

#include "tests/devices/radio/RemoteWindow.h"

namespace {

using std::chrono::milliseconds;
using testing::ElementsAre;
using testing::IsEmpty;

TEST_P(RemoteWindow, NamesAnOverflowAndStaysUsable) {
  OnPacket = [this](const Bytes& packet) {
    if (packet[1] == 40) {
      Arrive(3, Received(1, SearchAnswer(31)));
    }
  };
  Boxes.WhileOpen = [this](const auto& /*box*/) {
    EXPECT_FALSE(Port.PortOpen());
    EXPECT_EQ(QGuiApplication::overrideCursor(), nullptr);
  };
  Press("SearchGunsButton");
  EXPECT_THAT(Boxes.Boxes, ElementsAre(FakeMessageBoxes::Box{"Run-time error '6': Overflow", "Tessarine",
                                                             BoxIcon::Critical, BoxButtons::Ok}));
  EXPECT_EQ(TextOf("StatusLabel"), "Idle");
  ExpectUsable();
}

TEST_P(RemoteWindow, NamesTheOverflowOfATotalOfZero) {
  guns = {33};
  Press("SearchGunsButton");
  OnPacket = [this](const Bytes&) { Arrive(3, Received(1, {4, 33, 0, 0, 5, 1, 0, 0, 0})); };
  Press("GetScoresButton");
  ASSERT_EQ(Boxes.Boxes.size(), 1U);
  EXPECT_EQ(Boxes.Boxes[0].Text, "Run-time error '6': Overflow");
  ExpectUsable();
}

TEST_P(RemoteWindow, TellsOnceThatTheLineDidNotOpen) {
  Port.FailNextOpen(8002);
  Press("SearchGunsButton");
  ASSERT_EQ(Boxes.Boxes.size(), 1U);
  EXPECT_EQ(Boxes.Boxes[0].Text, "Run-time error '8018': Operation valid only when the port is open");
  EXPECT_EQ(TextOf("StatusLabel"), "Idle");
  ExpectUsable();
}

TEST_P(RemoteWindow, TellsOnceThatTheLineWasLost) {
  guns = {33};
  Press("SearchGunsButton");
  OnPacket = [this](const Bytes&) { Port.Lose(); };
  Press("GetScoresButton");
  ASSERT_EQ(Boxes.Boxes.size(), 1U);
  EXPECT_EQ(Boxes.Boxes[0].Text, "Run-time error '8012': The device is not open");
  EXPECT_THAT(Column(4), ElementsAre("Scores Failed"));
  EXPECT_EQ(TextOf("StatusLabel"), "Done");
  ExpectUsable();
}

TEST_P(RemoteWindow, ClosedInMidSearchGoesOnceThatHasUnwound) {
  bool stillThere = false;
  Meanwhile(100, [&] {
    window.close();
    stillThere = window.isVisible();
  });
  Press("SearchGunsButton");
  EXPECT_TRUE(stillThere);
  EXPECT_FALSE(window.isVisible());
  EXPECT_EQ(Events.Now(), milliseconds(100));
  EXPECT_FALSE(Port.PortOpen());
  EXPECT_EQ(QGuiApplication::overrideCursor(), nullptr);
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

TEST_P(RemoteWindow, ClosedByItsButtonInMidFetchGoesOnceThatHasUnwound) {
  guns = {33, 40};
  silent = 33;
  Press("SearchGunsButton");
  const auto start = Events.Now();
  Meanwhile(3000, [&] { Press("Close"); });
  Press("GetScoresButton");
  EXPECT_FALSE(window.isVisible());
  EXPECT_EQ(Events.Now() - start, milliseconds(3000));
  EXPECT_FALSE(Port.PortOpen());
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

TEST_P(RemoteWindow, IsNotClosedByEscapeInMidRun) {
  guns = {33};
  Meanwhile(100, [&] { QTest::keyClick(&window, Qt::Key_Escape); });
  Meanwhile(2000, [&] { QTest::keyClick(&Find<QPushButton>(window, "Close"), Qt::Key_Escape); });
  Press("SearchGunsButton");
  EXPECT_TRUE(window.isVisible());
  EXPECT_EQ(Frames.size(), 256U);
  EXPECT_EQ(List().rowCount(), 1);
  ExpectUsable();
}

TEST_P(RemoteWindow, IsClosedByEscapeWhenIdle) {
  QTest::keyClick(&window, Qt::Key_Escape);
  EXPECT_FALSE(window.isVisible());
}

TEST_P(RemoteWindow, SearchedDuringAFetchEndsThatAndSearches) {
  guns = {33, 40};
  silent = 33;
  Press("SearchGunsButton");
  Frames.clear();
  Meanwhile(1000, [&] { Press("SearchGunsButton"); });
  Press("GetScoresButton");
  EXPECT_EQ(Frames.size(), 1U + 256U);
  EXPECT_THAT(Column(4), ElementsAre("Scores Pending", "Scores Pending"));
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  ExpectUsable();
}

TEST_P(RemoteWindow, FetchedDuringASearchEndsThatAndFetches) {
  guns = {33, 40};
  Meanwhile(50, [&] { Press("GetScoresButton"); });
  Press("SearchGunsButton");
  EXPECT_THAT(Column(0), ElementsAre(Red() + "  1"));
  EXPECT_THAT(Column(4), ElementsAre("Scores OK"));
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  ExpectUsable();
}

TEST_P(RemoteWindow, FetchedDuringAFetchLeavesTheFirstOnesGunFailed) {
  guns = {33, 40};
  silent = 33;
  Press("SearchGunsButton");
  Meanwhile(100, [&] { Press("GetScoresButton"); });
  Press("GetScoresButton");
  EXPECT_THAT(Column(4), ElementsAre("Scores Failed", "Scores OK"));
  EXPECT_EQ(game.Players(2).ShotCount, 258);
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  ExpectUsable();
}

TEST_P(RemoteWindow, SurvivesAnyButtonAtAnyTime) {
  guns = {33, 34, 40};
  silent = 34;
  Press("SearchGunsButton");
  int presses = 0;
  for (int time = 7; time < 9000; time += 613) {
    Meanwhile(time, [this, &presses, time] {
      ++presses;
      Press(time % 2 == 0 ? "SearchGunsButton" : "GetScoresButton");
    });
  }
  Press("GetScoresButton");
  Press("GetScoresButton");
  EXPECT_GT(presses, 5);
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  ExpectUsable();
}

TEST_P(RemoteWindow, ClosedInANestedRunGoesWhenAllHaveUnwound) {
  Meanwhile(100, [&] { Press("SearchGunsButton"); });
  Meanwhile(200, [&] { Press("SearchGunsButton"); });
  Meanwhile(300, [&] { window.close(); });
  Press("SearchGunsButton");
  EXPECT_FALSE(window.isVisible());
  EXPECT_EQ(Events.Now(), milliseconds(300));
  EXPECT_FALSE(Port.PortOpen());
  EXPECT_EQ(QGuiApplication::overrideCursor(), nullptr);
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

}  // namespace
