#include <gmock/gmock.h>

#include <QLineEdit>
#include <QTimer>

#include "app/About.h"
#include "app/UploadProgress.h"
#include "settings/Settings.h"
#include "settings/SoldieringCalc.h"
#include "tests/support/Frames.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

// A download waits on the toolkit's own event loop, as in the program; what the operator does meanwhile are
// events in it.

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class DownloadWait : public testing::Test {
 protected:
  DownloadWait() { venue.Start(); }

  /// Presses GetScores and runs each step in a pass of its own of the wait for the first byte.
  void PressAndMeanwhile(std::vector<std::function<void()>> steps) {
    steps_ = std::move(steps);
    TakeNextStep();
    venue.Press("GetScores");
    EXPECT_EQ(stepsTaken_, steps_.size());
  }

  /// The base unit sends one frame at last.
  void SendFrame() {
    venue.Port.Receive({1});
    venue.Port.Receive(FrameOfRed1());
  }

  UploadProgress& Progress() const { return *venue.Window->findChild<UploadProgress*>(); }

  void ExpectUnwound() const {
    EXPECT_FALSE(venue.Port.PortOpen());
    EXPECT_EQ(venue.Window->findChild<UploadProgress*>(), nullptr);
  }

  std::vector<std::string> Texts() const {
    std::vector<std::string> texts;
    for (const auto& box : venue.Boxes.Boxes) {
      texts.push_back(box.Text);
    }
    return texts;
  }

  Venue venue{Language::English, Waits::Real};

 private:
  // Each step comes from a timer of its own: one that waits inside its step does not hold up the next.
  void TakeNextStep() {
    QTimer::singleShot(0, venue.Window.get(), [this] {
      if (!venue.Port.PortOpen()) {
        TakeNextStep();
      } else if (stepsTaken_ < steps_.size()) {
        TakeNextStep();
        steps_[stepsTaken_++]();
      }
    });
  }

  std::vector<std::function<void()>> steps_;
  std::size_t stepsTaken_ = 0;
};

TEST_F(DownloadWait, EndsWithTheFrame) {
  PressAndMeanwhile({[this] { SendFrame(); }});
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Red  1"));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  ExpectUnwound();
}

TEST_F(DownloadWait, EndsWhenTheProgressWindowIsClosed) {
  PressAndMeanwhile({[this] { EXPECT_TRUE(Progress().close()); }});
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  EXPECT_TRUE(venue.Window->isVisible());
  EXPECT_EQ(venue.RowCount("TeamScores"), 3);
  ExpectUnwound();
}

TEST_F(DownloadWait, EndsByEscapeInTheProgressWindow) {
  PressAndMeanwhile({[this] { QTest::keyClick(&Progress(), Qt::Key_Escape); }});
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  EXPECT_TRUE(venue.Window->isVisible());
  ExpectUnwound();
}

TEST_F(DownloadWait, OfACheckedFrameEndsWhenTheProgressWindowIsClosed) {
  PressAndMeanwhile({[this] {
                       venue.Port.Receive({2});
                       venue.Port.Receive(FrameOfRed1());
                     },
                     [this] { Progress().close(); }});
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Red  1"));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  ExpectUnwound();
}

TEST_F(DownloadWait, LetsTheMainWindowCloseOnceItHasUnwound) {
  bool closedAtOnce = true;
  bool stillVisible = false;
  PressAndMeanwhile({[&] {
    closedAtOnce = venue.Window->close();
    stillVisible = venue.Window->isVisible();
  }});
  EXPECT_FALSE(closedAtOnce);
  EXPECT_TRUE(stillVisible);
  EXPECT_FALSE(venue.Window->isVisible());
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  ExpectUnwound();
}

TEST_F(DownloadWait, LetsTheProgramEndByItsMenuItem) {
  PressAndMeanwhile({[this] { venue.Trigger("mnuExit"); }});
  EXPECT_FALSE(venue.Window->isVisible());
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  ExpectUnwound();
}

TEST_F(DownloadWait, AfterAWrongCheckByteLetsTheMainWindowClose) {
  venue.Boxes.WhileOpen = [this](const auto& /*box*/) { EXPECT_FALSE(venue.Window->close()); };
  PressAndMeanwhile({[this] {
    venue.Port.Receive({2});
    venue.Port.Receive(WithWrongCheckByte(FrameOfRed1()));
  }});
  EXPECT_THAT(Texts(), ElementsAre("Checksum failed"));
  EXPECT_FALSE(venue.Window->isVisible());
  ExpectUnwound();
}

