#include <gmock/gmock.h>

#include <filesystem>
#include <sstream>

#include "sim/recorder/SoundRecorder.h"
#include "tests/sim/recorder/RecorderHost.h"
#include "tests/support/TemporaryFolder.h"

namespace sim {
namespace {

using testing::HasSubstr;

TEST(SoundRecorder, KeepsEachRecordingAsFilesBeforeItAnswersTheEnd) {
  const TemporaryFolder folder;
  SoundRecorderSettings settings = Quick();
  settings.Files.emplace(folder.Path());
  SoundRecorder recorder(settings);
  {
    RecorderHost host(recorder.DevicePath(), Gun);
    RecordTwoInProduct(host);
  }
  EXPECT_EQ(ReadFile(folder / "recording-1/table.bin"), std::string(TableOfTwo.begin(), TableOfTwo.end()));
  EXPECT_EQ(ReadFile(folder / "recording-1/sound-001.wav").substr(44), std::string(256, '\x80'));
  RecorderHost host(recorder.DevicePath(), Alone);
  RecordTwoStandAlone(host);
  EXPECT_EQ(ReadFile(folder / "recording-2/sound-009.wav").substr(44), std::string(256, '\x80'));
}

TEST(SoundRecorder, KeepsWhatCameOfARecordingThatWasBrokenOff) {
  const TemporaryFolder folder;
  {
    SoundRecorderSettings settings = Quick();
    settings.Files.emplace(folder.Path());
    SoundRecorder recorder(settings);
    RecorderHost host(recorder.DevicePath(), Alone);
    BeginStandAlone(host);
    EXPECT_EQ(host.Ask({1, 0}), Ack);
    EXPECT_EQ(host.Ask(Bytes{2, 0} + RisingPage + Bytes{RisingCheck}), Ack);
  }
  EXPECT_EQ(ReadFile(folder / "recording-1/sound-000.wav").substr(44),
            std::string(RisingPage.begin(), RisingPage.end()));
}

TEST(SoundRecorder, KeepsNothingOfARecordingThatBroughtNothing) {
  const TemporaryFolder folder;
  {
    SoundRecorderSettings settings = Quick();
    settings.Files.emplace(folder.Path());
    SoundRecorder recorder(settings);
    RecorderHost host(recorder.DevicePath(), Alone);
    BeginStandAlone(host);
  }
  EXPECT_TRUE(std::filesystem::is_empty(folder.Path()));
}

TEST(SoundRecorder, GoesOnWhenItCannotKeepARecording) {
  const TemporaryFolder folder;
  std::ostringstream log;
  {
    SoundRecorderSettings settings = Quick();
    settings.Log = &log;
    settings.Files.emplace(folder / "gone");
    std::filesystem::remove(folder / "gone");
    SoundRecorder recorder(settings);
    RecorderHost host(recorder.DevicePath(), Alone);
    RecordTwoStandAlone(host);
  }
  EXPECT_THAT(log.str(), HasSubstr("recorder -- not kept: "));
}

}  // namespace
}  // namespace sim
