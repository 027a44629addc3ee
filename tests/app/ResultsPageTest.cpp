// Where the results page is served, and its window.

#include <gmock/gmock.h>

#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QPushButton>
#include <QSpinBox>
#include <filesystem>
#include <utility>

#include "core/text/Filled.h"
#include "tests/app/ResultsVenue.h"

namespace {

using testing::ElementsAre;
using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::StartsWith;

constexpr const char* Url8080 = "http://192.168.1.20:8080/";

using namespace std::string_literals;

class PageOfResults : public ResultsVenue {};

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
  Asker().OnOutput(PageAnswered);
  EXPECT_EQ(Board().State().Address(), "http://192.168.1.20:8081/");
  EXPECT_EQ(Host().Url(), "http://192.168.1.20:8081/");
  Set([](PageSetup& setup) { setup.On = false; });
  EXPECT_EQ(Board().State().Address(), "");
}

TEST_P(PageOfResults, TakesTheAddressOffTheBoardWhenItIsNoLongerAnswered) {
  Serve();
  ASSERT_EQ(Board().State().Address(), Url8080);
  const std::size_t asked = Asker().Runs.size();
  Host().Look();
  ASSERT_EQ(Asker().Runs.size(), asked + 1);
  Asker().OnOutput(PageUnanswered);
  EXPECT_EQ(Board().State().Address(), "");
  Host().Look();
  Asker().OnOutput(PageAnswered);
  EXPECT_EQ(Board().State().Address(), Url8080);
}

TEST_P(PageOfResults, ReplacesAProgramThatHangs) {
  Serve();
  for (int looks = 0; looks < 8; ++looks) {
    EXPECT_EQ(Server().Runs.size(), 1U);
    Host().Look();  // each asks, and finds that the one before is still without an answer
  }
  EXPECT_EQ(Server().Runs.size(), 2U);
  EXPECT_EQ(Host().Serving().Now, PageServing::Phase::Pausing);
  Server().OnOutput(ServedAt8080);
  Asker().OnOutput(PageAnswered);
  EXPECT_EQ(Board().State().Address(), Url8080);
  Host().Look();
  EXPECT_EQ(Server().Runs.size(), 2U);
}

TEST_P(PageOfResults, TakesTheAddressOffTheBoardWhenTheProgramEnds) {
  Serve();
  Server().End();
  EXPECT_EQ(Board().State().Address(), "");
  EXPECT_EQ(Host().Serving().Now, PageServing::Phase::Pausing);
  Server().OnOutput(ServedAt8080);
  EXPECT_EQ(Board().State().Address(), "");
  Asker().OnOutput(PageAnswered);
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

TEST_P(PageOfResults, DoesNotBeginInAProgramThatEnds) {
  SwitchOn();
  venue.Window->close();
  Host().Begin();
  EXPECT_EQ(venue.Piped.Live(), 0U);
  EXPECT_THAT(ReadFile(venue.DataFile("tessarine.ini")), HasSubstr("on=1"));
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
    Asker().OnOutput(PageAnswered);
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

TEST_P(PageOfResults, TellsWhatToDoWhenItsProgramCannotServe) {
  Serve();
  LookAt([this](ResultsPage& window) {
    const StringTable& strings = venue.Strings;
    const auto toldAfter = [&](int exitCode) {
      Server().End(exitCode);
      return Find<QLabel>(window, "PageState").text().toStdString();
    };
    EXPECT_THAT(toldAfter(2), EndsWith("\n" + strings.Text(OwnText::PagesRefused)));
    const std::string noPort = toldAfter(3);
    EXPECT_THAT(noPort, StartsWith(Filled(strings.Text(OwnText::PagePausing), {"3"})));
    EXPECT_THAT(noPort, EndsWith(Filled(strings.Text(OwnText::PageNoPort), {"192.168.1.20", "8080"})));
    EXPECT_THAT(toldAfter(4), EndsWith("\n" + strings.Text(OwnText::PageNotConfined)));
    EXPECT_THAT(toldAfter(5), EndsWith("\n" + strings.Text(OwnText::PageProgramMissing)));
    EXPECT_THAT(toldAfter(PipedProgram::NotStarted), EndsWith(strings.Text(OwnText::PageProgramMissing)));
    EXPECT_EQ(toldAfter(PipedProgram::Killed), Filled(strings.Text(OwnText::PagePausing), {"7"}));
  });
}

TEST_P(PageOfResults, IsSetInItsWindow) {
  LookAt([](ResultsPage& window) {
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
