#include "settings/SoldieringCalc.h"

#include <gmock/gmock.h>

#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <optional>

#include "tests/support/Controls.h"

namespace {

using testing::ElementsAre;

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

}  // namespace
