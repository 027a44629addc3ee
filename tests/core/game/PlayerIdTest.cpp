#include "core/game/PlayerId.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <initializer_list>

#include "platform/RuntimeError.h"

namespace {

struct Block {
  int FirstId;
  int Team;
  int FirstNumber;
};

constexpr Block Blocks[] = {{32, 1, 0},   {64, 2, 0},   {96, 3, 0},  {128, 1, 32},
                            {160, 1, 64}, {192, 2, 32}, {224, 2, 64}};

std::uint8_t Id(std::int16_t team, std::int16_t number) {
  return IdFromTeamAndNumber(static_cast<std::uint8_t>(team), static_cast<std::uint8_t>(number));
}

TEST(PlayerId, NamesTeamAndNumberByBlock) {
  for (const Block& block : Blocks) {
    for (int inBlock = 0; inBlock < 32; ++inBlock) {
      const auto id = static_cast<std::uint8_t>(block.FirstId + inBlock);
      EXPECT_EQ(TeamFromId(id), block.Team) << int{id};
      EXPECT_EQ(PlayerNumberFromId(id), block.FirstNumber + inBlock) << int{id};
    }
  }
}

TEST(PlayerId, ComesBackFromTeamAndNumber) {
  for (int id = 32; id <= 255; ++id) {
    const auto byte = static_cast<std::uint8_t>(id);
    EXPECT_EQ(Id(TeamFromId(byte), PlayerNumberFromId(byte)), id);
    EXPECT_LE(PlayerNumberFromId(byte), MaxPlayerNumber(TeamFromId(byte)));
  }
}

TEST(PlayerId, BelowThirtyTwoCountsAsNumberZeroOfTeamOne) {
  for (int id = 0; id < 32; ++id) {
    EXPECT_EQ(TeamFromId(static_cast<std::uint8_t>(id)), 1);
    EXPECT_EQ(PlayerNumberFromId(static_cast<std::uint8_t>(id)), 0);
  }
}

TEST(MaxPlayerNumber, IsThirtyOneForTeamThreeOnly) {
  EXPECT_EQ(MaxPlayerNumber(3), 31);
  for (const std::int16_t team : std::initializer_list<std::int16_t>{-1, 0, 1, 2, 4}) {
    EXPECT_EQ(MaxPlayerNumber(team), 95) << team;
  }
}

TEST(IdFromTeamAndNumber, StepsFromBlockToBlock) {
  EXPECT_EQ(Id(1, 31), 63);
  EXPECT_EQ(Id(1, 32), 128);
  EXPECT_EQ(Id(1, 40), 136);
  EXPECT_EQ(Id(1, 64), 160);
  EXPECT_EQ(Id(2, 31), 95);
  EXPECT_EQ(Id(2, 32), 192);
  EXPECT_EQ(Id(2, 95), 255);
  EXPECT_EQ(Id(3, 31), 127);
}

TEST(IdFromTeamAndNumber, IsZeroForAGunThatCannotExist) {
  EXPECT_EQ(Id(3, 32), 0);
  EXPECT_EQ(Id(0, 5), 0);
  EXPECT_EQ(Id(4, 5), 0);
}

TEST(IdFromTeamAndNumber, OverflowsPastTheLastId) {
  EXPECT_EQ(Id(1, 159), 255);
  EXPECT_THROW(Id(1, 160), RuntimeError);
  EXPECT_THROW(Id(2, 96), RuntimeError);
  EXPECT_EQ(Id(3, 255), 0);
}

TEST(TeamNames, AreThoseOfTheStringTable) {
  const StringTable english(Language::English);
  EXPECT_EQ(TeamNameFromNumber(english, 1), "Red");
  EXPECT_EQ(TeamNameFromNumber(english, 2), "Blue");
  EXPECT_EQ(TeamNameFromNumber(english, 3), "Yellow");
  for (const std::int16_t team : std::initializer_list<std::int16_t>{-1, 0, 4, 300}) {
    EXPECT_EQ(TeamNameFromNumber(english, team), "") << team;
  }
}

TEST(TeamNames, LeadBackToTheirTeamInBothLanguages) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    const StringTable texts(language);
    for (std::int16_t team = 1; team <= 3; ++team) {
      EXPECT_EQ(TeamNumberFromName(texts, TeamNameFromNumber(texts, team)), team);
    }
  }
}

TEST(TeamNames, AreComparedExactly) {
  const StringTable english(Language::English);
  for (const char* name : {"", "red", "Red ", "Green", "红队"}) {
    EXPECT_EQ(TeamNumberFromName(english, name), 0) << name;
  }
}

TEST(RecordIndex, RunsFromOneOverAllGuns) {
  EXPECT_EQ(IndexFromId(32), 1);
  EXPECT_EQ(IndexFromId(255), PlayerCount);
  EXPECT_EQ(IndexFromId(136), 105);
  EXPECT_EQ(IndexFromId(0), -31);
  for (int index = 1; index <= PlayerCount; ++index) {
    EXPECT_EQ(IndexFromId(IdFromIndex(index)), index);
  }
}

}  // namespace
