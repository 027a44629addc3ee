#include "devices/box/BoxConfig.h"

#include <gmock/gmock.h>

#include <QCheckBox>
#include <QGroupBox>
#include <QToolTip>

#include "tests/devices/box/BoxWindow.h"
#include "tests/support/CaredFor.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

constexpr const char* NumberEntries[] = {"PointsPerAct", "RechargePoints", "ActivationAmount",
                                         "AutoModeTime"};

INSTANTIATE_TEST_SUITE_P(Languages, BoxWindow,
                         testing::Values(Language::English, Language::SimplifiedChinese),
                         [](const auto& language) {
                           return language.param == Language::English ? "English" : "SimplifiedChinese";
                         });

TEST_P(BoxWindow, HasItsFormWithZeros) {
  EXPECT_EQ(window->windowTitle(), QStringLiteral("Util Box Configuration"));
  EXPECT_EQ(Find<QGroupBox>(*window, "Frame1").title(), QStringLiteral("Box Config"));
  for (const char* entry : NumberEntries) {
    EXPECT_EQ(Entry(entry).text(), QStringLiteral("0")) << entry;
  }
  EXPECT_FALSE(Find<QCheckBox>(*window, "Destroyable").isChecked());
  EXPECT_EQ(Find<QPushButton>(*window, "ProgramButton").text(), QStringLiteral("Send To Box"));
  EXPECT_EQ(Find<QPushButton>(*window, "Close").text(), QStringLiteral("Close"));
}

TEST_P(BoxWindow, OffersTheTypesAndTeams) {
  const auto entriesOf = [](const QComboBox& list) {
    std::vector<std::string> entries;
    for (int i = 0; i < list.count(); ++i) {
      entries.push_back(list.itemText(i).toStdString());
    }
    return entries;
  };
  EXPECT_THAT(entriesOf(List("BoxType")),
              ElementsAre("Medic", "Ammo", "Respawn Any", "Repair", "Multi", "Respawn Dead", "Multi-Player",
                          "Dom. (IR)", "Dom. (iBtn)"));
  EXPECT_THAT(entriesOf(List("TeamList")),
              ElementsAre("All", Strings.Text(114), Strings.Text(115), Strings.Text(116)));
  EXPECT_EQ(List("BoxType").currentIndex(), 0);
  EXPECT_EQ(List("TeamList").currentIndex(), 0);
}

TEST_P(BoxWindow, LabelsEachEntry) {
  const std::pair<const char*, const char*> labels[] = {
      {"BoxType", "Box Type"},
      {"PointsPerAct", "Points used per activation"},
      {"RechargePoints", "Points to recharge"},
      {"ActivationAmount", "Amount to give per activation"},
      {"AutoModeTime", "Automatic mode time x10"},
      {"TeamList", "Use with Team"},
      {"Results",
       GetParam() == Language::English ? "Boxes programmed since the start" : "本次启动后设置的装置"}};
  for (const auto& [entry, text] : labels) {
    std::string found;
    for (const QLabel* label : window->findChildren<QLabel*>()) {
      if (label->buddy() != nullptr && label->buddy()->objectName().toStdString() == entry) {
        found = label->text().toStdString();
      }
    }
    EXPECT_EQ(found, text);
  }
}

TEST_P(BoxWindow, HasItsToolTips) {
  const std::pair<const char*, const char*> tips[] = {
      {"PointsPerAct",
       "Sets the number of Points removed when the device is activated. Set to 0 for a device that never "
       "runs "
       "out."},
      {"ActivationAmount",
       "Sets the amount of health or ammo clips given to the player when the box is activated."},
      {"AutoModeTime",
       "Sets the time for which the device will automatically activate itself. Set to 0 for a manually "
       "controlled box. Units are 10 seconds ie value of 2 here sets 20 seconds."},
      {"RechargePoints",
       "Sets the number of points that are added to the boxes points every 10 seconds. Set to 0 for a box "
       "that "
       "doesn't recharge itself."},
      {"BoxType",
       "Sets the type of box; Medic (for healing players), Ammo (for giving ammo clips), Respawn (for "
       "restoring player health and ammo back to full, Repair (for repairing base devices.), Multi (for all "
       "at once), or Multi-Player (for all at once except Respawn)))"},
      {"Label6", "Controls what Team(s) can use this Box."}};
  for (const auto& [control, tip] : tips) {
    EXPECT_EQ(Find<QWidget>(*window, control).toolTip().toStdString(), tip);
    EXPECT_TRUE(Find<QWidget>(*window, control).accessibleDescription().isEmpty());
  }
}

