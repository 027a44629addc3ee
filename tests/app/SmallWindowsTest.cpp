#include <gmock/gmock.h>

#include <QLabel>
#include <QLineEdit>
#include <QProgressBar>
#include <QPushButton>
#include <QTest>
#include <QTimer>

#include "app/About.h"
#include "app/SoldieringCalc.h"
#include "app/UploadProgress.h"
#include "tests/app/Venue.h"

namespace {

/// Runs `operate` on the next modal window of type `Window`.
template <typename Window, typename Operate>
void WhenShown(Operate operate) {
  QTimer::singleShot(0, [operate] { operate(*qobject_cast<Window*>(QApplication::activeModalWidget())); });
}

QLineEdit& Entry(QWidget& window, const char* name) {
  return *window.findChild<QLineEdit*>(QString::fromUtf8(name));
}

void Press(QWidget& window, const char* name) {
  QTest::mouseClick(window.findChild<QPushButton*>(QString::fromUtf8(name)), Qt::LeftButton);
}

TEST(SoldieringCalculation, ShowsTheFactorsAndStoresTheirLeadingNumbers) {
  const StringTable strings(Language::English);
  SoldieringFactors factors{0.5, -1, -2.25, 3, 1, -1};
  SoldieringCalc window(factors, strings, nullptr);
  EXPECT_EQ(Entry(window, "TotalDamage").text(), QStringLiteral(".5"));
  EXPECT_EQ(Entry(window, "Respawns").text(), QStringLiteral("-1"));
  EXPECT_EQ(Entry(window, "Heals").text(), QStringLiteral("-2.25"));
  EXPECT_EQ(Entry(window, "AmmoAdds").text(), QStringLiteral("3"));
  EXPECT_EQ(Entry(window, "Accuracy").text(), QStringLiteral("1"));
  Entry(window, "TotalDamage").setText(QStringLiteral("12abc"));
  Entry(window, "Heals").setText(QStringLiteral("nothing"));
  window.show();
  Press(window, "SaveExit");
  EXPECT_EQ(factors.Damage, 12);
  EXPECT_EQ(factors.Heal, 0);
  EXPECT_EQ(factors.FriendlyFire, -1);
  EXPECT_FALSE(window.isVisible());
}

TEST(SoldieringCalculation, TakesItsCaptionsFromTheStringTable) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    const StringTable strings(language);
    SoldieringFactors factors;
    SoldieringCalc window(factors, strings, nullptr);
    EXPECT_EQ(window.windowTitle().toStdString(), strings.Text(163));
    const std::pair<const char*, int> labels[] = {
        {"DamageLabel", 165},   {"DeathLabel", 166},   {"HealLabel", 167},    {"AmmoLabel", 168},
        {"AccuracyLabel", 106}, {"Explanation1", 169}, {"Explanation2", 170}, {"Explanation3", 171}};
    for (const auto& [name, number] : labels) {
      EXPECT_EQ(window.findChild<QLabel*>(QString::fromUtf8(name))->text().toStdString(),
                strings.Text(number));
    }
  }
}

TEST(SoldieringCalculation, ChangesTheBoardAtOnceAndWritesTheFile) {
  Venue venue;
  venue.Start();
  WriteFile(
      venue.Folder / "game.xml",
      "<GameData><PlayerData><Player><Index>1</Index><Active>1</Active><HealCount>2</HealCount></Player>"
      "</PlayerData></GameData>");
  venue.Dialog.Answers = {venue.Folder / "game.xml"};
  venue.Trigger("mnuLoadScores");
  ASSERT_EQ(venue.Row("ScoreDisplay", 0)[2], "-2");
  WhenShown<SoldieringCalc>([](SoldieringCalc& window) {
    Entry(window, "Heals").setText(QStringLiteral("5"));
    Press(window, "SaveExit");
  });
  venue.Trigger("mnuSoldieringCalc");
  EXPECT_EQ(venue.Row("ScoreDisplay", 0)[2], " 10");
  EXPECT_NE(ReadFile(venue.DataFile("tessarine.ini")).find("heals= 5"), std::string::npos);
}

TEST(SoldieringCalculation, KeepsTheFactorsOnCancelButWritesThemBack) {
  Venue venue;
  venue.Start();
  WriteFile(venue.DataFile("tessarine.ini"), "");
  WhenShown<SoldieringCalc>([](SoldieringCalc& window) {
    Entry(window, "Heals").setText(QStringLiteral("5"));
    Press(window, "Cancel");
  });
  venue.Trigger("mnuSoldieringCalc");
  const std::string ini = ReadFile(venue.DataFile("tessarine.ini"));
  EXPECT_NE(ini.find("heals=-1"), std::string::npos);
  EXPECT_NE(ini.find("friendly_fire_factor=-1"), std::string::npos);
}

TEST(AboutWindow, ShowsTheVersionAndClosesByOk) {
  About window(nullptr);
  window.show();
  EXPECT_EQ(window.windowTitle(), QStringLiteral("Tessarine by Orvalin"));
  EXPECT_EQ(window.findChild<QLabel*>(QStringLiteral("VersionInfo"))->text(),
            QStringLiteral("3.54 21-5-2013"));
  Press(window, "OK");
  EXPECT_FALSE(window.isVisible());
}

TEST(UploadProgressWindow, ShowsOnlyWhatItIsTold) {
  const StringTable strings(Language::English);
  UploadProgress window(strings, nullptr);
  window.Open();
  const auto* bar = window.findChild<QProgressBar*>(QStringLiteral("Progress"));
  EXPECT_EQ(window.windowTitle(), QStringLiteral("Upload Progress"));
  EXPECT_TRUE(window.isVisible());
  EXPECT_EQ(bar->maximum(), 224);
  EXPECT_EQ(bar->value(), 0);
  window.SetMaximum(40);
  window.SetProgress(7);
  window.SetStatusText("Accepting Score Data...");
  EXPECT_EQ(bar->maximum(), 40);
  EXPECT_EQ(bar->value(), 7);
  EXPECT_EQ(window.findChild<QLabel*>(QStringLiteral("UploadIndex"))->text(), QStringLiteral("7"));
  EXPECT_EQ(window.findChild<QLabel*>(QStringLiteral("StatusText"))->text(),
            QStringLiteral("Accepting Score Data..."));
  EXPECT_FALSE(window.ClosedByOperator());
  window.reject();
  EXPECT_TRUE(window.ClosedByOperator());
}

}  // namespace
