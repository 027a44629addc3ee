// The program itself on an X display, started again while it runs, and what the desktop hears of it.

#include "tests/app/RunningProgram.h"
#include "tests/support/X11Display.h"

namespace {

class DesktopOfProgram : public RunningProgram {
 protected:
  DesktopOfProgram() {
    environment.insert(QStringLiteral("DISPLAY"), QString::fromStdString(display.Name()));
    environment.insert(QStringLiteral("QT_QPA_PLATFORM"), QStringLiteral("xcb"));
    environment.remove(QStringLiteral("DESKTOP_STARTUP_ID"));
    environment.remove(QStringLiteral("XDG_ACTIVATION_TOKEN"));
  }
  void SetUp() override { ASSERT_TRUE(display.Works()); }

  X11Display display;
};

TEST_F(DesktopOfProgram, HearsThatASecondStartHasEnded) {
  Start();
  environment.insert(QStringLiteral("DESKTOP_STARTUP_ID"), QStringLiteral("files-7 \"a\\b\"_TIME1234567"));
  ASSERT_TRUE(QTest::qWaitFor([this] { return StartAgain() == 0; }, Limit));
  EXPECT_EQ(display.StartupNotices(), "|remove: ID=\"files-7 \\\"a\\\\b\\\"_TIME1234567\"");
}

TEST_F(DesktopOfProgram, HearsNothingOfAStartThatItDidNotMake) {
  Start();
  ASSERT_TRUE(QTest::qWaitFor([this] { return StartAgain() == 0; }, Limit));
  EXPECT_EQ(display.StartupNotices(), "");
}

TEST_F(DesktopOfProgram, DoesNotKeepASecondStartWhenItIsGone) {
  Start();
  environment.insert(QStringLiteral("DESKTOP_STARTUP_ID"), QStringLiteral("files-7"));
  environment.insert(QStringLiteral("DISPLAY"), QStringLiteral(":nowhere"));
  EXPECT_TRUE(QTest::qWaitFor([this] { return StartAgain() == 0; }, Limit));
  EXPECT_EQ(display.StartupNotices(), "");
}

}  // namespace
