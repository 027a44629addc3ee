#include "audience/AudienceBoard.h"

#include <gmock/gmock.h>

#include <QLineEdit>
#include <set>

#include "audience/AudienceSettings.h"
#include "audience/GuestNameEntry.h"
#include "devices/radio/RemoteManage.h"
#include "members/Members.h"
#include "tests/app/AnsweringRed1.h"
#include "tests/support/Frames.h"
#include "tests/support/GameFiles.h"
#include "tests/support/OnScreen.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

class BoardOfTheAudience : public testing::Test {
 protected:
  void Start() {
    Prepare();
    Show(*venue.Window);
  }
  void Prepare() {
    venue.Window.reset();
    venue.PutDefaultFiles();
    venue.MakeWindow().setScreen(&ScreenNamed("recommended or better"));
    venue.Window->move(20, 20);
    venue.Window->FormLoad();
  }

  static AudienceWindow* Board() {
    for (QWidget* widget : QApplication::topLevelWidgets()) {
      if (auto* board = qobject_cast<AudienceWindow*>(widget)) {
        return board;
      }
    }
    return nullptr;
  }

  AudienceBoard& Control() const { return *venue.Window->findChild<AudienceBoard*>(); }

  static QScreen& HallScreen() { return ScreenNamed("as recommended"); }

  std::string StateFile() const { return ReadFile(venue.DataFile("state.ini")); }

  std::vector<std::string> Names() const {
    std::vector<std::string> names;
    for (const Standing& player : Control().State().Results().Players) {
      names.push_back(player.PublicName);
    }
    return names;
  }

  Venue venue;
};

TEST_F(BoardOfTheAudience, FillsAScreenThatIsNotTheOperators) {
  Start();
  EXPECT_EQ(Board(), nullptr);
  venue.Trigger("mnuAudienceBoard");
  ASSERT_NE(Board(), nullptr);
  EXPECT_EQ(Board()->geometry(), HallScreen().geometry());
  EXPECT_TRUE(Board()->windowFlags().testFlag(Qt::FramelessWindowHint));
  EXPECT_TRUE(venue.Find<QAction>("mnuAudienceBoard").isChecked());
  EXPECT_TRUE(venue.Window->isActiveWindow());
  venue.Trigger("mnuAudienceBoard");
  EXPECT_EQ(Board(), nullptr);
  EXPECT_FALSE(venue.Find<QAction>("mnuAudienceBoard").isChecked());
}

TEST_F(BoardOfTheAudience, IsPaintedInThePixelsOfAScaledScreen) {
  Start();
  AudienceSetup setup = Control().Setup();
  setup.Screen = "scaled by 2";
  Control().SetSetup(setup);
  venue.Trigger("mnuAudienceBoard");
  ASSERT_NE(Board(), nullptr);
  EXPECT_EQ(Control().Stage().Picture().size(), QSize(1920, 1080));
}

TEST_F(BoardOfTheAudience, KeepsScreensAwakeWhileItShows) {
  Start();
  venue.Trigger("mnuAudienceBoard");
  EXPECT_EQ(venue.Awake.Held, 1);
  venue.Trigger("mnuAudienceBoard");
  EXPECT_EQ(venue.Awake.Held, 0);
}

TEST_F(BoardOfTheAudience, GoesWithItsScreenAndReturnsWithIt) {
  Start();
  venue.Trigger("mnuAudienceBoard");
  emit qApp->screenRemoved(&HallScreen());
  EXPECT_EQ(Board(), nullptr);
  EXPECT_EQ(Control().AwaitedScreen(), "as recommended");
  EXPECT_EQ(venue.Awake.Held, 0);
  EXPECT_TRUE(venue.Find<QAction>("mnuAudienceBoard").isChecked());
  EXPECT_THAT(venue.Find<QWidget>("AudienceCopy").toolTip().toStdString(), HasSubstr("as recommended"));
  emit qApp->screenAdded(&HallScreen());
  ASSERT_NE(Board(), nullptr);
  EXPECT_EQ(Board()->geometry(), HallScreen().geometry());
  EXPECT_EQ(venue.Awake.Held, 1);
}

