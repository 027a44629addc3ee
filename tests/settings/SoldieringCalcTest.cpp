#include "settings/SoldieringCalc.h"

#include <gmock/gmock.h>

#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>

#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;

class SoldieringCalcWindow : public testing::Test {
 protected:
  void Open(const SoldieringFactors& inForce, Language language = Language::English) {
    strings.emplace(language);
    factors = inForce;
    window = std::make_unique<SoldieringCalc>(factors, *strings, nullptr);
    Show(*window);
  }

  std::string Shown(const char* entry) const { return Find<QLineEdit>(*window, entry).text().toStdString(); }

  void Enter(const char* entry, const char* text) const {
    QLineEdit& box = Find<QLineEdit>(*window, entry);
    box.setFocus();
    box.selectAll();
    QTest::keyClicks(&box, QString::fromUtf8(text));
  }

  SoldieringFactors factors;
  std::optional<StringTable> strings;
  std::unique_ptr<SoldieringCalc> window;
};

TEST_F(SoldieringCalcWindow, TakesItsCaptionsFromTheStringTable) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    Open({}, language);
    EXPECT_EQ(window->windowTitle().toStdString(), strings->Text(163));
    EXPECT_EQ(Find<QGroupBox>(*window, "Frame1").title().toStdString(), strings->Text(164));
    EXPECT_EQ(Find<QPushButton>(*window, "SaveExit").text().toStdString(), strings->Text(162));
    EXPECT_EQ(Find<QPushButton>(*window, "Cancel").text().toStdString(), strings->Text(141));
    const std::pair<const char*, int> captions[] = {
        {"TotalDamage", 165}, {"Respawns", 166}, {"Heals", 167}, {"AmmoAdds", 168}, {"Accuracy", 106}};
    for (const auto& [entry, number] : captions) {
      std::vector<std::string> labels;
      for (const QLabel* label : window->findChildren<QLabel*>()) {
        if (label->buddy() == &Find<QLineEdit>(*window, entry)) {
          labels.push_back(label->text().toStdString());
        }
      }
      EXPECT_THAT(labels, ElementsAre(strings->Text(number))) << entry;
    }
  }
}

TEST_F(SoldieringCalcWindow, ExplainsItselfInFull) {
  Open({});
  std::vector<std::string> texts;
  for (const QLabel* label : window->findChildren<QLabel*>()) {
    if (label->wordWrap()) {
      texts.push_back(label->text().toStdString());
    }
  }
  EXPECT_THAT(
      texts, ElementsAre(
                 "These values determine how the value of Soldiering is calculated.  For every point of each "
                 "quantity listed on the left, the number inside the corresponding box will be multiplied by "
                 "the count of that quantity and then added to the soldiering value. ",
                 "For example, if you put a value of 5 in for Total damage, and the player got 100 points of "
                 "Total Damage, then the Soldiering value will be increased by a value of 500 (which is 5 X "
                 "100.)",
                 "Use positive values for rewards, and negative values for penalties."));
}

TEST_F(SoldieringCalcWindow, ShowsTheFactorsWithoutTheLeadingBlank) {
  Open({0.5, -1, -2.25, 3, 1e20, -1});
  EXPECT_EQ(Shown("TotalDamage"), ".5");
  EXPECT_EQ(Shown("Respawns"), "-1");
  EXPECT_EQ(Shown("Heals"), "-2.25");
  EXPECT_EQ(Shown("AmmoAdds"), "3");
  EXPECT_EQ(Shown("Accuracy"), "1E+20");
}

TEST_F(SoldieringCalcWindow, StoresTheLeadingNumberOfEachEntry) {
  Open({});
  Enter("TotalDamage", "12abc");
  Enter("Respawns", "-.75");
  Enter("Heals", "nothing");
  Enter("AmmoAdds", "");
  Enter("Accuracy", "1,5");
  Press(*window, "SaveExit");
  EXPECT_FALSE(window->isVisible());
  EXPECT_EQ(factors.Damage, 12);
  EXPECT_EQ(factors.Death, -0.75);
  EXPECT_EQ(factors.Heal, 0);
  EXPECT_EQ(factors.Ammo, -1);  // nothing was typed over it
  EXPECT_EQ(factors.Accuracy, 1);
  EXPECT_EQ(factors.FriendlyFire, -1);
}

TEST_F(SoldieringCalcWindow, ReadsAnEmptiedEntryAs0) {
  Open({});
  Find<QLineEdit>(*window, "AmmoAdds").clear();
  Press(*window, "SaveExit");
  EXPECT_EQ(factors.Ammo, 0);
}

TEST_F(SoldieringCalcWindow, ChangesNothingUnlessSaved) {
  const std::function<void()> endings[] = {[this] { Press(*window, "Cancel"); },
                                           [this] { Type(*window, Qt::Key_Escape); },
                                           [this] { window->close(); }};
  for (const auto& end : endings) {
    Open({2, 3, 4, 5, 6, 7});
    Enter("Heals", "50");
    end();
    EXPECT_FALSE(window->isVisible());
    EXPECT_EQ(factors.Heal, 4);
    EXPECT_EQ(factors.FriendlyFire, 7);
  }
}

TEST_F(SoldieringCalcWindow, SavesByReturn) {
  Open({});
  Enter("Heals", "50");
  Type(*window, Qt::Key_Return);
  EXPECT_FALSE(window->isVisible());
  EXPECT_EQ(factors.Heal, 50);
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
