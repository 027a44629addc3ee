#include "takeover/OldInstallation.h"

#include <gmock/gmock.h>

#include "tests/fakes/FakeFiles.h"
#include "tests/support/Thrown.h"

namespace {

class OldInstallations : public testing::Test {
 protected:
  std::string FolderFound(const std::string& chosen) const {
    const auto old = FindOldInstallation(disk, chosen);
    return old ? old->Folder : "none";
  }

  FakeFiles disk;
};

TEST_F(OldInstallations, AreFoundInAnyCaseOfLetters) {
  disk.Put("/stick/MEMBERS.MDB", "m");
  disk.Put("/stick/Scenarios.mdb", "s");
  disk.Put("/stick/Score_Card.DOC", "d");
  disk.Put("/stick/TESSARINE.INI", "i");
  const auto old = FindOldInstallation(disk, "/stick");
  ASSERT_TRUE(old);
  EXPECT_EQ(old->Members, "/stick/MEMBERS.MDB");
  EXPECT_EQ(old->Missions, "/stick/Scenarios.mdb");
  EXPECT_EQ(old->Template, "/stick/Score_Card.DOC");
  EXPECT_EQ(old->Settings, "/stick/TESSARINE.INI");
  EXPECT_EQ(old->GamesFolder, "/stick");
}

TEST_F(OldInstallations, PreferTheExactNameOfTwo) {
  disk.Put("/stick/Members.mdb", "m");
  disk.Put("/stick/members.mdb", "m");
  disk.Put("/stick/memberS.mdb", "m");
  EXPECT_EQ(FindOldInstallation(disk, "/stick")->Members, "/stick/members.mdb");
}

TEST_F(OldInstallations, HaveEmptyPathsForWhatIsMissing) {
  disk.Put("/stick/members.mdb", "m");
  const auto old = FindOldInstallation(disk, "/stick");
  EXPECT_EQ(old->Missions + old->Template + old->Settings, "");
}

TEST_F(OldInstallations, AreFoundWhereCopiesAndDisksHaveThem) {
  for (const char* place :
       {"/a/tessarine", "/a/ORVALIN/Tessarine", "/a/Local/Orvalin/Tessarine",
        "/a/AppData/Local/Orvalin/Tessarine", "/a/.local/share/Orvalin/Tessarine",
        "/a/Ann/AppData/Local/Orvalin/Tessarine", "/a/users/Ann/appdata/local/orvalin/tessarine",
        "/a/Documents and Settings/Ann/Local Settings/Application Data/Orvalin/Tessarine",
        "/a/home/ann/.local/share/Orvalin/Tessarine"}) {
    disk = FakeFiles();
    disk.Put(std::string(place) + "/members.mdb", "m");
    EXPECT_EQ(FolderFound("/a"), place);
  }
}

TEST_F(OldInstallations, OfTheChosenFolderComeFirst) {
  disk.Put("/a/Orvalin/Tessarine/members.mdb", "m");
  disk.Put("/a/scenarios.mdb", "s");
  EXPECT_EQ(FolderFound("/a"), "/a");
}

TEST_F(OldInstallations, OfSeveralPersonsAreTheOneUsedLast) {
  class Dated : public FakeFiles {
   public:
    std::string TimeOfChange(const std::string& path) const override {
      return path.find("/Bob/") != std::string::npos ? "2014-01-01 00:00:00" : "2013-01-01 00:00:00";
    }
  } dated;
  for (const char* person : {"Ann", "Bob", "Cid"}) {
    dated.Put("/c/Users/" + std::string(person) + "/AppData/Local/Orvalin/Tessarine/members.mdb", "m");
  }
  const auto old = FindOldInstallation(dated, "/c");
  ASSERT_TRUE(old);
  EXPECT_EQ(old->Folder, "/c/Users/Bob/AppData/Local/Orvalin/Tessarine");
}

TEST_F(OldInstallations, OfAWholeDiskHaveTheirGamesInTheDataFolderAlone) {
  disk.Put("/c/Users/Ann/AppData/Local/Orvalin/Tessarine/members.mdb", "m");
  EXPECT_EQ(FindOldInstallation(disk, "/c")->GamesFolder, "/c/Users/Ann/AppData/Local/Orvalin/Tessarine");
  disk.Put("/stick/Tessarine/members.mdb", "m");
  EXPECT_EQ(FindOldInstallation(disk, "/stick")->GamesFolder, "/stick");
}

TEST_F(OldInstallations, AreNotInAFolderWithoutTheirFiles) {
  disk.Put("/photos/game.xml", "<GameData/>");
  EXPECT_EQ(FolderFound("/photos"), "none");
}

TEST_F(OldInstallations, TellOfAFolderThatCannotBeRead) {
  disk.AddFolder("/locked");
  disk.FailRead("/locked", RuntimeError(Fault::PermissionDenied, "Permission denied: /locked"));
  EXPECT_EQ(ThrownBy([&] { FindOldInstallation(disk, "/locked"); }).Text, "Permission denied: /locked");
}

TEST_F(OldInstallations, PassByFoldersOfOthersThatCannotBeRead) {
  disk.Put("/c/Users/Ann/AppData/Local/Orvalin/Tessarine/members.mdb", "m");
  disk.AddFolder("/c/Users/Bob");
  disk.FailRead("/c/Users/Bob", RuntimeError(Fault::PermissionDenied));
  EXPECT_EQ(FolderFound("/c"), "/c/Users/Ann/AppData/Local/Orvalin/Tessarine");
}

TEST_F(OldInstallations, CountGameFilesAlsoBelow) {
  disk.Put("/stick/a.xml", "\xEF\xBB\xBF<GameData>");
  disk.Put("/stick/2012/May/b.XML", "<?xml version=\"1.0\"?><GameData>");
  disk.Put("/stick/sounds.xml", "<SoundList>");
  disk.Put("/stick/c.txt", "<GameData>");
  disk.Put("/stick/d.xml", "<GameData>");
  disk.FailRead("/stick/d.xml", RuntimeError(Fault::PathAccess));
  const auto games = CountGameFiles(disk, "/stick", [] { return true; });
  ASSERT_TRUE(games);
  EXPECT_EQ(games->Count, 3U) << "one that cannot be read is told by the import";
  EXPECT_EQ(games->First, disk.ChangeTime);
  EXPECT_EQ(games->Last, disk.ChangeTime);
}

TEST_F(OldInstallations, StopCountingWhenToldTo) {
  disk.Put("/stick/a.xml", "<GameData>");
  EXPECT_FALSE(CountGameFiles(disk, "/stick", [] { return false; }));
}

}  // namespace