TEST_F(BoardOfTheAudience, StaysWhenAnotherScreenGoes) {
  Start();
  venue.Trigger("mnuAudienceBoard");
  const AudienceWindow* before = Board();
  emit qApp->screenRemoved(&ScreenNamed("laptop"));
  EXPECT_EQ(Board(), before);
}

TEST_F(BoardOfTheAudience, GivesWayWhenTheOperatorComesAndReturnsWhenHeGoes) {
  Start();
  venue.Trigger("mnuAudienceBoard");
  ASSERT_NE(Board(), nullptr);
  QScreen& own = *venue.Window->screen();
  venue.Window->windowHandle()->setScreen(&HallScreen());
  venue.Window->move(HallScreen().geometry().topLeft() + QPoint(20, 20));
  EXPECT_TRUE(QTest::qWaitFor([] { return Board() == nullptr; }));
  EXPECT_EQ(Control().AwaitedScreen(), "as recommended");
  venue.Window->windowHandle()->setScreen(&own);
  venue.Window->move(own.geometry().topLeft() + QPoint(20, 20));
  ASSERT_TRUE(QTest::qWaitFor([] { return Board() != nullptr; }));
  EXPECT_EQ(Board()->geometry(), HallScreen().geometry());
}

TEST_F(BoardOfTheAudience, IsOffWhenTheDesktopClosesIt) {
  Start();
  venue.Trigger("mnuAudienceBoard");
  Board()->close();
  EXPECT_TRUE(QTest::qWaitFor([this] { return !Control().IsOn(); }));
  EXPECT_FALSE(venue.Find<QAction>("mnuAudienceBoard").isChecked());
  EXPECT_EQ(venue.Awake.Held, 0);
}

TEST_F(BoardOfTheAudience, OpensAgainWhereItWasWithoutTheKeyboard) {
  Start();
  venue.Trigger("mnuAudienceBoard");
  venue.Window->close();
  EXPECT_EQ(Board(), nullptr);
  EXPECT_THAT(StateFile(), HasSubstr("screen=as recommended"));
  EXPECT_THAT(StateFile(), Not(HasSubstr("AudienceBoard=")));
  // The offscreen platform activates whatever is shown; desktops do as the window asks.
  Prepare();
  venue.Window->show();
  ASSERT_TRUE(QTest::qWaitFor([] { return Board() != nullptr; }));
  EXPECT_EQ(Board()->geometry(), HallScreen().geometry());
  EXPECT_TRUE(Board()->testAttribute(Qt::WA_ShowWithoutActivating));
}

TEST_F(BoardOfTheAudience, WaitsAtTheStartForAScreenThatIsNotThere) {
  venue.PutDefaultFiles();
  WriteFile(venue.DataFile("state.ini"), "[audience]\non=1\nscreen=HDMI-9\n");
  Start();
  ASSERT_TRUE(QTest::qWaitFor([this] { return Control().IsOn(); }));
  EXPECT_EQ(Board(), nullptr);
  EXPECT_EQ(Control().AwaitedScreen(), "HDMI-9");
}

TEST_F(BoardOfTheAudience, StaysOffAtTheStartOnceItWasSwitchedOff) {
  Start();
  venue.Trigger("mnuAudienceBoard");
  venue.Trigger("mnuAudienceBoard");
  venue.Window->close();
  Start();
  QCoreApplication::processEvents();
  EXPECT_FALSE(Control().IsOn());
}

TEST_F(BoardOfTheAudience, LeavesNoTraceWhereItIsNeverUsed) {
  Start();
  venue.LoadGame(SmallGame());
  venue.Window->close();
  EXPECT_THAT(ReadFile(venue.DataFile("tessarine.ini")), Not(HasSubstr("[audience]")));
  if (venue.Disk.FileExists(venue.DataFile("state.ini"))) {
    EXPECT_THAT(StateFile(), Not(HasSubstr("[audience]")));
  }
  EXPECT_THAT(venue.Awake.Reasons, IsEmpty());
}

