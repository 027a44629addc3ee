#include "core/FirstRun.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeFolders.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/platform/linux/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

class FirstRun : public testing::Test {
 protected:
  FirstRun() {
    folders.LocalAppDataPath = "/home/data";
    folders.ProgramPath = "/program";
    files.AddFolder("/home/data");
    files.Put("/program/scenarios_default.mdb", "missions");
    files.Put("/program/members_default.mdb", "members");
    files.Put("/program/score_card_default.doc", "card");
    files.Put("/program/tessarine.ini", "ini");
  }

  FakeMessageBoxes::Box Copied(const std::string& start) {
    return {start + "/home/data/Orvalin/Tessarine.", "Database status", BoxIcon::Information, BoxButtons::Ok};
  }

  std::string Prepare() { return PrepareUserDataFolder(folders, files, boxes); }

  FakeFolders folders;
  FakeFiles files;
  FakeMessageBoxes boxes;
};

TEST_F(FirstRun, CopiesTheDefaultsAndTellsOfThreeInOrder) {
  EXPECT_EQ(Prepare(), "/home/data/Orvalin/Tessarine");
  EXPECT_THAT(boxes.Boxes,
              ElementsAre(Copied("User Scenario database not found, creating new database in "),
                          Copied("User Member database not found, creating new database in "),
                          Copied("User Score Card template not found, creating new template in ")));
  EXPECT_EQ(files.Read("/home/data/Orvalin/Tessarine/scenarios.mdb"), "missions");
  EXPECT_EQ(files.Read("/home/data/Orvalin/Tessarine/members.mdb"), "members");
  EXPECT_EQ(files.Read("/home/data/Orvalin/Tessarine/score_card.doc"), "card");
  EXPECT_EQ(files.Read("/home/data/Orvalin/Tessarine/tessarine.ini"), "ini");
}

TEST_F(FirstRun, TellsBeforeItCopies) {
  boxes.WhileOpen = [this](const FakeMessageBoxes::Box&) { EXPECT_EQ(files.Replaced.size(), boxes.Boxes.size() - 1); };
  Prepare();
  EXPECT_EQ(boxes.Boxes.size(), 3u);
}

TEST_F(FirstRun, IsSilentTheSecondTime) {
  Prepare();
  boxes.Boxes.clear();
  files.Replaced.clear();
  Prepare();
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_THAT(files.Replaced, IsEmpty());
}

TEST_F(FirstRun, LeavesFilesThatExist) {
  files.Put("/home/data/Orvalin/Tessarine/members.mdb", "mine");
  Prepare();
  EXPECT_EQ(files.Read("/home/data/Orvalin/Tessarine/members.mdb"), "mine");
  EXPECT_EQ(boxes.Boxes.size(), 2u);
}

TEST_F(FirstRun, SaysWhenTheFolderIsUnknownAndGoesOn) {
  const std::pair<std::uint32_t, const char*> cases[] = {
      {0x80070057, "An invalid folder ID was specified"}, {1, "The folder does not exist"}};
  for (const auto& [code, text] : cases) {
    boxes.Boxes.clear();
    folders.Code = code;
    EXPECT_EQ(Prepare(), "/Orvalin/Tessarine");
    ASSERT_FALSE(boxes.Boxes.empty());
    EXPECT_EQ(boxes.Boxes[0], (FakeMessageBoxes::Box{text, "Tessarine", BoxIcon::None, BoxButtons::Ok}));
  }
}

TEST_F(FirstRun, FailsWhenAFolderCannotBeMade) {
  files.FailCreateFolder("/home/data/Orvalin", RuntimeError(75));
  EXPECT_EQ(NumberThrownBy([this] { Prepare(); }), 75);
}

TEST_F(FirstRun, FailsWhenACopyCannotBeMade) {
  files.Remove("/program/members_default.mdb");
  EXPECT_EQ(NumberThrownBy([this] { Prepare(); }), 53);
  EXPECT_FALSE(files.FileExists("/home/data/Orvalin/Tessarine/members.mdb"));
}

}  // namespace
