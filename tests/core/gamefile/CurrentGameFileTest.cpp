#include "core/gamefile/CurrentGameFile.h"

#include <gmock/gmock.h>

#include "core/gamefile/GameFile.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

constexpr const char* Filter = "XML Files & (*.xml) |*.xml";

class GameFiles : public testing::Test {
 protected:
  bool Load() {
    return gameFile.LoadGame(game, [](const std::string&) {});
  }

  FakeFileDialog dialog;
  FakeFiles files;
  FakeMessageBoxes boxes;
  StringTable strings{Language::English};
  Game game{strings};
  CurrentGameFile gameFile{dialog, files, boxes};
};

TEST_F(GameFiles, AreSavedUnderTheChosenNameWithoutABox) {
  dialog.Answers = {"/a.xml"};
  gameFile.SaveGame(game, "None");
  EXPECT_EQ(files.Read("/a.xml"), WriteGameFile(game, "None"));
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_THAT(dialog.Calls, ElementsAre(FakeFileDialog::Call{true, Filter, ""}));
}

TEST_F(GameFiles, AreNotSavedAfterCancelWithoutAnEarlierName) {
  gameFile.SaveGame(game, "None");
  EXPECT_THAT(files.Replaced, IsEmpty());
}

TEST_F(GameFiles, AreSavedUnderTheLastNameAfterCancel) {
  dialog.Answers = {"/a.xml", std::nullopt};
  gameFile.SaveGame(game, "None");
  gameFile.SaveGame(game, "Free For All");
  EXPECT_EQ(files.Read("/a.xml"), WriteGameFile(game, "Free For All"));
}

TEST_F(GameFiles, AreSavedUnderTheLoadedNameAfterCancel) {
  files.Put("/b.xml", "<GameData/>");
  dialog.Answers = {"/b.xml", std::nullopt};
  ASSERT_TRUE(gameFile.AskForGame());
  ASSERT_TRUE(Load());
  gameFile.SaveGame(game, "None");
  EXPECT_EQ(files.Read("/b.xml"), WriteGameFile(game, "None"));
}

TEST_F(GameFiles, ForgetTheirNameWhenLoadingIsCancelled) {
  dialog.Answers = {"/a.xml", std::nullopt, std::nullopt};
  gameFile.SaveGame(game, "None");
  EXPECT_FALSE(gameFile.AskForGame());
  EXPECT_EQ(dialog.Calls.back(), (FakeFileDialog::Call{false, Filter, ""}));
  files.Replaced.clear();
  gameFile.SaveGame(game, "None");
  EXPECT_THAT(files.Replaced, IsEmpty());
}

TEST_F(GameFiles, OfferTheLastNameWhenSavingAgainAndNoneWhenLoading) {
  dialog.Answers = {"/a.xml", "/b.xml"};
  gameFile.SaveGame(game, "None");
  gameFile.SaveGame(game, "None");
  gameFile.AskForGame();
  EXPECT_THAT(dialog.Calls, ElementsAre(FakeFileDialog::Call{true, Filter, ""},
                                        FakeFileDialog::Call{true, Filter, "/a.xml"},
                                        FakeFileDialog::Call{false, Filter, ""}));
  EXPECT_TRUE(files.FileExists("/a.xml") && files.FileExists("/b.xml"));
}

TEST_F(GameFiles, AreOfferedASuggestedNameInTheFolderOfTheLastSave) {
  files.AddFolder("/games");
  dialog.Answers = {"/games/a.xml", "/b.xml"};
  gameFile.SaveGame(game, "None");
  gameFile.SaveGame(game, "None", "Friday.xml");
  EXPECT_EQ(dialog.Calls.back(), (FakeFileDialog::Call{true, Filter, "Friday.xml", "/games"}));
  EXPECT_EQ(gameFile.SaveFolder(), "/");
}

