#include "core/game/DeskEntries.h"

#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;

/// What the entries say; a link stands in brackets, with what it does.
std::vector<std::string> Line(const DeskFacts& facts, Language language = Language::English) {
  std::vector<std::string> line;
  for (const DeskEntry& entry : DeskEntries(facts, StringTable(language))) {
    line.push_back(entry.IsLink ? "[" + entry.Text + "] " + entry.Tip : entry.Text);
  }
  return line;
}

DeskFacts Saved() {
  DeskFacts facts;
  facts.Present = true;
  facts.Players = 40;
  facts.Time = "21/11/2026 20:15";
  facts.Mission = "The Night Courier";
  return facts;
}

TEST(DeskEntries, SayThatThereIsNoGame) {
  DeskFacts facts = Saved();
  facts.Present = false;
  facts.Unsaved = true;
  facts.LowestFirst = true;
  EXPECT_THAT(Line(facts), ElementsAre("No game on the board"));
}

TEST(DeskEntries, NamePlayersTimeAndMission) {
  DeskFacts facts = Saved();
  EXPECT_THAT(Line(facts), ElementsAre("Players: 40, 21/11/2026 20:15, The Night Courier"));
  facts.Time.clear();
  EXPECT_THAT(Line(facts), ElementsAre("Players: 40, The Night Courier"));
  EXPECT_THAT(Line(facts, Language::SimplifiedChinese), ElementsAre("玩家：40，The Night Courier"));
}

TEST(DeskEntries, LinkWhatIsStillToBeDone) {
  DeskFacts facts = Saved();
  facts.Unsaved = true;
  facts.Commits = {3, 12};
  facts.CountedTwice = 2;
  EXPECT_THAT(Line(facts), ElementsAre(testing::_, "[Guns counted twice: 2] Show these players",
                                       "[Not saved] Save the game",
                                       "[Committed: 3 of 12] Commit the game to the database"));
  facts = Saved();
  facts.Commits = {12, 12};
  EXPECT_THAT(Line(facts), ElementsAre(testing::_, "Committed: 12 of 12"));
}

TEST(DeskEntries, LinkWhatChangedTheScores) {
  DeskFacts facts = Saved();
  facts.LowestFirst = true;
  facts.Change = {"None", "Free For All", 7};
  facts.SharedMembers = {"Mole", "Ada Berg"};
  EXPECT_THAT(Line(facts),
              ElementsAre(testing::_, "[Ranks: lowest score first] Rank the highest score first again",
                          "[Mission changed from None to Free For All, players rescored: 7] Go back to None",
                          "[On more than one gun: Mole, Ada Berg] Show these players"));
}

TEST(DeskEntries, NameFilesThatWereOrWereNotWritten) {
  DeskFacts facts;
  facts.FileOfCancel = "/games/a.xml";
  facts.UnsavedSettings = "/data/tessarine.ini";
  EXPECT_THAT(Line(facts),
              ElementsAre("No game on the board", "Cancelled, but saved to the last file: /games/a.xml",
                          "The settings could not be saved: /data/tessarine.ini"));
}

TEST(DeskEntries, TellWhyGamesAndCopiesAreNotKeptAlsoWithoutAGame) {
  DeskFacts facts;
  facts.NotKept = "The disk is full.";
  facts.KeptAt = "14:30";
  facts.UnusableArchive = "/data/games.mdb";
  facts.WeeklyCopyFailure = "No room.";
  facts.BackupLacksRoom = true;
  EXPECT_THAT(
      Line(facts),
      ElementsAre(
          "No game on the board", "Not kept among the past games: The disk is full.",
          testing::HasSubstr("The past games in /data/games.mdb cannot be read."),
          "The weekly copy of the past games could not be made: No room.",
          "No backup copy was made: too little of the disk is free. Delete what you no longer need."));
  EXPECT_EQ(Line(facts, Language::SimplifiedChinese).size(), 5U);
}

}  // namespace
