#include "takeover/TakeOverResume.h"

#include <gmock/gmock.h>

#include "takeover/TakeOverMark.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

/// A data folder with a mark that no start has finished yet.
class Resumed : public testing::Test {
 protected:
  Resumed() {
    disk.Put("/data/members.mdb", "old members");
    disk.Put("/data/scenarios.mdb", "old missions");
    disk.Put("/data/.takeover/members.mdb", "new members");
    disk.Put("/data/.takeover/scenarios.mdb", "new missions");
    MarkTakeOver(disk, "/data", {"members.mdb", "scenarios.mdb"});
  }

  ResumedTakeOver Resume() { return ResumeTakeOver(disk, "/data", boxes, strings); }
  std::string Data() const {
    return disk.Read("/data/members.mdb") + ", " + disk.Read("/data/scenarios.mdb");
  }

  FakeFiles disk;
  FakeMessageBoxes boxes;
  StringTable strings{Language::English};
};

TEST_F(Resumed, ATakeOverIsFinishedWithoutAWord) {
  const ResumedTakeOver resumed = Resume();
  EXPECT_TRUE(resumed.GoOn);
  EXPECT_EQ(resumed.ToTell, "");
  EXPECT_EQ(Data(), "new members, new missions");
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(Resumed, WithoutADataFolderThereIsNothingToDo) {
  FakeFiles empty;
  EXPECT_TRUE(ResumeTakeOver(empty, "/data", boxes, strings).GoOn);
  EXPECT_THAT(empty.Tidied, IsEmpty());
}

TEST_F(Resumed, OneWhoseFilesAreGoneOrChangedIsTakenBackWhereAllIsStillOld) {
  FakeFiles changed = disk;
  disk.Remove("/data/.takeover/members.mdb");
  ResumedTakeOver resumed = Resume();
  EXPECT_TRUE(resumed.GoOn);
  EXPECT_EQ(resumed.ToTell,
            "The old installation was not taken over, and all data is as it was before (File not found)");
  EXPECT_EQ(Data(), "old members, old missions");
  EXPECT_FALSE(HasTakeOverMark(disk, "/data"));
  EXPECT_EQ(Resume().ToTell, "") << "once is enough";

  disk = changed;
  disk.Put("/data/.takeover/scenarios.mdb", "new missionS");
  EXPECT_EQ(Resume().ToTell,
            "The old installation was not taken over, and all data is as it was before (Invalid file format: "
            "/data/.takeover/scenarios.mdb)");
  EXPECT_EQ(Data(), "old members, old missions");
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(Resumed, OneThatIsPartlyDoneAndCannotBeFinishedIsAskedAbout) {
  disk.Put("/data/members.mdb", "new members");
  disk.Remove("/data/.takeover/scenarios.mdb");
  boxes.Answers = {BoxAnswer::Cancel};
  EXPECT_FALSE(Resume().GoOn);
  ASSERT_EQ(boxes.Boxes.size(), 1U);
  EXPECT_EQ(boxes.Boxes[0].Text,
            "An old installation was being taken over, and that cannot be finished:\nFile not found\n\nOK "
            "continues with the data as it is now; what has already been replaced is kept in /data/backups. "
            "Cancel ends the program, and the next start tries again.");
  EXPECT_EQ(boxes.Boxes[0].Title, "Take Over an Old Installation");
  EXPECT_EQ(boxes.Boxes[0].Buttons, BoxButtons::OkCancel);
  EXPECT_TRUE(HasTakeOverMark(disk, "/data"));

  boxes.Answers = {BoxAnswer::Ok};
  EXPECT_TRUE(Resume().GoOn);
  EXPECT_FALSE(HasTakeOverMark(disk, "/data"));
  EXPECT_EQ(Data(), "new members, old missions");
  boxes.Boxes.clear();
  EXPECT_TRUE(Resume().GoOn);
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(Resumed, AMarkThatCannotBeReadIsAskedAbout) {
  disk.Put("/data/.takeover-ready", "Files to ta");
  EXPECT_TRUE(Resume().GoOn);
  EXPECT_EQ(boxes.Boxes.size(), 1U);
  EXPECT_EQ(Data(), "old members, old missions");
  EXPECT_FALSE(HasTakeOverMark(disk, "/data"));
}

TEST_F(Resumed, AFullDiskNeitherLocksTheProgramOutNorComesBackLater) {
  for (const char* file : {"/data/members.mdb", "/data/.takeover-ready"}) {
    disk.FailReplace(file, RuntimeError(Fault::DiskFull));
  }
  boxes.Answers = {BoxAnswer::Cancel};
  EXPECT_FALSE(Resume().GoOn);
  EXPECT_TRUE(HasTakeOverMark(disk, "/data")) << "the next start may have room";
  EXPECT_TRUE(Resume().GoOn);
  EXPECT_FALSE(HasTakeOverMark(disk, "/data"));
  EXPECT_THAT(disk.FileNames("/data/.takeover"), IsEmpty());
  EXPECT_EQ(Data(), "old members, old missions");
}

TEST_F(Resumed, AMarkThatStaysIsTold) {
  disk.Remove("/data/.takeover/members.mdb");
  disk.FailDelete("/data/.takeover-ready", RuntimeError(Fault::PathAccess));
  EXPECT_EQ(NumberThrownBy([&] { Resume(); }), Fault::PathAccess);
}

TEST_F(Resumed, WhatAKilledProgramWasWritingGoes) {
  Resume();
  EXPECT_THAT(disk.Tidied, ElementsAre("/data", "/data/backups"));
}

}  // namespace
