#include <gmock/gmock.h>

#include <QLineEdit>

#include "settings/Settings.h"
#include "settings/SoldieringCalc.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

TEST(SettingsCommand, OpensTheWindowAndLeavesThePortAlone) {
  Venue venue;
  venue.Start();
  const WhileModal<Settings> operatorAtWork([](Settings& window) {
    Find<QLineEdit>(window, "CommPortNumber").setText(QStringLiteral("3"));
    Press(window, "SaveExit");
  });
  venue.Trigger("mnuCommPort");
  EXPECT_EQ(operatorAtWork.Runs(), 1);
  EXPECT_THAT(ReadFile(venue.DataFile("tessarine.ini")), testing::HasSubstr("commport= 3"));
  EXPECT_THAT(venue.Port.Log, IsEmpty());
  EXPECT_EQ(venue.Window->findChild<Settings*>(), nullptr);
}

class SoldieringCalcCommand : public testing::Test {
 protected:
  SoldieringCalcCommand() {
    venue.PutDefaultFiles();
    WriteFile(venue.DataFile("tessarine.ini"),
              "[soldiering_calc]\nfriendly_fire_factor=-.5\n[other]\nkey=1\n");
    venue.Start();
  }

  /// Enters a factor for heals and presses a button.
  void Choose(const char* heals, const char* button) const {
    const WhileModal<SoldieringCalc> operatorAtWork([heals, button](SoldieringCalc& window) {
      Find<QLineEdit>(window, "Heals").setText(QString::fromUtf8(heals));
      Press(window, button);
    });
    venue.Trigger("mnuSoldieringCalc");
    EXPECT_EQ(operatorAtWork.Runs(), 1);
  }

  std::string IniFile() const { return ReadFile(venue.DataFile("tessarine.ini")); }

  Venue venue;
};

TEST_F(SoldieringCalcCommand, ShowsTheDefaultsOfAnIniFileWithoutFactors) {
  const WhileModal<SoldieringCalc> operatorAtWork([](SoldieringCalc& window) {
    for (const auto& [entry, factor] : {std::pair{"TotalDamage", "1"},
                                        {"Respawns", "-1"},
                                        {"Heals", "-1"},
                                        {"AmmoAdds", "-1"},
                                        {"Accuracy", "1"}}) {
      EXPECT_EQ(Find<QLineEdit>(window, entry).text().toStdString(), factor) << entry;
    }
    Press(window, "Cancel");
  });
  venue.Trigger("mnuSoldieringCalc");
  EXPECT_EQ(operatorAtWork.Runs(), 1);
}

TEST_F(SoldieringCalcCommand, WritesTheSixFactorsInNumberForm) {
  Choose("12abc", "SaveExit");
  EXPECT_EQ(IniFile(),
            "[soldiering_calc]\nfriendly_fire_factor=-.5\ntotal_damage= 1\nrespawns=-1\nheals= 12\n"
            "ammo_adds=-1\naccuracy= 1\n[other]\nkey=1\n");
}

TEST_F(SoldieringCalcCommand, WritesTheFactorsInForceOnCancel) {
  Choose("12", "Cancel");
  EXPECT_EQ(IniFile(),
            "[soldiering_calc]\nfriendly_fire_factor=-.5\ntotal_damage= 1\nrespawns=-1\nheals=-1\n"
            "ammo_adds=-1\naccuracy= 1\n[other]\nkey=1\n");
}

TEST_F(SoldieringCalcCommand, ChangesTheBoardAtOnce) {
  venue.LoadGame(GameFile(PlayerOf(1, "<HealCount>2</HealCount>")));
  ASSERT_EQ(venue.Row("ScoreDisplay", 0)[2], "-2");
  Choose("5", "SaveExit");
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[2], " 10");
  EXPECT_THAT(venue.Row("TeamScores", 0), ElementsAre("1", "Red", " 10"));
}

TEST_F(SoldieringCalcCommand, KeepsFactorsThatTheGameCannotBeScoredWith) {
  venue.LoadGame(GameFile(PlayerOf(1, "<HealCount>2</HealCount>")));
  Choose("1E300", "SaveExit");
  EXPECT_THAT(venue.Boxes.Boxes,
              ElementsAre(FakeMessageBoxes::Box{"Run-time error '6': Overflow", "Tessarine",
                                                BoxIcon::Critical, BoxButtons::Ok}));
  EXPECT_THAT(IniFile(), testing::HasSubstr("heals= 1E+300\n"));
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 0);
}

TEST_F(SoldieringCalcCommand, CalculatesNothingWithoutAGame) {
  Choose("5", "SaveExit");
  EXPECT_EQ(venue.RowCount("TeamScores"), 0);
}

TEST_F(SoldieringCalcCommand, KeepsItsFactorsForTheNextStart) {
  Choose("5", "SaveExit");
  venue.Window.reset();
  venue.Start();
  venue.LoadGame(GameFile(PlayerOf(1, "<HealCount>2</HealCount>")));
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[2], " 10");
}

}  // namespace
