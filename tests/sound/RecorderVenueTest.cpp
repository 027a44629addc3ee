#include <gmock/gmock.h>

#include <QComboBox>
#include <QLabel>
#include <QTimer>
#include <map>
#include <memory>
#include <optional>

#include "platform/linux/LinuxFiles.h"
#include "platform/qt/QtEventPump.h"
#include "platform/qt/QtSerialPort.h"
#include "sim/recorder/SoundRecorder.h"
#include "sound/ISD_rec.h"
#include "sound/SoundListView.h"
#include "tests/fakes/FakeEventPump.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/fakes/FakeSerialDevices.h"
#include "tests/fakes/FakeSoundConverter.h"
#include "tests/fakes/FakeSoundPlayer.h"
#include "tests/fakes/FakeWakeLock.h"
#include "tests/sound/Waves.h"
#include "tests/support/Bytes.h"
#include "tests/support/Controls.h"
#include "tests/support/TemporaryFolder.h"

// The window with its real line, event loop and files, and the simulated sound hardware. What is on the chip
// afterwards is compared with what the files say.

namespace {

using sim::RecorderFailure;
using std::chrono::milliseconds;
using testing::ElementsAre;
using testing::IsEmpty;
using Kind = sim::RecorderCommandKind;
using Sounds = std::map<std::uint8_t, Bytes>;

/// The real event loop, on request with short waits: the hardware here answers at once, never, or too late
/// for short and long ones alike.
class ShortWaits : public EventPump {
 public:
  bool Shortens = false;

  void EndWaits() override { events_.EndWaits(); }
  void DoEvents() override { events_.DoEvents(); }
  WaitResult WaitFor(const std::function<bool()>& condition, milliseconds limit) override {
    return events_.WaitFor(condition, Shortens ? Shorter(limit) : limit);
  }
  void Sleep(milliseconds time) override { events_.Sleep(time); }

 private:
  static milliseconds Shorter(milliseconds limit) {
    if (limit >= milliseconds(30'000)) {
      return milliseconds(1500);
    }
    return milliseconds(limit >= milliseconds(6000) ? 700 : 50);  // for an answer, or between sounds
  }

  QtEventPump events_;
};

/// Whole pages, a half to the even number, and the last of them silent.
Bytes OnChip(const std::string& samples) {
  std::size_t pages = samples.size() / 256;
  const std::size_t rest = samples.size() % 256;
  if (rest > 128 || (rest == 128 && pages % 2 == 1)) {
    ++pages;
  }
  Bytes bytes(samples.begin(), samples.end());
  bytes.resize(pages * 256);
  std::fill(bytes.end() - 256, bytes.end(), std::uint8_t{0x80});
  return bytes;
}

Bytes Joined(Bytes first, const Bytes& second) {
  first.insert(first.end(), second.begin(), second.end());
  return first;
}

class RecorderVenue : public testing::Test {
 protected:
  RecorderVenue() {
    WriteFile(folder / "sound_list_mainboard.xml",
              "<sound_defintions><sound_list_definition><sounds><sound_entry><name>Shot</name></sound_entry>"
              "<sound_entry><name>Hit</name></sound_entry><sound_entry><name>Reload</name></sound_entry>"
              "</sounds></sound_list_definition></sound_defintions>");
    WriteFile(folder / "tessarine.ini", "[comm]\ncommport=1\n");
    // A wave whose samples begin at byte 56, nothing, and raw samples.
    WriteFile(folder / "a.wav", Riff(Chunk("LIST", "abc") + FormatChunk() + Chunk("data", waveSamples)));
    WriteFile(folder / "c.raw", rawSamples);
  }

  void Open(sim::SoundRecorderSettings settings, ::Recorder recorder) {
    hardware.emplace(std::move(settings));
    devices.Ports = {hardware->DevicePath()};
    window = std::make_unique<ISD_rec>(ISD_rec::Parts{.MSComm1 = port,
                                                      .Ini = ini,
                                                      .Devices = devices,
                                                      .Events = events,
                                                      .Elapsed = time,
                                                      .Boxes = boxes,
                                                      .CD = dialog,
                                                      .Disk = disk,
                                                      .Player = player,
                                                      .Converter = converter,
                                                      .Awake = awake,
                                                      .Strings = strings,
                                                      .ProgramFolder = folder.Path()},
                                       nullptr);
    Show(*window);
    Find<QComboBox>(*window, "RecorderSelect").setCurrentIndex(static_cast<int>(recorder));
    SetSound(0, "a.wav");
    SetSound(2, "c.raw");
  }

  void SetSound(int row, const std::string& name) {
    Find<SoundListView>(*window, "SoundList").SelectRow(row);
    dialog.Answers = {folder / name};
    Press("SetSound");
  }

  void Press(const char* button) { ::Press(*window, button); }
  std::string TextOf(const char* label) const { return Find<QLabel>(*window, label).text().toStdString(); }

