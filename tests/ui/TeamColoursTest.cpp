#include "ui/TeamColours.h"

#include <gtest/gtest.h>

#include <QApplication>

#include "tests/support/Contrast.h"

namespace {

/// Ground and text of lists.
struct Desktop {
  QColor Base;
  QColor Text;
};

const Desktop Desktops[] = {{Qt::white, Qt::black},
                            {QColor(0xfcfcfc), QColor(0x232629)},
                            {Qt::black, Qt::white},
                            {QColor(0x1b1e20), QColor(0xfcfcfc)},
                            {QColor(0x2d2d2d), Qt::white}};

TEST(TeamTint, LeavesTextsReadableOnLightAndDarkDesktops) {
  for (const auto& [base, text] : Desktops) {
    for (const int team : {1, 2, 3}) {
      for (const double share : {RowTint, SelectedRowTint}) {
        EXPECT_GE(Contrast(text.rgb(), TeamTint(team, base, share).rgb()), LeastContrast)
            << base.name().toStdString() << ", team " << team << ", " << share;
      }
    }
  }
}

TEST(TeamBadge, IsSeenOnRowsOfItsOwnColour) {
  const QPalette before = QApplication::palette();
  for (const Desktop& desktop : Desktops) {
    QPalette palette = before;
    palette.setColor(QPalette::Base, desktop.Base);
    QApplication::setPalette(palette);
    for (const int team : {1, 2, 3}) {
      constexpr int edge = 6;
      const QColor ring = TeamBadge(team).pixmap(QSize(64, 64), 1).toImage().pixelColor(edge, 32);
      for (const double share : {RowTint, SelectedRowTint}) {
        EXPECT_GE(Contrast(ring.rgb(), TeamTint(team, desktop.Base, share).rgb()), LeastContrast)
            << desktop.Base.name().toStdString() << ", team " << team << ", " << share;
      }
    }
  }
  QApplication::setPalette(before);
}

TEST(TeamBadge, IsSeenOnTheSelectionOfTheToolkit) {
  for (const int team : {1, 2, 3}) {
    const auto colourAt = [team](QIcon::Mode mode, int x) {
      return TeamBadge(team).pixmap(QSize(64, 64), 1, mode).toImage().pixelColor(x, 32);
    };
    constexpr int ring = 6;
    constexpr int middle = 32;
    EXPECT_EQ(colourAt(QIcon::Normal, middle), TeamColour(team));
    EXPECT_EQ(colourAt(QIcon::Selected, middle), TeamColour(team));
    EXPECT_GT(colourAt(QIcon::Selected, ring).lightness(), 240);
    EXPECT_LT(colourAt(QIcon::Normal, ring).lightness(), 140);
  }
}

TEST(TeamBadge, KeepsItsProportionsInAWiderPlace) {
  EXPECT_EQ(TeamBadge(1).actualSize(QSize(28, 14)), QSize(14, 14));
}

TEST(TeamBadge, HasAShapeOfItsOwnForEachTeam) {
  const auto ink = [](int team, int x, int y) {
    return TeamBadge(team).pixmap(QSize(64, 64), 1).toImage().pixelColor(x, y).alpha() > 200;
  };
  constexpr int nearEdge = 9;
  // A circle has no corners, a square four, a triangle with its base at the left two.
  EXPECT_FALSE(ink(1, nearEdge, nearEdge));
  EXPECT_TRUE(ink(1, 64 - nearEdge, 32));
  EXPECT_TRUE(ink(2, nearEdge, nearEdge));
  EXPECT_TRUE(ink(2, 64 - nearEdge, 64 - nearEdge));
  EXPECT_TRUE(ink(3, nearEdge, nearEdge + 2));
  EXPECT_TRUE(ink(3, nearEdge, 64 - nearEdge - 2));
  EXPECT_FALSE(ink(3, 64 - nearEdge, 64 - nearEdge));
  EXPECT_FALSE(ink(3, 64 - nearEdge, nearEdge));
}

TEST(TeamBadge, KeepsItsShapeInAWideRoom) {
  for (const int team : {1, 2, 3}) {
    const QImage wide = TeamBadge(team).pixmap(QSize(128, 64), 1).toImage();
    const QImage square = TeamBadge(team).pixmap(QSize(64, 64), 1).toImage();
    ASSERT_EQ(wide.size(), QSize(128, 64));
    EXPECT_EQ(wide.copy(32, 0, 64, 64), square) << team;
    EXPECT_EQ(wide.pixelColor(16, 32).alpha(), 0) << team;
  }
}

}  // namespace
