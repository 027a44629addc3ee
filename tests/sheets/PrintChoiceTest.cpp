#include "sheets/PrintChoice.h"

#include <gtest/gtest.h>

namespace {

/// The entries of a freshly opened window, but with this selection.
PrintEntries Entries(std::int16_t selection) {
  return {selection, 0, 0, 0, false, false};
}

TEST(TakeEntries, KeepsSelectionOutputAndRank) {
  PrintChoice choice;
  PrintEntries entries = Entries(SheetSelection::Active);
  EXPECT_TRUE(TakeEntries(entries, choice));
  EXPECT_EQ(choice.SheetSelection, 1001);
  EXPECT_EQ(choice.OutputTarget, 1);
  EXPECT_FALSE(choice.RankHidden);
  entries = {SheetSelection::All, 0, 0, 0, true, true};
  EXPECT_TRUE(TakeEntries(entries, choice));
  EXPECT_EQ(choice.SheetSelection, 1000);
  EXPECT_EQ(choice.OutputTarget, 2);
  EXPECT_TRUE(choice.RankHidden);
}

TEST(TakeEntries, TakesTeamAndNumberOfOnePlayer) {
  PrintChoice choice;
  EXPECT_TRUE(TakeEntries({SheetSelection::OnePlayer, 1, 95, 2, false, false}, choice));
  EXPECT_EQ(choice.SheetSelection, 1);
  EXPECT_EQ(choice.SelectedTeam, 2);
  EXPECT_EQ(choice.SelectedNumber, 95);
}

TEST(TakeEntries, TakesTheTeamOfATeam) {
  PrintChoice choice;
  EXPECT_TRUE(TakeEntries({SheetSelection::Team, 1, 95, 2, false, false}, choice));
  EXPECT_EQ(choice.SheetSelection, 500);
  EXPECT_EQ(choice.SelectedTeam, 3);
  EXPECT_EQ(choice.SelectedNumber, 0);
}

TEST(TakeEntries, RefusesANumberThatTheTeamDoesNotHaveButKeepsTheSelection) {
  PrintChoice choice;
  EXPECT_FALSE(TakeEntries({SheetSelection::OnePlayer, 2, 40, 0, true, true}, choice));
  EXPECT_EQ(choice.SheetSelection, 1);
  EXPECT_EQ(choice.SelectedTeam, 3);
  EXPECT_EQ(choice.SelectedNumber, 40);
  EXPECT_EQ(choice.OutputTarget, 0);
  EXPECT_FALSE(choice.RankHidden);
  EXPECT_TRUE(TakeEntries({SheetSelection::OnePlayer, 2, 31, 0, true, true}, choice));
}

TEST(TakeEntries, TestsTheNumberOfEarlierUsesWithEverySelection) {
  PrintChoice choice;
  ASSERT_TRUE(TakeEntries({SheetSelection::OnePlayer, 0, 40, 0, true, false}, choice));
  EXPECT_FALSE(TakeEntries({SheetSelection::Team, 0, 0, 2, false, true}, choice));
  EXPECT_EQ(choice.SheetSelection, 500);
  EXPECT_EQ(choice.SelectedTeam, 3);
  EXPECT_EQ(choice.OutputTarget, 2);
  EXPECT_FALSE(TakeEntries(Entries(SheetSelection::Active), choice));
  EXPECT_TRUE(TakeEntries(Entries(SheetSelection::Team), choice));
}

}  // namespace
