#include "sound/ISD_rec.h"

#include <QGroupBox>
#include <QHeaderView>
#include <QTest>

#include "platform/RuntimeError.h"
#include "sound/StatusText.h"
#include "tests/sound/SoundWindow.h"
#include "tests/support/Captions.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

class SoundRecorder : public SoundWindow {
 protected:
  void ExpectButtonsApart() const {
    const auto buttons = Window->findChildren<QPushButton*>();
    for (const QPushButton* one : buttons) {
      const QRect place(one->mapTo(Window.get(), QPoint(0, 0)), one->size());
      EXPECT_TRUE(Window->rect().contains(place)) << one->objectName().toStdString();
      for (const QPushButton* other : buttons) {
        const QRect otherPlace(other->mapTo(Window.get(), QPoint(0, 0)), other->size());
        EXPECT_TRUE(one == other || !place.intersects(otherPlace))
            << one->objectName().toStdString() << " " << other->objectName().toStdString();
      }
    }
  }
};

TEST_F(SoundRecorder, OpensAsTold) {
  Open();
  EXPECT_EQ(Window->windowTitle(), QStringLiteral("Sound Recorder"));
  ExpectCaptions(*Window, {{"RecorderFrame", "Recorder"},
                           {"Frame5", "Product"},
                           {"Status", "Status"},
                           {"StatusLabel", "Idle"},
                           {"Status2", ""},
                           {"Frame4", "Settings"},
                           {"CommPortLabel", "Comm Port"},
                           {"Frame3", "Record Controls"},
                           {"Preview", "Preview"},
                           {"RecordButton", "Record"},
                           {"Test", "Test"},
                           {"Close", "Close"},
                           {"Frame1", "List Controls"},
                           {"SaveList", "Save List"},
                           {"OpenList", "Open List"},
                           {"SetSound", "Set Sound"},
                           {"Frame2", "Sound List"}});
  EXPECT_EQ(TextOf("Utilisation"), "Sound Chip Utilisation: 0.00 seconds, 0.00%.");
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
  EXPECT_THAT(Port.Log, IsEmpty());
}

TEST_F(SoundRecorder, OffersBothRecordersAndBothProducts) {
  Open();
  EXPECT_EQ(Combo("RecorderSelect").count(), 2);
  EXPECT_EQ(Combo("RecorderSelect").itemText(0), QStringLiteral("In Product"));
  EXPECT_EQ(Combo("RecorderSelect").itemText(1), QStringLiteral("Stand Alone"));
  EXPECT_EQ(Combo("RecorderSelect").currentIndex(), 1);
  EXPECT_EQ(Combo("ProductSelect").count(), 2);
  EXPECT_EQ(Combo("ProductSelect").itemText(0), QStringLiteral("Mainboard"));
  EXPECT_EQ(Combo("ProductSelect").itemText(1), QStringLiteral("Maltrone"));
  EXPECT_EQ(Combo("ProductSelect").currentIndex(), 0);
}

TEST_F(SoundRecorder, ShowsThePortOfTheSettings) {
  Open();
  EXPECT_EQ(Combo("CommPortCombo").currentText(), QStringLiteral("Comm 2"));
  EXPECT_EQ(Combo("CommPortCombo").toolTip(), QStringLiteral("/dev/ttyS1"));
  EXPECT_FALSE(Combo("CommPortCombo").isEnabled());
  EXPECT_EQ(LabelOf(*Window, Combo("CommPortCombo")), "Comm Port");
}

TEST_F(SoundRecorder, OpensWithoutABoxWhateverThePortIs) {
  for (const char* number : {"", "abc", "0", "99", "1e9"}) {
    Disk.Put("/data/tessarine.ini", std::string("[comm]\ncommport=") + number + "\n");
    Open();
    EXPECT_THAT(Boxes.Boxes, IsEmpty()) << number;
  }
}

