#include <gmock/gmock.h>

#include <QCheckBox>

#include "tests/devices/box/BoxWindow.h"

// What the window of utility boxes does with the boxes it has programmed: its list, its sign and its sound.

namespace {

using testing::ElementsAre;
using testing::SizeIs;

TEST_P(BoxWindow, ListsTheBoxesNewestFirst) {
  AnswerWith({0xAA});
  Press("ProgramButton");
  AnswerWith({0x00});
  List("BoxType").setCurrentIndex(1);
  List("TeamList").setCurrentIndex(1);
  Press("ProgramButton");
  Port.OnOutput = {};
  Press("ProgramButton");
  EXPECT_THAT(Row(0), ElementsAre("3", "14:30:05", "Ammo", Strings.Text(114), In("No answer", "无应答")));
  EXPECT_THAT(Row(1), ElementsAre("2", "14:30:05", "Ammo", Strings.Text(114), In("Rejected", "已拒绝")));
  EXPECT_THAT(Row(2), ElementsAre("1", "14:30:05", "Medic", "All", In("Accepted", "已接受")));
}

TEST_P(BoxWindow, ListsNoBoxThatGotNoFrame) {
  Port.FailNextOpen(Fault::PortAlreadyOpen);
  Press("ProgramButton");
  EXPECT_THAT(Boxes.Boxes, ElementsAre(PortTaken()));
  EXPECT_EQ(Results().rowCount(), 0);
  EXPECT_EQ(Sign(), In("\u2717 Not sent", "\u2717 未发送"));
}

TEST_P(BoxWindow, FindsTheListAgainButNotTheEntries) {
  AnswerWith({0xAA});
  Enter("PointsPerAct", "55");
  Press("ProgramButton");
  EXPECT_EQ(Entry("PointsPerAct").text(), QStringLiteral("55"));
  Press("Close");
  Open();
  EXPECT_EQ(Entry("PointsPerAct").text(), QStringLiteral("0"));
  ASSERT_EQ(Results().rowCount(), 1);
  EXPECT_THAT(Row(0), ElementsAre("1", "14:30:05", "Medic", "All", In("Accepted", "已接受")));
}

TEST_P(BoxWindow, CountsOnWhereTheListNoLongerHoldsTheFirstBoxes) {
  for (std::size_t i = 0; i < ProgrammedBoxes::Most + 2; ++i) {
    programmed.Add({"09:00:00", {}, BoxResult::Accepted});
  }
  Open();
  EXPECT_EQ(Results().rowCount(), static_cast<int>(ProgrammedBoxes::Most));
  EXPECT_EQ(Row(0)[0], "502");
  EXPECT_EQ(Row(Results().rowCount() - 1)[0], "3");
  AnswerWith({0xAA});
  Results().scrollToBottom();
  Press("SendAgain3");
  EXPECT_EQ(Row(0)[0], "503");
  EXPECT_EQ(Row(Results().rowCount() - 1)[0], "4");
}

TEST_P(BoxWindow, ProgramsABoxOfTheListAgainWithOneClick) {
  AnswerWith({0xAA});
  List("BoxType").setCurrentIndex(3);
  List("TeamList").setCurrentIndex(2);
  Enter("PointsPerAct", "55");
  Find<QCheckBox>(*window, "Destroyable").setChecked(true);
  Press("ProgramButton");
  List("BoxType").setCurrentIndex(0);
  Find<QCheckBox>(*window, "Destroyable").setChecked(false);
  Enter("PointsPerAct", "1");
  Press("ProgramButton");
  Press("Close");
  Open();
  Port.Sent.clear();
  Press("SendAgain1");
  EXPECT_THAT(Port.Sent, ElementsAre(0x42, 0x43, 0x23, 55, 0, 0, 0, 1, 0, 0));
  EXPECT_EQ(Entry("PointsPerAct").text(), QStringLiteral("55"));
  EXPECT_EQ(List("BoxType").currentIndex(), 3);
  EXPECT_EQ(Results().rowCount(), 3);
}

TEST_P(BoxWindow, DoesNotProgramAnotherBoxWhileItWaits) {
  AnswerWith({0xAA});
  Press("ProgramButton");
  Port.OnOutput = {};
  Meanwhile(400, [this] { Press("SendAgain1"); });
  Press("ProgramButton");
  EXPECT_THAT(Port.Sent, SizeIs(20));
}

TEST_P(BoxWindow, SignalsSuccessAndFailureBeforeTheBoxOpens) {
  std::string signAtBox;
  std::size_t soundsAtBox = 0;
  Boxes.WhileOpen = [&](const FakeMessageBoxes::Box&) {
    signAtBox = Sign();
    soundsAtBox = sounds.Played.size();
  };
  AnswerWith({0xAA});
  Press("ProgramButton");
  EXPECT_EQ(signAtBox, In("\u2713 Accepted", "\u2713 已接受"));
  EXPECT_EQ(soundsAtBox, 1U);
  AnswerWith({0x01});
  Press("ProgramButton");
  EXPECT_EQ(signAtBox, In("\u2717 Rejected", "\u2717 已拒绝"));
  ASSERT_EQ(soundsAtBox, 2U);
  EXPECT_NE(sounds.Played[0], sounds.Played[1]);
}

TEST_P(BoxWindow, TakesABoxThatDidNotConfirmForAFailure) {
  Meanwhile(400, [this] { Port.Lose(); });
  Press("ProgramButton");
  EXPECT_EQ(Sign(), In("\u2717 Not confirmed", "\u2717 未确认"));
  EXPECT_THAT(Row(0), ElementsAre("1", "14:30:05", "Medic", "All", In("Not confirmed", "未确认")));
  EXPECT_NE(Results().item(0, 0)->background().style(), Qt::NoBrush);
}

TEST_P(BoxWindow, TakesTheSignAwayAtTheNextPress) {
  AnswerWith({0xAA});
  Press("ProgramButton");
  Port.OnOutput = {};
  std::string signInWait = "none";
  Meanwhile(400, [&] { signInWait = Sign(); });
  Press("ProgramButton");
  EXPECT_EQ(signInWait, "");
}

}  // namespace
