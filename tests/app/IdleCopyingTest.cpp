#include "app/IdleCopying.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QKeyEvent>
#include <QTest>

#include "tests/fakes/FakeEventPump.h"

namespace {

using std::chrono::milliseconds;
using std::chrono::seconds;

class CopyingWhileIdle : public testing::Test {
 protected:
  void Wait(milliseconds time) { pump.Pass(time); }
  void PressAKey() {
    QKeyEvent key(QEvent::KeyPress, Qt::Key_A, Qt::NoModifier);
    QCoreApplication::sendEvent(&window, &key);
  }

  FakeEventPump pump;
  int stepsLeft = 3;
  int steps = 0;
  bool busy = false;
  QObject window;
  IdleCopying copying{{.DoAPart =
                           [this] {
                             ++steps;
                             return --stepsLeft > 0;
                           },
                       .Busy = [this] { return busy; },
                       .Elapsed = pump}};
};

TEST_F(CopyingWhileIdle, GoesStepByStepAndThenRests) {
  Wait(seconds(60));
  EXPECT_LE(copying.Look(), milliseconds(50));
  EXPECT_LE(copying.Look(), milliseconds(50));
  EXPECT_GE(copying.Look(), std::chrono::minutes(1));
  EXPECT_EQ(steps, 3);
}

TEST_F(CopyingWhileIdle, WaitsUntilTheOperatorHasBeenQuietForAWhile) {
  Wait(seconds(60));
  PressAKey();
  EXPECT_GE(copying.Look(), milliseconds(500));
  Wait(seconds(4));
  copying.Look();
  EXPECT_EQ(steps, 0);
  Wait(seconds(1));
  copying.Look();
  EXPECT_EQ(steps, 1);
  PressAKey();
  copying.Look();
  EXPECT_EQ(steps, 1);
}

TEST_F(CopyingWhileIdle, WaitsForCommandsAndWindows) {
  Wait(seconds(60));
  busy = true;
  copying.Look();
  EXPECT_EQ(steps, 0);
  busy = false;
  copying.Look();
  EXPECT_EQ(steps, 1);
}

TEST_F(CopyingWhileIdle, NeedNotWaitForTheNextLookWhenThereMayBeSomethingToDo) {
  Wait(seconds(60));
  copying.LookSoon();
  EXPECT_TRUE(QTest::qWaitFor([this] { return steps == 3; }, 20'000));
}

}  // namespace
