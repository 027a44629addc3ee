#include <gmock/gmock.h>

#include <QLabel>
#include <QMenu>
#include <QMenuBar>
#include <QRegularExpression>
#include <algorithm>
#include <set>

#include "manual/ManualWindow.h"
#include "tests/support/Venue.h"

namespace {

using testing::ElementsAre;
using testing::ElementsAreArray;

struct Item {
  const char* Name;
  int Text;             ///< number in the string table, 0 for none
  const char* English;  ///< with the mark of the Alt key
  bool Enabled;
};

struct Menu {
  Item Head;
  std::vector<Item> Items;
};

const std::vector<Menu> Menus = {
    {{"mnuFile", 204, "&Games", true},
     {{"mnuLoadScores", 205, "&Load Game", true},
      {"mnuSaveScores", 206, "&Save Game", true},
      {"mnuClearScores", 207, "&Clear Game", true},
      {"mnuGetKeshData", 0, "Get Score Data", true},
      {"mnuCommitGame", 0, "C&ommit Game to Database", true},
      {"mnuPrintScores", 208, "&Print Score Sheets", true},
      {"mnuAdminData", 209, "&Admin Data", true},
      {"mnuExit", 210, "E&xit", true},
      {"mnuGameCharts", static_cast<int>(OwnText::GameChartsItem), "Game Cha&rts", true},
      {"mnuExport", static_cast<int>(OwnText::GameExportMenu), "&Export", true},
      {"mnuImportGames", static_cast<int>(OwnText::ImportGamesItem), "&Import Game Files", true}}},
    {{"mnuMissions", 211, "&Missions", true},
     {{"mnuMissionResults", 212, "Set Mission &Results", false},
      {"mnuSetupMissions", 213, "&Setup Missions", true}}},
    {{"mnuMembers", 0, "M&embers", true},
     {{"mnuManageMembers", 0, "Mana&ge Members", true},
      {"mnuCheckButton", 0, "&Check Membership Button", true},
      {"mnuExportMembers", static_cast<int>(OwnText::ExportMembersItem), "&Export Members", true},
      {"mnuImportMembers", static_cast<int>(OwnText::ImportMembersItem), "&Import Members", true}}},
    {{"mnuTools", 0, "&Tools", true},
     {{"mnuBoxConfig", 0, "&Utility Box Configuration", true},
      {"mnuFirmwareUpdate", 0, "F&irmware Update", true},
      {"mnuSoundRecorder", 0, "Sound &Recorder", true},
      {"mnuChargeiButton", 0, "Charge &iButton", true},
      {"mnuRemoteManage", 0, "Remote &Manage", true},
      {"mnuBackupCopies", static_cast<int>(OwnText::BackupCopiesItem), "&Backup Copies", true},
      {"mnuTakeOver", static_cast<int>(OwnText::TakeOverItem), "&Take Over an Old Installation", true}}},
    {{"mnuSettings", 214, "&Settings", true},
     {{"mnuCommPort", 215, "&Communications Port", true},
      {"mnuSoldieringCalc", 216, "&Soldiering Calculation", true}}},
    {{"mnuShow", static_cast<int>(OwnText::ShowMenu), "Sho&w", true},
     {{"mnuLargerLetters", static_cast<int>(OwnText::LargerLetters), "&Larger Letters", true},
      {"mnuSmallerLetters", static_cast<int>(OwnText::SmallerLetters), "&Smaller Letters", true},
      {"mnuUsualLetters", static_cast<int>(OwnText::UsualLetters), "&Usual Letters", true},
      {"mnuUsualColumns", static_cast<int>(OwnText::UsualColumns), "Usual &Column Widths", true},
      {"mnuAudienceBoard", static_cast<int>(OwnText::AudienceBoardItem), "&Audience Board", true},
      {"mnuAudienceResults", static_cast<int>(OwnText::AudienceResultsItem), "Show &Results", true},
      {"mnuAudienceVenue", static_cast<int>(OwnText::AudienceVenueItem), "Show &Venue", true},
      {"mnuAudienceBlank", static_cast<int>(OwnText::AudienceBlankItem), "&Blank the Board", true},
      {"mnuGuestNames", static_cast<int>(OwnText::GuestNamesItem), "&Guest Names", true},
      {"mnuAudienceSettings", static_cast<int>(OwnText::AudienceSettingsItem), "Audience Board Se&ttings",
       true}}},
    {{"mnuHelp", 217, "&Help", true},
     {{"mnuAbout", 218, "&About", true}, {"mnuManual", 524, "&Manual", true}}},
};

/// The items of a menu or the menus of a bar, without the lines between them.
std::vector<QAction*> ItemsOf(const QWidget& menu) {
  std::vector<QAction*> items;
  for (QAction* action : menu.actions()) {
    if (!action->isSeparator()) {
      items.push_back(action);
    }
  }
  return items;
}

/// A name to compare: of the menu when the action opens one.
std::string NameOf(const QAction& action) {
  return (action.menu() != nullptr ? action.menu()->objectName() : action.objectName()).toStdString();
}

/// Without the mark of the Alt key, or without the letter that was added for it.
std::string WithoutMark(QString caption) {
  static const QRegularExpression added(QStringLiteral("\\(&.\\)$"));
  return caption.remove(added).remove(u'&').toStdString();
}

/// What the item is to show in `language`: a caption without a number keeps its English text.
std::string CaptionOf(const Item& item, const StringTable& strings) {
  return item.Text != 0 ? WithoutMark(QString::fromStdString(strings.Text(item.Text)))
                        : WithoutMark(QString::fromUtf8(item.English));
}

class MenuBar : public testing::TestWithParam<Language> {
 protected:
  MenuBar() {
    venue.ButtonSwipe = [] { return std::string(NoDallasId); };
    venue.Start();
  }

