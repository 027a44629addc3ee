#include "core/game/SoldieringFactors.h"

#include <gtest/gtest.h>

#include <string>

#include "core/text/NumberForms.h"
#include "tests/fakes/FakeFiles.h"

namespace {

constexpr const char* Path = "/data/tessarine.ini";

class SoldieringFactorsTest : public testing::Test {
 protected:
  SoldieringFactors Read(const std::string& bytes) {
    Store.Put(Path, bytes);
    return ReadSoldieringFactors(Ini);
  }

  int ErrorOf(const std::string& bytes) {
    try {
      Read(bytes);
    } catch (const RuntimeError& error) {
      return error.Number();
    }
    return 0;
  }

  FakeFiles Store;
  IniReader Ini{Store, Path};
};

TEST_F(SoldieringFactorsTest, HaveTheirDefaultsWithoutTheSection) {
  const SoldieringFactors factors = Read("[comm]\ncommport=1\n");
  EXPECT_EQ(factors.Damage, 1);
  EXPECT_EQ(factors.Death, -1);
  EXPECT_EQ(factors.Heal, -1);
  EXPECT_EQ(factors.Ammo, -1);
  EXPECT_EQ(factors.Accuracy, 1);
  EXPECT_EQ(factors.FriendlyFire, -1);
}

TEST_F(SoldieringFactorsTest, ComeFromTheirKeys) {
  const SoldieringFactors factors = Read(
      "[soldiering_calc]\nfriendly_fire_factor=-.5\ntotal_damage= 2\nrespawns=-3\nheals= .25\nammo_adds=0\n"
      "accuracy= 1E-05\n");
  EXPECT_EQ(factors.Damage, 2);
  EXPECT_EQ(factors.Death, -3);
  EXPECT_EQ(factors.Heal, 0.25);
  EXPECT_EQ(factors.Ammo, 0);
  EXPECT_EQ(factors.Accuracy, 1E-5);
  EXPECT_EQ(factors.FriendlyFire, -0.5);
}

TEST_F(SoldieringFactorsTest, HaveADefaultForEachMissingKey) {
  const SoldieringFactors factors = Read("[soldiering_calc]\nheals=-2\n");
  EXPECT_EQ(factors.Damage, 1);
  EXPECT_EQ(factors.Heal, -2);
}

TEST_F(SoldieringFactorsTest, ReportATextThatIsNoNumber) {
  for (const char* key :
       {"total_damage", "respawns", "heals", "ammo_adds", "accuracy", "friendly_fire_factor"}) {
    const std::string start = "[soldiering_calc]\n" + std::string(key) + "=";
    EXPECT_EQ(ErrorOf(start + "12abc\n"), 13) << key;
    EXPECT_EQ(ErrorOf(start + "\n"), 13) << key;
    EXPECT_EQ(ErrorOf(start + "1E999\n"), 6) << key;
  }
}

TEST_F(SoldieringFactorsTest, AreWrittenInNumberFormAndOrder) {
  Store.AddFolder("/data");
  WriteSoldieringFactors(
      Ini, {.Damage = 2.5, .Death = -1, .Heal = 0, .Ammo = -0.5, .Accuracy = 0.5, .FriendlyFire = 1E-5});
  EXPECT_EQ(Store.Read(Path),
            "[soldiering_calc]\ntotal_damage= 2.5\nrespawns=-1\nheals= 0\nammo_adds=-.5\naccuracy= .5\n"
            "friendly_fire_factor= 1E-05\n");
  EXPECT_EQ(Store.Replaced.size(), 1U);
}

TEST_F(SoldieringFactorsTest, ComeBackAsTheyWereWritten) {
  Store.Put(Path, "; kept\r\n[soldiering_calc]\r\nheals = 9\r\n");
  WriteSoldieringFactors(
      Ini, {.Damage = 2.5, .Death = -3, .Heal = 0.125, .Ammo = 7, .Accuracy = -4, .FriendlyFire = 0.5});
  const SoldieringFactors factors = ReadSoldieringFactors(Ini);
  EXPECT_EQ(factors.Damage, 2.5);
  EXPECT_EQ(factors.Death, -3);
  EXPECT_EQ(factors.Heal, 0.125);
  EXPECT_EQ(factors.Ammo, 7);
  EXPECT_EQ(factors.Accuracy, -4);
  EXPECT_EQ(factors.FriendlyFire, 0.5);
  EXPECT_TRUE(Store.Read(Path).starts_with("; kept\r\n[soldiering_calc]\r\nheals = .125\r\n"));
}

TEST_F(SoldieringFactorsTest, OfAnyEntryInABoxCanBeReadBack) {
  Store.AddFolder("/data");
  WriteSoldieringFactors(Ini, {.Damage = Val("1E999"), .Death = Val("-1E999"), .Heal = Val("none")});
  const SoldieringFactors factors = ReadSoldieringFactors(Ini);
  EXPECT_EQ(factors.Damage, Val("1E999"));
  EXPECT_EQ(factors.Death, Val("-1E999"));
  EXPECT_EQ(factors.Heal, 0);
}

TEST_F(SoldieringFactorsTest, DoNotReportAFailedWrite) {
  Store.Put(Path, "[soldiering_calc]\nheals=-2\n");
  Store.FailReplace(Path, RuntimeError(61));
  EXPECT_NO_THROW(WriteSoldieringFactors(Ini, {}));
  EXPECT_EQ(ReadSoldieringFactors(Ini).Heal, -2);
}

}  // namespace
