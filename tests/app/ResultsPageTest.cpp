#include "web/ResultsPage.h"

#include <gmock/gmock.h>

#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QListWidget>
#include <QPushButton>
#include <QSpinBox>
#include <QTableView>
#include <filesystem>
#include <map>

#include "audience/GuestNameEntry.h"
#include "core/text/Filled.h"
#include "tests/support/Frames.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

using namespace std::string_literals;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

const std::string ServedAt8080 = "P\x90\x1F\x00\x00"s;
const std::string ServedAt8081 = "P\x91\x1F\x00\x00"s;
const std::string Answer = "A\x01\x00\x00\x00"s;
const std::string NoAnswer = "A\x00\x00\x00\x00"s;

constexpr const char* Url8080 = "http://192.168.1.20:8080/";

class PageOfResults : public testing::TestWithParam<Language> {
 protected:
  PageOfResults() {
    venue.Time.Stamps["today"] = "2013-05-21 14:20:00";
    venue.Start();
    QCoreApplication::processEvents();
  }

  void StartAgain() {
    venue.Window->close();
    venue.Window.reset();
    venue.Start();
    QCoreApplication::processEvents();
  }

  ResultsHost& Host() const { return *venue.Window->findChild<ResultsHost*>(); }
  AudienceBoard& Board() const { return *venue.Window->findChild<AudienceBoard*>(); }

  void Set(const std::function<void(PageSetup&)>& change) const {
    PageSetup setup = Host().Setup();
    change(setup);
    Host().SetSetup(setup);
  }
  void SwitchOn() const {
    Set([](PageSetup& setup) { setup.On = true; });
  }
  void ShowNames() const {
    Set([](PageSetup& setup) { setup.Names = NamesShown::OnBoardAndPage; });
  }

  FakePipedProgram& Server() { return venue.Piped.At(0); }
  FakePipedProgram& Asker() { return venue.Piped.At(1); }

  void Serve() {
    SwitchOn();
    Server().OnOutput(ServedAt8080);
    Asker().OnOutput(Answer);
  }

  /// The pages that the serving program has by now.
  std::map<std::string, std::string> Served() {
    std::map<std::string, std::string> pages;
    PageFrameReader reader;
    reader.Add(Server().Input);
    while (const auto frame = reader.Next()) {
      if (frame->Order == PageOrder::Put) {
        pages[frame->Path] = frame->Body;
      } else if (frame->Order == PageOrder::Remove) {
        pages.erase(frame->Path);
      }
    }
    EXPECT_FALSE(reader.Broken());
    return pages;
  }

  bool AnyServed(const std::string& text) {
    return std::ranges::any_of(Served(),
                               [&](const auto& page) { return page.second.find(text) != text.npos; });
  }

  bool IsServed(const std::string& path) { return Served().contains(path); }

  std::vector<std::string> NamesOnBoard() const {
    std::vector<std::string> names;
    for (const Standing& player : Board().State().Results().Players) {
      names.push_back(player.PublicName);
    }
    return names;
  }

  void NameGuest(const char* entry, const char* name) {
    const WhileModal<GuestNameEntry> window([&](GuestNameEntry& names) {
      Find<QLineEdit>(names, entry).setText(QString::fromUtf8(name));
      ::Press(names, "SaveExit");
    });
    venue.Trigger("mnuGuestNames");
    EXPECT_EQ(window.Runs(), 1);
  }

  void Hide(int row) {
    venue.Find<QTableView>("ScoreDisplay").selectRow(row);
    venue.Boxes.Answers = {BoxAnswer::Ok};
    venue.Trigger("mnuHidePlayer");
  }

  void LookAt(const std::function<void(ResultsPage&)>& look) const {
    const WhileModal<ResultsPage> open([&look](ResultsPage& window) {
      look(window);
      window.close();
    });
    venue.Trigger("mnuResultsPage");
    EXPECT_EQ(open.Runs(), 1);
  }

  Venue venue{GetParam()};
};

