#include <gtest/gtest.h>

#include <QWheelEvent>

#include "tests/support/Venue.h"

namespace {

/// Where the keyboard's focus is in the main window, so that no stray key changes the game.
class CalmDesk : public testing::Test {
 protected:
  CalmDesk() { venue.Start(); }

  std::string Focus() const {
    const QWidget* focus = venue.Window->focusWidget();
    return focus != nullptr ? focus->objectName().toStdString() : std::string();
  }

  Venue venue;
};

TEST_F(CalmDesk, HasTheFocusOnTheBoardAtTheStart) {
  EXPECT_EQ(Focus(), "ScoreDisplay");
}

TEST_F(CalmDesk, GivesItBackToTheBoardAfterAPull) {
  venue.Press("GetScores");
  EXPECT_EQ(Focus(), "ScoreDisplay");
  const std::size_t boxes = venue.Boxes.Boxes.size();
  Type(*venue.Window, Qt::Key_Space);
  EXPECT_EQ(venue.Boxes.Boxes.size(), boxes) << "a stray Space pulls again";
}

TEST_F(CalmDesk, GivesItBackToTheBoardAfterTheChoiceOfAMission) {
  venue.ActiveMission().setFocus();
  QTest::keyClick(&venue.ActiveMission(), Qt::Key_Down);
  EXPECT_EQ(venue.ActiveMission().currentIndex(), 1);
  EXPECT_EQ(Focus(), "ScoreDisplay");
  venue.ActiveMission().setFocus();
  QTest::keyClick(&venue.ActiveMission(), Qt::Key_F);
  ASSERT_TRUE(venue.ActiveMission().view()->isVisible());
  QTest::keyClick(venue.ActiveMission().view(), Qt::Key_Return);
  EXPECT_EQ(Focus(), "ScoreDisplay");
}

TEST_F(CalmDesk, GivesItBackToTheBoardWhenTheListOfMissionsIsClosedWithoutAChoice) {
  venue.ActiveMission().setFocus();
  QTest::keyClick(&venue.ActiveMission(), Qt::Key_F);
  QTest::keyClick(venue.ActiveMission().view(), Qt::Key_Escape);
  EXPECT_TRUE(QTest::qWaitFor([this] { return Focus() == "ScoreDisplay"; }));
  EXPECT_EQ(venue.ActiveMission().currentIndex(), 0);
}

TEST_F(CalmDesk, KeepsTheMissionWhenTheWheelIsTurnedOverIt) {
  QComboBox& list = venue.ActiveMission();
  const QPointF middle(list.rect().center());
  for (const bool hasFocus : {false, true}) {
    if (hasFocus) {
      list.setFocus();
    }
    QWheelEvent wheel(middle, list.mapToGlobal(middle), {}, QPoint(0, -120), Qt::NoButton, Qt::NoModifier,
                      Qt::NoScrollPhase, false);
    QApplication::sendEvent(&list, &wheel);
    EXPECT_EQ(list.currentIndex(), 0);
  }
}

TEST_F(CalmDesk, GivesItBackToTheBoardAfterAMenuItem) {
  venue.Find<QPushButton>("RemoteManageButton").setFocus();
  venue.Trigger("mnuClearScores");
  EXPECT_EQ(Focus(), "ScoreDisplay");
}

TEST_F(CalmDesk, GivesItBackToTheBoardOnceAMenuThatWasOpenedMeanwhileIsClosed) {
  venue.Find<QPushButton>("GetScores").setFocus();
  auto& menu = venue.Find<QMenu>("mnuFile");
  menu.popup(QPoint(10, 10));
  venue.Trigger("mnuClearScores");
  ASSERT_TRUE(menu.isVisible());
  EXPECT_EQ(Focus(), "GetScores");
  QTest::keyClick(&menu, Qt::Key_Escape);
  EXPECT_TRUE(QTest::qWaitFor([this] { return Focus() == "ScoreDisplay"; }));
}

}  // namespace
