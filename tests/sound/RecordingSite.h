#pragma once

#include <gmock/gmock.h>

#include <string>
#include <vector>

#include "sound/PageIndexTable.h"
#include "sound/RecorderLink.h"
#include "sound/SoundRecording.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/sound/FakeRecorder.h"
#include "tests/sound/Waves.h"

inline constexpr const char* TimeOutText =
    "Timed out waiting for response from device. Check connections and retry";

/// Records what a job shows.
class FakeRecorderDisplay : public RecorderDisplay {
 public:
  std::vector<std::string> Statuses;
  std::vector<std::string> Statuses2;
  std::vector<std::size_t> Rows;
  int Pages = 0;

  void SetStatus(const std::string& text) override { Statuses.push_back(text); }
  void SetStatus2(const std::string& text) override { Statuses2.push_back(text); }
  void SelectRow(std::size_t row) override { Rows.push_back(row); }
  void PageBegins() override { ++Pages; }
};

/// A recorder on a line, and sounds for it.
class RecordingSite : public testing::Test {
 protected:
  RecordingSite() { port.Pump = &pump; }

  void Use(Recorder recorder) {
    mode = recorder;
    hardware.StandAlone = recorder == Recorder::StandAlone;
  }

  /// Rows with these files, whose contents are `bytes`.
  void Fill(const std::vector<std::pair<std::string, std::string>>& files) {
    list.Fill(std::vector<std::string>(files.size(), "Event"));
    for (std::size_t row = 0; row < files.size(); ++row) {
      const auto& [path, bytes] = files[row];
      if (!path.empty()) {
        disk.Put(path, bytes);
        list.AddSoundToList(path, row);
      }
    }
  }

  /// Records with a link of its own, as the window does.
  void Record() {
    table.Build(list, disk, wave);
    Work([this](RecorderLink& link) { SoundRecording({link, list, table, disk, wave, display}).Record(); });
  }
  void Test() {
    Work([this](RecorderLink& link) { TestSounds(link, list, display); });
  }
  void Work(const std::function<void(RecorderLink&)>& job) {
    RecorderLink link({port, pump, boxes, [this] { return mode; }, [this] { return stopped; }});
    link.Open("/dev/x");
    job(link);
    link.ThrowIfLineLost();
  }

  void ExpectTimeOuts(std::size_t count) {
    const FakeMessageBoxes::Box box{TimeOutText, "Tessarine", BoxIcon::Exclamation};
    EXPECT_THAT(boxes.Boxes, testing::ElementsAreArray(std::vector(count, box)));
  }

  FakeEventPump pump;
  FakeSerialPort port;
  FakeRecorder hardware{port, pump};
  FakeMessageBoxes boxes;
  FakeFiles disk;
  WaveFile wave{disk, boxes};
  SoundList list{disk, wave};
  PageIndexTable table;
  FakeRecorderDisplay display;
  Recorder mode = Recorder::StandAlone;
  bool stopped = false;
};
