#include "ui/WindowPlaces.h"

#include <gtest/gtest.h>

#include "board/AdminData.h"
#include "tests/support/OnScreen.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

class RememberedWindow : public testing::Test {
 protected:
  /// Starts on the screen of this name in Screens.json.
  QWidget& StartOn(const char* screen) {
    venue.PutDefaultFiles();
    venue.Window.reset();
    venue.MakeWindow().setScreen(&ScreenNamed(screen));
    venue.Window->move(ScreenNamed(screen).geometry().topLeft() + QPoint(20, 20));
    venue.Window->FormLoad();
    Show(*venue.Window);
    return *venue.Window;
  }

  bool Maximised() const { return venue.Window->windowState().testFlag(Qt::WindowMaximized); }

  Venue venue;
};

TEST_F(RememberedWindow, ComesBackWhereItWas) {
  StartOn("recommended or better").setGeometry(60, 70, 1100, 740);
  venue.Window->close();
  EXPECT_EQ(StartOn("recommended or better").geometry(), QRect(60, 70, 1100, 740));
}

TEST_F(RememberedWindow, ComesBackMaximised) {
  StartOn("recommended or better").setGeometry(60, 70, 1100, 740);
  venue.Window->showMaximized();
  venue.Window->close();
  StartOn("recommended or better");
  EXPECT_TRUE(Maximised());
  venue.Window->showNormal();
  EXPECT_TRUE(QTest::qWaitFor([this] { return venue.Window->size() == QSize(1100, 740); }));
  venue.Window->close();
  StartOn("recommended or better");
  EXPECT_FALSE(Maximised());
  EXPECT_EQ(venue.Window->size(), QSize(1100, 740));
}

TEST_F(RememberedWindow, StartsMaximisedOnALaptopUntilTheOperatorGivesItAPlace) {
  StartOn("laptop");
  EXPECT_TRUE(Maximised());
  venue.Window->showNormal();
  venue.Window->setGeometry(ScreenNamed("laptop").geometry().adjusted(100, 40, -100, -40));
  venue.Window->close();
  StartOn("laptop");
  EXPECT_FALSE(Maximised());
  EXPECT_TRUE(ScreenNamed("laptop").geometry().contains(venue.Window->geometry()));
}

TEST_F(RememberedWindow, StartsAsEverOnTheRecommendedScreenAndBelow) {
  for (const char* screen : {"as recommended", "too small", "too low"}) {
    WriteFile(venue.DataFile("state.ini"), "[windows]\nfrmRx=1300,10,500,400\n");
    StartOn(screen);
    EXPECT_TRUE(Maximised()) << screen;
  }
}

TEST_F(RememberedWindow, OfADialogComesBackToo) {
  StartOn("recommended or better");
  const WhileModal<AdminData> moved([](AdminData& window) {
    Show(window);
    window.setGeometry(31, 47, 600, 500);
    window.close();
  });
  venue.Trigger("mnuAdminData");
  const WhileModal<AdminData> again([](AdminData& window) {
    EXPECT_EQ(window.geometry(), QRect(31, 47, 600, 500));
    window.close();
  });
  venue.Trigger("mnuAdminData");
  EXPECT_EQ(again.Runs(), 1);
}

}  // namespace