TEST_F(DownloadWait, SurvivesASecondPress) {
  PressAndMeanwhile({[this] { venue.Press("GetScores"); }, [this] { SendFrame(); }});
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Red  1"));
  ExpectUnwound();
}

TEST_F(DownloadWait, SurvivesThreePressesAndTheEndOfTheProgram) {
  PressAndMeanwhile({[this] { venue.Press("GetScores"); }, [this] { venue.Trigger("mnuGetKeshData"); },
                     [this] { EXPECT_FALSE(venue.Window->close()); }});
  EXPECT_FALSE(venue.Window->isVisible());
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  ExpectUnwound();
}

TEST_F(DownloadWait, SurvivesThatTheOuterProgressWindowIsClosedFirst) {
  UploadProgress* outer = nullptr;
  PressAndMeanwhile({[&] {
                       outer = &Progress();
                       venue.Press("GetScores");
                     },
                     [&] { outer->close(); }, [this] { SendFrame(); }});
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Red  1"));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  ExpectUnwound();
}

TEST_F(DownloadWait, AllowsToLoadAndClearAGame) {
  int rowsOfLoaded = 0;
  PressAndMeanwhile({[&] {
                       venue.LoadGame(SmallGame());
                       rowsOfLoaded = venue.RowCount("ScoreDisplay");
                     },
                     [this] { venue.Trigger("mnuClearScores"); }, [this] { SendFrame(); }});
  EXPECT_EQ(rowsOfLoaded, 2);
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Red  1"));
  ExpectUnwound();
}

TEST_F(DownloadWait, AllowsToLookAround) {
  const WhileModal<About> about([](About& window) { ::Press(window, "OK"); });
  PressAndMeanwhile({[this] { venue.ActiveMission().setCurrentIndex(1); },
                     [this] { venue.Trigger("mnuAbout"); }, [this] { SendFrame(); }});
  EXPECT_EQ(about.Runs(), 1);
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[4], " 5");
  ExpectUnwound();
}

TEST_F(DownloadWait, AllowsToChangeTheFactors) {
  const WhileModal<SoldieringCalc> factors([](SoldieringCalc& window) {
    ::Find<QLineEdit>(window, "TotalDamage").setText(QStringLiteral("100"));
    ::Press(window, "SaveExit");
  });
  PressAndMeanwhile({[this] { venue.Trigger("mnuSoldieringCalc"); }, [this] { SendFrame(); }});
  EXPECT_EQ(factors.Runs(), 1);
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[4], "-5");
  EXPECT_LT(std::stoi(venue.Row("ScoreDisplay", 0)[2]), -400);
}

TEST_F(DownloadWait, AllowsToChooseAPortForTheNextTime) {
  venue.Devices.Ports = {"/dev/ttyS0", "/dev/ttyS1"};
  const WhileModal<Settings> settings([](Settings& window) {
    ::Find<QLineEdit>(window, "CommPortNumber").setText(QStringLiteral("2"));
    ::Press(window, "SaveExit");
  });
  PressAndMeanwhile({[this] { venue.Trigger("mnuCommPort"); }, [this] { SendFrame(); }});
  EXPECT_EQ(venue.Port.Device, "/dev/ttyS0");
  venue.Port.OnOutput = [this](std::uint8_t byte) {
    if (byte == 0) {
      venue.Port.Receive({0});
    }
  };
  venue.Press("GetScores");
  EXPECT_EQ(venue.Port.Device, "/dev/ttyS1");
}

TEST_F(DownloadWait, EndsWhileAnotherWindowIsOpenAndTheProgramCloses) {
  const WhileModal<About> about([this](About& window) {
    EXPECT_FALSE(venue.Window->close());
    EXPECT_TRUE(window.isVisible());
    ::Press(window, "OK");
  });
  PressAndMeanwhile({[this] { venue.Trigger("mnuAbout"); }});
  EXPECT_EQ(about.Runs(), 1);
  EXPECT_FALSE(venue.Window->isVisible());
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  ExpectUnwound();
}

TEST_F(DownloadWait, AllowsCommandsWhileABoxOfTheBoardIsOpen) {
  // The box tells in the middle of a calculation that the member is gone.
  int boxes = 0;
  venue.Boxes.WhileOpen = [&](const auto& /*box*/) {
    if (++boxes == 1) {
      venue.Trigger("mnuClearScores");
      venue.LoadGame(SmallGame());
    }
  };
  venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>99</MemberIndex>") + PlayerOf(2) +
                          PlayerOf(3, "<MemberIndex>98</MemberIndex>")));
  EXPECT_GE(boxes, 2);
  venue.ActiveMission().setCurrentIndex(1);
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Blue  7", "Red  0"));
}

}  // namespace
