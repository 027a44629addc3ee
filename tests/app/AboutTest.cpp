#include "app/About.h"

#include <gtest/gtest.h>

#include <QLabel>

#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

TEST(AboutWindow, ShowsTheVersion) {
  About window(nullptr);
  EXPECT_EQ(window.windowTitle(), QStringLiteral("Tessarine by Orvalin"));
  QLabel& version = Find<QLabel>(window, "VersionInfo");
  EXPECT_EQ(version.text(), QStringLiteral("3.54 21-5-2013"));
  int labels = 0;
  for (const QLabel* label : window.findChildren<QLabel*>()) {
    if (label->buddy() == &version) {
      ++labels;
      EXPECT_EQ(label->text(), QStringLiteral("Version:"));
    }
  }
  EXPECT_EQ(labels, 1);
}

TEST(AboutWindow, IsClosedByOk) {
  About window(nullptr);
  Show(window);
  Press(window, "OK");
  EXPECT_FALSE(window.isVisible());
}

TEST(AboutWindow, IsClosedByReturnAndEscape) {
  for (const Qt::Key key : {Qt::Key_Return, Qt::Key_Escape}) {
    About window(nullptr);
    Show(window);
    Type(window, key);
    EXPECT_FALSE(window.isVisible());
  }
}

TEST(AboutCommand, OpensTheWindowInFrontOfTheMainWindow) {
  Venue venue;
  venue.Start();
  const WhileModal<About> operatorAtWork([&venue](About& window) {
    EXPECT_EQ(window.parentWidget(), venue.Window.get());
    Press(window, "OK");
  });
  venue.Trigger("mnuAbout");
  EXPECT_EQ(operatorAtWork.Runs(), 1);
  EXPECT_EQ(venue.Window->findChild<About*>(), nullptr);
}

}  // namespace
