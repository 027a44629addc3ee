#include "audience/GuestNameEntry.h"

#include <gmock/gmock.h>

#include <QLabel>
#include <QLineEdit>

#include "tests/support/Controls.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::Pair;

constexpr int Red0 = 1;
constexpr int Red5 = 6;
constexpr int Blue7 = 40;

class GuestNamesWindow : public testing::TestWithParam<Language> {
 protected:
  GuestNamesWindow() {
    game.Players(Red0).Active = true;
    game.Players(Red5).Active = true;
    game.Players(Red5).MemberIndex = 3;
    game.Players(Blue7).Active = true;
  }

  void Open() {
    window = std::make_unique<GuestNameEntry>(game, guests, strings, nullptr);
    Show(*window);
  }

  QLineEdit& EntryOf(int index) const { return Find<QLineEdit>(*window, "Guest" + std::to_string(index)); }

  StringTable strings{GetParam()};
  Game game{strings};
  GuestList guests;
  std::unique_ptr<GuestNameEntry> window;
};

TEST_P(GuestNamesWindow, HasAnEntryForEachActiveGunWithoutAMember) {
  Open();
  EXPECT_EQ(window->windowTitle().toStdString(), strings.Text(OwnText::GuestNamesTitle));
  EXPECT_EQ(window->findChildren<QLineEdit*>().size(), 2);
  EXPECT_TRUE(EntryOf(Red0).hasFocus());
  EXPECT_TRUE(EntryOf(Blue7).isVisible());
}

TEST_P(GuestNamesWindow, KeepsWhatIsTyped) {
  Open();
  QTest::keyClicks(&EntryOf(Red0), QStringLiteral("  Ann "));
  QTest::keyClicks(&EntryOf(Blue7), QStringLiteral("Bob"));
  EXPECT_THAT(window->Names(), ElementsAre(Pair(Red0, "Ann"), Pair(Blue7, "Bob")));
}

TEST_P(GuestNamesWindow, ShowsAndTakesBackNames) {
  guests.SetNames({{Red0, "Ann"}, {Red5, "Cid"}, {Blue7, "Bob"}});
  Open();
  EXPECT_EQ(EntryOf(Blue7).text(), QStringLiteral("Bob"));
  EntryOf(Blue7).clear();
  EXPECT_THAT(window->Names(), ElementsAre(Pair(Red0, "Ann"), Pair(Red5, "Cid")));
}

TEST_P(GuestNamesWindow, SaysThatThereIsNobodyToName) {
  game.Clear();
  Open();
  EXPECT_EQ(Find<QLabel>(*window, "Explanation").text().toStdString(), strings.Text(OwnText::NoGuests));
  EXPECT_FALSE(Find<QPushButton>(*window, "SaveExit").isEnabled());
  EXPECT_THAT(window->Names(), IsEmpty());
}

INSTANTIATE_TEST_SUITE_P(Languages, GuestNamesWindow,
                         testing::Values(Language::English, Language::SimplifiedChinese),
                         [](const auto& language) {
                           return language.param == Language::English ? "English" : "SimplifiedChinese";
                         });

}  // namespace
