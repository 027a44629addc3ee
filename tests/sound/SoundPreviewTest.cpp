#include "sound/SoundPreview.h"

#include "tests/fakes/FakeSoundPlayer.h"
#include "tests/sound/RecordingSite.h"

namespace {

using std::chrono::milliseconds;
using testing::ElementsAre;
using testing::IsEmpty;

class Previewed : public RecordingSite {
 protected:
  void PlayAll() {
    preview.PlayAll(list, display, [this] { return stopped; });
  }

  FakeSoundPlayer player{pump};
  SoundPreview preview{{disk, player, pump, boxes}};
};

TEST_F(Previewed, PlaysWavePcmAndRawAsTheChipWould) {
  Fill({{"/a.wav", Wave("\x10\x20\x30")}, {"/b.pcm", "\x01\x02"}, {"/c.raw", "\x03"}});
  PlayAll();
  EXPECT_THAT(player.Played,
              ElementsAre(FakeSoundPlayer::Sound{{0x10, 0x20, 0x30}, 22050},
                          FakeSoundPlayer::Sound{{1, 2}, 22050}, FakeSoundPlayer::Sound{{3}, 22050}));
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(Previewed, SelectsEachRowAndInTheEndTheFirst) {
  Fill({{"/a.raw", Samples(22050)}, {"/b.raw", Samples(44100)}});
  PlayAll();
  EXPECT_THAT(display.Rows, ElementsAre(0, 1, 0));
  EXPECT_EQ(pump.Now(), milliseconds(1000 + 1000 + 2000 + 1000));
  EXPECT_FALSE(player.Playing());
  EXPECT_EQ(player.Position(), milliseconds(0));
}

TEST_F(Previewed, TellsARowWithoutAFileAndGoesOn) {
  Fill({{"", ""}, {"/b.raw", Samples(10)}});
  PlayAll();
  EXPECT_THAT(boxes.Boxes,
              ElementsAre(FakeMessageBoxes::Box{"Error 53\nFile not found", "Tessarine", BoxIcon::None}));
  EXPECT_EQ(player.Played.size(), 1U);
}

TEST_F(Previewed, TellsEachFileThatDoesNotOpen) {
  Fill({{"/a.wav", "text"}, {"/gone.raw", ""}, {"/gone.wav", ""}});
  disk.Remove("/gone.wav");
  disk.Remove("/gone.raw");
  PlayAll();
  ASSERT_EQ(boxes.Boxes.size(), 3U);
  EXPECT_EQ(boxes.Boxes[0].Text, "Error 321\nNot a Wave file. /a.wav");
  EXPECT_EQ(boxes.Boxes[1].Text.substr(0, 9), "Error 53\n");
  EXPECT_EQ(boxes.Boxes[2].Text.substr(0, 9), "Error 53\n");
}

TEST_F(Previewed, TellsAMissingDeviceOnceAndEndsTheRun) {
  player.NoDevice = true;
  Fill({{"", ""}, {"/b.raw", Samples(10)}, {"/c.raw", Samples(10)}});
  PlayAll();
  ASSERT_EQ(boxes.Boxes.size(), 2U);
  EXPECT_EQ(boxes.Boxes[0].Text, "Error 53\nFile not found");
  EXPECT_EQ(boxes.Boxes[1].Text, "Error 68\nDevice unavailable");
  EXPECT_THAT(display.Rows, ElementsAre(0, 1, 0));
}

TEST_F(Previewed, NeedsNoDeviceForAnEmptySound) {
  player.NoDevice = true;
  Fill({{"/a.raw", ""}, {"/b.wav", Wave("")}});
  PlayAll();
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(Previewed, PlaysWhatACutWaveHolds) {
  Fill({{"/a.wav", Riff(FormatChunk() + "data" + Little(0xFFFFFFFF, 4) + "\x05\x06")}});
  PlayAll();
  EXPECT_THAT(player.Played, ElementsAre(FakeSoundPlayer::Sound{{5, 6}, 22050}));
}

TEST_F(Previewed, StopsAtOnceInASound) {
  Fill({{"/a.raw", Samples(220500)}, {"/b.raw", Samples(10)}});
  pump.At(milliseconds(500), [this] { stopped = true; });
  PlayAll();
  EXPECT_EQ(pump.Now(), milliseconds(500));
  EXPECT_FALSE(player.Playing());
  EXPECT_EQ(player.Played.size(), 1U);
}

TEST_F(Previewed, StopsAtOnceBetweenSounds) {
  Fill({{"/a.raw", Samples(22050)}, {"/b.raw", Samples(10)}});
  pump.At(milliseconds(1200), [this] { stopped = true; });
  PlayAll();
  EXPECT_EQ(pump.Now(), milliseconds(1200));
  EXPECT_EQ(player.Played.size(), 1U);
}

TEST_F(Previewed, OfOneRowReplacesASoundThatPlays) {
  disk.Put("/a.raw", Samples(22050));
  EXPECT_EQ(preview.PlayRow("/a.raw"), SoundPreview::Started::Yes);
  EXPECT_TRUE(player.Playing());
  EXPECT_EQ(preview.PlayRow("/none.raw"), SoundPreview::Started::NotThis);
  EXPECT_FALSE(player.Playing());
}

}  // namespace
