#include "devices/buttons/RomSearch.h"

#include <gmock/gmock.h>

namespace {

using testing::Each;
using testing::ElementsAre;

// Button 01-00CDAB896745-A3 alone on the bus.
constexpr SearchBlock ButtonAlone = {0x02, 0x00, 0x22, 0x20, 0x2A, 0x28, 0x82, 0x80,
                                     0x8A, 0x88, 0xA2, 0xA0, 0x00, 0x00, 0x0A, 0x88};
// The same beside the reader's own device 81-0000302010E3-08: they differ in bit 7.
constexpr SearchBlock ButtonBesideReader = {0x02, 0x40, 0x22, 0x20, 0x2A, 0x28, 0x82, 0x80,
                                            0x8A, 0x88, 0xA2, 0xA0, 0x00, 0x00, 0x0A, 0x88};
constexpr SearchBlock ReaderBesideButton = {0x02, 0xC0, 0x0A, 0xA8, 0x00, 0x02, 0x00, 0x08,
                                            0x00, 0x0A, 0x00, 0x00, 0x00, 0x00, 0x80, 0x00};

TEST(RomSearch, BeginsWithTheZeroPath) {
  EXPECT_THAT(PathToNext({}), Each(0));
}

TEST(RomSearch, TakesTheNumberFromTheUpperBitOfEachPair) {
  OneWireState state;
  EXPECT_TRUE(TakeFound(ButtonAlone, state));
  EXPECT_TRUE(state.Found);
  EXPECT_THAT(state.Rom, ElementsAre(0x01, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0x00, 0xA3));
  EXPECT_EQ(state.Branch, OneWireState::None);
}

TEST(RomSearch, TurnsOffAtTheHighestConflictNext) {
  OneWireState state;
  ASSERT_TRUE(TakeFound(ButtonBesideReader, state));
  EXPECT_EQ(state.Branch, 7);
  const SearchBlock path = PathToNext(state);
  EXPECT_THAT(path, ElementsAre(0x02, 0x80, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0));
}

TEST(RomSearch, IsAtTheLastDeviceWhenAllConflictsWereTakenUpwards) {
  OneWireState state;
  ASSERT_TRUE(TakeFound(ButtonBesideReader, state));
  ASSERT_TRUE(TakeFound(ReaderBesideButton, state));
  EXPECT_THAT(state.Rom, ElementsAre(0x81, 0xE3, 0x10, 0x20, 0x30, 0x00, 0x00, 0x08));
  EXPECT_EQ(state.Branch, OneWireState::None);
}

TEST(RomSearch, KeepsItsPathBelowTheBranch) {
  OneWireState state;
  state.Found = true;
  state.Rom = {0x0C, 0x01, 0x02, 0x03, 0x04, 0x05, 0x0A, 0x26};
  state.Branch = 63;
  EXPECT_THAT(PathToNext(state), ElementsAre(0xA0, 0x00, 0x02, 0x00, 0x08, 0x00, 0x0A, 0x00, 0x20, 0x00, 0x22,
                                             0x00, 0x88, 0x00, 0x28, 0x88));
}

TEST(RomSearch, TakesNoDeviceOnAnotherWayThanTheOneAskedFor) {
  OneWireState state;
  EXPECT_FALSE(TakeFound(ReaderBesideButton, state));
  EXPECT_FALSE(state.Found);
  ASSERT_TRUE(TakeFound(ButtonBesideReader, state));
  EXPECT_FALSE(TakeFound(ButtonBesideReader, state));
}

TEST(RomSearch, KnowsTheLastDevice) {
  EXPECT_TRUE(IsLast(ReaderBesideButton));
  EXPECT_TRUE(IsLast(ButtonAlone));
  EXPECT_FALSE(IsLast(ButtonBesideReader));
  SearchBlock nobody{};
  EXPECT_FALSE(IsLast(nobody));
  nobody.fill(0xFF);
  EXPECT_FALSE(IsLast(nobody));
}

TEST(RomSearch, AsksForADeviceByAllOfItsNumber) {
  EXPECT_EQ(PathTo({0x01, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0x00, 0xA3}), ButtonAlone);
  EXPECT_THAT(PathTo({}), Each(0));
}

/// Paths never hold the byte that would have to be sent twice in data mode (0xE3): only upper bits are set.
TEST(RomSearch, NeedsSixteenBytesForAnyPath) {
  OneWireState state;
  state.Found = true;
  state.Rom.fill(0xFF);
  state.Branch = 63;
  EXPECT_THAT(PathToNext(state), Each(0xAA));
}

class NoNumber : public testing::Test {
 protected:
  static void ExpectNone(const SearchBlock& answer) {
    OneWireState state;
    state.Found = true;
    state.Rom = {0x01, 0x45, 0x67, 0x89, 0xAB, 0xCD, 0x00, 0xA3};
    state.Branch = 7;
    EXPECT_FALSE(TakeFound(answer, state));
    EXPECT_FALSE(state.Found);
    EXPECT_THAT(state.Rom, Each(0));
    EXPECT_EQ(state.Branch, OneWireState::None);
  }
};

TEST_F(NoNumber, IsReadFromABusWithoutAnAnswer) {
  SearchBlock nobody{};
  nobody.fill(0xFF);
  ExpectNone(nobody);
}

TEST_F(NoNumber, IsReadFromAShortedBus) {
  ExpectNone({});
}

TEST_F(NoNumber, IsReadWhenTheDeviceLeavesAnywhereInTheRead) {
  for (std::size_t left = 0; left < ButtonAlone.size(); ++left) {
    SearchBlock answer = ButtonAlone;
    std::fill(answer.begin() + static_cast<std::ptrdiff_t>(left), answer.end(), std::uint8_t{0xFF});
    ExpectNone(answer);
  }
}

TEST_F(NoNumber, IsReadWhenOneBitIsWrong) {
  for (int bit = 0; bit < 64; ++bit) {
    SearchBlock answer = ButtonAlone;
    answer[static_cast<std::size_t>(bit / 4)] ^= static_cast<std::uint8_t>(2U << (bit % 4 * 2));
    ExpectNone(answer);
  }
}

}  // namespace
