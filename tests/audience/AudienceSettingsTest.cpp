#include "audience/AudienceSettings.h"

#include <gmock/gmock.h>

#include <QBuffer>
#include <QCheckBox>
#include <QComboBox>
#include <QDoubleSpinBox>
#include <QGuiApplication>
#include <QImage>
#include <QLabel>
#include <QLineEdit>
#include <QSpinBox>
#include <optional>
#include <set>

#include "core/text/Filled.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/Controls.h"
#include "tests/support/OnScreen.h"

namespace {

using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;

class AudienceSettingsWindow : public testing::Test {
 protected:
  void Open(const AudienceSetup& setup = {}, Language language = Language::English) {
    strings.emplace(language);
    window = std::make_unique<AudienceSettings>(
        setup, AudienceSettings::Parts{.Boxes = boxes, .Dialogs = dialog, .Disk = files, .Strings = *strings},
        nullptr);
    Show(*window);
  }

  std::string Consequence() const { return Find<QLabel>(*window, "Consequence").text().toStdString(); }

  /// Entries and text have the height that they want.
  void ExpectWhole() const {
    QCoreApplication::processEvents();
    for (const char* entry : {"VenueName", "PictureName"}) {
      const auto& line = Find<QLineEdit>(*window, entry);
      EXPECT_GE(line.height(), line.sizeHint().height()) << entry;
      EXPECT_GE(line.width(), 200) << entry;
    }
    const auto& told = Find<QLabel>(*window, "Consequence");
    EXPECT_GE(told.height(), told.heightForWidth(told.width()));
  }

  void PutPicture(const std::string& path) {
    QImage picture(40, 30, QImage::Format_RGB32);
    picture.fill(Qt::blue);
    QByteArray bytes;
    QBuffer buffer(&bytes);
    picture.save(&buffer, "PNG");
    files.Put(path, bytes.toStdString());
  }

  FakeFiles files;
  FakeFileDialog dialog;
  FakeMessageBoxes boxes;
  std::optional<StringTable> strings;
  std::unique_ptr<AudienceSettings> window;
};

TEST_F(AudienceSettingsWindow, TakesItsTextsFromTheStringTable) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    Open({}, language);
    EXPECT_EQ(window->windowTitle().toStdString(), strings->Text(OwnText::AudienceSettingsTitle));
    EXPECT_EQ(Find<QCheckBox>(*window, "Follow").text().remove(u'&').toStdString().substr(0, 6),
              strings->Text(OwnText::AudienceFollow).substr(0, 6));
    EXPECT_EQ(Find<QComboBox>(*window, "AudienceScreen").itemText(0).toStdString(),
              strings->Text(OwnText::AudienceAnyScreen));
  }
}

TEST_F(AudienceSettingsWindow, LeavesWhatItShowsAsItWas) {
  const std::string screen = QGuiApplication::screens().at(1)->name().toStdString();
  for (const AudienceSetup& setup :
       {AudienceSetup(), AudienceSetup{screen, 7.5, 55, 12, "North", "/a.png", false},
        AudienceSetup{"not plugged in", 50, 300, 60, "", "", true}}) {
    Open(setup);
    EXPECT_EQ(window->Setup(), setup);
  }
}

TEST_F(AudienceSettingsWindow, HoldsWhatTheOperatorEnters) {
  Open();
  Find<QComboBox>(*window, "AudienceScreen").setCurrentIndex(2);
  Find<QDoubleSpinBox>(*window, "Distance").setValue(9.5);
  Find<QDoubleSpinBox>(*window, "Diagonal").setValue(65);
  Find<QSpinBox>(*window, "SecondsAPage").setValue(15);
  QTest::keyClicks(&Find<QLineEdit>(*window, "VenueName"), QStringLiteral("North "));
  Find<QCheckBox>(*window, "Follow").click();
  const std::string screen = QGuiApplication::screens().at(1)->name().toStdString();
  EXPECT_EQ(window->Setup(), (AudienceSetup{screen, 9.5, 65, 15, "North", "", false}));
  Press(*window, "SaveExit");
  EXPECT_EQ(window->result(), QDialog::Accepted);
}

TEST_F(AudienceSettingsWindow, TellsHowLargeTheLettersBecome) {
  Open({"", 10, 86, 8, "", "", true});
  EXPECT_THAT(Consequence(), HasSubstr("mm high"));
  EXPECT_THAT(Consequence(), Not(HasSubstr("too small")));
  Find<QDoubleSpinBox>(*window, "Distance").setValue(40);
  Find<QDoubleSpinBox>(*window, "Diagonal").setValue(24);
  EXPECT_THAT(Consequence(), HasSubstr("too small"));
}

TEST_F(AudienceSettingsWindow, SaysWhereWinnersHaveNoRoomInLargeLetters) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    Open({"", 5, 55, 8, "", "", true}, language);
    const std::string none = strings->Text(OwnText::AudienceNoWinners);
    EXPECT_THAT(Consequence(), Not(HasSubstr(none)));
    std::set<std::string> fewer;
    for (double metres = 5; metres < 30; metres += 0.5) {
      Find<QDoubleSpinBox>(*window, "Distance").setValue(metres);
      for (const char* count : {"1", "2"}) {
        if (Consequence().ends_with(Filled(strings->Text(OwnText::AudienceFewWinners), {count}))) {
          fewer.insert(count);
        }
      }
    }
    EXPECT_THAT(fewer, Not(IsEmpty()));
    EXPECT_THAT(Consequence(), EndsWith(none));
  }
}

TEST_F(AudienceSettingsWindow, GrowsWithWhatItSaysAndKeepsItsEntriesWhole) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    for (const int points : {9, 14}) {
      const FontOfSize font(points);
      Open({"", 2, 86, 8, "North", "/home/venue-picture.png", true}, language);
      const int before = window->height();
      Find<QDoubleSpinBox>(*window, "Distance").setValue(50);
      Find<QDoubleSpinBox>(*window, "Diagonal").setValue(24);
      EXPECT_GT(window->height(), before);
      ExpectWhole();
      Open({"", 50, 24, 8, "North", "/home/venue-picture.png", true}, language);
      ExpectWhole();
    }
  }
}

TEST_F(AudienceSettingsWindow, TakesAPictureAndGivesItBack) {
  PutPicture("/home/venue.png");
  Open();
  EXPECT_FALSE(Find<QPushButton>(*window, "NoPicture").isEnabled());
  dialog.Answers = {"/home/venue.png"};
  Press(*window, "ChoosePicture");
  EXPECT_EQ(window->Setup().Picture, "/home/venue.png");
  EXPECT_EQ(Find<QLineEdit>(*window, "PictureName").text(), QStringLiteral("venue.png"));
  Press(*window, "NoPicture");
  EXPECT_EQ(window->Setup().Picture, "");
}

TEST_F(AudienceSettingsWindow, RefusesAFileThatIsNoPicture) {
  files.Put("/home/notes.png", "notes");
  Open();
  dialog.Answers = {"/home/notes.png"};
  Press(*window, "ChoosePicture");
  EXPECT_EQ(window->Setup().Picture, "");
  ASSERT_THAT(boxes.Boxes, SizeIs(1));
  EXPECT_EQ(boxes.Boxes[0].Text, Filled(strings->Text(OwnText::AudienceBadPicture), {"/home/notes.png"}));
}

}  // namespace
