#include <gmock/gmock.h>

#include <QGuiApplication>

#include "tests/support/Venue.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

constexpr const char* Filter = "XML Files & (*.xml) |*.xml";

const FakeMessageBoxes::Box NoGameFile{"Unable to open Game file.", "Game File Error", BoxIcon::Exclamation,
                                       BoxButtons::Ok};

FakeMessageBoxes::Box ErrorReport(const std::string& text) {
  return {text, "Tessarine", BoxIcon::Critical, BoxButtons::Ok};
}

class GameFileCommands : public testing::Test {
 protected:
  GameFileCommands() { venue.Start(); }

  void ExpectEmptyBoard() const {
    EXPECT_EQ(venue.RowCount("ScoreDisplay"), 0);
    EXPECT_EQ(venue.RowCount("TeamScores"), 0);
    EXPECT_EQ(QGuiApplication::overrideCursor(), nullptr);
  }

  std::string FileOf(const std::string& name) const { return venue.Folder / name; }

  void SaveAs(const std::optional<std::string>& name) {
    venue.Dialog.Answers = {name};
    venue.Trigger("mnuSaveScores");
  }

  Venue venue;
};

TEST_F(GameFileCommands, AskWithTheirFilter) {
  venue.Trigger("mnuLoadScores");
  venue.Trigger("mnuSaveScores");
  EXPECT_THAT(venue.Dialog.Calls,
              ElementsAre(FakeFileDialog::Call{false, Filter, ""}, FakeFileDialog::Call{true, Filter, ""}));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(GameFileCommands, LoadAGameWithItsMission) {
  venue.LoadGame(GameFile(PlayerOf(1, "<BonusPoints>5</BonusPoints>"), "First Muster"));
  EXPECT_EQ(venue.ActiveMission().currentText(), QStringLiteral("First Muster"));
  EXPECT_THAT(venue.Row("ScoreDisplay", 0),
              ElementsAre("1", "Red  0", " 5", "Error", " 0", " 0", " 0", " 0", " 0"));
  EXPECT_EQ(venue.RowCount("TeamScores"), 3);
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  EXPECT_EQ(QGuiApplication::overrideCursor(), nullptr);
}

TEST_F(GameFileCommands, ReplaceTheGameOnTheBoardByTheLoadedOne) {
  venue.LoadGame(SmallGame());
  venue.LoadGame(GameFile(PlayerOf(65)));
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Yellow  0"));
}

TEST_F(GameFileCommands, LoadWhatTheySaved) {
  venue.LoadGame(
      GameFile("<Player><Index>2</Index><Active>1</Active><ShotCount>9</ShotCount>"
               "<HitData><HitByPlayer><Index>33</Index><Amount>70</Amount></HitByPlayer></HitData>"
               "<Committed>1</Committed><PrimaryDamage>7</PrimaryDamage></Player>" +
                   PlayerOf(33, "<ShotCount>4</ShotCount><PrimaryDamage>10</PrimaryDamage>"),
               "Signal Fires"));
  const auto blue = venue.Row("ScoreDisplay", 0);
  const auto red = venue.Row("ScoreDisplay", 1);
  ASSERT_EQ(blue[4], " 70");
  SaveAs(FileOf("saved.xml"));
  EXPECT_THAT(ReadFile(FileOf("saved.xml")), HasSubstr("<Committed>1</Committed>"));
  venue.Trigger("mnuClearScores");
  venue.ActiveMission().setCurrentIndex(0);
  venue.Dialog.Answers = {FileOf("saved.xml")};
  venue.Trigger("mnuLoadScores");
  EXPECT_EQ(venue.Row("ScoreDisplay", 0), blue);
  EXPECT_EQ(venue.Row("ScoreDisplay", 1), red);
  EXPECT_EQ(venue.ActiveMission().currentText(), QStringLiteral("Signal Fires"));
}

TEST_F(GameFileCommands, SaveAGameWithoutPlayersToo) {
  SaveAs(FileOf("empty.xml"));
  EXPECT_THAT(ReadFile(FileOf("empty.xml")), HasSubstr("<PlayerData></PlayerData>"));
  venue.Dialog.Answers = {FileOf("empty.xml")};
  venue.Trigger("mnuLoadScores");
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 0);
  EXPECT_EQ(venue.RowCount("TeamScores"), 3);
}

TEST_F(GameFileCommands, WriteTheActiveMissionInTheirFile) {
  venue.ActiveMission().setCurrentIndex(1);
  SaveAs(FileOf("saved.xml"));
  EXPECT_THAT(ReadFile(FileOf("saved.xml")), HasSubstr("<MissionName>Free For All</MissionName>"));
}

TEST_F(GameFileCommands, KeepTheGameWhenLoadingIsCancelled) {
  venue.LoadGame(SmallGame());
  venue.Dialog.Answers = {std::nullopt};
  venue.Trigger("mnuLoadScores");
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 2);
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(GameFileCommands, SaveNothingWhenCancelledWithoutAnEarlierFile) {
  SaveAs(std::nullopt);
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  EXPECT_TRUE(std::filesystem::equivalent(venue.DataFolder() + "/../..", venue.Folder.Path()));
  for (const auto& entry : std::filesystem::directory_iterator(venue.Folder.Path())) {
    EXPECT_EQ(entry.path().filename(), "Orvalin");
  }
}

