#include <gmock/gmock.h>

#include <QLabel>
#include <filesystem>

#include "archive/import/ImportGames.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

/// Games, Import Game Files on real databases and files.
class ImportGamesCommand : public testing::Test {
 protected:
  ImportGamesCommand() {
    venue.PutDefaultFiles();
    venue.ChangeDatabase("members.mdb",
                         "INSERT INTO Members (ContactID, DallasID, NickName) VALUES (5, 'BB00000000000001', "
                         "'Mole')");
    venue.Start();
    std::filesystem::create_directories(venue.Folder / "old/deeper");
    WriteFile(venue.Folder / "old/a.xml", SmallGame());
    WriteFile(venue.Folder / "old/deeper/b.xml",
              GameFile(PlayerOf(1, "<MemberIndex>9</MemberIndex><DallasID>BB00000000000001</DallasID>")));
    WriteFile(venue.Folder / "old/c.xml", "<GameData>");
  }

  std::string Import() {
    std::string status;
    const WhileModal<ImportGames> act([&](ImportGames& window) {
      venue.Dialog.Answers = {venue.Folder / "old"};
      ::Press(window, "ChooseFolder");
      ::Press(window, "Import");
      status = Find<QLabel>(window, "Status").text().toStdString();
      window.close();
    });
    venue.Trigger("mnuImportGames");
    EXPECT_EQ(act.Runs(), 1);
    return status;
  }

  Venue venue;
};

TEST_F(ImportGamesCommand, MakesPastGamesOfFiles) {
  EXPECT_EQ(Import(), "2 games imported, 0 were there already, 1 files refused.");
  EXPECT_EQ(venue.QueryDatabase("games.mdb", "SELECT count(*) FROM Games WHERE Source = 'import'"), "2");
  EXPECT_EQ(venue.QueryDatabase("games.mdb", "SELECT max(MemberID) FROM GamePlayers"), "5");
  EXPECT_EQ(Import(), "0 games imported, 2 were there already, 1 files refused.");
  EXPECT_TRUE(venue.Boxes.Boxes.empty());
}

TEST_F(ImportGamesCommand, KnowsTheGameThatIsKeptOfTheBoard) {
  venue.LoadGame(SmallGame());
  EXPECT_EQ(Import(), "1 games imported, 1 were there already, 1 files refused.");
}

TEST_F(ImportGamesCommand, IsKnownByTheBoardThatLoadsItsFileLater) {
  Import();
  venue.LoadGame(SmallGame());
  EXPECT_EQ(venue.QueryDatabase("games.mdb", "SELECT count(*) FROM Games"), "2");
}

}  // namespace