TEST_P(PageOfResults, LeavesNoTraceWhereItIsNeverUsed) {
  venue.LoadGame(SmallGame());
  Host().Look();
  venue.Window->close();
  EXPECT_EQ(venue.Piped.Made, 0);
  EXPECT_THAT(ReadFile(venue.DataFile("tessarine.ini")), Not(HasSubstr("[results]")));
  EXPECT_FALSE(std::filesystem::exists(venue.DataFile("hidden-names.txt")));
}

TEST_P(PageOfResults, StartsTheProgramAtTheAddressOfTheDefaultRoute) {
  SwitchOn();
  ASSERT_EQ(venue.Piped.Live(), 2U);
  ASSERT_EQ(Server().Runs.size(), 1U);
  EXPECT_THAT(Server().Runs[0].Words, ElementsAre("/bin/results", "192.168.1.20", "8080"));
  EXPECT_THAT(Asker().Runs, IsEmpty());
  Set([](PageSetup& setup) { setup.On = false; });
  EXPECT_EQ(venue.Piped.Live(), 0U);
  EXPECT_FALSE(Host().IsOn());
}

TEST_P(PageOfResults, TellsTheBoardItsAddressOnceThatIsAnswered) {
  SwitchOn();
  Server().OnOutput(ServedAt8081);
  EXPECT_EQ(Board().State().Address(), "");
  ASSERT_EQ(Asker().Runs.size(), 1U);
  EXPECT_THAT(Asker().Runs[0].Words, ElementsAre("/bin/results", "--ask", "192.168.1.20", "8081"));
  Asker().OnOutput(Answer);
  EXPECT_EQ(Board().State().Address(), "http://192.168.1.20:8081/");
  EXPECT_EQ(Host().Url(), "http://192.168.1.20:8081/");
  Set([](PageSetup& setup) { setup.On = false; });
  EXPECT_EQ(Board().State().Address(), "");
}

TEST_P(PageOfResults, TakesTheAddressOffTheBoardWhenItIsNoLongerAnswered) {
  Serve();
  ASSERT_EQ(Board().State().Address(), Url8080);
  const std::size_t asked = Asker().Runs.size();
  for (int looks = 0; looks < 6; ++looks) {
    Host().Look();
  }
  ASSERT_EQ(Asker().Runs.size(), asked + 1);
  Asker().OnOutput(NoAnswer);
  EXPECT_EQ(Board().State().Address(), "");
  Host().Look();
  Asker().OnOutput(Answer);
  EXPECT_EQ(Board().State().Address(), Url8080);
}

TEST_P(PageOfResults, TakesTheAddressOffTheBoardWhenTheProgramEnds) {
  Serve();
  Server().End();
  EXPECT_EQ(Board().State().Address(), "");
  EXPECT_EQ(Host().Serving().Now, PageServing::Phase::Pausing);
  Server().OnOutput(ServedAt8080);
  EXPECT_EQ(Board().State().Address(), "");
  Asker().OnOutput(Answer);
  EXPECT_EQ(Board().State().Address(), Url8080);
}

TEST_P(PageOfResults, FollowsTheCableOutAndInAgain) {
  Serve();
  const std::vector<LocalAddress> before = std::exchange(venue.Addresses.List, {});
  Host().Look();
  EXPECT_EQ(Board().State().Address(), "");
  EXPECT_FALSE(Server().Running);
  venue.Addresses.List = before;
  Host().Look();
  EXPECT_TRUE(Server().Running);
}

TEST_P(PageOfResults, MovesWithTheAddressThatIsChosen) {
  Serve();
  Set([](PageSetup& setup) { setup.Address = "127.0.0.1"; });
  EXPECT_EQ(Board().State().Address(), "");
  EXPECT_THAT(Server().Runs.back().Words, ElementsAre("/bin/results", "127.0.0.1", "8080"));
  Set([](PageSetup& setup) { setup.Address = "10.9.9.9"; });
  EXPECT_FALSE(Server().Running);
}

TEST_P(PageOfResults, IsOnAgainAtTheNextStart) {
  Serve();
  StartAgain();
  EXPECT_TRUE(Host().IsOn());
  EXPECT_EQ(Server().Runs.size(), 1U);
}

