#include "sim/box/BoxFrame.h"

#include <gtest/gtest.h>

#include <vector>

namespace sim {
namespace {

constexpr BoxFrame Zeros{0x42, 0x43, 0, 0, 0, 0, 0, 0, 0, 0};
constexpr BoxFrame Domination{0x42, 0x43, 0x38, 0x14, 0x05, 0x64, 0x02, 0x01, 0x00, 0x00};

BoxFrame With(BoxFrame frame, std::size_t index, std::uint8_t value) {
  frame.at(index) = value;
  return frame;
}

std::vector<BoxFrame> FramesIn(const std::vector<std::uint8_t>& bytes) {
  BoxFrameReader reader;
  std::vector<BoxFrame> frames;
  for (const std::uint8_t byte : bytes) {
    if (const std::optional<BoxFrame> frame = reader.Take(byte)) {
      frames.push_back(*frame);
    }
  }
  return frames;
}

TEST(BoxFrame, HasNoFaultWithTheLeastAndTheMostOfEachValue) {
  EXPECT_EQ(WrongIn(Zeros), std::nullopt);
  EXPECT_EQ(WrongIn({0x42, 0x43, 0x38, 100, 100, 100, 255, 1, 0, 0}), std::nullopt);
}

TEST(BoxFrame, IsWrongBeyondTheRangeOfEachValue) {
  const std::vector<std::pair<BoxFrame, std::string>> wrong{
      {With(Zeros, 2, 0x40), "a team of 4"},
      {With(Zeros, 2, 0x39), "a type of 9"},
      {With(Zeros, 3, 101), "101 in byte 3, where 100 is the most"},
      {With(Zeros, 4, 101), "101 in byte 4, where 100 is the most"},
      {With(Zeros, 5, 255), "255 in byte 5, where 100 is the most"},
      {With(Zeros, 7, 2), "2 for a yes or no"},
      {With(Zeros, 7, 255), "255 for a yes or no"},
      {With(Zeros, 8, 1), "something in the last two bytes"},
      {With(Zeros, 9, 1), "something in the last two bytes"}};
  for (const auto& [frame, what] : wrong) {
    EXPECT_EQ(WrongIn(frame), what);
  }
}

TEST(BoxFrame, IsDescribedInWords) {
  EXPECT_EQ(
      Describe(Domination),
      "Dom. (iBtn), yellow, 20 points per activation, 5 to recharge, 100 to give, automatic after 20 s, "
      "destroyable");
  EXPECT_EQ(Describe(Zeros),
            "Medic, all teams, 0 points per activation, 0 to recharge, 0 to give, automatic after 0 s, "
            "not destroyable");
}

TEST(BoxFrameReader, TakesFramesOneAfterTheOther) {
  std::vector<std::uint8_t> bytes(Zeros.begin(), Zeros.end());
  bytes.insert(bytes.end(), Domination.begin(), Domination.end());
  EXPECT_EQ(FramesIn(bytes), (std::vector<BoxFrame>{Zeros, Domination}));
}

TEST(BoxFrameReader, DropsWhatComesBeforeAFramesTwoLetters) {
  for (const std::vector<std::uint8_t>& noise :
       std::vector<std::vector<std::uint8_t>>{{0xFF, 0x00}, {0x43}, {0x42}, {0x42, 0x42}, {0x42, 0x44}}) {
    std::vector<std::uint8_t> bytes = noise;
    bytes.insert(bytes.end(), Domination.begin(), Domination.end());
    EXPECT_EQ(FramesIn(bytes), std::vector<BoxFrame>{Domination}) << noise.size();
  }
}

TEST(BoxFrameReader, TakesTheTwoLettersForValuesWithinAFrame) {
  const BoxFrame letters{0x42, 0x43, 0x32, 0x42, 0x43, 0x42, 0x43, 0x01, 0x00, 0x00};
  EXPECT_EQ(FramesIn({letters.begin(), letters.end()}), std::vector<BoxFrame>{letters});
}

TEST(BoxFrameReader, ForgetsWhatHasBegunWhenToldToStartOver) {
  BoxFrameReader reader;
  reader.Take(0x42);
  reader.Take(0x43);
  EXPECT_EQ(reader.Count(), 2U);
  reader.StartOver();
  EXPECT_EQ(reader.Count(), 0U);
  for (std::size_t i = 0; i < 9; ++i) {
    EXPECT_EQ(reader.Take(Zeros.at(i)), std::nullopt);
  }
  EXPECT_EQ(reader.Take(0), Zeros);
}

}  // namespace
}  // namespace sim
