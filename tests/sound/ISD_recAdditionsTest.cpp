#include <QDropEvent>
#include <QMimeData>
#include <QProgressBar>
#include <QTest>
#include <QUrl>

#include "platform/RuntimeError.h"
#include "sound/ISD_rec.h"
#include "sound/SoundConversion.h"
#include "tests/sound/SoundWindow.h"
#include "tests/support/CaredFor.h"

namespace {

using std::chrono::milliseconds;
using testing::Contains;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

class SoundAdditions : public SoundWindow {
 protected:
  SoundAdditions() {
    Disk.Put("/sounds/stereo.wav", Riff(FormatChunk(2) + Chunk("data", "1234")));
    Converter.Sounds["/sounds/stereo.wav"] = {.Samples = std::vector<std::uint8_t>(512, 130), .Peak = 0.5};
    Converter.Sounds["/sounds/a.flac"] = {
        .Samples = std::vector<std::uint8_t>(300, 255), .Peak = 2, .Clipped = 300};
    Disk.Put("/sounds/a.flac", "fLaC");
    Open();
  }

  /// Drops files from a file manager on a row.
  void Drop(int row, const std::vector<std::string>& paths) {
    QMimeData data;
    QList<QUrl> urls;
    for (const std::string& path : paths) {
      urls << QUrl::fromLocalFile(QString::fromStdString(path));
    }
    data.setUrls(urls);
    const QPoint place = List().visualRect(List().model()->index(row, 1)).center();
    QDragEnterEvent enter(place, Qt::CopyAction, &data, Qt::LeftButton, Qt::NoModifier);
    QCoreApplication::sendEvent(List().viewport(), &enter);
    EXPECT_TRUE(enter.isAccepted());
    QDropEvent drop(place, Qt::CopyAction, &data, Qt::LeftButton, Qt::NoModifier);
    QCoreApplication::sendEvent(List().viewport(), &drop);
    QCoreApplication::processEvents();
  }
};

TEST_F(SoundAdditions, AreSecondsAndPagesOfEachSound) {
  SetSound(0, "/sounds/300.wav");
  SetSound(1, "/sounds/400.raw");
  EXPECT_THAT(Column(2), ElementsAre("0.01", "0.02", ""));
  EXPECT_THAT(Column(3), ElementsAre("1", "2", ""));
}

TEST_F(SoundAdditions, AreABarOfHowFullTheChipIs) {
  auto& fill = Find<QProgressBar>(*Window, "ChipFill");
  EXPECT_EQ(fill.value(), 0);
  Disk.Put("/sounds/45.raw", std::string(22050 * 45, 'x'));
  SetSound(0, "/sounds/45.raw");
  EXPECT_NEAR(fill.value(), fill.maximum() / 2, fill.maximum() / 100);
  Disk.Put("/sounds/100.raw", std::string(22050 * 100, 'x'));
  SetSound(1, "/sounds/100.raw");
  EXPECT_EQ(fill.value(), fill.maximum());
}

TEST_F(SoundAdditions, AreNotesBeforeARecordingThatDoNotStopIt) {
  EXPECT_THAT(Notes(), IsEmpty());
  Disk.Put("/sounds/128.raw", std::string(128, 'x'));
  SetSound(0, "/sounds/128.raw");
  EXPECT_THAT(Notes(), ElementsAre(HasSubstr("Row 1: this sound is shorter than half a page")));
  Combo("RecorderSelect").setCurrentIndex(0);
  EXPECT_THAT(Notes(), Contains(HasSubstr("From row 1 on, the page table differs")));
}

TEST_F(SoundAdditions, AreNotesAboutFilesThatAreGoneWhenRecordIsPressed) {
  SetSound(0, "/sounds/400.raw");
  EXPECT_THAT(Notes(), IsEmpty());
  Disk.Remove("/sounds/400.raw");
  Press("RecordButton");
  EXPECT_THAT(Notes(), ElementsAre(HasSubstr("Row 1 cannot be recorded: ")));
}

TEST_F(SoundAdditions, TellTheTimeOfARecordingInEitherMode) {
  Disk.Put("/sounds/60.raw", std::string(22050 * 60, 'x'));
  SetSound(0, "/sounds/60.raw");
  EXPECT_EQ(TextOf("Estimate"), "Time to record: about 7 min, and erasing");
  Combo("RecorderSelect").setCurrentIndex(0);
  EXPECT_EQ(TextOf("Estimate"), "Time to record: about 32 min, and erasing");
  SetSound(0, "/sounds/300.wav");
  EXPECT_EQ(TextOf("Estimate"), "Time to record: less than a minute, and erasing");
}

TEST_F(SoundAdditions, ShowTheLevelOfTheSelectedSound) {
  Disk.Put("/sounds/half.raw", std::string(300, char(64)));
  SetSound(0, "/sounds/half.raw");
  EXPECT_EQ(TextOf("LevelText"), "Peak: -6.0 dB");
  Disk.Put("/sounds/loud.raw", std::string(300, char(255)));
  SetSound(1, "/sounds/loud.raw");
  EXPECT_EQ(TextOf("LevelText"), "Peak: -0.1 dB, clipped samples: 300");
  Disk.Put("/sounds/still.raw", std::string(300, char(128)));
  SetSound(2, "/sounds/still.raw");
  EXPECT_EQ(TextOf("LevelText"), "Silent");
  List().SelectRow(0);
  EXPECT_EQ(TextOf("LevelText"), "Peak: -6.0 dB");
}

TEST_F(SoundAdditions, LeaveTheLevelAloneWhileARecordingRuns) {
  Disk.Put("/sounds/half.raw", std::string(300, char(64)));
  Disk.Put("/sounds/loud.raw", std::string(300, char(255)));
  SetSound(1, "/sounds/loud.raw");
  SetSound(0, "/sounds/half.raw");
  std::string meanwhile;
  Hardware.Acknowledges = [&](const std::string& what) {
    if (what == "header 1") {
      EXPECT_EQ(List().SelectedRow(), 1);
      meanwhile = TextOf("LevelText");
    }
    return true;
  };
  Press("RecordButton");
  EXPECT_EQ(meanwhile, "Peak: -6.0 dB");
  EXPECT_EQ(TextOf("LevelText"), "Peak: -0.1 dB, clipped samples: 300");
}

TEST_F(SoundAdditions, ConvertASoundOfAnotherFormatBesideItsOriginal) {
  List().SelectRow(1);
  Dialog.Answers = {"/sounds/stereo.wav"};
  Press("ConvertSound");
  EXPECT_EQ(Dialog.Calls.back().Title, "Convert a Sound");
  EXPECT_EQ(Disk.Read("/sounds/stereo-chip.wav"), WaveBytes(std::vector<std::uint8_t>(512, 130)));
  EXPECT_THAT(Paths(), ElementsAre("", "/sounds/stereo-chip.wav", ""));
  EXPECT_EQ(Notes().front(), "Converted to /sounds/stereo-chip.wav. Peak: -6.0 dB");
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  Press("ConvertSound");
  EXPECT_THAT(Paths(), ElementsAre("", "/sounds/stereo-chip.wav", ""));
}

TEST_F(SoundAdditions, TellHowMuchOfAConvertedSoundIsClipped) {
  Dialog.Answers = {"/sounds/a.flac"};
  Press("ConvertSound");
  EXPECT_EQ(
      Notes().front(),
      "Converted to /sounds/a-chip.wav. Too loud: 300 samples were clipped, up to 6.0 dB above full scale");
}

TEST_F(SoundAdditions, TakeASoundInTheChipsFormatAsItIs) {
  Dialog.Answers = {"/sounds/300.wav"};
  Press("ConvertSound");
  EXPECT_THAT(Paths(), ElementsAre("/sounds/300.wav", "", ""));
  EXPECT_FALSE(Disk.FileExists("/sounds/300-chip.wav"));
}

TEST_F(SoundAdditions, ReportASoundThatCannotBeConverted) {
  Dialog.Answers = {"/sounds/text.doc"};
  Press("ConvertSound");
  EXPECT_THAT(BoxTexts(), ElementsAre("Run-time error '321': Unknown format"));
  EXPECT_THAT(Paths(), ElementsAre("", "", ""));
}

TEST_F(SoundAdditions, ReportAFolderThatCannotBeWritten) {
  Disk.FailReplace("/sounds/stereo-chip.wav",
                   RuntimeError(Fault::DiskFull, "Disk full: /sounds/stereo-chip.wav"));
  Dialog.Answers = {"/sounds/stereo.wav"};
  Press("ConvertSound");
  EXPECT_THAT(BoxTexts(), ElementsAre("Run-time error '61': Disk full: /sounds/stereo-chip.wav"));
  EXPECT_THAT(Paths(), ElementsAre("", "", ""));
}

TEST_F(SoundAdditions, EndAConversionWhenTheWindowCloses) {
  Converter.InTheMidst = [this] { Events.At(milliseconds(0), [this] { Window->close(); }); };
  Dialog.Answers = {"/sounds/stereo.wav"};
  Press("ConvertSound");
  EXPECT_FALSE(Window->isVisible());
  EXPECT_FALSE(Disk.FileExists("/sounds/stereo-chip.wav"));
}

TEST_F(SoundAdditions, SayNothingMoreWhenTheWindowClosesInAConversion) {
  Disk.Put("/sounds/later-bad.wav", Wave(Samples(300)));
  SetSound(2, "/sounds/later-bad.wav");
  Disk.Put("/sounds/later-bad.wav", "text");
  Converter.InTheMidst = [this] { Events.At(milliseconds(0), [this] { Window->close(); }); };
  Dialog.Answers = {"/sounds/stereo.wav"};
  Press("ConvertSound");
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  Window->show();
  Drop(0, {"/sounds/stereo.wav", "/sounds/a.flac"});
  EXPECT_THAT(BoxTexts(), ElementsAre(HasSubstr("stereo.wav is not in the sound chip's format.")));
  EXPECT_FALSE(Window->isVisible());
}

TEST_F(SoundAdditions, LandDroppedSoundsOnTheirRows) {
  Drop(1, {"/sounds/300.wav", "/sounds/400.raw", "/sounds/300.wav"});
  EXPECT_THAT(Paths(), ElementsAre("", "/sounds/300.wav", "/sounds/400.raw"));
  EXPECT_THAT(TextOf("Utilisation"), HasSubstr("0.03 seconds"));
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

TEST_F(SoundAdditions, AskBeforeTheyConvertADroppedSound) {
  Drop(0, {"/sounds/stereo.wav"});
  EXPECT_THAT(Boxes.Boxes, ElementsAre(FakeMessageBoxes::Box{
                               "/sounds/stereo.wav is not in the sound chip's format. Convert it? "
                               "The original stays as it is.",
                               "Tessarine", BoxIcon::Question, BoxButtons::YesNo}));
  EXPECT_THAT(Paths(), ElementsAre("/sounds/stereo-chip.wav", "", ""));
  Boxes.Answers = {BoxAnswer::No};
  Drop(1, {"/sounds/a.flac"});
  EXPECT_THAT(Paths(), ElementsAre("/sounds/stereo-chip.wav", "", ""));
}

TEST_F(SoundAdditions, TellTheOutcomeOfEachDroppedSoundThatTheyConvert) {
  Drop(0, {"/sounds/stereo.wav", "/sounds/300.wav", "/sounds/a.flac"});
  EXPECT_THAT(Paths(), ElementsAre("/sounds/stereo-chip.wav", "/sounds/300.wav", "/sounds/a-chip.wav"));
  EXPECT_THAT(Notes(), ElementsAre("Converted to /sounds/stereo-chip.wav. Peak: -6.0 dB",
                                   HasSubstr("Converted to /sounds/a-chip.wav. Too loud: 300 samples")));
}

TEST_F(SoundAdditions, ReckonOnceForAllDroppedSounds) {
  SetSound(2, "/sounds/300.wav");
  Disk.Put("/sounds/300.wav", "text");
  Boxes.Boxes.clear();
  Drop(0, {"/sounds/400.raw", "/sounds/400.raw"});
  EXPECT_THAT(BoxTexts(), ElementsAre("Sound File Format error: Not a Wave file."));
}

TEST_F(SoundAdditions, KeepWhatLandedBeforeADroppedSoundThatFails) {
  Disk.FailReplace("/sounds/stereo-chip.wav",
                   RuntimeError(Fault::DiskFull, "Disk full: /sounds/stereo-chip.wav"));
  Drop(0, {"/sounds/400.raw", "/sounds/stereo.wav", "/sounds/300.wav"});
  EXPECT_THAT(BoxTexts(), ElementsAre(HasSubstr("Convert it?"),
                                      "Run-time error '61': Disk full: /sounds/stereo-chip.wav"));
  EXPECT_THAT(Paths(), ElementsAre("/sounds/400.raw", "", ""));
  EXPECT_THAT(TextOf("Utilisation"), HasSubstr("0.02 seconds"));
}

TEST_F(SoundAdditions, TakeNoDroppedFolder) {
  Disk.AddFolder("/sounds/folder");
  Drop(0, {"/sounds/folder"});
  EXPECT_THAT(Paths(), ElementsAre("", "", ""));
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

TEST_F(SoundAdditions, ConvertACompandedWaveThoughItPassesTheCheck) {
  Disk.Put("/sounds/law.wav", Riff(FormatChunk(1, 22050, 8, 7) + Chunk("data", "1234")));
  Converter.Sounds["/sounds/law.wav"] = {.Samples = std::vector<std::uint8_t>(512, 130), .Peak = 0.5};
  Dialog.Answers = {"/sounds/law.wav"};
  Press("ConvertSound");
  Drop(1, {"/sounds/law.wav"});
  EXPECT_THAT(Paths(), ElementsAre("/sounds/law-chip.wav", "/sounds/law-chip-2.wav", ""));
  SetSound(2, "/sounds/law.wav");
  EXPECT_EQ(Paths()[2], "/sounds/law.wav");
}

TEST_F(SoundAdditions, TellADroppedWaveThatIsNone) {
  Disk.Put("/sounds/text.wav", "text");
  Drop(0, {"/sounds/text.wav"});
  EXPECT_THAT(BoxTexts(), ElementsAre("Sound File Format error: Not a Wave file."));
  EXPECT_THAT(Paths(), ElementsAre("", "", ""));
}

TEST_F(SoundAdditions, TakeNoDropsWhileAJobRuns) {
  Events.At(milliseconds(500), [this] { Drop(0, {"/sounds/300.wav"}); });
  Press("RecordButton");
  EXPECT_THAT(Paths(), ElementsAre("", "", ""));
}

class SoundWindowLooks : public SoundWindow, public testing::WithParamInterface<Language> {
 protected:
  SoundWindowLooks() : SoundWindow(GetParam()) {}
};

INSTANTIATE_TEST_SUITE_P(InEachLanguage, SoundWindowLooks,
                         testing::Values(Language::English, Language::SimplifiedChinese));

TEST_P(SoundWindowLooks, AreCaredFor) {
  Open();
  Disk.Put("/sounds/100.raw", std::string(22050 * 100, 'x'));
  SetSound(0, "/sounds/100.raw");
  Combo("RecorderSelect").setCurrentIndex(0);
  ExpectCaredFor(*Window);
}

}  // namespace
