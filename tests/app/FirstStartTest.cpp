#include "app/FirstStart.h"

#include <gtest/gtest.h>

#include <filesystem>

#include "tests/support/TemporaryFolder.h"

namespace {

class PlaceOfAProgram : public testing::Test {
 protected:
  std::string NameFor(const std::string& dataFolder) const {
    return InstancePlaceOf(folder.Path(), dataFolder).Name;
  }

  TemporaryFolder folder;
};

TEST_F(PlaceOfAProgram, IsTheSameByEachPathOfADataFolder) {
  std::filesystem::create_directories(folder / "data/Orvalin/Tessarine");
  std::filesystem::create_directory_symlink(folder / "data", folder / "link");
  const std::string name = NameFor(folder / "data/Orvalin/Tessarine");
  EXPECT_EQ(NameFor(folder / "link/Orvalin/Tessarine"), name);
  EXPECT_EQ(NameFor(folder / "data/../data/Orvalin/Tessarine"), name);
}

TEST_F(PlaceOfAProgram, IsTheSameBeforeTheFolderIsMade) {
  std::filesystem::create_directory_symlink(folder / "data", folder / "link");
  std::filesystem::create_directory(folder / "data");
  const std::string name = NameFor(folder / "link/Orvalin/Tessarine");
  std::filesystem::create_directories(folder / "data/Orvalin/Tessarine");
  EXPECT_EQ(NameFor(folder / "data/Orvalin/Tessarine"), name);
}

TEST_F(PlaceOfAProgram, DiffersForAnotherDataFolder) {
  EXPECT_NE(NameFor(folder / "a/Orvalin/Tessarine"), NameFor(folder / "b/Orvalin/Tessarine"));
}

TEST_F(PlaceOfAProgram, DoesNotTellThePath) {
  EXPECT_EQ(NameFor(folder / "anna").find("anna"), std::string::npos);
  EXPECT_EQ(InstancePlaceOf(folder.Path(), folder / "anna").Folders,
            (std::vector<std::string>{folder.Path(), folder / "anna"}));
}

}  // namespace
