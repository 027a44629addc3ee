#include <gmock/gmock.h>

#include <QLabel>
#include <QLineEdit>
#include <QProgressBar>

#include "app/UploadProgress.h"
#include "settings/Settings.h"
#include "tests/support/Frames.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

using std::chrono::milliseconds;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

/// What the operator sees in the progress window.
struct Shown {
  bool Visible = false;
  std::string Status;
  int Value = -1;
  int Maximum = -1;
  std::string Index;

  bool operator==(const Shown&) const = default;
  friend std::ostream& operator<<(std::ostream& out, const Shown& shown) {
    return out << (shown.Visible ? "visible" : "hidden") << ", \"" << shown.Status << "\", " << shown.Value
               << " of " << shown.Maximum << ", \"" << shown.Index << '"';
  }
};

class Download : public testing::Test {
 protected:
  Download() {
    venue.Start();
    venue.Port.OnOutput = [this](std::uint8_t byte) { Answer(byte); };
  }

  /// The base unit: after the request the number of frames, and after each reply the next one.
  void Answer(std::uint8_t byte) {
    sawAtOutput.push_back(Progress());
    const bool requested = venue.Port.Sent.size() >= 2 && !answered && byte == 0;
    if (requested) {
      answered = true;
      venue.Port.Receive({static_cast<std::uint8_t>(frames.size())});
    }
    if ((requested || answered) && next < frames.size()) {
      venue.Port.Receive(frames[next++]);
    }
  }

  Shown Progress() const {
    const auto* window = venue.Window->findChild<UploadProgress*>();
    if (window == nullptr) {
      return {};
    }
    const auto& bar = ::Find<QProgressBar>(*window, "Progress");
    return {window->isVisible(), ::Find<QLabel>(*window, "StatusText").text().toStdString(), bar.value(),
            bar.maximum(), ::Find<QLabel>(*window, "UploadIndex").text().toStdString()};
  }

  std::vector<std::string> Texts() const {
    std::vector<std::string> texts;
    for (const auto& box : venue.Boxes.Boxes) {
      texts.push_back(box.Text);
    }
    return texts;
  }

  void ExpectUnwound() const {
    EXPECT_FALSE(venue.Port.PortOpen());
    EXPECT_EQ(venue.Window->findChild<UploadProgress*>(), nullptr);
    EXPECT_EQ(venue.RowCount("TeamScores"), 3);
  }

  Venue venue;
  std::vector<Bytes> frames = {FrameOfRed1()};
  std::size_t next = 0;
  bool answered = false;
  std::vector<Shown> sawAtOutput;
};

TEST_F(Download, FillsTheBoard) {
  frames = {FrameOfRed1(), FrameOfBlue0()};
  venue.Press("GetScores");
  EXPECT_THAT(venue.Port.Sent, ElementsAre(1, 0, 170, 170));
  EXPECT_EQ(venue.Port.Settings, "19200,N,8,1");
  EXPECT_EQ(venue.Port.Device, "/dev/ttyS0");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  // Blue 0 took nothing and dealt 260 to Red 1 with one shot of 20: 1300%.
  EXPECT_THAT(venue.Row("ScoreDisplay", 0),
              ElementsAre("1", "Blue  0", " 1558", "1300.00%", " 260", " 1", " 0", " 2", " 0"));
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Blue  0", "Red  1"));
  ExpectUnwound();
}

TEST_F(Download, StartsByTheMenuItem) {
  venue.Trigger("mnuGetKeshData");
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Red  1"));
  ExpectUnwound();
}

TEST_F(Download, StartsByItsKey) {
  venue.Find<QTableView>("ScoreDisplay").setFocus();
  Type(*venue.Window, Qt::Key_F5);
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Red  1"));
}

TEST_F(Download, StartsByTheSpaceBarOnItsButton) {
  venue.Find<QPushButton>("GetScores").setFocus();
  Type(*venue.Window, Qt::Key_Space);
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Red  1"));
}

TEST_F(Download, ShowsItsProgress) {
  frames = {FrameOfRed1(), FrameOfBlue0()};
  venue.Press("GetScores");
  const Shown requesting{true, "Requesting Data...", 0, 224, ""};
  EXPECT_THAT(sawAtOutput,
              ElementsAre(requesting, requesting, Shown{true, "Accepting Score Data...", 1, 2, "1"},
                          Shown{true, "Accepting Score Data...", 2, 2, "2"}));
}

