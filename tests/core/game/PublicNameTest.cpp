#include "core/game/PublicName.h"

#include <gtest/gtest.h>

#include <stdexcept>

#include "core/text/TextEncoding.h"

namespace {

constexpr int Blue7 = 40;
constexpr int Red40 = 105;

std::string Repeated(std::string_view text, int times) {
  std::string all;
  for (int i = 0; i < times; ++i) {
    all += text;
  }
  return all;
}

TEST(CleanName, KeepsAnOrdinaryNameOfAnyScript) {
  for (const char* name :
       {"Mole", "O'Brien & Söhne <3", "小龙", "Ørjan \"Z\" Ångström", "नमस्ते", "👩‍🚀 Eva"}) {
    EXPECT_EQ(CleanName(name), name);
  }
}

TEST(CleanName, DropsControlAndDirectionCharacters) {
  EXPECT_EQ(CleanName("A\tB\r\nC\x01\x7F"), "ABC");
  EXPECT_EQ(CleanName("A\u0085B\u2028C\u2029D"), "ABCD");
  for (const char* turning : {"\u061C", "\u200E", "\u200F", "\u202A", "\u202B", "\u202C", "\u202D", "\u202E",
                              "\u2066", "\u2067", "\u2068", "\u2069", "\u206A", "\uFEFF"}) {
    EXPECT_EQ(CleanName("evil" + std::string(turning) + "txt"), "eviltxt");
  }
  EXPECT_EQ(CleanName(std::string("A\0B", 3)), "AB");
}

TEST(CleanName, DropsBytesThatAreNoText) {
  EXPECT_EQ(CleanName("M\xF6we\xC3"), "Mwe");
  EXPECT_EQ(CleanName("A\uFFFE\U0001FFFF"), "A");
}

TEST(CleanName, DropsBlanksAtTheEndsOnly) {
  EXPECT_EQ(CleanName("  Big  Owl \u3000"), "Big  Owl");
  EXPECT_EQ(CleanName(" \t\u00A0\u3164"), "");
  EXPECT_EQ(CleanName(""), "");
}

TEST(CleanName, HasAtMostThirtyCharactersAndNoneHalf) {
  EXPECT_EQ(CleanName(Repeated("x", 30)), Repeated("x", 30));
  EXPECT_EQ(CleanName(Repeated("x", 31)), Repeated("x", 30));
  EXPECT_EQ(CleanName(Repeated("龙", 10000)), Repeated("龙", 30));
  EXPECT_EQ(CleanName(Repeated("𝄞", 40)), Repeated("𝄞", 30));
  EXPECT_EQ(CleanName("\n" + Repeated("x", 30)), Repeated("x", 30));
  EXPECT_EQ(CleanName(Repeated("x", 29) + " y"), Repeated("x", 29));
}

TEST(CleanName, PartsNoLetterFromItsMarks) {
  EXPECT_EQ(CleanName(Repeated("x", 29) + "e\u0301"), Repeated("x", 29));
  EXPECT_EQ(CleanName(Repeated("x", 28) + "e\u0301z"), Repeated("x", 28) + "e\u0301");
  EXPECT_EQ(CleanName(Repeated("x", 28) + "👩\u200D🚀"), Repeated("x", 28));
  EXPECT_EQ(CleanName(Repeated("x", 29) + "\u0928\u093F"), Repeated("x", 29));
}

TEST(CleanName, HasNoMarkWithoutALetter) {
  EXPECT_EQ(CleanName("\u0301\u200DMole"), "Mole");
  EXPECT_EQ(CleanName("\n\u0301"), "");
  EXPECT_EQ(CleanName("Mole\u200D"), "Mole");
}

TEST(CleanName, KeepsThirtyCharactersOfALetterWithEndlessMarks) {
  const std::string name = CleanName("e" + Repeated("\u0301", 500) + "x");
  EXPECT_EQ(name, "e" + Repeated("\u0301", 29));
  EXPECT_TRUE(IsUtf8(name));
}

class PublicNames : public testing::Test {
 protected:
  PublicNames() { game.Players(Blue7).MemberIndex = 5; }

  std::string Name(const std::string& nickName, const GuestNames& guests = {}) const {
    return PublicName(
        game, Blue7, [&nickName](std::int32_t id) { return id == 5 ? nickName : "?"; }, guests);
  }

  StringTable strings{Language::English};
  Game game{strings};
};

TEST_F(PublicNames, AreTheNicknameOfTheMember) {
  EXPECT_EQ(Name(" Mole\u202E"), "Mole");
  EXPECT_EQ(Name("Mole", [](int) { return "Guest"; }), "Mole");
}

TEST_F(PublicNames, AreTheGuestNameWithoutOne) {
  const auto guests = [](int index) { return index == Blue7 ? "\tGuest" : "?"; };
  EXPECT_EQ(Name("", guests), "Guest");
  EXPECT_EQ(Name("\u200E", guests), "Guest");
}

TEST_F(PublicNames, AreTheGunWithoutEither) {
  EXPECT_EQ(Name(""), "Blue 7");
  EXPECT_EQ(Name(" ", [](int) { return ""; }), "Blue 7");
  game.Players(Blue7).MemberIndex = 0;
  EXPECT_EQ(Name("Mole"), "Blue 7");
}

TEST_F(PublicNames, DoNotLookUpANoMember) {
  EXPECT_EQ(PublicName(game, Red40,
                       [](std::int32_t id) -> std::string { throw std::runtime_error(std::to_string(id)); }),
            "Red 40");
}

TEST(GunNames, HaveTheTeamInTheLanguageOfTheProgram) {
  const StringTable strings(Language::SimplifiedChinese);
  const Game game(strings);
  EXPECT_EQ(GunName(game, Blue7), "蓝队 7");
  EXPECT_EQ(GunName(game, Red40), "红队 40");
}

}  // namespace
