#include "ui/PollTimer.h"

#include <gmock/gmock.h>

#include <QApplication>
#include <QDialog>
#include <QMessageBox>
#include <QWidget>

#include "platform/RuntimeError.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/Controls.h"
#include "tests/support/WhileModal.h"
#include "ui/Commands.h"

namespace {

constexpr int Interval = 5;

class PollTimerOfAWindow : public testing::Test {
 protected:
  PollTimerOfAWindow() { Show(window); }

  /// Serves events for a good many ticks.
  static void LetTimePass() {
    bool over = false;
    QTimer::singleShot(20 * Interval, QCoreApplication::instance(), [&] { over = true; });
    EXPECT_TRUE(QTest::qWaitFor([&] { return over; }));
  }

  void Await(int count) {
    EXPECT_TRUE(QTest::qWaitFor([this, count] { return ticks >= count; }));
  }

  int ticks = 0;
  std::function<void()> onTick = [] {};
  FakeMessageBoxes boxes;
  QDialog window;
  Commands commands{window, boxes};
  PollTimer* timer = new PollTimer(commands, Interval, [this] {
    ++ticks;
    onTick();
  });
};

TEST_F(PollTimerOfAWindow, TicksOnceItIsStarted) {
  LetTimePass();
  EXPECT_EQ(ticks, 0);
  timer->start();
  Await(3);
}

TEST_F(PollTimerOfAWindow, DoesNotTickUnderABoxAndGoesOnAfterwards) {
  timer->start();
  int before = -1;
  int after = -1;
  const WhileModal<QMessageBox> looking([&](QMessageBox& box) {
    before = ticks;
    LetTimePass();
    after = ticks;
    box.accept();
  });
  QMessageBox(&window).exec();
  ASSERT_EQ(looking.Runs(), 1);
  EXPECT_EQ(after, before);
  Await(after + 2);
}

TEST_F(PollTimerOfAWindow, TicksWhileItsWindowIsTheModalOne) {
  onTick = [this] {
    if (ticks == 3) {
      window.accept();
    }
  };
  timer->start();
  window.hide();
  window.exec();
  EXPECT_EQ(ticks, 3);
}

TEST_F(PollTimerOfAWindow, NeverTicksWithinATickEvenWhenThatStartsItAnew) {
  int depth = 0;
  int deepest = 0;
  onTick = [&] {
    ++depth;
    deepest = std::max(deepest, depth);
    if (ticks == 1) {
      timer->start();
      LetTimePass();
    }
    --depth;
  };
  timer->start();
  Await(3);
  EXPECT_EQ(deepest, 1);
}

TEST_F(PollTimerOfAWindow, ReportsAFailureAndTicksOn) {
  onTick = [this] {
    if (ticks == 1) {
      throw RuntimeError(6);
    }
  };
  timer->start();
  Await(2);
  ASSERT_EQ(boxes.Boxes.size(), 1U);
  EXPECT_EQ(boxes.Boxes[0].Text, "Run-time error '6': Overflow");
}

TEST_F(PollTimerOfAWindow, KeepsTheWindowUntilTheTickIsOver) {
  bool mayClose = true;
  onTick = [&] { mayClose = commands.MayClose(); };
  timer->start();
  Await(1);
  EXPECT_FALSE(mayClose);
  EXPECT_FALSE(window.isVisible());
}

TEST_F(PollTimerOfAWindow, GoesWithItsWindow) {
  auto other = std::make_unique<QWidget>();
  auto commandsOfOther = std::make_unique<Commands>(*other, boxes);
  const QPointer<PollTimer> itsTimer = new PollTimer(*commandsOfOther, Interval, [] {});
  other.reset();
  EXPECT_TRUE(itsTimer.isNull());
}

}  // namespace
