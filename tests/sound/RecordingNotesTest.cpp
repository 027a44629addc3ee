#include "sound/RecordingNotes.h"

#include <gmock/gmock.h>

#include "platform/RuntimeError.h"
#include "sound/RecordingTime.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/sound/Waves.h"

namespace {

using std::chrono::minutes;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

class Noted : public testing::Test {
 protected:
  void Fill(const std::vector<std::string>& files) {
    list.Fill(std::vector<std::string>(files.size(), "Event"));
    for (std::size_t row = 0; row < files.size(); ++row) {
      list.AddSoundToList(files[row], row);
    }
  }
  std::vector<std::string> Notes(Recorder recorder = Recorder::StandAlone) const {
    return RecordingNotes(list, disk, recorder, strings);
  }

  FakeFiles disk;
  FakeMessageBoxes boxes;
  WaveFile wave{disk, boxes};
  SoundList list{disk, wave};
  StringTable strings{Language::English};
};

TEST_F(Noted, IsNothingForSoundsThatFit) {
  disk.Put("/a.raw", Samples(1000));
  Fill({"", "/a.raw"});
  EXPECT_THAT(Notes(), IsEmpty());
  Fill({});
  EXPECT_THAT(Notes(), IsEmpty());
}

TEST_F(Noted, AreSoundsThatStopTheRecording) {
  disk.Put("/short.raw", std::string(128, 'x'));
  disk.Put("/text.wav", "text");
  disk.FailRead("/locked.raw", RuntimeError(Fault::PathAccess, "Path/File access error: /locked.raw"));
  Fill({"", "/short.raw", "/text.wav", "/gone.wav", "/locked.raw"});
  EXPECT_THAT(
      Notes(),
      ElementsAre(
          "Row 2: this sound is shorter than half a page, so the recording would stop here. /short.raw",
          "Row 3 cannot be recorded: Not a Wave file. /text.wav",
          "Row 4 cannot be recorded: Unable to open file. /gone.wav",
          "Row 5 cannot be recorded: Path/File access error: /locked.raw"));
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(Noted, IsAListThatTheChipDoesNotHold) {
  disk.Put("/a.raw", std::string(22050 * 91, 'x'));
  Fill({"/a.raw"});
  EXPECT_THAT(Notes(), ElementsAre("All sounds together take 91.00 seconds; the chip holds 90."));
}

TEST_F(Noted, IsATableThatDiffersFromWhatAProductGets) {
  disk.Put("/a.raw", Samples(1024));
  Fill({"", "/a.raw", "", "/a.raw"});
  EXPECT_THAT(
      Notes(Recorder::InProduct),
      ElementsAre(
          "From row 2 on, the page table differs from the pages that are sent: page 2 instead of 0."));
}

TEST_F(Noted, AreMoreRowsAndPagesThanTheTableHas) {
  Fill(std::vector<std::string>(130));
  EXPECT_THAT(Notes(), ElementsAre("The list has 130 rows, the page table has room for 128."));
  disk.Put("/a.wav", Riff(FormatChunk() + "data" + Little(0x7FFFFFFF, 4)));
  Fill({"/a.wav"});
  EXPECT_THAT(Notes().front(), HasSubstr("the page table ends at 32767"));
}

TEST_F(Noted, IsNeverAFault) {
  disk.Put("/a.wav", Riff(FormatChunk() + "data" + Little(0xFFFFFFFF, 4)));
  Fill(std::vector<std::string>(128, "/a.wav"));
  EXPECT_FALSE(Notes(Recorder::InProduct).empty());
}

TEST(RecordingTime, IsMinutesForAMinuteOfSound) {
  EXPECT_NEAR(std::chrono::duration<double>(RecordingTime(5168, Recorder::StandAlone)).count(), 7 * 60, 30);
  EXPECT_GE(RecordingTime(5168, Recorder::InProduct), minutes(31));
  EXPECT_LE(RecordingTime(5168, Recorder::InProduct), minutes(42));
}

}  // namespace