TEST_P(PageOfResults, ShowsGunsUntilNamesAreSwitchedOn) {
  Serve();
  venue.LoadGame(SmallGame());
  NameGuest("Guest40", "Ann");
  EXPECT_TRUE(IsServed("/en/g/1/40"));
  EXPECT_TRUE(IsServed("/zh/g/1/1"));
  EXPECT_FALSE(AnyServed("Ann"));
  ShowNames();
  EXPECT_TRUE(AnyServed("Ann"));
  Set([](PageSetup& setup) { setup.Names = NamesShown::Nowhere; });
  EXPECT_FALSE(AnyServed("Ann"));
}

TEST_P(PageOfResults, TakesNamesOffTheBoardTooWhereThatIsSet) {
  Serve();
  venue.LoadGame(SmallGame());
  NameGuest("Guest40", "Ann");
  venue.Trigger("mnuAudienceResults");
  EXPECT_THAT(NamesOnBoard().front(), "Ann");
  Set([](PageSetup& setup) { setup.Names = NamesShown::Nowhere; });
  EXPECT_THAT(NamesOnBoard().front(), Not("Ann"));
  Set([](PageSetup& setup) { setup.Names = NamesShown::OnBoard; });
  EXPECT_THAT(NamesOnBoard().front(), "Ann");
}

TEST_P(PageOfResults, HasTheGameThatIsOnTheBoardWhenItIsSwitchedOn) {
  venue.LoadGame(SmallGame());
  Serve();
  EXPECT_TRUE(IsServed("/en/g/1/"));
  EXPECT_THAT(Served().at("/en/"), HasSubstr("14:20"));
}

TEST_P(PageOfResults, LeavesGamesOfOtherDaysAway) {
  Serve();
  venue.Time.Stamps["today"] = "2013-05-20 20:00:00";
  venue.LoadGame(SmallGame());
  EXPECT_FALSE(IsServed("/en/g/1/"));
  venue.Time.Stamps.erase("today");
  venue.LoadGame(SmallGame());
  EXPECT_FALSE(IsServed("/en/g/1/"));
}

TEST_P(PageOfResults, HasAPulledGameOnceItIsScored) {
  Serve();
  bool wasThere = false;
  bool answered = false;
  venue.Port.OnOutput = [&](std::uint8_t byte) {
    wasThere = wasThere || IsServed("/en/g/1/");
    if (byte == 0 && venue.Port.Sent.size() >= 2 && !std::exchange(answered, true)) {
      venue.Port.Receive({1});
      venue.Port.Receive(FrameOfBlue0());
    }
  };
  venue.Trigger("mnuGetKeshData");
  EXPECT_TRUE(answered);
  EXPECT_FALSE(wasThere);
  EXPECT_TRUE(IsServed("/en/g/1/"));
  EXPECT_FALSE(IsServed("/en/g/2/"));
}

TEST_P(PageOfResults, NumbersTheGamesAndShowsAsManyAsAreSet) {
  Serve();
  for (int game = 0; game < 4; ++game) {
    venue.LoadGame(SmallGame());
  }
  EXPECT_TRUE(IsServed("/en/g/1/"));
  EXPECT_TRUE(IsServed("/en/g/4/"));
  Set([](PageSetup& setup) { setup.Games = 2; });
  EXPECT_FALSE(IsServed("/en/g/2/"));
  EXPECT_TRUE(IsServed("/en/g/3/"));
  Set([](PageSetup& setup) { setup.Games = 3; });
  EXPECT_TRUE(IsServed("/en/g/2/"));
}

TEST_P(PageOfResults, RenewsAGameThatIsChanged) {
  Serve();
  venue.LoadGame(SmallGame());
  const std::string before = Served().at("/en/g/1/");
  const std::size_t sent = Server().Input.size();
  venue.OpenPopup(0, [](QMenu&) {});  // calculates, with nothing new
  EXPECT_EQ(Server().Input.size(), sent);
  venue.ActiveMission().setCurrentIndex(0);
  NameGuest("Guest40", "Ann");
  ShowNames();
  EXPECT_NE(Served().at("/en/g/1/"), before);
  EXPECT_FALSE(IsServed("/en/g/2/"));
}