TEST_F(SoundRecorder, TellsAFaultAtLoadUnlessAFileIsMissing) {
  Devices.OnNames = [] { throw RuntimeError(Fault::DeviceUnavailable); };
  Open();
  EXPECT_THAT(Boxes.Boxes, ElementsAre(FakeMessageBoxes::Box{"Error Occured: Device unavailable", "Tessarine",
                                                             BoxIcon::None}));
  EXPECT_TRUE(Window->isVisible());
  Boxes.Boxes.clear();
  Devices.OnNames = [] { throw RuntimeError(Fault::FileNotFound); };
  Open();
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

TEST_F(SoundRecorder, ListsTheEventsOfTheProductWithTheFirstSelected) {
  Open();
  EXPECT_THAT(Column(0), ElementsAre("Shot", "Hit", "Reload"));
  EXPECT_THAT(Paths(), ElementsAre("", "", ""));
  EXPECT_EQ(List().SelectedRow(), 0);
  EXPECT_EQ(List().model()->headerData(0, Qt::Horizontal).toString(), QStringLiteral("Sound Event"));
  EXPECT_EQ(List().model()->headerData(1, Qt::Horizontal).toString(), QStringLiteral("File"));
}

TEST_F(SoundRecorder, SharesTheWidthThatTheOtherColumnsLeave) {
  Open();
  Window->resize(1000, 700);
  QCoreApplication::processEvents();
  const int rest = List().viewport()->width() - List().columnWidth(2) - List().columnWidth(3);
  EXPECT_EQ(List().columnWidth(0), static_cast<int>(rest * 0.22));
  EXPECT_EQ(List().columnWidth(1), static_cast<int>(rest * 0.74));
}

TEST_F(SoundRecorder, FillsTheListAnewForAnotherProduct) {
  Open();
  SetSound(1, "/sounds/400.raw");
  EXPECT_THAT(TextOf("Utilisation"), HasSubstr("0.02 seconds"));
  Combo("ProductSelect").setCurrentIndex(1);
  EXPECT_THAT(Column(0), ElementsAre("Alarm", "Armed"));
  EXPECT_THAT(Paths(), ElementsAre("", ""));
  EXPECT_EQ(List().SelectedRow(), 0);
  EXPECT_THAT(TextOf("Utilisation"), HasSubstr("0.00 seconds"));
}

TEST_F(SoundRecorder, TellsADefinitionFileThatCannotBeLoaded) {
  const FakeMessageBoxes::Box box{"Unable to open Sound List defintion file.", "Sound Recorder Error",
                                  BoxIcon::None};
  Disk.Remove("/program/sound_list_mainboard.xml");
  Open();
  EXPECT_THAT(Boxes.Boxes, ElementsAre(box));
  EXPECT_THAT(Column(0), IsEmpty());
  Disk.Put("/program/sound_list_maltrone.xml", "<sound_defintions>");
  Combo("ProductSelect").setCurrentIndex(1);
  EXPECT_THAT(Boxes.Boxes, ElementsAre(box, box));
  Disk.Put("/program/sound_list_mainboard.xml", Definition({"New"}));
  Combo("ProductSelect").setCurrentIndex(0);
  EXPECT_THAT(Column(0), ElementsAre("New"));
}

TEST_F(SoundRecorder, SetsTheSoundOfTheSelectedRowAndRemembersItsFolder) {
  Open();
  SetSound(1, "/sounds/300.wav");
  EXPECT_THAT(Dialog.Calls,
              ElementsAre(FakeFileDialog::Call{false, "Wave Files|*.wav;|PCM Files|*.pcm;|Raw Files|*.raw;",
                                               "", "", "Open Audio File"}));
  EXPECT_THAT(Paths(), ElementsAre("", "/sounds/300.wav", ""));
  EXPECT_EQ(TextOf("Utilisation"), "Sound Chip Utilisation: 0.01 seconds, 0.01%.");
  EXPECT_EQ(Ini.ReadIni("Media Player", "1", "none"), "/sounds");
  SetSound(2, "/sounds/400.raw");
  EXPECT_EQ(Dialog.Calls.back().Folder, "/sounds");
  EXPECT_EQ(TextOf("Utilisation"), "Sound Chip Utilisation: 0.03 seconds, 0.04%.");
}

TEST_F(SoundRecorder, ChangesNothingWhenTheDialogIsCancelled) {
  Open();
  SetSound(0, "/sounds/300.wav");
  const std::string ini = Disk.Read("/data/tessarine.ini");
  Dialog.Answers = {};
  Press("SetSound");
  Press("SaveList");
  Press("OpenList");
  EXPECT_THAT(Paths(), ElementsAre("/sounds/300.wav", "", ""));
  EXPECT_EQ(Disk.Read("/data/tessarine.ini"), ini);
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

TEST_F(SoundRecorder, RefusesAWaveOfAnotherFormatAndKeepsTheRow) {
  Open();
  SetSound(0, "/sounds/300.wav");
  Disk.Put("/other/stereo.wav", Riff(FormatChunk(2) + Chunk("data", "1234")));
  Converter.Sounds["/other/stereo.wav"] = {};
  SetSound(0, "/other/stereo.wav");
  EXPECT_THAT(Boxes.Boxes, ElementsAre(FakeMessageBoxes::Box{
                               "Sound File Format error: Only Mono, 8 bit, 22khz wave files supported.",
                               "Tessarine", BoxIcon::None}));
  EXPECT_THAT(Paths(), ElementsAre("/sounds/300.wav", "", ""));
  EXPECT_EQ(Ini.ReadIni("Media Player", "1", ""), "/sounds");
}

TEST_F(SoundRecorder, TakesAnyOtherFileAsRawSamples) {
  Open();
  Disk.Put("/sounds/text.txt", std::string(256, 't'));
  SetSound(0, "/sounds/text.txt");
  EXPECT_THAT(Paths(), ElementsAre("/sounds/text.txt", "", ""));
  EXPECT_THAT(TextOf("Utilisation"), HasSubstr("0.01 seconds"));
}

TEST_F(SoundRecorder, RefusesAPathThatAPlaylistCannotKeep) {
  Open();
  Disk.Put("/sounds/\"a\".raw", "x");
  SetSound(0, "/sounds/\"a\".raw");
  EXPECT_THAT(Paths(), ElementsAre("", "", ""));
  ASSERT_EQ(Boxes.Boxes.size(), 1U);
  EXPECT_THAT(Boxes.Boxes[0].Text, HasSubstr("/sounds/\"a\".raw"));
}

TEST_F(SoundRecorder, WithoutRowsSetsNoSound) {
  Disk.Put("/program/sound_list_mainboard.xml", Definition({}));
  Open();
  Press("SetSound");
  EXPECT_THAT(Dialog.Calls, IsEmpty());
}

TEST_F(SoundRecorder, ReportsRawSamplesThatAreGone) {
  Open();
  SetSound(0, "/sounds/gone.raw");
  ASSERT_EQ(Boxes.Boxes.size(), 1U);
  EXPECT_THAT(Boxes.Boxes[0].Text, HasSubstr("Run-time error '53': File not found"));
  EXPECT_THAT(Paths(), ElementsAre("/sounds/gone.raw", "", ""));
}

TEST_F(SoundRecorder, SavesAndOpensAPlaylist) {
  Open();
  SetSound(0, "/sounds/300.wav");
  SetSound(2, "/sounds/400.raw");
  Disk.AddFolder("/lists");
  Dialog.Answers = {"/lists/a.txt"};
  Press("SaveList");
  EXPECT_EQ(Dialog.Calls.back(), (FakeFileDialog::Call{true, "Playlist Files|*.txt|All Files|*.*", "",
                                                       "/sounds", "Select Play List Filename"}));
  EXPECT_EQ(Disk.Read("/lists/a.txt"), "\"/sounds/300.wav\"\r\n\"\"\r\n\"/sounds/400.raw\"\r\n");
  EXPECT_EQ(Ini.ReadIni("Media Player", "1", ""), "/sounds");

  Combo("ProductSelect").setCurrentIndex(1);
  Dialog.Answers = {"/lists/a.txt"};
  Press("OpenList");
  EXPECT_EQ(Dialog.Calls.back(), (FakeFileDialog::Call{false, "Playlist Files|*.txt|All Files|*.*", "",
                                                       "/sounds", "Open Play List"}));
  EXPECT_THAT(Paths(), ElementsAre("/sounds/300.wav", "/sounds/400.raw"));
  EXPECT_EQ(TextOf("Utilisation"), "Sound Chip Utilisation: 0.03 seconds, 0.04%.");
}

TEST_F(SoundRecorder, ReportsAPlaylistThatCannotBeSavedOrRead) {
  Open();
  Dialog.Answers = {"/nowhere/a.txt"};
  Press("SaveList");
  Dialog.Answers = {"/none.txt"};
  Press("OpenList");
  EXPECT_THAT(BoxTexts(), ElementsAre("Run-time error '76': Path not found: /nowhere/a.txt",
                                      "Run-time error '53': File not found"));
}

TEST_F(SoundRecorder, ReportsAPlaylistWithMoreSoundsThanRows) {
  Open();
  Disk.Put("/a.txt", "\"/sounds/300.wav\"\n\"2\"\n\"3\"\n\"4\"\n");
  Dialog.Answers = {"/a.txt"};
  Press("OpenList");
  EXPECT_THAT(BoxTexts(), ElementsAre("Run-time error '9': Subscript out of range"));
  EXPECT_THAT(Paths(), ElementsAre("/sounds/300.wav", "2", "3"));
}

TEST_F(SoundRecorder, ChecksNoWaveOfAPlaylistButTellsWhatItCannotReckon) {
  Open();
  Disk.Put("/a.txt", "\"/gone.wav\"\r\n\"/sounds/300.wav\"\r\n");
  Dialog.Answers = {"/a.txt"};
  Press("OpenList");
  EXPECT_THAT(Paths(), ElementsAre("/gone.wav", "/sounds/300.wav", ""));
  EXPECT_THAT(BoxTexts(), ElementsAre("Sound File Format error: Unable to open file."));
  EXPECT_THAT(TextOf("Utilisation"), HasSubstr("0.01 seconds"));
}

TEST_F(SoundRecorder, PlaysARowOnDoubleClickAndOnReturn) {
  Open();
  SetSound(1, "/sounds/300.wav");
  const QPoint place = List().visualRect(List().model()->index(1, 0)).center();
  QTest::mouseClick(List().viewport(), Qt::LeftButton, {}, place);
  QTest::mouseDClick(List().viewport(), Qt::LeftButton, {}, place);
  ASSERT_EQ(Player.Played.size(), 1U);
  EXPECT_EQ(Player.Played[0].Samples.size(), 300U);
  List().setFocus();
  QTest::keyClick(&List(), Qt::Key_Return);
  EXPECT_EQ(Player.Played.size(), 2U);
  EXPECT_THAT(Dialog.Calls, testing::SizeIs(1));  // Return pressed no button besides
}

TEST_F(SoundRecorder, StopsTheSoundWhenItCloses) {
  Open();
  Disk.Put("/sounds/long.raw", Samples(220500));
  SetSound(0, "/sounds/long.raw");
  List().setFocus();
  QTest::keyClick(&List(), Qt::Key_Return);
  EXPECT_TRUE(Player.Playing());
  Press("Close");
  EXPECT_FALSE(Player.Playing());
  EXPECT_FALSE(Window->isVisible());
}

TEST_F(SoundRecorder, ClosesOnEscape) {
  Open();
  Type(*Window, Qt::Key_Escape);
  EXPECT_FALSE(Window->isVisible());
}

TEST_F(SoundRecorder, IsNotWidenedByALongPath) {
  Open();
  const int width = Window->minimumSizeHint().width();
  const std::string folder =
      "/" + std::string(120, 'a') + "/" + std::string(120, 'b') + "/" + std::string(120, 'c');
  Disk.Put(folder + ".raw", Samples(300));
  SetSound(0, folder + ".raw");
  Press("RecordButton");
  QCoreApplication::processEvents();
  EXPECT_EQ(Paths()[0], folder + ".raw");
  EXPECT_EQ(Window->minimumSizeHint().width(), width);
}

TEST_F(SoundRecorder, KeepsItsButtonsApartWhateverThePath) {
  Open();
  const std::string name(200, 'n');
  for (const std::string& path : {"/" + name + ".raw", "/" + name + "/" + name + "/" + name + "/a.raw",
                                  "/" + std::string(4000, 'n') + ".raw"}) {
    Disk.Put(path, Samples(300));
    SetSound(0, path);
    int looks = 0;
    Hardware.Acknowledges = [&](const std::string& what) {
      if (what == "data") {
        ++looks;
        QCoreApplication::processEvents();
        ExpectButtonsApart();
        EXPECT_EQ(TextOf("StatusLabel"), "Programming File: " + path);
      }
      return true;
    };
    Press("RecordButton");
    EXPECT_EQ(looks, 1);
  }
}

TEST(StatusText, LooksPlainWhenItIsLongAndLargeWhenItIsShort) {
  QWidget around;
  StatusText plain(&around);
  StatusText large(&around);
  QFont font = large.font();
  font.setPointSize(13);
  font.setBold(true);
  large.setFont(font);
  for (StatusText* text : {&plain, &large}) {
    text->resize(500, 100);
    text->setText(QString(300, QLatin1Char('n')));
  }
  EXPECT_EQ(large.grab().toImage(), plain.grab().toImage());
  EXPECT_EQ(large.heightForWidth(500), plain.heightForWidth(500));
  for (StatusText* text : {&plain, &large}) {
    text->setText(QStringLiteral("Idle"));
  }
  EXPECT_NE(large.grab().toImage(), plain.grab().toImage());
}

TEST_F(SoundRecorder, TellsWhatIsTooLongForACellInItsToolTip) {
  Open();
  SetSound(0, "/sounds/300.wav");
  const QAbstractItemModel& model = *List().model();
  EXPECT_EQ(model.index(0, 0).data(Qt::ToolTipRole).toString(), QStringLiteral("Shot"));
  EXPECT_EQ(model.index(0, 1).data(Qt::ToolTipRole).toString(), QStringLiteral("/sounds/300.wav"));
}

TEST_F(SoundRecorder, ShowsAPathOfMegabytes) {
  Open();
  Disk.Put("/a.txt", std::string(10'000'000, 'x') + ".raw\n");
  Dialog.Answers = {"/a.txt"};
  Press("OpenList");
  Window->grab();
  EXPECT_EQ(Paths()[0].size(), 10'000'004U);
}

}  // namespace
