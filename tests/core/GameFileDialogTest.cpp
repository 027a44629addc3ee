#include "core/GameFileDialog.h"

#include <gmock/gmock.h>

#include "core/GameFile.h"
#include "tests/fakes/FakeFileDialog.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/platform/linux/Thrown.h"

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
  GameFileDialog gameFile{dialog, files, boxes};
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

TEST_F(GameFiles, ThatCannotBeWrittenLeaveTheOldOne) {
  files.Put("/a.xml", "old");
  files.FailReplace("/a.xml", RuntimeError(61));
  dialog.Answers = {"/a.xml"};
  EXPECT_EQ(NumberThrownBy([this] { gameFile.SaveGame(game, "None"); }), 61);
  EXPECT_EQ(files.Read("/a.xml"), "old");
}

TEST_F(GameFiles, ThatCannotBeReadGiveTheBox) {
  const FakeMessageBoxes::Box box{"Unable to open Game file.", "Game File Error", BoxIcon::Exclamation, BoxButtons::Ok};
  files.Put("/bad.xml", "<Other/>");
  dialog.Answers = {"/missing.xml", "/bad.xml"};
  ASSERT_TRUE(gameFile.AskForGame());
  EXPECT_FALSE(Load());
  ASSERT_TRUE(gameFile.AskForGame());
  EXPECT_FALSE(Load());
  EXPECT_THAT(boxes.Boxes, ElementsAre(box, box));
}

}  // namespace