TEST_P(BoxWindow, ShowsTheTipOfTheEntryThatTheKeyboardComesTo) {
  Entry("PointsPerAct").setFocus();
  for (const char* next : {"RechargePoints", "ActivationAmount", "AutoModeTime"}) {
    Type(*window, Qt::Key_Tab);
    QCoreApplication::processEvents();
    EXPECT_TRUE(QToolTip::isVisible());
    EXPECT_EQ(QToolTip::text(), Entry(next).toolTip()) << next;
  }
  QToolTip::hideText();
}

TEST_P(BoxWindow, SendsWhatWasEntered) {
  AnswerWith({0xAA});
  List("BoxType").setCurrentIndex(8);
  List("TeamList").setCurrentIndex(3);
  Enter("PointsPerAct", "10");
  Enter("RechargePoints", "20");
  Enter("ActivationAmount", "100");
  Enter("AutoModeTime", "255");
  Find<QCheckBox>(*window, "Destroyable").setChecked(true);
  Press("ProgramButton");
  EXPECT_THAT(Port.Sent, ElementsAre(0x42, 0x43, 0x38, 10, 20, 100, 255, 1, 0, 0));
  EXPECT_THAT(Boxes.Boxes, ElementsAre(Successful()));
}

TEST_P(BoxWindow, SendsZerosAsTheyStand) {
  AnswerWith({0xAA});
  Type(*window, Qt::Key_Return);
  EXPECT_THAT(Port.Sent, ElementsAre(0x42, 0x43, 0, 0, 0, 0, 0, 0, 0, 0));
}

TEST_P(BoxWindow, RefusesPointsOutsideTheirRangeWhenTheyAreLeft) {
  const FakeMessageBoxes::Box range = {"Invalid value, must be between 0 and 100", "Entry Error",
                                       BoxIcon::None};
  for (const char* entry : {"PointsPerAct", "RechargePoints", "ActivationAmount"}) {
    for (const char* text : {"-1", "101", "100.5", "1e9", "-0.01"}) {
      Boxes.Boxes.clear();
      Enter(entry, text);
      Leave();
      EXPECT_THAT(Boxes.Boxes, ElementsAre(range)) << entry << ' ' << text;
      EXPECT_TRUE(Entry(entry).hasFocus()) << entry << ' ' << text;
    }
    for (const char* text : {"0", "100", "99.9", " 7 "}) {
      Boxes.Boxes.clear();
      Enter(entry, text);
      Leave();
      EXPECT_THAT(Boxes.Boxes, IsEmpty()) << entry << ' ' << text;
      EXPECT_FALSE(Entry(entry).hasFocus()) << entry << ' ' << text;
    }
  }
}

