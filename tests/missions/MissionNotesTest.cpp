#include "missions/MissionNotes.h"

#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

/// The places at which a description of `length` characters loses one.
std::vector<std::size_t> LostOf(std::size_t length) {
  std::vector<std::size_t> places;
  for (const LostCharacter& lost : LostCharacters(std::string(length, 'x'))) {
    places.push_back(lost.Position);
  }
  return places;
}

TEST(LostCharacters, AreThoseBetweenTheColumns) {
  EXPECT_THAT(LostOf(0), IsEmpty());
  EXPECT_THAT(LostOf(509), IsEmpty());
  EXPECT_THAT(LostOf(510), ElementsAre(510));
  EXPECT_THAT(LostOf(765), ElementsAre(510));
  EXPECT_THAT(LostOf(766), ElementsAre(510, 766));
  EXPECT_THAT(LostOf(1000), ElementsAre(510, 766));
}

TEST(LostCharacters, AreShownAmongTheirNeighbours) {
  const std::string text = std::string(501, '.') + "the seal" + "e" + "d tube at the gate";
  ASSERT_THAT(LostCharacters(text), testing::SizeIs(1));
  EXPECT_EQ(InItsPlace(LostCharacters(text)[0]), "the seal[e]d tube a");
  const std::string chinese = std::string(507, '.') + "守住水井";
  EXPECT_EQ(InItsPlace(LostCharacters(chinese)[0]), "......守住[水]井");
}

TEST(LostCharacters, MayBeHalfOfALineBreak) {
  EXPECT_EQ(InItsPlace(LostCharacters(std::string(509, '.') + "\r\nTwo")[0]), "........[↵]↵Two");
  EXPECT_EQ(InItsPlace(LostCharacters(std::string(508, '.') + "\r\nTwo")[0]), ".......↵[↵]Two");
  EXPECT_EQ(InItsPlace(LostCharacters(std::string(506, '.') + "\r\naTwo")[0]), ".....↵a[T]wo");
}

TEST(Penalties, AreSavedAsTheyStandIfTheyAreNumbers) {
  for (const char* number : {"0", "12", "-2.5", " 7 ", ".5", "1e2"}) {
    EXPECT_EQ(PenaltySavedAs(number), std::nullopt) << number;
  }
}

TEST(Penalties, AreSavedAsTheNumberThatTheyBeginWith) {
  for (const auto& [text, number] : {std::pair{"", 0.0},
                                     {"ten", 0.0},
                                     {",5", 0.0},
                                     {"-", 0.0},
                                     {"1,5", 1.0},
                                     {"12 points", 12.0},
                                     {"1 2", 12.0}}) {
    EXPECT_EQ(PenaltySavedAs(text), number) << text;
  }
}

}  // namespace