TEST_F(GameFiles, AreNeverSavedUnderASuggestedNameAfterCancel) {
  gameFile.SetSaveFolder("/games");
  EXPECT_FALSE(gameFile.SaveGame(game, "None", "Friday.xml"));
  EXPECT_THAT(files.Replaced, IsEmpty());
  EXPECT_EQ(gameFile.SavedOnCancel(), "");
  EXPECT_EQ(dialog.Calls.back().Folder, "/games");
  dialog.Answers = {"/a.xml", std::nullopt};
  gameFile.SaveGame(game, "None");
  EXPECT_TRUE(gameFile.SaveGame(game, "Keep", "Friday.xml"));
  EXPECT_EQ(files.Read("/a.xml"), WriteGameFile(game, "Keep"));
  EXPECT_EQ(gameFile.SavedOnCancel(), "/a.xml");
  dialog.Answers = {"/a.xml"};
  gameFile.SaveGame(game, "None");
  EXPECT_EQ(gameFile.SavedOnCancel(), "");
}

TEST_F(GameFiles, ChosenWithoutADialogAreLoadedAndSavedTo) {
  files.Put("/b.xml", "<GameData/>");
  gameFile.Choose("/b.xml");
  ASSERT_TRUE(Load());
  gameFile.SaveGame(game, "None");
  EXPECT_EQ(dialog.Calls.back(), (FakeFileDialog::Call{true, Filter, "/b.xml"}));
  EXPECT_EQ(files.Read("/b.xml"), WriteGameFile(game, "None"));
}

TEST_F(GameFiles, ReplaceAnExistingOneWithoutAQuestion) {
  files.Put("/a.xml", "old and much longer than before");
  dialog.Answers = {"/a.xml"};
  gameFile.SaveGame(game, "None");
  EXPECT_EQ(files.Read("/a.xml"), WriteGameFile(game, "None"));
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(GameFiles, GiveTheirMissionAndContentsWhenLoaded) {
  files.Put(
      "/b.xml",
      "<GameData><GameHeader><MissionName>Keep</MissionName></GameHeader><PlayerData><Player><Index>5</Index>"
      "<Committed>1</Committed></Player></PlayerData></GameData>");
  dialog.Answers = {"/b.xml"};
  ASSERT_TRUE(gameFile.AskForGame());
  std::vector<std::string> missions;
  EXPECT_TRUE(gameFile.LoadGame(game, [&](const std::string& mission) { missions.push_back(mission); }));
  EXPECT_THAT(missions, ElementsAre("Keep"));
  EXPECT_TRUE(game.Players(5).Committed);
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(GameFiles, KeepTheNameOfABadOneForTheNextSave) {
  files.Put("/bad.xml", "bad");
  dialog.Answers = {"/bad.xml", std::nullopt};
  ASSERT_TRUE(gameFile.AskForGame());
  EXPECT_FALSE(Load());
  gameFile.SaveGame(game, "None");
  EXPECT_EQ(files.Read("/bad.xml"), WriteGameFile(game, "None"));
}

TEST_F(GameFiles, WithAFaultInsideReportItWithoutTheBox) {
  files.Put("/b.xml", "<GameData><PlayerData><Player><Index>x</Index></Player></PlayerData></GameData>");
  dialog.Answers = {"/b.xml"};
  ASSERT_TRUE(gameFile.AskForGame());
  EXPECT_EQ(NumberThrownBy([this] { Load(); }), 13);
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(GameFiles, ThatCannotBeWrittenLeaveTheOldOne) {
  files.Put("/a.xml", "old");
  files.FailReplace("/a.xml", RuntimeError(61));
  dialog.Answers = {"/a.xml"};
  EXPECT_EQ(NumberThrownBy([this] { gameFile.SaveGame(game, "None"); }), 61);
  EXPECT_EQ(files.Read("/a.xml"), "old");
}

TEST_F(GameFiles, ThatCannotBeReadGiveTheBox) {
  const FakeMessageBoxes::Box box{"Unable to open Game file.", "Game File Error", BoxIcon::Exclamation,
                                  BoxButtons::Ok};
  files.Put("/bad.xml", "<Other/>");
  files.Put("/locked.xml", "<GameData/>");
  files.FailRead("/locked.xml", RuntimeError(75));
  files.AddFolder("/folder");
  const std::vector<std::string> paths = {"/missing.xml", "/bad.xml", "/locked.xml", "/folder"};
  game.GameDate = "before";
  for (const std::string& path : paths) {
    dialog.Answers = {path};
    ASSERT_TRUE(gameFile.AskForGame());
    EXPECT_FALSE(Load()) << path;
  }
  EXPECT_THAT(boxes.Boxes, ElementsAre(box, box, box, box));
  EXPECT_EQ(game.GameDate, "before");
}

}  // namespace
