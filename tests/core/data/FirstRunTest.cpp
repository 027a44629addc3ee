#include "core/data/FirstRun.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeFolders.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/Thrown.h"

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
  boxes.WhileOpen = [this](const FakeMessageBoxes::Box&) {
    EXPECT_EQ(files.Replaced.size(), boxes.Boxes.size() - 1);
  };
  Prepare();
  EXPECT_EQ(boxes.Boxes.size(), 3U);
}

TEST_F(FirstRun, MakesBothFolders) {
  Prepare();
  EXPECT_THAT(files.Created, ElementsAre("/home/data/Orvalin", "/home/data/Orvalin/Tessarine"));
}

TEST_F(FirstRun, MakesOnlyTheInnerFolderBesideAnotherProgramsData) {
  files.Put("/home/data/Orvalin/Other/file", "");
  Prepare();
  EXPECT_THAT(files.Created, ElementsAre("/home/data/Orvalin/Tessarine"));
}

TEST_F(FirstRun, IsSilentTheSecondTime) {
  Prepare();
  boxes.Boxes.clear();
  files.Replaced.clear();
  files.Created.clear();
  EXPECT_EQ(Prepare(), "/home/data/Orvalin/Tessarine");
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_THAT(files.Replaced, IsEmpty());
  EXPECT_THAT(files.Created, IsEmpty());
}

TEST_F(FirstRun, CopiesOnlyWhatIsMissing) {
  const std::pair<const char*, std::size_t> cases[] = {
      {"scenarios.mdb", 1}, {"members.mdb", 1}, {"score_card.doc", 1}, {"tessarine.ini", 0}};
  const std::string folder = "/home/data/Orvalin/Tessarine/";
  for (const auto& [missing, messages] : cases) {
    SCOPED_TRACE(missing);
    for (const auto& [file, unused] : cases) {
      files.Put(folder + file, "mine");
    }
    files.Remove(folder + missing);
    boxes.Boxes.clear();
    files.Replaced.clear();
    Prepare();
    EXPECT_EQ(boxes.Boxes.size(), messages);
    ASSERT_EQ(files.Replaced.size(), 1U);
    EXPECT_EQ(files.Replaced[0].Path, folder + missing);
  }
}

TEST_F(FirstRun, SaysWhenTheFolderIsUnknownAndGoesOn) {
  const std::pair<std::uint32_t, const char*> cases[] = {{0x80070057, "An invalid folder ID was specified"},
                                                         {1, "The folder does not exist"}};
  for (const auto& [code, text] : cases) {
    boxes.Boxes.clear();
    folders.Code = code;
    EXPECT_EQ(Prepare(), "/Orvalin/Tessarine");
    ASSERT_FALSE(boxes.Boxes.empty());
    EXPECT_EQ(boxes.Boxes[0], (FakeMessageBoxes::Box{text, "Tessarine", BoxIcon::None, BoxButtons::Ok}));
  }
}

TEST_F(FirstRun, SaysNothingWhenTheFolderIsFound) {
  Prepare();
  EXPECT_EQ(boxes.Boxes[0].Title, "Database status");
}

TEST_F(FirstRun, FailsWhenAFolderCannotBeMade) {
  for (const char* folder : {"/home/data/Orvalin/Tessarine", "/home/data/Orvalin"}) {
    files.FailCreateFolder(folder, RuntimeError(75));
    EXPECT_EQ(NumberThrownBy([this] { Prepare(); }), 75) << folder;
  }
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_THAT(files.Replaced, IsEmpty());
}

TEST_F(FirstRun, FailsWhenTheDefaultCopyIsMissing) {
  files.Remove("/program/members_default.mdb");
  EXPECT_EQ(NumberThrownBy([this] { Prepare(); }), 53);
  EXPECT_EQ(boxes.Boxes.size(), 2U);
  EXPECT_FALSE(files.FileExists("/home/data/Orvalin/Tessarine/members.mdb"));
  EXPECT_FALSE(files.FileExists("/home/data/Orvalin/Tessarine/score_card.doc"));
}

TEST_F(FirstRun, FailsWhenTheDefaultCopyCannotBeRead) {
  files.FailRead("/program/tessarine.ini", RuntimeError(75));
  EXPECT_EQ(NumberThrownBy([this] { Prepare(); }), 75);
  EXPECT_FALSE(files.FileExists("/home/data/Orvalin/Tessarine/tessarine.ini"));
}

TEST_F(FirstRun, FailsWhenACopyCannotBeWritten) {
  files.FailReplace("/home/data/Orvalin/Tessarine/members.mdb", RuntimeError(61));
  EXPECT_EQ(NumberThrownBy([this] { Prepare(); }), 61);
  EXPECT_EQ(files.Read("/home/data/Orvalin/Tessarine/scenarios.mdb"), "missions");
  EXPECT_FALSE(files.FileExists("/home/data/Orvalin/Tessarine/members.mdb"));
  EXPECT_FALSE(files.FileExists("/home/data/Orvalin/Tessarine/score_card.doc"));
}

TEST_F(FirstRun, FinishesTheNextTimeWhatFailed) {
  files.Remove("/program/members_default.mdb");
  EXPECT_EQ(NumberThrownBy([this] { Prepare(); }), 53);
  files.Put("/program/members_default.mdb", "members");
  boxes.Boxes.clear();
  Prepare();
  EXPECT_THAT(boxes.Boxes,
              ElementsAre(Copied("User Member database not found, creating new database in "),
                          Copied("User Score Card template not found, creating new template in ")));
  EXPECT_EQ(files.Read("/home/data/Orvalin/Tessarine/members.mdb"), "members");
}

}  // namespace
