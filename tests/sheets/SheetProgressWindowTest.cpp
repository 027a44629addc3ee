#include "sheets/SheetProgressWindow.h"

#include <gtest/gtest.h>

#include <QGuiApplication>
#include <QLabel>
#include <QProgressBar>

#include "tests/support/Controls.h"

namespace {

class SheetRunWindow : public testing::Test {
 protected:
  SheetRunWindow() {
    window.Open();
    window.ShowSheet(3, 40, "Red 2-Ann Lee");
  }

  QString TextOf(const char* label) const { return Find<QLabel>(window, label).text(); }
  bool MayBeStopped() const { return Find<QPushButton>(window, "Stop").isEnabled(); }

  /// Expects a window that waits for the current sheet to end.
  void ExpectStopping() const {
    EXPECT_TRUE(window.Stopped());
    EXPECT_TRUE(window.isVisible());
    EXPECT_FALSE(MayBeStopped());
    EXPECT_EQ(TextOf("SheetLabel"), QStringLiteral("Stopping after this sheet..."));
  }

  StringTable strings{Language::English};
  SheetProgressWindow window{strings, nullptr};
  const QProgressBar& bar = Find<QProgressBar>(window, "Progress");
};

TEST_F(SheetRunWindow, ShowsTheSheetAndThePlayer) {
  EXPECT_EQ(window.windowTitle(), QStringLiteral("Print Status"));
  EXPECT_EQ(TextOf("SheetLabel"), QStringLiteral("Sheet 3 of 40"));
  EXPECT_EQ(TextOf("PlayerLabel"), QStringLiteral("Red 2-Ann Lee"));
  EXPECT_EQ(bar.maximum(), 40);
  EXPECT_EQ(bar.value(), 2);
  EXPECT_NE(QGuiApplication::overrideCursor(), nullptr);
  window.Close();
  EXPECT_FALSE(window.isVisible());
  EXPECT_EQ(QGuiApplication::overrideCursor(), nullptr);
}

TEST_F(SheetRunWindow, IsStoppedByItsButton) {
  Press(window, "Stop");
  ExpectStopping();
}

TEST_F(SheetRunWindow, IsStoppedByItsCloseBox) {
  window.close();
  ExpectStopping();
}

TEST_F(SheetRunWindow, IsNotStoppedByEscape) {
  QTest::keyClick(&window, Qt::Key_Escape);
  QTest::keyClick(&Find<QPushButton>(window, "Stop"), Qt::Key_Escape);
  QTest::keyClick(&window, Qt::Key_Return);
  EXPECT_FALSE(window.Stopped());
  EXPECT_TRUE(window.isVisible());
  EXPECT_TRUE(MayBeStopped());
  EXPECT_EQ(TextOf("SheetLabel"), QStringLiteral("Sheet 3 of 40"));
}

TEST_F(SheetRunWindow, KeepsSayingThatItStops) {
  Press(window, "Stop");
  window.ShowSheet(4, 40, "Red 3-Bo Ray");
  ExpectStopping();
  EXPECT_EQ(TextOf("PlayerLabel"), QStringLiteral("Red 3-Bo Ray"));
  window.Open();
  EXPECT_FALSE(window.Stopped());
  EXPECT_TRUE(MayBeStopped());
}

}  // namespace
