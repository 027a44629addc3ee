#include "check/FailureBoxes.h"

#include <gmock/gmock.h>

#include "platform/ErrorReport.h"
#include "tests/fakes/FakeMessageBoxes.h"

namespace {

using testing::ElementsAre;
using Box = FakeMessageBoxes::Box;

class BoxesOfFailures : public testing::Test {
 protected:
  /// How often a failure became known while this box was shown.
  int FailuresOf(const Box& box) {
    const int before = failures;
    boxes.Show(box.Text, box.Title, box.Icon, box.Buttons);
    return failures - before;
  }

  StringTable strings{Language::English};
  FakeMessageBoxes shown;
  int failures = 0;
  FailureBoxes boxes{shown, strings, [this] { ++failures; }};
};

TEST_F(BoxesOfFailures, MakeThemKnown) {
  const Box told[] = {
      {"Run-time error '61': Disk full", "Tessarine", BoxIcon::Critical},
      {"Error occured during printing.", "Print Error", BoxIcon::Exclamation, BoxButtons::OkCancel},
      {strings.Text(121), strings.Text(122), BoxIcon::Exclamation, BoxButtons::OkCancel},
      {strings.Text(117), strings.Text(118), BoxIcon::Exclamation},
      {strings.Text(OwnText::BackupFailed), "Database status", BoxIcon::Exclamation},
      {"Error occured while saving data to Database", "Database Error", BoxIcon::Exclamation},
      {"Error occured when saving Mission. Please check the entered data.", "Mission Save Error",
       BoxIcon::Exclamation},
      {"Error loading Membership button driver", "Memberbership Error", BoxIcon::Exclamation},
      {"Error loading membership driver. Please ensure it has been installed.", "Driver Error",
       BoxIcon::Exclamation},
      {"Error loading button driver", "Button Error", BoxIcon::None},
      {"No response from Box, please check serial connection and try again.", "Communications Error"},
      {"Could not access Comms port", "Comms error", BoxIcon::Exclamation},
      {"Checksum failed", "Tessarine", BoxIcon::Critical},
      {"Timed out waiting for Data. Please try again.", "Tessarine", BoxIcon::Exclamation},
      {"Error occured receiving data. Please try again.", "Tessarine", BoxIcon::Exclamation}};
  for (const Box& box : told) {
    EXPECT_EQ(FailuresOf(box), 1) << box;
  }
}

TEST_F(BoxesOfFailures, LeaveOutQuestionsMistakesAndNews) {
  const Box others[] = {
      {"Kesh has no score data.", "Tessarine", BoxIcon::Information},
      {strings.Text(123), strings.Text(124), BoxIcon::Question, BoxButtons::OkCancel},
      {strings.Text(130), strings.Text(131), BoxIcon::Information},
      {strings.Text(175), strings.Text(176), BoxIcon::Exclamation},
      {strings.Text(101), strings.Text(102), BoxIcon::Exclamation},
      {"Unable to open Game file.", "Game File Error", BoxIcon::Exclamation},
      {strings.Text(OwnText::OldDatabaseConverted), "Database status", BoxIcon::Information}};
  for (const Box& box : others) {
    EXPECT_EQ(FailuresOf(box), 0) << box;
  }
}

TEST_F(BoxesOfFailures, KnowTheTitlesOfEachLanguage) {
  const StringTable chinese(Language::SimplifiedChinese);
  for (const int title : {118, 122, 133}) {
    EXPECT_TRUE(TellsOfFailure(chinese, "", chinese.Text(title), BoxIcon::Exclamation)) << title;
  }
  EXPECT_FALSE(TellsOfFailure(chinese, chinese.Text(175), chinese.Text(176), BoxIcon::Exclamation));
}

TEST_F(BoxesOfFailures, ShowTheSameAsBeforeAndReturnItsAnswer) {
  shown.Answers = {BoxAnswer::Cancel};
  shown.WhileOpen = [this](const Box& /*box*/) { EXPECT_EQ(failures, 1) << "known while the box is open"; };
  const Box box{"Error occured during printing.", "Print Error", BoxIcon::Exclamation, BoxButtons::OkCancel};
  EXPECT_EQ(boxes.Show(box.Text, box.Title, box.Icon, box.Buttons), BoxAnswer::Cancel);
  EXPECT_THAT(shown.Boxes, ElementsAre(box));
}

}  // namespace