  /// Closes the window as soon as a status is shown.
  void CloseAt(const char* label, const std::string& status) {
    watch.disconnect();
    watch.callOnTimeout([this, label, status] {
      if (TextOf(label) == status) {
        watch.stop();
        Press("Close");
      }
    });
    watch.start(1);
  }

  const std::string waveSamples = Samples(700);
  const std::string rawSamples = Samples(400, 50);
  TemporaryFolder folder;
  LinuxFiles disk;
  IniReader ini{disk, folder / "tessarine.ini"};
  std::optional<sim::SoundRecorder> hardware;
  FakeSerialDevices devices;
  ShortWaits events;
  QtSerialPort port;
  FakeEventPump time;
  FakeMessageBoxes boxes;
  FakeFileDialog dialog;
  FakeSoundPlayer player{time};
  FakeSoundConverter converter;
  FakeWakeLock awake;
  StringTable strings{Language::English};
  QTimer watch;
  std::unique_ptr<ISD_rec> window;
};

TEST_F(RecorderVenue, RecordsStandAloneWhatTheFilesHold) {
  Open({}, ::Recorder::StandAlone);
  Press("RecordButton");
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_EQ(TextOf("StatusLabel"), "Recording Complete.");
  EXPECT_FALSE(port.PortOpen());
  const sim::SoundRecorderTraffic traffic = hardware->Traffic();
  EXPECT_EQ(traffic.Recordings, 1);
  EXPECT_EQ(traffic.Chip.Sounds(), (Sounds{{0, OnChip(waveSamples)}, {2, OnChip(rawSamples)}}));
  EXPECT_THAT(traffic.Commands,
              ElementsAre(sim::RecorderCommand{Kind::Start}, sim::RecorderCommand{Kind::Erase},
                          sim::RecorderCommand{Kind::Header, 0}, sim::RecorderCommand{Kind::Header, 2},
                          sim::RecorderCommand{Kind::End}));
  EXPECT_THAT(hardware->HostFaults(), IsEmpty());
}

TEST_F(RecorderVenue, RecordsInAProductWhatTheFilesHoldAndTheToldTable) {
  Open({}, ::Recorder::InProduct);
  Press("RecordButton");
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_EQ(TextOf("StatusLabel"), "Recording Complete.");
  const sim::SoundRecorderTraffic traffic = hardware->Traffic();
  EXPECT_EQ(traffic.Recordings, 1);
  // From page 1: (700 - 56) / 256 are 3 pages, as many again for the row without a file, and 2.
  Bytes table = {0, 1, 0, 4, 0, 7, 0, 9};
  table.resize(256);
  ASSERT_TRUE(traffic.Chip.IndexTable().has_value());
  EXPECT_EQ(Bytes(traffic.Chip.IndexTable()->begin(), traffic.Chip.IndexTable()->end()), table);
  EXPECT_EQ(traffic.Chip.AllPages(), Joined(OnChip(waveSamples), OnChip(rawSamples)));
  EXPECT_THAT(hardware->HostFaults(), IsEmpty());
}

TEST_F(RecorderVenue, PlaysEachSoundByItsNumberInEitherMode) {
  for (const ::Recorder recorder : {::Recorder::StandAlone, ::Recorder::InProduct}) {
    events.Shortens = true;
    Open({.LinePace = sim::Pace::Fast}, recorder);
    Press("Test");
    EXPECT_EQ(TextOf("StatusLabel"), "Testing complete.");
    EXPECT_THAT(hardware->Traffic().Commands,
                ElementsAre(sim::RecorderCommand{Kind::Play, 0}, sim::RecorderCommand{Kind::Play, 1},
                            sim::RecorderCommand{Kind::Play, 2}));
  }
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(RecorderVenue, EndsTheWaitForTheEraseWhenTheWindowCloses) {
  Open({.LinePace = sim::Pace::Fast, .EraseTime = milliseconds(60'000)}, ::Recorder::StandAlone);
  CloseAt("StatusLabel", "Erasing Flash...");
  Press("RecordButton");
  EXPECT_FALSE(window->isVisible());
  EXPECT_FALSE(port.PortOpen());
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(RecorderVenue, EndsARecordingInAPageWhenTheWindowCloses) {
  for (const ::Recorder recorder : {::Recorder::StandAlone, ::Recorder::InProduct}) {
    Open({.LinePace = sim::Pace::Fast}, recorder);
    CloseAt("Status2", "Sending Page Number:  1 of  2");
    Press("RecordButton");
    EXPECT_FALSE(window->isVisible());
    EXPECT_FALSE(port.PortOpen());
    EXPECT_THAT(boxes.Boxes, IsEmpty());
    EXPECT_EQ(hardware->Traffic().Recordings, 0);
  }
}

TEST_F(RecorderVenue, RecordsAnewAfterARecorderThatWasNotReady) {
  Open({.Failure = RecorderFailure::NoStartAnswer, .LinePace = sim::Pace::Fast}, ::Recorder::StandAlone);
  events.Shortens = true;
  Press("RecordButton");
  EXPECT_TRUE(port.PortOpen());
  window->close();
  Open({.LinePace = sim::Pace::Fast}, ::Recorder::StandAlone);
  Press("RecordButton");
  EXPECT_EQ(TextOf("StatusLabel"), "Recording Complete.");
  EXPECT_EQ(hardware->Traffic().Chip.Sounds().size(), 2U);
}

/// What a failure of the hardware comes to.
struct Outcome {
  int TimeOuts = 0;
  const char* Status = "Recording Complete.";
  std::size_t PagesOfWave = 3;
  std::size_t PagesOfRaw = 2;
  bool IsPulledOut = false;
};

constexpr Outcome Idle(int timeOuts) {
  return {timeOuts, "Idle", 0, 0};
}
constexpr Outcome Failed(int timeOuts, std::size_t pages) {
  return {timeOuts, "Recording Failed.", pages, 0};
}

Outcome OutcomeOf(RecorderFailure failure) {
  switch (failure) {
    case RecorderFailure::NoStartAnswer:
    case RecorderFailure::NoEraseAnswer:
    case RecorderFailure::NoEraseEnd:
    case RecorderFailure::SlowErase:
    case RecorderFailure::OtherAnswer:  // the end of the erase then passes for its answer
      return Idle(1);
    case RecorderFailure::NoTableAnswer:
      return Failed(2, 0);  // also none for the first sound
    case RecorderFailure::NoHeaderAnswer:
      return Failed(1, 0);
    case RecorderFailure::NoPageAnswer:
      return Failed(1, 2);  // page 2 is there, only its answer is not
    case RecorderFailure::RefusedPage:
    case RecorderFailure::LostByte:
      return Failed(1, 1);
    case RecorderFailure::NoEndAnswer:
    case RecorderFailure::NoPlayAnswer:
      return {.TimeOuts = 1};
    case RecorderFailure::UnpluggedInErase:
      return {.Status = "Idle", .PagesOfWave = 0, .PagesOfRaw = 0, .IsPulledOut = true};
    case RecorderFailure::UnpluggedInPage:
      return {.Status = "Recording Failed.", .PagesOfWave = 1, .PagesOfRaw = 0, .IsPulledOut = true};
    case RecorderFailure::None:
    case RecorderFailure::MergedEraseAnswers:
    case RecorderFailure::DoubleAnswer:
    case RecorderFailure::NoiseBeforeAnswer:
      return {};
  }
  return {};
}

class RecorderVenueWith : public RecorderVenue,
                          public testing::WithParamInterface<sim::RecorderFailureInfo> {};

INSTANTIATE_TEST_SUITE_P(Every, RecorderVenueWith, testing::ValuesIn(sim::RecorderFailures),
                         [](const testing::TestParamInfo<sim::RecorderFailureInfo>& failure) {
                           std::string name(failure.param.Name);
                           std::replace(name.begin(), name.end(), '-', '_');
                           return name;
                         });

TEST_P(RecorderVenueWith, EndsAsToldAndTheChipHoldsWhatCame) {
  const RecorderFailure failure = GetParam().Failure;
  const Outcome outcome = OutcomeOf(failure);
  events.Shortens = true;
  Open({.Failure = failure,
        .FailurePlace = 2,
        .LinePace = sim::Pace::Fast,
        .SlowEraseTime = milliseconds(60'000)},
       failure == RecorderFailure::NoTableAnswer ? ::Recorder::InProduct : ::Recorder::StandAlone);
  Press("RecordButton");
  EXPECT_EQ(TextOf("StatusLabel"), outcome.Status);
  EXPECT_EQ(port.PortOpen(), outcome.Status == std::string("Idle") && !outcome.IsPulledOut);
  if (failure == RecorderFailure::NoPlayAnswer) {
    Press("Test");
    EXPECT_EQ(TextOf("StatusLabel"), "Testing complete.");
  }
  const FakeMessageBoxes::Box timeOut{
      "Timed out waiting for response from device. Check connections and retry", "Tessarine",
      BoxIcon::Exclamation};
  const FakeMessageBoxes::Box pulledOut{"Run-time error '8012': The device is not open", "Tessarine",
                                        BoxIcon::Critical};
  std::vector<FakeMessageBoxes::Box> told(static_cast<std::size_t>(outcome.TimeOuts), timeOut);
  if (outcome.IsPulledOut) {
    told.push_back(pulledOut);
  }
  EXPECT_EQ(boxes.Boxes, told);
  Sounds held;
  const Bytes wave = OnChip(waveSamples);
  if (outcome.PagesOfWave > 0) {
    held[0] = Bytes(wave.begin(), wave.begin() + static_cast<std::ptrdiff_t>(outcome.PagesOfWave * 256));
  }
  if (outcome.PagesOfRaw > 0) {
    held[2] = OnChip(rawSamples);
  }
  EXPECT_EQ(hardware->Traffic().Chip.Sounds(), held);
}

}  // namespace
