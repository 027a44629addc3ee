#include "sound/SoundList.h"

#include <gmock/gmock.h>

#include "sound/Playlist.h"
#include "sound/SoundDefinition.h"
#include "sound/SoundPages.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/sound/Waves.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::Optional;

TEST(SoundPages, AreThoseNearestToASizeWithHalvesToTheEvenNeighbour) {
  EXPECT_EQ(SoundChip::PagesOf(0), 0);
  EXPECT_EQ(SoundChip::PagesOf(128), 0);
  EXPECT_EQ(SoundChip::PagesOf(129), 1);
  EXPECT_EQ(SoundChip::PagesOf(300), 1);
  EXPECT_EQ(SoundChip::PagesOf(384), 2);
  EXPECT_EQ(SoundChip::PagesOf(400), 2);
  EXPECT_EQ(SoundChip::PagesOf(640), 2);
  EXPECT_EQ(SoundChip::PagesOf(20000), 78);
  EXPECT_EQ(SoundChip::PagesOf(-24), 0);
  EXPECT_EQ(SoundChip::PagesOf(-200), -1);
  EXPECT_EQ(NumberThrownBy([] { SoundChip::PagesOf(std::int64_t{1} << 60U); }), 6);
}

TEST(SoundDefinition, GivesTheNamesOfTheEntriesInFileOrder) {
  EXPECT_THAT(ReadSoundDefinition("<sound_defintions><sound_list_definition><sounds>"
                                  "<sound_entry><name>First</name></sound_entry>"
                                  "<sound_entry><name>Second</name><name>no</name></sound_entry>"
                                  "<sound_entry><id>3</id></sound_entry>"
                                  "</sounds></sound_list_definition></sound_defintions>"),
              Optional(ElementsAre("First", "Second", "0")));
}

TEST(SoundDefinition, FindsListAndEntriesAtAnyDepthEachOnce) {
  EXPECT_THAT(ReadSoundDefinition(
                  "<sound_defintions><product><sound_list_definition><group><sounds><a>"
                  "<sound_entry><name>1</name><sounds><sound_entry><name>2</name></sound_entry></sounds>"
                  "</sound_entry></a></sounds></group><sound_entry><name>outside</name></sound_entry>"
                  "<sounds><sound_entry><name>3</name></sound_entry></sounds>"
                  "</sound_list_definition><sound_list_definition><sounds>"
                  "<sound_entry><name>other list</name></sound_entry></sounds></sound_list_definition>"
                  "</product></sound_defintions>"),
              Optional(ElementsAre("1", "2", "3")));
}

TEST(SoundDefinition, MayBeEmpty) {
  EXPECT_THAT(ReadSoundDefinition("<sound_defintions><sound_list_definition/></sound_defintions>"),
              Optional(IsEmpty()));
}

TEST(SoundDefinition, IsRefusedWithoutTheListOrWhenItIsNotWellFormed) {
  EXPECT_EQ(ReadSoundDefinition(""), std::nullopt);
  EXPECT_EQ(ReadSoundDefinition("<sound_defintions>"), std::nullopt);
  EXPECT_EQ(ReadSoundDefinition("<sound_defintions/>"), std::nullopt);
  EXPECT_EQ(ReadSoundDefinition("<sound_list_definition><sounds/></sound_list_definition>"), std::nullopt);
  EXPECT_EQ(ReadSoundDefinition("<x><sound_defintions><sound_list_definition/></sound_defintions></x>"),
            std::nullopt);
  EXPECT_EQ(ReadSoundDefinition("<sound_defintions><sound_list_definition/></sound_defintions><x/>"),
            std::nullopt);
}

TEST(SoundDefinition, MayNestDeeply) {
  std::string deep = "<sound_defintions><sound_list_definition>";
  std::string end = "</sound_list_definition></sound_defintions>";
  for (int i = 0; i < 20'000; ++i) {
    deep += "<sounds>";
    end = "</sounds>" + end;
  }
  EXPECT_THAT(ReadSoundDefinition(deep + "<sound_entry/>" + end), Optional(ElementsAre("0")));
}

TEST(Playlist, IsWrittenAsOneQuotedPathALine) {
  EXPECT_EQ(WritePlaylist({"/a b.wav", "", "/\xE5\xA3\xB0.raw"}),
            "\"/a b.wav\"\r\n\"\"\r\n\"/\xE5\xA3\xB0.raw\"\r\n");
  EXPECT_EQ(WritePlaylist({}), "");
}

TEST(Playlist, IsReadWithEitherLineEndAndWithOrWithoutQuotes) {
  EXPECT_THAT(ReadPlaylist("\"/a.wav\"\r\n\"\"\n/plain path.raw\r\n\r\n\"half\n\"\"\n\""),
              ElementsAre("/a.wav", "", "/plain path.raw", "", "\"half", "", "\""));
  EXPECT_THAT(ReadPlaylist(""), IsEmpty());
}

TEST(Playlist, IsReadInEachEncoding) {
  EXPECT_THAT(ReadPlaylist("\xEF\xBB\xBF\"/\xE5\xA3\xB0.wav\"\r\n"), ElementsAre("/\xE5\xA3\xB0.wav"));
  EXPECT_THAT(ReadPlaylist("\"/caf\xE9.wav\"\r\n"), ElementsAre("/caf\xC3\xA9.wav"));
}

TEST(Playlist, CannotKeepQuotesAndLineBreaks) {
  EXPECT_TRUE(FitsPlaylist("/a 'b' \xE5\xA3\xB0.wav"));
  EXPECT_FALSE(FitsPlaylist("/a\"b.wav"));
  EXPECT_FALSE(FitsPlaylist("/a\nb.wav"));
}