TEST_F(Download, LeavesTheMainWindowInTheOperatorsHands) {
  bool blocked = true;
  venue.Events.At(milliseconds(700), [&] {
    blocked = QApplication::activeModalWidget() != nullptr || !venue.Window->isEnabled();
  });
  frames = {};
  venue.Port.OnOutput = nullptr;
  venue.Press("GetScores");
  EXPECT_FALSE(blocked);
}

TEST_F(Download, SaysWhenThereAreNoScores) {
  frames = {};
  bool hidden = false;
  venue.Boxes.WhileOpen = [&](const auto& /*box*/) { hidden = !Progress().Visible; };
  venue.Press("GetScores");
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(FakeMessageBoxes::Box{"Kesh has no score data.", "Tessarine",
                                                                   BoxIcon::Information, BoxButtons::Ok}));
  EXPECT_TRUE(hidden);
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 0);
  ExpectUnwound();
}

TEST_F(Download, SaysWhenNothingComesForFiveSeconds) {
  venue.Port.OnOutput = nullptr;
  venue.Press("GetScores");
  EXPECT_THAT(venue.Boxes.Boxes,
              ElementsAre(FakeMessageBoxes::Box{"Timed out waiting for Data. Please try again.", "Tessarine",
                                                BoxIcon::Exclamation, BoxButtons::Ok}));
  EXPECT_EQ(venue.Events.Now(), milliseconds(5020));
  ExpectUnwound();
}

TEST_F(Download, KeepsTheFramesBeforeATimeOut) {
  frames = {FrameOfRed1(), {46, 0, 41}};
  venue.Press("GetScores");
  EXPECT_THAT(Texts(), ElementsAre("Timed out waiting for Data. Please try again."));
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Red  1"));
  ExpectUnwound();
}

TEST_F(Download, LeavesOutAFrameWithAWrongCheckByte) {
  frames = {FrameOfRed1(), WithWrongCheckByte(FrameOfBlue0()), SecondFrameOfRed1()};
  Shown afterwards;
  venue.Events.OnSleep = [&](milliseconds time) {
    if (time == milliseconds(2000)) {
      afterwards = Progress();
    }
  };
  venue.Press("GetScores");
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(FakeMessageBoxes::Box{"Checksum failed", "Tessarine",
                                                                   BoxIcon::Critical, BoxButtons::Ok}));
  EXPECT_EQ(afterwards, (Shown{true, "Checksum failed!", 2, 3, "2"}));
  EXPECT_THAT(venue.Port.Sent, ElementsAre(1, 0, 170, 0, 170));
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Red  1"));
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[5], " 516");  // 258 shots in each of two frames
}

TEST_F(Download, AddsToTheLastOneUntilTheGameIsCleared) {
  const auto again = [this] {
    next = 0;
    answered = false;
    venue.Port.Sent.clear();
    venue.Press("GetScores");
    return venue.Row("ScoreDisplay", 0)[5];
  };
  EXPECT_EQ(again(), " 258");
  EXPECT_EQ(again(), " 516");
  venue.Trigger("mnuClearScores");
  EXPECT_EQ(again(), " 258");
}

TEST_F(Download, MakesAGameThatAChangeOfMissionScoresAnew) {
  venue.Press("GetScores");
  ASSERT_EQ(venue.Row("ScoreDisplay", 0)[4], "-5");  // hit itself
  venue.ActiveMission().setCurrentIndex(1);
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[4], " 5");
}

TEST_F(Download, DatesTheGame) {
  venue.Press("GetScores");
  venue.Dialog.Answers = {venue.Folder / "saved.xml"};
  venue.Trigger("mnuSaveScores");
  EXPECT_THAT(ReadFile(venue.Folder / "saved.xml"), HasSubstr("<GameDate>21/05/2013 14:30</GameDate>"));
}

