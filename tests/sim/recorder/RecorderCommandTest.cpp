#include "sim/recorder/RecorderCommand.h"

#include <gtest/gtest.h>

#include <utility>
#include <vector>

#include "tests/support/Bytes.h"

namespace sim {
namespace {

using Kind = RecorderCommandKind;

constexpr RecorderMode Gun = RecorderMode::InProduct;
constexpr RecorderMode Alone = RecorderMode::StandAlone;

std::optional<RecorderCommand> ReadIn(RecorderMode mode, const Bytes& bytes) {
  return ReadRecorderCommand(mode, bytes);
}

TEST(RecorderCommand, OfAGunIsReadFromItsBytes) {
  EXPECT_EQ(ReadIn(Gun, {10, 0}), RecorderCommand{Kind::Start});
  EXPECT_EQ(ReadIn(Gun, {2, 0}), RecorderCommand{Kind::Erase});
  EXPECT_EQ(ReadIn(Gun, {1, 0, 0, 0}), (RecorderCommand{Kind::Page, 0}));
  EXPECT_EQ(ReadIn(Gun, {1, 0, 0x34, 0x12}), (RecorderCommand{Kind::Page, 0x1234}));
  EXPECT_EQ(ReadIn(Gun, {0, 0}), RecorderCommand{Kind::End});
  EXPECT_EQ(ReadIn(Gun, {14, 0, 59}), (RecorderCommand{Kind::Play, 59}));
}

TEST(RecorderCommand, OfAStandAloneRecorderIsReadFromItsBytes) {
  EXPECT_EQ(ReadIn(Alone, {2, 3}), RecorderCommand{Kind::StartOrErase});
  EXPECT_EQ(ReadIn(Alone, {1, 127}), (RecorderCommand{Kind::Header, 127}));
  EXPECT_EQ(ReadIn(Alone, {0, 0}), RecorderCommand{Kind::End});
  EXPECT_EQ(ReadIn(Alone, {3, 2, 5}), (RecorderCommand{Kind::Play, 5}));
}

TEST(RecorderCommand, IsNoneUntilItIsWholeAndNoneWithMoreBehindIt) {
  for (const auto& [mode, whole] : std::vector<std::pair<RecorderMode, Bytes>>{
           {Gun, {10, 0}}, {Gun, {1, 0, 5, 0}}, {Gun, {14, 0, 5}}, {Alone, {2, 3}}, {Alone, {3, 2, 5}}}) {
    for (std::size_t length = 1; length < whole.size(); ++length) {
      const Bytes begun(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(length));
      EXPECT_EQ(ReadIn(mode, begun), std::nullopt);
      EXPECT_TRUE(BeginsRecorderCommand(mode, begun));
    }
    Bytes longer = whole;
    longer.push_back(0);
    EXPECT_EQ(ReadIn(mode, longer), std::nullopt);
    EXPECT_FALSE(BeginsRecorderCommand(mode, longer));
  }
}

TEST(RecorderCommand, BelongsToOneModeOnly) {
  EXPECT_FALSE(BeginsRecorderCommand(Alone, Bytes{10}));
  EXPECT_FALSE(BeginsRecorderCommand(Alone, Bytes{2, 0}));
  EXPECT_FALSE(BeginsRecorderCommand(Alone, Bytes{14}));
  EXPECT_FALSE(BeginsRecorderCommand(Gun, Bytes{2, 3}));
  EXPECT_FALSE(BeginsRecorderCommand(Gun, Bytes{3}));
  EXPECT_FALSE(BeginsRecorderCommand(Gun, Bytes{1, 7}));
}

TEST(RecorderCommand, IsFoundAtTheEndOfABrokenBlockWhenAHostBeginsAnew) {
  EXPECT_EQ(NewBeginningAtEndOf(Alone, Bytes{2, 3}), 2U);
  EXPECT_EQ(NewBeginningAtEndOf(Alone, Bytes{7, 7, 2, 3}), 2U);
  EXPECT_EQ(NewBeginningAtEndOf(Alone, Bytes{3, 2, 9}), 3U);
  EXPECT_EQ(NewBeginningAtEndOf(Gun, Bytes{7, 10, 0}), 2U);
  EXPECT_EQ(NewBeginningAtEndOf(Gun, Bytes{14, 0, 1}), 3U);
  EXPECT_EQ(NewBeginningAtEndOf(Gun, Bytes{2, 3}), 0U);
  EXPECT_EQ(NewBeginningAtEndOf(Alone, Bytes{2, 3, 7}), 0U);
  EXPECT_EQ(NewBeginningAtEndOf(Alone, Bytes{0, 0}), 0U);
  EXPECT_EQ(NewBeginningAtEndOf(Alone, Bytes{3}), 0U);
  EXPECT_EQ(NewBeginningAtEndOf(Alone, Bytes{}), 0U);
}

TEST(RecorderCommand, GoesByTheSpeedOfTheLine) {
  EXPECT_EQ(ModeAt(19200), Gun);
  EXPECT_EQ(ModeAt(115200), Alone);
}

}  // namespace
}  // namespace sim
