#include <gmock/gmock.h>

#include <QLabel>
#include <QLineEdit>
#include <QTimer>

#include "app/About.h"
#include "app/UploadProgress.h"
#include "devices/radio/RemoteManage.h"
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
    stepsTaken_ = 0;
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

  /// What the status line says; empty also when it is hidden.
  std::string Status() const {
    const auto& label = venue.Find<QLabel>("Status");
    EXPECT_EQ(label.isVisible(), !label.text().isEmpty());
    return label.text().toStdString();
  }

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

TEST_F(DownloadWait, GoesOnAfterEscapeInTheProgressWindow) {
  PressAndMeanwhile({[this] { QTest::keyClick(&Progress(), Qt::Key_Escape); }, [this] { SendFrame(); }});
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Red  1"));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  EXPECT_EQ(Status(), "");
  ExpectUnwound();
}

TEST_F(DownloadWait, EndsByTheStopButtonAndSaysSo) {
  PressAndMeanwhile({[this] {
                       venue.Port.Receive({2});
                       venue.Port.Receive(FrameOfRed1());
                     },
                     [this] { ::Press(Progress(), "Stop"); }});
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Red  1"));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  EXPECT_EQ(Status(), "Download stopped. Guns received: 1 of 2.");
  ExpectUnwound();
}

TEST_F(DownloadWait, AfterOneThatWasStoppedBeginsAnewAndCountsNoGunAgain) {
  PressAndMeanwhile({[this] {
                       venue.Port.Receive({2});
                       venue.Port.Receive(FrameOfRed1());
                     },
                     [this] { ::Press(Progress(), "Stop"); }});
  ASSERT_EQ(venue.Row("ScoreDisplay", 0)[5], " 258");
  PressAndMeanwhile({[this] {
    venue.Port.Receive({2});
    venue.Port.Receive(FrameOfRed1());
    venue.Port.Receive(FrameOfBlue0());
  }});
  EXPECT_THAT(venue.Column("ScoreDisplay", 5), ElementsAre(" 1", " 258"));
  EXPECT_EQ(Status(), "");
}

TEST_F(DownloadWait, AfterAClearedGameTakesNothingBack) {
  PressAndMeanwhile({[this] {
                       venue.Port.Receive({2});
                       venue.Port.Receive(FrameOfRed1());
                     },
                     [this] { ::Press(Progress(), "Stop"); }});
  venue.Trigger("mnuClearScores");
  EXPECT_EQ(Status(), "");
  PressAndMeanwhile({[this] { SendFrame(); }});
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[5], " 258");
}

TEST_F(DownloadWait, EndsWithoutABoxWhenTheRadioTakesTheLine) {
  const WhileModal<RemoteManage> remote([](RemoteManage& window) {
    ::Press(window, "GetScoresButton");
    ::Press(window, "Close");
  });
  PressAndMeanwhile({[this] { venue.Trigger("mnuRemoteManage"); }});
  EXPECT_EQ(remote.Runs(), 1);
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  EXPECT_EQ(Status(), "Download stopped. No data was received.");
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

TEST_F(DownloadWait, SwallowsASecondPressByButtonMenuAndKey) {
  const auto sees = [this](const std::function<void()>& press) {
    return [this, press] {
      Show(*venue.Window);
      press();
      EXPECT_TRUE(venue.Port.PortOpen());
      EXPECT_EQ(venue.Window->findChildren<UploadProgress*>().size(), 1);
    };
  };
  PressAndMeanwhile(
      {[this] {
         venue.Port.Receive({2});
         venue.Port.Receive(FrameOfRed1());
       },
       sees([this] { venue.Press("GetScores"); }), sees([this] { venue.Trigger("mnuGetKeshData"); }),
       sees([this] { Type(*venue.Window, Qt::Key_F5); }),
       sees([this] { Type(*venue.Window, Qt::Key_Space); }), [this] { venue.Port.Receive(FrameOfBlue0()); }});
  EXPECT_THAT(venue.Column("ScoreDisplay", 5), ElementsAre(" 1", " 258"));
  EXPECT_THAT(venue.Port.Sent, ElementsAre(1, 0, 170, 170));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  ExpectUnwound();
}

TEST_F(DownloadWait, SurvivesThreePressesAndTheEndOfTheProgram) {
  PressAndMeanwhile({[this] { venue.Press("GetScores"); }, [this] { venue.Trigger("mnuGetKeshData"); },
                     [this] { EXPECT_FALSE(venue.Window->close()); }});
  EXPECT_FALSE(venue.Window->isVisible());
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