class Sounds : public testing::Test {
 protected:
  Sounds() { list.Fill({"One", "Two", "Three", "Four"}); }

  std::vector<std::string> Files() const {
    std::vector<std::string> files;
    for (const SoundRow& row : list.Rows()) {
      files.push_back(row.File);
    }
    return files;
  }

  FakeFiles disk;
  FakeMessageBoxes boxes;
  WaveFile wave{disk, boxes};
  SoundList list{disk, wave};
};

TEST_F(Sounds, AreGivenTheirFilesWithoutBlanksAround) {
  list.AddSoundToList("  /a b.wav ", 1);
  EXPECT_THAT(Files(), ElementsAre("", "/a b.wav", "", ""));
  EXPECT_EQ(NumberThrownBy([this] { list.AddSoundToList("/a.wav", 4); }), 9);
}

TEST_F(Sounds, MoveUpWhenAListWithAHoleComesBack) {
  list.AddSoundToList("/a.wav", 0);
  list.AddSoundToList("/c.wav", 2);
  const std::string saved = list.Playlist();
  EXPECT_EQ(saved, "\"/a.wav\"\r\n\"\"\r\n\"/c.wav\"\r\n\"\"\r\n");
  list.Fill({"One", "Two", "Three", "Four"});
  list.TakePlaylist(saved);
  EXPECT_THAT(Files(), ElementsAre("/a.wav", "/c.wav", "", ""));
}

TEST_F(Sounds, KeepTheirFilesWhereAPlaylistDoesNotReach) {
  list.AddSoundToList("/old1.wav", 0);
  list.AddSoundToList("/old4.wav", 3);
  list.TakePlaylist("\"/new.wav\"\r\n");
  EXPECT_THAT(Files(), ElementsAre("/new.wav", "", "", "/old4.wav"));
}

TEST_F(Sounds, OfAPlaylistThatIsTooLongAreTakenAsFarAsThereAreRows) {
  EXPECT_EQ(NumberThrownBy([this] { list.TakePlaylist("1\n2\n3\n\n4\n5\n"); }), 9);
  EXPECT_THAT(Files(), ElementsAre("1", "2", "3", "4"));
  list.TakePlaylist("a\nb\nc\nd\n\n\"\"\n\n");
  EXPECT_THAT(Files(), ElementsAre("a", "b", "c", "d"));
}

TEST_F(Sounds, TakePagesByTheirSamples) {
  disk.Put("/300.wav", Wave(Samples(300)));
  disk.Put("/400.raw", std::string(400, 'x'));
  disk.Put("/128.pcm", std::string(128, 'x'));
  list.AddSoundToList("/300.wav", 0);
  list.AddSoundToList("/400.raw", 1);
  list.AddSoundToList("/128.pcm", 3);
  EXPECT_DOUBLE_EQ(list.Reckon(), 3 * 256 / 22050.0);
  EXPECT_EQ(list.Rows()[0].Pages, 1);
  EXPECT_EQ(list.Rows()[1].Pages, 2);
  EXPECT_EQ(list.Rows()[2].Pages, std::nullopt);
  EXPECT_EQ(list.Rows()[3].Pages, 0);
}

TEST_F(Sounds, CountWithTheSizeThatAWaveDeclares) {
  disk.Put("/a.wav", Riff(FormatChunk() + "data" + Little(22050 * 256, 4)));
  list.AddSoundToList("/a.wav", 0);
  EXPECT_DOUBLE_EQ(list.Reckon(), 256);
}

TEST_F(Sounds, ThatAreNoWavesHaveABoxEachAndCountNothing) {
  disk.Put("/300.wav", Wave(Samples(300)));
  disk.Put("/bad.wav", "text");
  list.AddSoundToList("/bad.wav", 0);
  list.AddSoundToList("/300.wav", 1);
  list.AddSoundToList("/none.wav", 2);
  EXPECT_DOUBLE_EQ(list.Reckon(), 256 / 22050.0);
  ASSERT_EQ(boxes.Boxes.size(), 2U);
  EXPECT_EQ(boxes.Boxes[0].Text, "Sound File Format error: Not a Wave file.");
  EXPECT_EQ(boxes.Boxes[1].Text, "Sound File Format error: Unable to open file.");
  EXPECT_EQ(list.Rows()[0].Pages, std::nullopt);
}

TEST_F(Sounds, OfRawSamplesThatAreGoneAreAFault) {
  list.AddSoundToList("/none.raw", 0);
  EXPECT_EQ(NumberThrownBy([this] { list.Reckon(); }), 53);
}

TEST(UtilisationText, TellsSecondsAndShareOfTheChip) {
  EXPECT_EQ(UtilisationText(0), "Sound Chip Utilisation: 0.00 seconds, 0.00%.");
  EXPECT_EQ(UtilisationText(45), "Sound Chip Utilisation: 45.00 seconds, 50.00%.");
  EXPECT_EQ(UtilisationText(3 * 256 / 22050.0), "Sound Chip Utilisation: 0.03 seconds, 0.04%.");
}

TEST(UtilisationText, ComparesWithoutRounding) {
  EXPECT_EQ(UtilisationText(90), "Sound Chip Utilisation: 90.00 seconds, 100.00%.");
  EXPECT_EQ(UtilisationText(90.001), "Sound Chip Utilisation: 90.00 seconds.  Error! Sounds too long!");
  EXPECT_EQ(UtilisationText(100.5), "Sound Chip Utilisation: 100.50 seconds.  Error! Sounds too long!");
}

}  // namespace
