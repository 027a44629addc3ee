#include <QProgressBar>
#include <QTest>

#include "platform/RuntimeError.h"
#include "sound/ISD_rec.h"
#include "tests/sound/SoundWindow.h"

namespace {

using std::chrono::milliseconds;
using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

class SoundJobs : public SoundWindow {
 protected:
  SoundJobs() { Open(); }

  void UseProduct() {
    Combo("RecorderSelect").setCurrentIndex(0);
    Hardware.StandAlone = false;
  }
};

TEST_F(SoundJobs, RecordTheSoundsAtTheSpeedOfTheRecorder) {
  SetSound(1, "/sounds/300.wav");
  Press("RecordButton");
  EXPECT_THAT(Hardware.Log, ElementsAre("start", "erase", "header 1", "pages 1", "data", "end"));
  EXPECT_EQ(Port.Log.front(), "Open /dev/ttyS1 115200,N,8,1");
  EXPECT_EQ(Port.Log.back(), "Close");
  EXPECT_EQ(TextOf("StatusLabel"), "Recording Complete.");
  EXPECT_EQ(TextOf("Status2"), "");
  EXPECT_EQ(List().SelectedRow(), 1);
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

TEST_F(SoundJobs, RecordInAProduct) {
  UseProduct();
  SetSound(0, "/sounds/400.raw");
  Press("RecordButton");
  EXPECT_THAT(Hardware.Log, ElementsAre("start", "erase", "data", "data", "data", "end"));
  EXPECT_EQ(Port.Log.front(), "Open /dev/ttyS1 19200,N,8,1");
}

TEST_F(SoundJobs, ShowEachStepInLabelsOfItsOwn) {
  SetSound(0, "/sounds/400.raw");
  std::vector<std::string> shown;
  Hardware.Acknowledges = [&](const std::string& what) {
    shown.push_back(what + ": " + TextOf("StatusLabel") + "|" + TextOf("Status2"));
    return true;
  };
  Press("RecordButton");
  EXPECT_THAT(shown,
              ElementsAre("start: Starting...|", "erase: Erasing Flash...|", "header 0: Erase complete.|",
                          "data: Programming File: /sounds/400.raw|Sending Page Number:  0 of  1",
                          "data: Programming File: /sounds/400.raw|Sending Page Number:  1 of  1",
                          "end: Idle|Sending Page Number:  1 of  1"));
}

TEST_F(SoundJobs, ReadThePortAtTheMomentOfUse) {
  Ini.WriteIni("comm", "commport", "1");
  Press("Test");
  EXPECT_EQ(Port.Device, "/dev/ttyS0");
}

TEST_F(SoundJobs, ReportAPortThatCannotBeOpenedAndStayIdle) {
  for (const int fault : {8002, 8005}) {
    Port.FailNextOpen(fault);
    Press("RecordButton");
    EXPECT_THAT(Boxes.Boxes.back().Text, HasSubstr("Run-time error '" + std::to_string(fault)));
    EXPECT_EQ(Boxes.Boxes.back().Icon, BoxIcon::Critical);
    EXPECT_EQ(TextOf("StatusLabel"), "Idle");
  }
  Ini.WriteIni("comm", "commport", "abc");
  Press("Test");
  EXPECT_THAT(Boxes.Boxes.back().Text, HasSubstr("Run-time error '13'"));
}

TEST_F(SoundJobs, LeaveTheLineOpenWithoutAnAnswerUntilTheWindowCloses) {
  Hardware.Acknowledges = [](const std::string&) { return false; };
  Press("RecordButton");
  EXPECT_THAT(BoxTexts(),
              ElementsAre("Timed out waiting for response from device. Check connections and retry"));
  EXPECT_EQ(Boxes.Boxes[0].Icon, BoxIcon::Exclamation);
  EXPECT_EQ(TextOf("StatusLabel"), "Idle");
  EXPECT_TRUE(Port.PortOpen());
  Press("Close");
  EXPECT_FALSE(Port.PortOpen());
}

TEST_F(SoundJobs, ChangeTheSpeedOfAnOpenLineAtOnce) {
  Hardware.Acknowledges = [](const std::string&) { return false; };
  Press("RecordButton");
  Combo("RecorderSelect").setCurrentIndex(0);
  EXPECT_EQ(Port.Settings, "19200,N,8,1");
  Combo("RecorderSelect").setCurrentIndex(1);
  EXPECT_EQ(Port.Settings, "115200,N,8,1");
  Press("Close");
  EXPECT_THAT(Port.Log, Contains("Settings 19200,N,8,1"));
}

TEST_F(SoundJobs, CloseAnOpenLineThatIsLostWhenItsSpeedChanges) {
  Hardware.Acknowledges = [](const std::string&) { return false; };
  Press("RecordButton");
  Boxes.Boxes.clear();
  Port.Lose();
  Combo("RecorderSelect").setCurrentIndex(0);
  EXPECT_THAT(BoxTexts(), ElementsAre("Run-time error '8012': The device is not open"));
  EXPECT_FALSE(Port.PortOpen());
  Combo("RecorderSelect").setCurrentIndex(1);
  EXPECT_EQ(Boxes.Boxes.size(), 1U);
}

TEST_F(SoundJobs, ReportALineThatIsLostWhenItsSpeedChangesMeanwhileOnce) {
  SetSound(0, "/sounds/400.raw");
  Events.At(milliseconds(500), [this] {
    Port.Lose();
    Combo("RecorderSelect").setCurrentIndex(0);
  });
  Press("RecordButton");
  EXPECT_THAT(BoxTexts(), ElementsAre("Run-time error '8012': The device is not open"));
  EXPECT_FALSE(Port.PortOpen());
  EXPECT_EQ(TextOf("StatusLabel"), "Idle");
}

TEST_F(SoundJobs, ChangeTheSpeedMeanwhile) {
  SetSound(0, "/sounds/400.raw");
  Hardware.Acknowledges = [this](const std::string& what) {
    if (what == "start") {
      Combo("RecorderSelect").setCurrentIndex(0);
      Hardware.StandAlone = false;
    }
    return true;
  };
  Press("RecordButton");
  EXPECT_THAT(Hardware.Log, ElementsAre("start", "erase", "data", "data", "data", "end"));
  EXPECT_EQ(Port.Settings, "19200,N,8,1");
  EXPECT_EQ(TextOf("StatusLabel"), "Recording Complete.");
}

TEST_F(SoundJobs, LeaveAClosedLineAlone) {
  Combo("RecorderSelect").setCurrentIndex(0);
  EXPECT_THAT(Port.Log, IsEmpty());
}

TEST_F(SoundJobs, EndSilentlyWhenTheWindowClosesInARecording) {
  SetSound(0, "/sounds/400.raw");
  Events.At(milliseconds(500), [this] { Window->close(); });
  Press("RecordButton");
  EXPECT_FALSE(Window->isVisible());
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  EXPECT_FALSE(Port.PortOpen());
  EXPECT_THAT(Hardware.Log, ElementsAre("start", "erase"));
}

TEST_F(SoundJobs, EndSilentlyByTheCloseButtonInAPage) {
  Disk.Put("/sounds/long.raw", Samples(100'000));
  SetSound(0, "/sounds/long.raw");
  Events.At(milliseconds(4000), [this] { Press("Close"); });
  Press("RecordButton");
  EXPECT_FALSE(Window->isVisible());
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  EXPECT_FALSE(Port.PortOpen());
  EXPECT_THAT(Hardware.Log, Not(Contains("end")));
  EXPECT_GT(Hardware.Data.size(), 5U);
}

TEST_F(SoundJobs, DoNothingOnEscapeAndOtherButtonsMeanwhile) {
  SetSound(0, "/sounds/400.raw");
  const auto dialogs = Dialog.Calls.size();
  Events.At(milliseconds(500), [this] {
    Type(*Window, Qt::Key_Escape);
    for (const char* button :
         {"RecordButton", "Test", "Preview", "SetSound", "OpenList", "SaveList", "ConvertSound"}) {
      Press(button);
    }
    List().setFocus();
    QTest::keyClick(&List(), Qt::Key_Return);
  });
  Press("RecordButton");
  EXPECT_TRUE(Window->isVisible());
  EXPECT_EQ(Dialog.Calls.size(), dialogs);
  EXPECT_THAT(Player.Played, IsEmpty());
  EXPECT_THAT(Hardware.Log, ElementsAre("start", "erase", "header 0", "pages 2", "data", "data", "end"));
}

TEST_F(SoundJobs, KeepTheirProductMeanwhile) {
  SetSound(0, "/sounds/400.raw");
  Events.At(milliseconds(500), [this] { Combo("ProductSelect").setCurrentIndex(1); });
  Press("RecordButton");
  EXPECT_EQ(Combo("ProductSelect").currentIndex(), 0);
  EXPECT_THAT(Column(0), ElementsAre("Shot", "Hit", "Reload"));
  EXPECT_EQ(TextOf("StatusLabel"), "Recording Complete.");
  Combo("ProductSelect").setCurrentIndex(1);
  EXPECT_THAT(Column(0), ElementsAre("Alarm", "Armed"));
}

TEST_F(SoundJobs, ReportALostLineOnceAndBeginAnewAfterwards) {
  SetSound(0, "/sounds/400.raw");
  Hardware.Acknowledges = [this](const std::string& what) {
    if (what == "data") {
      Port.Lose();
    }
    return true;
  };
  Press("RecordButton");
  EXPECT_THAT(BoxTexts(), ElementsAre("Run-time error '8012': The device is not open"));
  EXPECT_EQ(TextOf("StatusLabel"), "Recording Failed.");
  EXPECT_EQ(TextOf("Status2"), "");
  EXPECT_FALSE(Port.PortOpen());
}

TEST_F(SoundJobs, ReportASoundOfNoPagesAndCloseTheLine) {
  Disk.Put("/sounds/128.raw", std::string(128, 'x'));
  SetSound(0, "/sounds/128.raw");
  Press("RecordButton");
  EXPECT_THAT(BoxTexts(), ElementsAre("Run-time error '9': Subscript out of range"));
  EXPECT_FALSE(Port.PortOpen());
  EXPECT_THAT(Hardware.Log, ElementsAre("start", "erase"));
}

TEST_F(SoundJobs, FailAtASoundOfNoPagesBehindAnother) {
  Disk.Put("/sounds/128.raw", std::string(128, 'x'));
  SetSound(0, "/sounds/400.raw");
  SetSound(1, "/sounds/128.raw");
  Press("RecordButton");
  EXPECT_THAT(Hardware.Log, ElementsAre("start", "erase", "header 0", "pages 2", "data", "data"));
  EXPECT_EQ(TextOf("StatusLabel"), "Recording Failed.");
  EXPECT_EQ(TextOf("Status2"), "");
}

TEST_F(SoundJobs, ReportMoreThan128RowsBeforeTheLineIsOpened) {
  Disk.Put("/program/sound_list_maltrone.xml", Definition(std::vector<std::string>(130, "Event")));
  Combo("ProductSelect").setCurrentIndex(1);
  Press("RecordButton");
  EXPECT_THAT(BoxTexts(), ElementsAre("Run-time error '9': Subscript out of range"));
  EXPECT_THAT(Port.Log, IsEmpty());
}

TEST_F(SoundJobs, TestEverySound) {
  Press("Test");
  EXPECT_THAT(Hardware.Log, ElementsAre("play 0", "play 1", "play 2"));
  EXPECT_EQ(TextOf("StatusLabel"), "Testing complete.");
  EXPECT_FALSE(Port.PortOpen());
}

TEST_F(SoundJobs, PreviewAllSoundsAndStopByClose) {
  SetSound(0, "/sounds/300.wav");
  SetSound(1, "/sounds/400.raw");
  SetSound(2, "/sounds/300.wav");
  Press("Preview");
  EXPECT_EQ(Player.Played.size(), 3U);
  EXPECT_EQ(List().SelectedRow(), 0);
  Events.At(milliseconds(500), [this] { Press("Close"); });
  Press("Preview");
  EXPECT_EQ(Player.Played.size(), 4U);
  EXPECT_FALSE(Window->isVisible());
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

TEST_F(SoundJobs, PreviewWithoutADeviceSaysSoOnce) {
  SetSound(0, "/sounds/300.wav");
  SetSound(1, "/sounds/400.raw");
  Player.NoDevice = true;
  Press("Preview");
  EXPECT_THAT(BoxTexts(), ElementsAre("Error 68\nDevice unavailable"));
  EXPECT_EQ(List().SelectedRow(), 0);
}

TEST_F(SoundJobs, KeepTheComputerAwakeWhileTheyRecord) {
  int held = 0;
  Hardware.Acknowledges = [&](const std::string&) {
    held = Awake.Held;
    return true;
  };
  Press("RecordButton");
  EXPECT_EQ(held, 1);
  EXPECT_EQ(Awake.Held, 0);
  EXPECT_THAT(Awake.Reasons, ElementsAre("Recording sounds"));
}

TEST_F(SoundJobs, ShowTheirProgressAndTheTimeLeft) {
  Disk.Put("/sounds/long.raw", Samples(2'000'000));
  SetSound(0, "/sounds/long.raw");
  auto& progress = Find<QProgressBar>(*Window, "Progress");
  std::vector<int> values;
  std::set<std::string> times;
  Hardware.Acknowledges = [&](const std::string& what) {
    if (what == "data") {
      EXPECT_TRUE(progress.isVisible());
      values.push_back(progress.value());
      times.insert(TextOf("TimeLeft"));
    }
    return true;
  };
  EXPECT_FALSE(progress.isVisible());
  Press("RecordButton");
  EXPECT_TRUE(std::is_sorted(values.begin(), values.end()));
  EXPECT_GT(values.back(), progress.maximum() * 0.99);
  EXPECT_THAT(times, Contains("About 10 min left"));
  EXPECT_THAT(times, Contains("About 1 min left"));
  EXPECT_THAT(times, Contains("Less than a minute left"));
  EXPECT_FALSE(progress.isVisible());
}

}  // namespace
