#include <QProgressBar>
#include <QTimer>
#include <functional>
#include <utility>

#include "tests/archive/copies/CopiesWindow.h"

namespace {

/// With copies so large that an operation takes many steps.
class LargeCopies : public BackupCopiesWindow {
 protected:
  LargeCopies() {
    OtherConnection(site.MembersFile()).Execute("UPDATE Members SET Photograph = zeroblob(40000000)");
    Open();
    boxes.Answers = {BoxAnswer::Ok};
  }

  /// Runs `act` as soon as progress is shown.
  void DuringTheJob(std::function<void()> act) {
    act_ = std::move(act);
    QObject::connect(&timer_, &QTimer::timeout, &timer_, [this] {
      if (Find<QProgressBar>(*window, "Progress").isVisible() && act_) {
        std::exchange(act_, nullptr)();
        ++acted;
      }
    });
    timer_.start(0);
  }

  int acted = 0;

 private:
  std::function<void()> act_;
  QTimer timer_;
};

TEST_F(LargeCopies, ShowProgressAndCanBeStopped) {
  DuringTheJob([this] {
    EXPECT_FALSE(Enabled("Restore"));
    EXPECT_FALSE(Enabled("CopyNow"));
    ::Press(*window, "Stop");
  });
  ::Press(*window, "Restore");
  EXPECT_EQ(acted, 1);
  EXPECT_EQ(Status(), QStringLiteral("Stopped. Nothing was changed."));
  EXPECT_EQ(site.Names(), "Ann Bob Cid");
  EXPECT_EQ(site.Disk.FileNames(site.CopyFolder()).size(), 2U);
  EXPECT_TRUE(Enabled("Restore"));
  EXPECT_EQ(reopened, 0);
}

TEST_F(LargeCopies, EndWithTheWindowThatIsClosed) {
  DuringTheJob([this] { window->close(); });
  ::Press(*window, "Restore");
  EXPECT_EQ(acted, 1);
  EXPECT_FALSE(window->isVisible());
  EXPECT_EQ(site.Names(), "Ann Bob Cid");
}

TEST_F(LargeCopies, LeaveEscapeWithoutEffectMeanwhile) {
  DuringTheJob([this] { Type(*window, Qt::Key_Escape); });
  ::Press(*window, "Restore");
  EXPECT_EQ(acted, 1);
  EXPECT_TRUE(window->isVisible());
  EXPECT_EQ(reopened, 1);
  Type(*window, Qt::Key_Escape);
  EXPECT_FALSE(window->isVisible());
}

}  // namespace
