#include "board/PlayerDetails.h"

#include <gmock/gmock.h>

#include <QLabel>
#include <QListWidget>

#include "tests/support/Captions.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class Details : public testing::Test {
 protected:
  /// Opens the details of the only row of the board.
  void Open(const std::string& fields, const std::function<void(const PlayerDetails&)>& look) {
    venue.Start();
    venue.LoadGame(GameFile(PlayerOf(40, fields)));
    const WhileModal<PlayerDetails> open([&](PlayerDetails& window) {
      look(window);
      ::Press(window, "OKButton");
      EXPECT_FALSE(window.isVisible());
    });
    venue.ChooseInPopup(0, "mnuShowDetailed");
    EXPECT_EQ(open.Runs(), 1);
  }

  static std::string Shown(const PlayerDetails& window, const char* display) {
    return ::Find<QLabel>(window, display).text().toStdString();
  }

  static std::vector<std::string> Lines(const PlayerDetails& window, const char* list) {
    std::vector<std::string> lines;
    const auto& widget = ::Find<QListWidget>(window, list);
    for (int row = 0; row < widget.count(); ++row) {
      lines.push_back(widget.item(row)->text().toStdString());
    }
    return lines;
  }

  Venue venue;
};

TEST_F(Details, ShowEveryFigure) {
  Open(
      "<ShotCount>60</ShotCount><PrimaryDamage>10</PrimaryDamage><SecondaryDamage>11</SecondaryDamage>"
      "<HealCount>12</HealCount><AmmoAddCount>13</AmmoAddCount><AdminKillCount>14</AdminKillCount>"
      "<RespawnCount>15</RespawnCount><DeathCount>16</DeathCount><RunCounter>125</RunCounter>"
      "<RemainingHealth>17</RemainingHealth><RemainingClips>18</RemainingClips><RemainingAmmo>19</"
      "RemainingAmmo>"
      "<PowerCheatFlag>20</PowerCheatFlag><DallasID>AB00000000000001</DallasID><Committed>1</Committed>"
      "<HitData><HitByPlayer><Index>40</Index><Amount>300</Amount></HitByPlayer></HitData>",
      [](const PlayerDetails& window) {
        // 60 shots of 10, hits of 300 on itself, which count as -300.
        for (const auto& [display, text] : {std::pair{"SoldieringDisplay", "-291"},
                                            {"AccuracyDisplay", "50.00%"},
                                            {"PowerCheatDisplay", " 20"},
                                            {"AdminKillDisplay", " 14"},
                                            {"CommitedDisplay", "Yes"},
                                            {"MemberIndexDisplay", " 0"},
                                            {"MemberIDDisplay", "AB00000000000001"},
                                            {"SecondaryDamageDisplay", " 11"},
                                            {"PrimaryDamageDisplay", " 10"},
                                            {"DeathDisplay", " 16"},
                                            {"RunTimeDisplay", "125"},
                                            {"RespawnDisplay", " 15"},
                                            {"AmmoAddDisplay", " 13"},
                                            {"HealDisplay", " 12"},
                                            {"DamageDisplay", "-300"},
                                            {"TotalShotsDisplay", " 60"},
                                            {"RemAmmoDisplay", " 19"},
                                            {"RemClipsDisplay", "18"},
                                            {"RemHealthDisplay", "17"}}) {
          EXPECT_EQ(Shown(window, display), text) << display;
        }
        EXPECT_EQ(window.windowTitle(), QStringLiteral("Player Detailed Data"));
      });
}

TEST_F(Details, HaveTheirCaptions) {
  Open("", [](const PlayerDetails& window) {
    EXPECT_EQ(window.windowTitle(), QStringLiteral("Player Detailed Data"));
    ExpectCaptions(window, {{"Frame7", "Calculated"},
                            {"Frame6", "General"},
                            {"Frame5", "Counters"},
                            {"Frame4", "Totals"},
                            {"Frame3", "Values Remaining"},
                            {"Frame2", "Damage Taken"},
                            {"Frame1", "Damage Inflicted"},
                            {"OKButton", "OK"}});
    ExpectLabels(window, {{"SoldieringDisplay", "Soldiering:"},
                          {"AccuracyDisplay", "Accuracy:"},
                          {"PowerCheatDisplay", "Power Cheat:"},
                          {"AdminKillDisplay", "Admin Kills:"},
                          {"CommitedDisplay", "Saved to DB:"},
                          {"MemberIndexDisplay", "Member Index:"},
                          {"MemberIDDisplay", "Member ID:"},
                          {"SecondaryDamageDisplay", "Secondary Damage:"},
                          {"PrimaryDamageDisplay", "Primary Damage:"},
                          {"DeathDisplay", "Deaths:"},
                          {"RunTimeDisplay", "Run Time:"},
                          {"RespawnDisplay", "Respawns:"},
                          {"AmmoAddDisplay", "Ammo Adds:"},
                          {"HealDisplay", "Heal Points:"},
                          {"DamageDisplay", "Damage Dealt:"},
                          {"TotalShotsDisplay", "Shots Fired:"},
                          {"RemAmmoDisplay", "Remaining Ammo:"},
                          {"RemClipsDisplay", "Remaining Clips:"},
                          {"RemHealthDisplay", "Remaining Health:"}});
  });
}

TEST_F(Details, ShowNoAccuracyOfZeroAndNoHits) {
  Open("<ShotCount>60</ShotCount><PrimaryDamage>10</PrimaryDamage>", [](const PlayerDetails& window) {
    EXPECT_EQ(Shown(window, "AccuracyDisplay"), "N/A");
    EXPECT_EQ(Shown(window, "CommitedDisplay"), "No");
    EXPECT_THAT(Lines(window, "WhoHitYou"), IsEmpty());
    EXPECT_THAT(Lines(window, "WhoYouHit"), IsEmpty());
  });
}

TEST_F(Details, ListWhoHitWhomWithMembersNames) {
  venue.PutDefaultFiles();
  venue.ChangeDatabase("members.mdb",
                       "INSERT INTO Members (ContactID, FirstName, LastName, NickName) VALUES (4, 'Ada', "
                       "'Byron', 'Countess')");
  Open(
      "<MemberIndex>4</MemberIndex><ExplosiveDamage>5</ExplosiveDamage><StunCount>2</StunCount><HitData>"
      "<HitByPlayer><Index>40</Index><Amount>7</Amount></HitByPlayer>"
      "<HitByPlayer><Index>105</Index><Amount>30</Amount></HitByPlayer>"
      "<HitByPlayer><Index>2</Index><Amount>-4</Amount></HitByPlayer></HitData>",
      [](const PlayerDetails& window) {
        EXPECT_THAT(Lines(window, "WhoHitYou"),
                    ElementsAre("Blue  7:  7  (Ada Byron)", "Red  40:  30", "Explosive: 5", "Stuns: 2"));
        EXPECT_THAT(Lines(window, "WhoYouHit"), ElementsAre("Blue  7:  7  (Ada Byron)"));
      });
}

}  // namespace
