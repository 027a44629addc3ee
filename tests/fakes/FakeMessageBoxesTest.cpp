#include "tests/fakes/FakeMessageBoxes.h"

#include <gtest/gtest.h>

namespace {

TEST(FakeMessageBoxes, TakesNoAnswerThatTheBoxHasNoButtonFor) {
  const std::pair<BoxButtons, std::vector<BoxAnswer>> missing[] = {
      {BoxButtons::OkCancel, {BoxAnswer::Yes, BoxAnswer::No}},
      {BoxButtons::YesNo, {BoxAnswer::Ok, BoxAnswer::Cancel}},
      {BoxButtons::YesNoCancel, {BoxAnswer::Ok}}};
  for (const auto& [buttons, answers] : missing) {
    for (const BoxAnswer answer : answers) {
      FakeMessageBoxes boxes;
      boxes.Answers = {answer};
      EXPECT_THROW(boxes.Show("Text", "Title", BoxIcon::Question, buttons), std::logic_error);
    }
  }
}

TEST(FakeMessageBoxes, GivesTheAnswersInTurnAndThenTheDefaultButton) {
  FakeMessageBoxes boxes;
  const auto ask = [&](BoxButtons buttons) {
    return boxes.Show("Text", "Title", BoxIcon::Question, buttons);
  };
  boxes.Answers = {BoxAnswer::Cancel, BoxAnswer::No, BoxAnswer::Cancel, BoxAnswer::No};
  EXPECT_EQ(ask(BoxButtons::OkCancel), BoxAnswer::Cancel);
  EXPECT_EQ(ask(BoxButtons::Ok), BoxAnswer::Ok);
  EXPECT_EQ(ask(BoxButtons::YesNo), BoxAnswer::No);
  EXPECT_EQ(ask(BoxButtons::YesNoCancel), BoxAnswer::Cancel);
  EXPECT_EQ(ask(BoxButtons::YesNoCancel), BoxAnswer::No);
  EXPECT_EQ(ask(BoxButtons::YesNoCancel), BoxAnswer::Yes);
  EXPECT_EQ(ask(BoxButtons::YesNo), BoxAnswer::Yes);
  EXPECT_EQ(ask(BoxButtons::OkCancel), BoxAnswer::Ok);
}

TEST(FakeMessageBoxes, EndsATestWhoseBoxesHaveNoEnd) {
  FakeMessageBoxes boxes;
  std::size_t shown = 0;
  const auto askForEver = [&] {
    while (boxes.Show("Again?", "Title", BoxIcon::Question, BoxButtons::YesNo) == BoxAnswer::Yes) {
      ++shown;
    }
  };
  EXPECT_THROW(askForEver(), std::logic_error);
  EXPECT_EQ(shown, FakeMessageBoxes::MostBoxes);
}

}  // namespace