TEST_P(PageOfResults, WaitsForTheBoardWhereThatIsSet) {
  Serve();
  Set([](PageSetup& setup) { setup.WithBoard = true; });
  venue.Trigger("mnuAudienceBoard");
  venue.LoadGame(SmallGame());
  EXPECT_FALSE(IsServed("/en/g/1/"));
  venue.Trigger("mnuAudienceResults");
  EXPECT_TRUE(IsServed("/en/g/1/"));
  venue.Trigger("mnuAudienceBoard");
  venue.LoadGame(SmallGame());
  EXPECT_TRUE(IsServed("/en/g/2/"));  // the board is off
}

TEST_P(PageOfResults, LosesAHiddenNameInAllItsGamesAtOnce) {
  Serve();
  ShowNames();
  venue.Trigger("mnuAudienceBoard");
  for (int game = 0; game < 2; ++game) {
    venue.LoadGame(SmallGame());
    NameGuest("Guest40", "Ann");
  }
  venue.Trigger("mnuAudienceResults");
  ASSERT_THAT(Served().at("/en/g/1/"), HasSubstr("Ann"));
  ASSERT_THAT(NamesOnBoard().front(), "Ann");
  Hide(0);
  EXPECT_FALSE(AnyServed("Ann"));
  EXPECT_THAT(NamesOnBoard().front(), Not("Ann"));
  EXPECT_THAT(venue.Boxes.Boxes.back().Text, HasSubstr("Ann"));
}

TEST_P(PageOfResults, LosesAHiddenNameAlsoFromABoardWithAnEarlierGame) {
  venue.Trigger("mnuAudienceBoard");
  venue.LoadGame(SmallGame());
  NameGuest("Guest40", "Ann");
  venue.Trigger("mnuAudienceResults");
  venue.LoadGame(SmallGame());
  NameGuest("Guest40", "Ann");
  ASSERT_THAT(NamesOnBoard().front(), "Ann");
  Hide(0);
  EXPECT_THAT(NamesOnBoard().front(), Not("Ann"));
}

TEST_P(PageOfResults, KeepsAMemberHiddenUntilShownAgain) {
  venue.ChangeDatabase("members.mdb",
                       "INSERT INTO Members (ContactID, FirstName, LastName, NickName) VALUES "
                       "(4711, 'Ada', 'Byron', 'Mole')");
  StartAgain();
  const std::string game =
      GameFile(PlayerOf(1) + PlayerOf(40, "<BonusPoints>9</BonusPoints><MemberIndex>4711</MemberIndex>"));
  Serve();
  ShowNames();
  venue.LoadGame(game);
  ASSERT_TRUE(AnyServed("Mole"));
  Hide(0);
  EXPECT_FALSE(AnyServed("Mole"));
  StartAgain();
  Serve();
  venue.LoadGame(game);
  EXPECT_TRUE(IsServed("/en/g/1/40"));
  EXPECT_FALSE(AnyServed("Mole"));
  LookAt([this](ResultsPage& window) {
    auto& list = Find<QListWidget>(window, "HiddenPlayers");
    ASSERT_EQ(list.count(), 1);
    EXPECT_EQ(list.item(0)->text(), QStringLiteral("Mole"));
    EXPECT_FALSE(Find<QPushButton>(window, "ShowAgain").isEnabled());
    list.setCurrentRow(0);
    ::Press(window, "ShowAgain");
    EXPECT_EQ(list.count(), 0);
    EXPECT_TRUE(AnyServed("Mole"));
  });
  StartAgain();
  Serve();
  venue.LoadGame(game);
  EXPECT_TRUE(AnyServed("Mole"));
}

