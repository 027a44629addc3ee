#include "devices/radio/GunTable.h"

#include <gmock/gmock.h>

#include <map>

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

TEST(Weapons, HaveTheNamesOfTheirCodes) {
  const std::map<int, std::string> names = {
      {0, "Target"},     {1, "Pistol 1"},  {2, "Shotgun 1"}, {3, "SMG 1"},     {4, "P90"},
      {5, "Assault 1"},  {6, "Assault 2"}, {7, "Sniper 1"},  {8, "SAW 1"},     {9, "SAW 2"},
      {10, "Kids"},      {11, "SciFi 1"},  {12, "SciFi 2"},  {13, "Sniper 3"}, {14, "Sniper 4"},
      {15, "Shotgun 2"}, {16, "Pistol 2"}, {17, "Vintorez"}, {100, "Target"},  {101, "HMG 1"},
      {102, "M134A"},    {103, "M134B"},   {104, "RPG"},     {105, "LMG 1"},   {106, "Sniper 2"},
      {107, "MG34"},     {108, "Sniper 5"}};
  for (int code = 0; code <= 255; ++code) {
    const auto name = names.find(code);
    EXPECT_EQ(WeaponText(static_cast<std::uint8_t>(code)), name != names.end() ? name->second : "Unknown")
        << code;
  }
}

TEST(ScoreStatuses, HaveTheirNumbersAndTexts) {
  EXPECT_EQ(static_cast<int>(ScoreStatus::Pending), 0);
  EXPECT_EQ(static_cast<int>(ScoreStatus::InProgress), 1);
  EXPECT_EQ(static_cast<int>(ScoreStatus::Failed), 2);
  EXPECT_EQ(static_cast<int>(ScoreStatus::Ok), 3);
  EXPECT_EQ(StatusText(ScoreStatus::Pending), "Scores Pending");
  EXPECT_EQ(StatusText(ScoreStatus::InProgress), "Scores In Progress");
  EXPECT_EQ(StatusText(ScoreStatus::Failed), "Scores Failed");
  EXPECT_EQ(StatusText(ScoreStatus::Ok), "Scores OK");
}

TEST(GunTables, TellWhetherGunsAnsweredUpToTheEdgeOfTheSearch) {
  const auto answered = [](int index, std::int16_t ids) {
    GunTable guns;
    guns[static_cast<std::size_t>(index)].Present = true;
    return AnsweredUpToEdge(guns, ids);
  };
  EXPECT_FALSE(answered(126, 128));
  EXPECT_TRUE(answered(127, 128));
  EXPECT_TRUE(answered(200, 128));
  EXPECT_FALSE(answered(223, 224));  // there are no more
  EXPECT_FALSE(AnsweredUpToEdge(GunTable{}, 128));
}

TEST(GunRows, HaveABlankBeforeTheBattery) {
  GunEntry gun;
  gun.PlayerName = "Red  1";
  gun.Firmware = " 2. 5";
  gun.Battery = 85;
  gun.WeaponType = 17;
  gun.ScoreStatus = ScoreStatus::Ok;
  EXPECT_THAT(RowOf(gun), ElementsAre("Red  1", " 2. 5", " 85%", "Vintorez", "Scores OK"));
  EXPECT_EQ(BatteryText(0), " 0%");
  EXPECT_EQ(BatteryText(255), " 255%");
}

TEST(ListedGuns, AreThosePresentUpToTheLargestIdAndItself) {
  GunTable guns;
  EXPECT_THAT(ListedGuns(guns, 224), IsEmpty());
  for (const std::size_t index : {0U, 5U, 127U, 128U, 129U, 223U}) {
    guns[index].Present = true;
  }
  EXPECT_THAT(ListedGuns(guns, 128), ElementsAre(0, 5, 127, 128));
  EXPECT_THAT(ListedGuns(guns, 224), ElementsAre(0, 5, 127, 128, 129, 223));
}

TEST(GunTables, Have225Entries) {
  EXPECT_EQ(GunTable().size(), 225U);
}

}  // namespace