  QMenuBar& Bar() const { return venue.Find<QMenuBar>("menubar"); }

  Venue venue{GetParam()};
};

TEST_P(MenuBar, HasEveryItemInItsPlace) {
  std::vector<std::string> heads;
  for (const QAction* action : ItemsOf(Bar())) {
    if (action->isVisible()) {
      heads.push_back(NameOf(*action));
    }
  }
  EXPECT_THAT(heads, ElementsAre("mnuFile", "mnuMissions", "mnuMembers", "mnuTools", "mnuSettings", "mnuShow",
                                 "mnuHelp"));
  for (const Menu& menu : Menus) {
    std::vector<std::string> expected;
    for (const Item& item : menu.Items) {
      expected.emplace_back(item.Name);
    }
    std::vector<std::string> names;
    for (const QAction* action : ItemsOf(venue.Find<QMenu>(menu.Head.Name))) {
      names.push_back(NameOf(*action));
    }
    EXPECT_THAT(names, ElementsAreArray(expected)) << menu.Head.Name;
  }
}

TEST_P(MenuBar, TakesItsCaptionsFromTheStringTable) {
  for (const Menu& menu : Menus) {
    EXPECT_EQ(WithoutMark(venue.Find<QMenu>(menu.Head.Name).title()), CaptionOf(menu.Head, venue.Strings));
    for (const Item& item : menu.Items) {
      EXPECT_EQ(WithoutMark(venue.Find<QAction>(item.Name).text()), CaptionOf(item, venue.Strings));
    }
  }
}

TEST_P(MenuBar, DisablesWhatHasNoWindowYet) {
  for (const Menu& menu : Menus) {
    EXPECT_TRUE(venue.Find<QMenu>(menu.Head.Name).isEnabled()) << menu.Head.Name;
    for (const Item& item : menu.Items) {
      EXPECT_EQ(venue.Find<QAction>(item.Name).isEnabled(), item.Enabled) << item.Name;
    }
  }
  EXPECT_TRUE(venue.Find<QPushButton>("RemoteManageButton").isEnabled());
  EXPECT_TRUE(venue.Find<QPushButton>("GetScores").isEnabled());
}

TEST_P(MenuBar, OffersToCheckAMembershipButtonOnlyWhereThereIsAReader) {
  EXPECT_TRUE(venue.Find<QAction>("mnuCheckButton").isEnabled());
  venue.ButtonSwipe = nullptr;
  venue.MakeWindow().FormLoad();
  EXPECT_FALSE(venue.Find<QAction>("mnuCheckButton").isEnabled());
}

TEST_P(MenuBar, GivesNoAltKeyTwice) {
  const auto letterOf = [](const QAction* action) {
    const auto mark = action->text().indexOf(u'&');
    return mark < 0 ? QString() : action->text().mid(mark + 1, 1).toUpper();
  };
  std::vector<const QWidget*> menus = {&Bar()};
  for (const Menu& menu : Menus) {
    menus.push_back(&venue.Find<QMenu>(menu.Head.Name));
  }
  for (const QWidget* menu : menus) {
    std::set<QString> letters;
    for (const QAction* action : ItemsOf(*menu)) {
      if (action->objectName() == QStringLiteral("mnuChargeiButton")) {
        continue;  // shares its letter with Firmware Update by design
      }
      if (const QString letter = letterOf(action); !letter.isEmpty()) {
        EXPECT_TRUE(letters.insert(letter).second) << WithoutMark(action->text());
      }
    }
  }
}

TEST_P(MenuBar, StandsAboveLabelsFromTheStringTable) {
  const auto text = [this](int number) { return QString::fromStdString(venue.Strings.Text(number)); };
  EXPECT_EQ(venue.Find<QLabel>("Label1").text(), text(203));
  EXPECT_EQ(venue.Find<QLabel>("Label2").text(), text(201));
  EXPECT_EQ(venue.Find<QLabel>("ActiveMissionLabel").text(), text(202));
  EXPECT_EQ(venue.Find<QPushButton>("GetScores").text(), QStringLiteral("Get Score Data"));
  EXPECT_EQ(venue.Find<QPushButton>("RemoteManageButton").text(), QStringLiteral("Remote Manage"));
}

INSTANTIATE_TEST_SUITE_P(Languages, MenuBar, testing::Values(Language::English, Language::SimplifiedChinese),
                         [](const auto& language) {
                           return language.param == Language::English ? "English" : "SimplifiedChinese";
                         });

class MenuKeys : public testing::Test {
 protected:
  MenuKeys() { venue.Start(); }