TEST_F(BoardOfTheAudience, IsAnOrdinaryWindowOnTheOperatorsScreen) {
  Start();
  AudienceSetup setup = Control().Setup();
  setup.Screen = "recommended or better";
  Control().SetSetup(setup);
  venue.Trigger("mnuAudienceBoard");
  ASSERT_NE(Board(), nullptr);
  EXPECT_FALSE(Board()->windowFlags().testFlag(Qt::FramelessWindowHint));
  Board()->close();
  EXPECT_TRUE(QTest::qWaitFor([] { return Board() == nullptr; }));
  EXPECT_FALSE(venue.Find<QAction>("mnuAudienceBoard").isChecked());
}

TEST_F(BoardOfTheAudience, ShowsAGameOnCommandAndKeepsIt) {
  Start();
  venue.LoadGame(SmallGame());
  venue.Trigger("mnuAudienceBoard");
  EXPECT_EQ(Control().State().View(), AudienceView::Idle);
  venue.Trigger("mnuAudienceResults");
  EXPECT_EQ(Control().State().View(), AudienceView::Results);
  EXPECT_THAT(Names(), ElementsAre("Blue 7", "Red 0"));
  venue.Boxes.Answers = {BoxAnswer::Ok};
  venue.Trigger("mnuClearScores");
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 0);
  EXPECT_THAT(Names(), ElementsAre("Blue 7", "Red 0"));
  venue.Trigger("mnuAudienceBlank");
  EXPECT_EQ(Control().State().View(), AudienceView::Blank);
  venue.Trigger("mnuAudienceVenue");
  EXPECT_EQ(Control().State().View(), AudienceView::Idle);
}

TEST_F(BoardOfTheAudience, IsSwitchedOnByShowResults) {
  Start();
  venue.LoadGame(SmallGame());
  venue.Trigger("mnuAudienceResults");
  EXPECT_NE(Board(), nullptr);
  EXPECT_EQ(Control().State().View(), AudienceView::Results);
}

TEST_F(BoardOfTheAudience, ShowsAPullByItselfOnceItIsScored) {
  Start();
  venue.Trigger("mnuAudienceBoard");
  std::vector<AudienceView> seen;
  bool answered = false;
  venue.Port.OnOutput = [&](std::uint8_t byte) {
    seen.push_back(Control().State().View());
    if (byte == 0 && venue.Port.Sent.size() >= 2 && !std::exchange(answered, true)) {
      venue.Port.Receive({1});
      venue.Port.Receive(FrameOfBlue0());
    }
  };
  venue.Trigger("mnuGetKeshData");
  ASSERT_FALSE(seen.empty());
  EXPECT_THAT(seen, testing::Each(AudienceView::Incoming));
  EXPECT_EQ(Control().State().View(), AudienceView::Results);
  EXPECT_THAT(Names(), ElementsAre("Blue 0"));
}

TEST_F(BoardOfTheAudience, CountsTheGunsOfAPullByRadioAndShowsThemOnceTheyAreScored) {
  Start();
  venue.Trigger("mnuAudienceBoard");
  AnsweringRed1 gun(venue);
  std::vector<std::string> seen;
  const WhileModal<RemoteManage> window([&](RemoteManage& remote) {
    venue.Port.OnOutput = [&](std::uint8_t byte) { gun.Hear(byte); };
    ::Press(remote, "SearchGunsButton");
    EXPECT_EQ(Control().State().View(), AudienceView::Idle);
    QObject::connect(&Control(), &AudienceBoard::Changed, &remote, [&] {
      EXPECT_EQ(Control().State().View(), AudienceView::Incoming);
      seen.push_back(std::to_string(Control().State().Received()) + "/" +
                     std::to_string(Control().State().Expected()));
    });
    ::Press(remote, "GetScoresButton");
    QObject::disconnect(&Control(), &AudienceBoard::Changed, &remote, nullptr);
    EXPECT_EQ(Control().State().View(), AudienceView::Incoming);
    remote.close();
  });
  venue.Press("RemoteManageButton");
  EXPECT_EQ(window.Runs(), 1);
  EXPECT_THAT(seen, ElementsAre("0/1", "1/1"));
  EXPECT_EQ(Control().State().View(), AudienceView::Results);
  EXPECT_THAT(Names(), ElementsAre("Red 1"));
}