TEST_F(Download, FindsTheMemberOfTheButton) {
  venue.ChangeDatabase("members.mdb",
                       "INSERT INTO Members (FirstName, LastName, DallasID) VALUES"
                       " ('Ada', 'Berg', '0807060504030201')");
  venue.Press("GetScores");
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Red  1"));  // members of the start only
  venue.Window.reset();
  next = 0;
  answered = false;
  venue.Port.Sent.clear();
  venue.Start();
  venue.Press("GetScores");
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Red  1: Ada Berg"));
}

TEST_F(Download, SaysOnTheStatusLineWhatIsMissing) {
  const auto status = [this] { return ::Find<QLabel>(*venue.Window, "Status").text().toStdString(); };
  frames = {FrameOfRed1(), WithWrongCheckByte(FrameOfBlue0())};
  venue.Press("GetScores");
  EXPECT_EQ(status(), "Download incomplete. Guns received: 1 of 2.");
  EXPECT_TRUE(::Find<QLabel>(*venue.Window, "Status").isVisible());
  venue.Port.OnOutput = nullptr;
  venue.Press("GetScores");
  EXPECT_EQ(status(), "Download failed. No data was received.");
  venue.LoadGame(SmallGame());
  EXPECT_EQ(status(), "");
  EXPECT_FALSE(::Find<QLabel>(*venue.Window, "Status").isVisible());
  Venue chinese(Language::SimplifiedChinese);
  chinese.Start();
  chinese.Press("GetScores");
  EXPECT_EQ(::Find<QLabel>(*chinese.Window, "Status").text(), QStringLiteral("下载失败。未收到数据。"));
}

class PortQuestion : public Download {
 protected:
  const FakeMessageBoxes::Box question{
      "Communications port could not be opened. Please select a valid port and press OK, or press Cancel to "
      "proceed with communications disabled.",
      "Comm Port Error", BoxIcon::Exclamation, BoxButtons::OkCancel};
};

TEST_F(PortQuestion, EndsTheDownloadOnCancelWithoutAnotherBox) {
  venue.Port.FailNextOpen(8002);
  venue.Boxes.Answers = {BoxAnswer::Cancel};
  venue.Press("GetScores");
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(question));
  EXPECT_THAT(venue.Port.Sent, IsEmpty());
  ExpectUnwound();
}

TEST_F(PortQuestion, LeadsToTheSettingsOnOkAndTriesTheNewNumber) {
  venue.Devices.Ports = {"/dev/ttyS0", "/dev/ttyUSB1"};
  venue.Port.FailNextOpen(8005);
  const WhileModal<Settings> operatorAtWork([](Settings& settings) {
    ::Find<QLineEdit>(settings, "CommPortNumber").setText(QStringLiteral("2"));
    ::Press(settings, "SaveExit");
  });
  venue.Press("GetScores");
  EXPECT_EQ(operatorAtWork.Runs(), 1);
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(question));
  EXPECT_EQ(venue.Port.Device, "/dev/ttyUSB1");
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Red  1"));
}

TEST_F(PortQuestion, ComesAgainWhileNoPortCanBeOpened) {
  venue.Devices.Ports.clear();
  int settingsShown = 0;
  const auto close = [&settingsShown](Settings& settings) {
    ++settingsShown;
    ::Press(settings, "Cancel");
  };
  std::vector<std::unique_ptr<WhileModal<Settings>>> operatorAtWork;
  venue.Boxes.WhileOpen = [&](const auto& /*box*/) {
    operatorAtWork.push_back(std::make_unique<WhileModal<Settings>>(close));
    venue.Boxes.Answers = {settingsShown < 2 ? BoxAnswer::Ok : BoxAnswer::Cancel};
  };
  venue.Press("GetScores");
  EXPECT_EQ(settingsShown, 2);
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(question, question, question));
  ExpectUnwound();
}

TEST_F(PortQuestion, IsAskedInChinese) {
  Venue chinese(Language::SimplifiedChinese);
  chinese.Start();
  chinese.Port.FailNextOpen(8002);
  chinese.Boxes.Answers = {BoxAnswer::Cancel};
  chinese.Press("GetScores");
  ASSERT_EQ(chinese.Boxes.Boxes.size(), 1u);
  EXPECT_EQ(chinese.Boxes.Boxes[0].Text, chinese.Strings.Text(121));
  EXPECT_EQ(chinese.Boxes.Boxes[0].Title, "通信端口错误");
}

}  // namespace