TEST_P(PageOfResults, HasNothingToHideWithoutAPlayerOrAName) {
  venue.Boxes.Answers = {BoxAnswer::Ok, BoxAnswer::Ok};
  venue.Trigger("mnuHidePlayer");
  EXPECT_EQ(venue.Boxes.Boxes.back().Text, venue.Strings.Text(OwnText::HideSelectFirst));
  venue.LoadGame(SmallGame());
  Hide(1);
  EXPECT_EQ(venue.Boxes.Boxes.back().Text,
            Filled(venue.Strings.Text(OwnText::HideNothing),
                   {venue.Strings.TextLanguage() == Language::English ? "Red 0" : "红队 0"}));
  EXPECT_FALSE(std::filesystem::exists(venue.DataFile("hidden-names.txt")));
}

TEST_P(PageOfResults, HasTheRankingOfTheMonthWhereItIsWanted) {
  std::filesystem::copy_file(TESSARINE_PROGRAM_FOLDER "/games_default.mdb", venue.DataFile("games.mdb"));
  venue.ChangeDatabase("members.mdb",
                       "INSERT INTO Members (ContactID, FirstName, LastName, NickName) VALUES "
                       "(4711, 'Ada', 'Byron', 'Mole'), (4712, 'Bob', 'Cole', NULL)");
  for (const char* played : {"2013-05-01 20:00:00", "2013-05-31 23:00:00", "2013-06-01 00:00:00"}) {
    venue.ChangeDatabase("games.mdb",
                         "INSERT INTO Games VALUES (NULL, '" + std::string(played) +
                             "', '', '', 'Cable', 1, 2, 0, 0, 0, 0, 1, 1, 1, 1, 1, 1, 1, '', NULL)");
    venue.ChangeDatabase("games.mdb",
                         "INSERT INTO GamePlayers SELECT max(GameID), 1, 4711, '', 1, 350, 0.5, 1, 1, 1, 1, "
                         "1, 1, 0 FROM Games");
    venue.ChangeDatabase(
        "games.mdb",
        "INSERT INTO GamePlayers SELECT max(GameID), 2, 4712, '', 2, 20, 0.5, 1, 1, 1, 1, 1, "
        "1, 0 FROM Games");
  }
  StartAgain();
  Serve();
  Set([](PageSetup& setup) { setup.Ranking = true; });
  EXPECT_FALSE(IsServed("/en/month"));
  ShowNames();
  ASSERT_TRUE(IsServed("/en/month"));
  EXPECT_THAT(Served().at("/zh/month"), HasSubstr("Mole"));
  EXPECT_THAT(Served().at("/en/month"), HasSubstr("<td>700"));
  EXPECT_FALSE(AnyServed("Cole"));
  EXPECT_FALSE(AnyServed("4711"));
  venue.LoadGame(GameFile(PlayerOf(40, "<MemberIndex>4711</MemberIndex>")));
  Hide(0);
  EXPECT_THAT(Served().at("/en/month"), Not(HasSubstr("Mole")));
}

TEST_P(PageOfResults, IsSwitchedAndToldInItsWindow) {
  LookAt([this](ResultsPage& window) {
    const auto state = [&window] { return Find<QLabel>(window, "PageState").text().toStdString(); };
    const StringTable& strings = venue.Strings;
    EXPECT_EQ(state(), strings.Text(OwnText::PageIsOff));
    EXPECT_FALSE(Find<QPushButton>(window, "PrintPoster").isEnabled());
    EXPECT_TRUE(Find<QLabel>(window, "QrPicture").pixmap(Qt::ReturnByValue).isNull());
    Find<QCheckBox>(window, "PageOn").click();
    EXPECT_EQ(state(), strings.Text(OwnText::PageStarting));
    Server().OnOutput(ServedAt8081);
    EXPECT_THAT(state(), HasSubstr("http://192.168.1.20:8081/"));
    Asker().OnOutput(Answer);
    EXPECT_THAT(state(), HasSubstr("8081"));
    EXPECT_THAT(state(), HasSubstr(Filled(strings.Text(OwnText::PageServes), {"0"})));
    Server().OnOutput("V\x07\x00\x00\x00"s);
    EXPECT_THAT(state(), HasSubstr(Filled(strings.Text(OwnText::PageServes), {"7"})));
    EXPECT_EQ(Find<QLabel>(window, "PageUrl").text(), QStringLiteral("http://192.168.1.20:8081/"));
    EXPECT_FALSE(Find<QLabel>(window, "QrPicture").pixmap(Qt::ReturnByValue).isNull());
    Server().End();
    EXPECT_EQ(state(), Filled(strings.Text(OwnText::PagePausing), {"2"}));
    EXPECT_EQ(Find<QLabel>(window, "PageUrl").text(), QString());
    Find<QCheckBox>(window, "PageOn").click();
    EXPECT_EQ(state(), strings.Text(OwnText::PageIsOff));
  });
}