TEST_F(BoardOfTheAudience, ShowsTheVenueAgainWhereNoGunCameInByRadio) {
  Start();
  venue.Trigger("mnuAudienceBoard");
  AnsweringRed1 gun(venue);
  gun.IsSilent = true;
  std::set<AudienceView> seen;
  const WhileModal<RemoteManage> window([&](RemoteManage& remote) {
    venue.Port.OnOutput = [&](std::uint8_t byte) {
      seen.insert(Control().State().View());
      gun.Hear(byte);
    };
    ::Press(remote, "SearchGunsButton");
    ::Press(remote, "GetScoresButton");
    EXPECT_THAT(seen, ElementsAre(AudienceView::Idle, AudienceView::Incoming));
    EXPECT_EQ(Control().State().View(), AudienceView::Idle);
    remote.close();
  });
  venue.Press("RemoteManageButton");
  EXPECT_EQ(window.Runs(), 1);
}

TEST_F(BoardOfTheAudience, NamesGuestsUntilTheNextGame) {
  Start();
  venue.LoadGame(SmallGame());
  venue.Trigger("mnuAudienceResults");
  const WhileModal<GuestNameEntry> entry([](GuestNameEntry& window) {
    Find<QLineEdit>(window, "Guest40").setText(QStringLiteral("Ann"));
    ::Press(window, "SaveExit");
  });
  venue.Trigger("mnuGuestNames");
  EXPECT_EQ(entry.Runs(), 1);
  EXPECT_THAT(Names(), ElementsAre("Ann", "Red 0"));
  EXPECT_THAT(venue.Column("ScoreDisplay", 1).front(), Not(HasSubstr("Ann")));
  venue.LoadGame(SmallGame());
  venue.Trigger("mnuAudienceResults");
  EXPECT_THAT(Names(), ElementsAre("Blue 7", "Red 0"));
}

TEST_F(BoardOfTheAudience, CallsMembersByTheirNewNicknamesOnceTheWindowIsClosed) {
  Start();
  venue.Window->close();
  venue.ChangeDatabase("members.mdb",
                       "DELETE FROM Members; INSERT INTO Members (ContactID, NickName) VALUES (4, 'Mole')");
  Start();
  venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>4</MemberIndex>")));
  venue.Trigger("mnuAudienceResults");
  EXPECT_THAT(Names(), ElementsAre("Mole"));
  venue.ChangeDatabase("members.mdb", "UPDATE Members SET NickName = NULL");
  const WhileModal<Members> members([](Members& window) { window.close(); });
  venue.Trigger("mnuManageMembers");
  EXPECT_EQ(members.Runs(), 1);
  EXPECT_THAT(Names(), ElementsAre("Red 0"));
}

TEST_F(BoardOfTheAudience, MovesToTheScreenThatIsSet) {
  Start();
  venue.Trigger("mnuAudienceBoard");
  const WhileModal<AudienceSettings> settings([](AudienceSettings& window) {
    auto& screens = Find<QComboBox>(window, "AudienceScreen");
    screens.setCurrentIndex(screens.findText(QStringLiteral("laptop"), Qt::MatchStartsWith));
    ::Press(window, "SaveExit");
  });
  venue.Trigger("mnuAudienceSettings");
  EXPECT_EQ(settings.Runs(), 1);
  ASSERT_NE(Board(), nullptr);
  EXPECT_EQ(Board()->geometry(), ScreenNamed("laptop").geometry());
  EXPECT_THAT(ReadFile(venue.DataFile("tessarine.ini")), HasSubstr("[audience]"));
}

TEST_F(BoardOfTheAudience, HasASmallCopyInTheBarWhileItIsOn) {
  Start();
  venue.Window->resize(1200, 800);
  QCoreApplication::processEvents();
  venue.Trigger("mnuAudienceBoard");
  auto& copy = venue.Find<QWidget>("AudienceCopy");
  EXPECT_TRUE(QTest::qWaitFor([&] { return copy.isVisible() && copy.width() > 50; }));
  const QImage idle = copy.grab().toImage();
  venue.LoadGame(SmallGame());
  venue.Trigger("mnuAudienceResults");
  EXPECT_NE(copy.grab().toImage(), idle);
  venue.Trigger("mnuAudienceBoard");
  EXPECT_FALSE(copy.isVisible());
}

}  // namespace