TEST_F(GameFileCommands, SaveToTheLastFileWhenCancelledAfterALoad) {
  venue.LoadGame(SmallGame());
  const std::string loaded = ReadFile(FileOf("game.xml"));
  SaveAs(std::nullopt);
  EXPECT_EQ(venue.Dialog.Calls.back(), (FakeFileDialog::Call{true, Filter, FileOf("game.xml")}));
  EXPECT_NE(ReadFile(FileOf("game.xml")), loaded);
  EXPECT_THAT(ReadFile(FileOf("game.xml")), HasSubstr("<PlayerID>Blue  7</PlayerID>"));
}

TEST_F(GameFileCommands, SaveToTheLastFileWhenCancelledAfterASave) {
  venue.LoadGame(SmallGame());
  SaveAs(FileOf("saved.xml"));
  venue.ActiveMission().setCurrentIndex(1);
  SaveAs(std::nullopt);
  EXPECT_THAT(ReadFile(FileOf("saved.xml")), HasSubstr("<MissionName>Free For All</MissionName>"));
}

TEST_F(GameFileCommands, ForgetTheLastFileWhenLoadingIsCancelled) {
  venue.LoadGame(SmallGame());
  const std::string loaded = ReadFile(FileOf("game.xml"));
  venue.Dialog.Answers = {std::nullopt};
  venue.Trigger("mnuLoadScores");
  SaveAs(std::nullopt);
  EXPECT_EQ(ReadFile(FileOf("game.xml")), loaded);
}

TEST_F(GameFileCommands, ClearTheBoardBeforeAWrongFile) {
  for (const char* contents : {"", "no markup", "<Other/>", "<GameData><GameHeader>"}) {
    venue.LoadGame(SmallGame());
    ASSERT_EQ(venue.RowCount("ScoreDisplay"), 2);
    venue.Boxes.Boxes.clear();
    venue.LoadGame(contents);
    EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(NoGameFile)) << contents;
    ExpectEmptyBoard();
  }
}

TEST_F(GameFileCommands, ShowTheHourglassUntilAGameIsLoaded) {
  int boxes = 0;
  venue.Boxes.WhileOpen = [&](const FakeMessageBoxes::Box&) {  // the real boxes take it away
    ++boxes;
    ASSERT_NE(QGuiApplication::overrideCursor(), nullptr);
    EXPECT_EQ(QGuiApplication::overrideCursor()->shape(), Qt::WaitCursor);
  };
  venue.LoadGame("no markup");
  EXPECT_EQ(boxes, 1);
  EXPECT_EQ(QGuiApplication::overrideCursor(), nullptr);
}

TEST_F(GameFileCommands, SayThatAMissingFileIsNoGameFile) {
  venue.Dialog.Answers = {FileOf("missing.xml")};
  venue.Trigger("mnuLoadScores");
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(NoGameFile));
}

TEST_F(GameFileCommands, CalculateNothingAfterAWrongFile) {
  venue.LoadGame(SmallGame());
  venue.LoadGame("<Other/>");
  venue.ActiveMission().setCurrentIndex(1);
  ExpectEmptyBoard();
}

TEST_F(GameFileCommands, ReportATextWhereANumberIsDueAndGoOn) {
  venue.LoadGame(SmallGame());
  venue.LoadGame(GameFile(PlayerOf(1) + "<Player><Index>x</Index></Player>"));
  EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(ErrorReport("Run-time error '13': Type mismatch")));
  ExpectEmptyBoard();
  venue.LoadGame(SmallGame());
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 2);
}

TEST_F(GameFileCommands, ReportAnIndexOutsideTheTable) {
  for (const int index : {0, 225}) {
    venue.Boxes.Boxes.clear();
    venue.LoadGame(GameFile(PlayerOf(index)));
    EXPECT_THAT(venue.Boxes.Boxes, ElementsAre(ErrorReport("Run-time error '9': Subscript out of range")));
    ExpectEmptyBoard();
  }
}

TEST_F(GameFileCommands, KeepTheRecordsThatWereReadBeforeTheError) {
  venue.LoadGame(GameFile(PlayerOf(7) + PlayerOf(225)));
  venue.Port.FailNextOpen(8002);
  venue.Boxes.Answers = {BoxAnswer::Cancel};
  venue.Press("GetScores");  // ends in a calculation
  EXPECT_THAT(venue.Column("ScoreDisplay", 1), ElementsAre("Red  6"));
}

TEST_F(GameFileCommands, ReportAFolderThatIsMissingWhenSaving) {
  SaveAs(FileOf("nowhere/saved.xml"));
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1u);
  EXPECT_THAT(venue.Boxes.Boxes[0].Text, testing::StartsWith("Run-time error '76': "));
  EXPECT_EQ(venue.Boxes.Boxes[0].Icon, BoxIcon::Critical);
}

}  // namespace