TEST_P(PageOfResults, IsSetInItsWindow) {
  LookAt([this](ResultsPage& window) {
    auto& addresses = Find<QComboBox>(window, "PageAddress");
    ASSERT_EQ(addresses.count(), 3);
    EXPECT_THAT(addresses.itemText(0).toStdString(), HasSubstr("192.168.1.20"));
    addresses.setCurrentIndex(2);
    Find<QSpinBox>(window, "PagePort").setValue(9000);
    Find<QSpinBox>(window, "PageGames").setValue(7);
    Find<QComboBox>(window, "PageNames").setCurrentIndex(1);
    Find<QComboBox>(window, "NewGame").setCurrentIndex(1);
    Find<QCheckBox>(window, "MonthRanking").click();
  });
  const PageSetup wanted{.On = false,
                         .Address = "127.0.0.1",
                         .Port = 9000,
                         .Names = NamesShown::OnBoardAndPage,
                         .Games = 7,
                         .WithBoard = true,
                         .Ranking = true};
  EXPECT_EQ(Host().Setup(), wanted);
  StartAgain();
  EXPECT_EQ(Host().Setup(), wanted);
  LookAt([](ResultsPage& window) {
    EXPECT_EQ(Find<QComboBox>(window, "PageAddress").currentIndex(), 2);
    EXPECT_EQ(Find<QSpinBox>(window, "PagePort").value(), 9000);
    EXPECT_EQ(Find<QComboBox>(window, "PageNames").currentIndex(), 1);
  });
  EXPECT_EQ(venue.Piped.Made, 0);
}

TEST_P(PageOfResults, WaitsForANetworkAndSaysSo) {
  venue.Addresses.List.clear();
  SwitchOn();
  EXPECT_THAT(Server().Runs, IsEmpty());
  LookAt([this](ResultsPage& window) {
    EXPECT_EQ(Find<QLabel>(window, "PageState").text().toStdString(),
              venue.Strings.Text(OwnText::PageNoAddress));
  });
}

TEST_P(PageOfResults, IsOnAPosterThatTheDesktopOpens) {
  Serve();
  LookAt([](ResultsPage& window) { ::Press(window, "PrintPoster"); });
  const std::string poster = venue.DataFile("results-poster.pdf");
  EXPECT_THAT(ReadFile(poster), testing::StartsWith("%PDF"));
  EXPECT_THAT(ReadFile(poster), Not(HasSubstr("DCTDecode")));  // a photo's compression spoils the code
  ASSERT_EQ(venue.Started.Started.size(), 1U);
  EXPECT_THAT(venue.Started.Started[0], ElementsAre("xdg-open", poster));
}

TEST_P(PageOfResults, TellsWhereThePosterIsThatTheDesktopDoesNotOpen) {
  Serve();
  venue.Started.Failure = RuntimeError(53);
  venue.Boxes.Answers = {BoxAnswer::Ok};
  LookAt([](ResultsPage& window) { ::Press(window, "PrintPoster"); });
  EXPECT_THAT(venue.Boxes.Boxes.back().Text, HasSubstr(venue.DataFile("results-poster.pdf")));
}

INSTANTIATE_TEST_SUITE_P(Languages, PageOfResults,
                         testing::Values(Language::English, Language::SimplifiedChinese),
                         [](const auto& language) {
                           return language.param == Language::English ? "English" : "SimplifiedChinese";
                         });

}  // namespace