TEST_P(BoxWindow, RefusesATimeOutsideItsRangeWhenItIsLeft) {
  const FakeMessageBoxes::Box range = {"Invalid value, must be between 0 and 255", "Entry Error",
                                       BoxIcon::None};
  for (const char* text : {"-1", "256", "255.1", "1e9"}) {
    Boxes.Boxes.clear();
    Enter("AutoModeTime", text);
    Leave();
    EXPECT_THAT(Boxes.Boxes, ElementsAre(range)) << text;
    EXPECT_TRUE(Entry("AutoModeTime").hasFocus()) << text;
  }
  Boxes.Boxes.clear();
  Enter("AutoModeTime", "255");
  Leave();
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

TEST_P(BoxWindow, ReportsAnEntryThatIsNoNumberWhenItIsLeft) {
  for (const char* entry : NumberEntries) {
    for (const char* text : {"", "abc", "  ", "\u0661\u0662", "1 x"}) {
      Boxes.Boxes.clear();
      Enter(entry, text);
      Leave();
      EXPECT_THAT(Boxes.Boxes, ElementsAre(FakeMessageBoxes::Box{"Run-time error '13': Type mismatch",
                                                                 "Tessarine", BoxIcon::Critical}))
          << entry << " \"" << text << '"';
    }
    Enter(entry, "0");
  }
}

TEST_P(BoxWindow, DoesNotSendWhatItRefuses) {
  Enter("PointsPerAct", "101");
  Press("ProgramButton");
  EXPECT_THAT(Boxes.Boxes, SizeIs(1));
  EXPECT_TRUE(Entry("PointsPerAct").hasFocus());
  Type(*window, Qt::Key_Return);
  EXPECT_THAT(Boxes.Boxes, SizeIs(2));
  EXPECT_THAT(Port.Log, IsEmpty());
}

TEST_P(BoxWindow, TellsOfABadEntryThatIsSentAllTheSame) {
  Entry("RechargePoints").setText(QStringLiteral("abc"));
  Find<QPushButton>(*window, "ProgramButton").click();
  EXPECT_THAT(Boxes.Boxes, ElementsAre(PortError()));
  EXPECT_THAT(Port.Sent, IsEmpty());
  EXPECT_FALSE(Port.PortOpen());
}

TEST_P(BoxWindow, PutsATypeOutsideTheListBackToTheFirst) {
  List("BoxType").setFocus();
  List("BoxType").setCurrentIndex(-1);
  Leave();
  EXPECT_EQ(List("BoxType").currentIndex(), 0);
  List("BoxType").addItem(QStringLiteral("Tenth"));
  List("BoxType").setFocus();
  List("BoxType").setCurrentIndex(9);
  Leave();
  EXPECT_EQ(List("BoxType").currentIndex(), 0);
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

TEST_P(BoxWindow, ClosesWithoutAnyCheck) {
  Enter("PointsPerAct", "abc");
  Press("Close");
  EXPECT_FALSE(window->isVisible());
  Open();
  Enter("PointsPerAct", "101");
  Type(*window, Qt::Key_Escape);
  EXPECT_FALSE(window->isVisible());
  Open();
  Enter("PointsPerAct", "");
  window->close();
  EXPECT_FALSE(window->isVisible());
  QCoreApplication::processEvents();
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

TEST_P(BoxWindow, SendsAgainWhileItWaits) {
  Meanwhile(400, [this] { Press("ProgramButton"); });
  Meanwhile(900, [this] { Port.Receive({0xAA}); });
  Press("ProgramButton");
  EXPECT_THAT(Port.Sent, SizeIs(20));
  EXPECT_THAT(Boxes.Boxes, ElementsAre(Successful()));
  EXPECT_EQ(Results().rowCount(), 1);
}

TEST_P(BoxWindow, GoesInMidWaitWithoutABox) {
  for (const bool byButton : {true, false}) {
    Open();
    Meanwhile(400, [this, byButton] {
      if (byButton) {
        Press("Close");
      } else {
        window->close();
      }
    });
    Press("ProgramButton");
    EXPECT_FALSE(window->isVisible());
    EXPECT_FALSE(Port.PortOpen());
    EXPECT_THAT(Boxes.Boxes, IsEmpty());
    EXPECT_THAT(sounds.Played, IsEmpty());
    EXPECT_EQ(programmed.All().back().Result, BoxResult::Unconfirmed);
  }
}

TEST_P(BoxWindow, ClosesThePortWhenItIsHidden) {
  Meanwhile(400, [this] { window->hide(); });
  Press("ProgramButton");
  EXPECT_FALSE(Port.PortOpen());
  EXPECT_THAT(Boxes.Boxes, IsEmpty());
}

TEST_P(BoxWindow, StaysAtEscapeWhileItWaits) {
  bool visible = false;
  Meanwhile(400, [&] {
    Type(*window, Qt::Key_Escape);
    visible = window->isVisible();
  });
  AnswerWith({0xAA}, 800);
  Press("ProgramButton");
  EXPECT_TRUE(visible);
  EXPECT_TRUE(window->isVisible());
  EXPECT_THAT(Boxes.Boxes, ElementsAre(Successful()));
}

TEST_P(BoxWindow, ReportsALostLineOnce) {
  Meanwhile(400, [this] { Port.Lose(); });
  Press("ProgramButton");
  ASSERT_THAT(Boxes.Boxes, SizeIs(1));
  EXPECT_THAT(Boxes.Boxes[0].Text, testing::StartsWith("Run-time error '8012'"));
  EXPECT_FALSE(Port.PortOpen());
  AnswerWith({0xAA});
  Press("ProgramButton");
  EXPECT_EQ(Boxes.Boxes.back(), Successful());
}

TEST_P(BoxWindow, IsCaredForWithAndWithoutBoxes) {
  ExpectCaredFor(*window);
  AnswerWith({0xAA});
  for (int i = 0; i < 3; ++i) {
    Press("ProgramButton");
    ExpectCaredFor(*window);
    Press("Close");
    Open();
    ExpectCaredFor(*window);
  }
}

TEST_P(BoxWindow, WritesNoSettings) {
  AnswerWith({0xAA});
  Press("ProgramButton");
  Press("Close");
  EXPECT_FALSE(Store.FileExists("/tessarine.ini"));
}

}  // namespace
