#include "sound/PageIndexTable.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/sound/Waves.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;

class Table : public testing::Test {
 protected:
  void Fill(const std::vector<std::string>& files) {
    list.Fill(std::vector<std::string>(files.size(), "Event"));
    for (std::size_t row = 0; row < files.size(); ++row) {
      list.AddSoundToList(files[row], row);
    }
  }
  void Build() { table.Build(list, disk, wave); }
  std::vector<int> Entries(std::size_t count) const {
    std::vector<int> entries;
    for (std::size_t i = 0; i < count; ++i) {
      entries.push_back(table.Entry(i));
    }
    return entries;
  }

  FakeFiles disk;
  FakeMessageBoxes boxes;
  WaveFile wave{disk, boxes};
  SoundList list{disk, wave};
  PageIndexTable table;
};

TEST_F(Table, StartsAtPageOneAndEndsBehindTheLastSound) {
  disk.Put("/5.raw", std::string(5 * 256, 'x'));
  disk.Put("/2.raw", std::string(2 * 256, 'x'));
  Fill({"/5.raw", "/2.raw"});
  Build();
  EXPECT_THAT(Entries(4), ElementsAre(1, 6, 8, 0));
}

TEST_F(Table, GivesARowWithoutAFileTheStepOfTheFileBefore) {
  disk.Put("/5.raw", std::string(5 * 256, 'x'));
  Fill({"", "", "/5.raw", "", ""});
  Build();
  EXPECT_THAT(Entries(6), ElementsAre(1, 2, 3, 8, 13, 18));
}

TEST_F(Table, CountsAWaveWithItsSamplesLessTheirOffset) {
  disk.Put("/a.wav", Wave(Samples(400)));  // 400 bytes are 2 pages, 356 are 1
  Fill({"/a.wav", ""});
  Build();
  EXPECT_THAT(Entries(3), ElementsAre(1, 2, 3));
}

TEST_F(Table, GoesBackWhereTheOffsetIsLargerThanTheSamples) {
  disk.Put("/a.wav", Riff(FormatChunk() + Chunk("junk", std::string(1000, 'j')) + Chunk("data", "12")));
  Fill({"/a.wav", ""});
  Build();
  EXPECT_THAT(Entries(3), ElementsAre(1, -3, -7));
  const auto bytes = table.Bytes();
  EXPECT_THAT(std::vector(bytes.begin(), bytes.begin() + 8), ElementsAre(0, 1, 0xFF, 0xFD, 0xFF, 0xF9, 0, 0));
}

TEST_F(Table, TakesARefusedWaveAsEmptyWithTheOffsetOfTheLastGoodOne) {
  disk.Put("/good.wav",
           Riff(FormatChunk() + Chunk("junk", std::string(1000, 'j')) + Chunk("data", Samples(5000))));
  Fill({"/good.wav", "/none.wav"});
  Build();
  // Samples begin at byte 1052: (5000 - 1052) / 256 are 15 pages, (0 - 1052) / 256 are 4 back.
  EXPECT_THAT(Entries(3), ElementsAre(1, 16, 12));
  ASSERT_EQ(boxes.Boxes.size(), 1U);
  EXPECT_EQ(boxes.Boxes[0].Text, "Sound File Format error: Unable to open file.");
}

TEST_F(Table, IsSentWithTheHighByteFirstAndWithoutTheLastEntry) {
  disk.Put("/300.raw", std::string(300 * 256, 'x'));
  Fill({"/300.raw", ""});
  Build();
  const auto bytes = table.Bytes();
  EXPECT_EQ(bytes.size(), 256U);
  EXPECT_THAT(std::vector(bytes.begin(), bytes.begin() + 8), ElementsAre(0, 1, 1, 0x2D, 2, 0x59, 0, 0));
}

TEST_F(Table, KeepsEntriesThatAShorterListDoesNotReach) {
  Fill({"", "", "", ""});
  Build();
  Fill({"", ""});
  Build();
  EXPECT_THAT(Entries(6), ElementsAre(1, 2, 3, 4, 5, 0));
}

TEST_F(Table, HasRoomFor128Sounds) {
  Fill(std::vector<std::string>(128));
  Build();
  EXPECT_EQ(table.Entry(128), 129);
  Fill(std::vector<std::string>(129));
  EXPECT_EQ(NumberThrownBy([this] { Build(); }), 9);
  Fill(std::vector<std::string>(130));
  EXPECT_EQ(NumberThrownBy([this] { Build(); }), 9);
}

TEST_F(Table, OverflowsBeyondPage32767) {
  disk.Put("/a.raw", std::string(32766 * 256, 'x'));
  Fill({"/a.raw"});
  Build();
  EXPECT_EQ(table.Entry(1), 32767);
  Fill({"/a.raw", ""});
  EXPECT_EQ(NumberThrownBy([this] { Build(); }), 6);
  disk.Put("/a.wav", Riff(FormatChunk() + "data" + Little(0xFFFFFFFF, 4)));
  Fill({"/a.wav"});
  EXPECT_EQ(NumberThrownBy([this] { Build(); }), 6);
}

TEST_F(Table, FailsForRawSamplesThatAreGone) {
  Fill({"/none.raw"});
  EXPECT_EQ(NumberThrownBy([this] { Build(); }), 53);
}

TEST(TheTwoBytes, OfAValueAreThoseOfItsTwosComplement) {
  EXPECT_EQ(LoByte(0x1234), 0x34);
  EXPECT_EQ(HiByte(0x1234), 0x12);
  EXPECT_EQ(LoByte(-2), 0xFE);
  EXPECT_EQ(HiByte(-2), 0xFF);
}

}  // namespace