  Venue venue;
};

TEST_F(MenuKeys, KeepTheLettersOfTheDesign) {
  for (const Menu& menu : Menus) {
    EXPECT_EQ(venue.Find<QMenu>(menu.Head.Name).title().toStdString(), menu.Head.English);
    for (const Item& item : menu.Items) {
      EXPECT_EQ(venue.Find<QAction>(item.Name).text().toStdString(), item.English);
    }
  }
}

TEST_F(MenuKeys, StandBehindTheCaptionsInChinese) {
  Venue chinese(Language::SimplifiedChinese);
  chinese.Start();
  const auto expectLetter = [](const Item& item, const QString& caption) {
    const QString design = QString::fromUtf8(item.English);
    const QString letter = design.mid(design.indexOf(u'&') + 1, 1).toUpper();
    EXPECT_TRUE(item.Text == 0 || caption.endsWith(QStringLiteral("(&") + letter + u')'))
        << caption.toStdString();
  };
  for (const Menu& menu : Menus) {
    expectLetter(menu.Head, chinese.Find<QMenu>(menu.Head.Name).title());
    for (const Item& item : menu.Items) {
      expectLetter(item, chinese.Find<QAction>(item.Name).text());
    }
  }
  QTest::keyClick(chinese.Window.get(), Qt::Key_G, Qt::AltModifier);
  EXPECT_TRUE(chinese.Find<QMenu>("mnuFile").isVisible());
}

TEST_F(MenuKeys, OpenAMenuAndChooseInIt) {
  QTest::keyClick(venue.Window.get(), Qt::Key_G, Qt::AltModifier);
  QMenu& games = venue.Find<QMenu>("mnuFile");
  ASSERT_TRUE(games.isVisible());
  QTest::keyClick(&games, Qt::Key_C);
  EXPECT_FALSE(games.isVisible());
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1u);
  EXPECT_EQ(venue.Boxes.Boxes[0].Title, "Confirm Clear");
}

TEST_F(MenuKeys, GiveWayToTheMouse) {
  QMenuBar& bar = venue.Find<QMenuBar>("menubar");
  QMenu& games = venue.Find<QMenu>("mnuFile");
  QTest::mouseClick(&bar, Qt::LeftButton, {}, bar.actionGeometry(games.menuAction()).center());
  ASSERT_TRUE(games.isVisible());
  QAction& clear = venue.Find<QAction>("mnuClearScores");
  QTest::mouseClick(&games, Qt::LeftButton, {}, games.actionGeometry(&clear).center());
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1u);
  EXPECT_EQ(venue.Boxes.Boxes[0].Title, "Confirm Clear");
}

TEST_F(MenuKeys, LoadAndSaveAtOnce) {
  Type(*venue.Window, Qt::Key_O, Qt::ControlModifier);
  Type(*venue.Window, Qt::Key_S, Qt::ControlModifier);
  ASSERT_EQ(venue.Dialog.Calls.size(), 2u);
  EXPECT_FALSE(venue.Dialog.Calls[0].Save);
  EXPECT_TRUE(venue.Dialog.Calls[1].Save);
}

TEST_F(MenuKeys, OpenTheManual) {
  Type(*venue.Window, Qt::Key_F1);
  const QWidgetList windows = QApplication::topLevelWidgets();
  EXPECT_TRUE(std::any_of(windows.begin(), windows.end(), [](const QWidget* window) {
    return qobject_cast<const ManualWindow*>(window) != nullptr && window->isVisible();
  }));
}

TEST_F(MenuKeys, ExitAtOnce) {
  Type(*venue.Window, Qt::Key_Q, Qt::ControlModifier);
  EXPECT_FALSE(venue.Window->isVisible());
}

}  // namespace
