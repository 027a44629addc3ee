#include "core/game/HiddenNames.h"

#include <gmock/gmock.h>

#include "platform/RuntimeError.h"
#include "tests/fakes/FakeFiles.h"

namespace {

using testing::ElementsAre;

const NameHolder Mole{.Member = 12, .NickName = "Mole"};
const NameHolder Ann{.GuestName = "Ann"};

class HiddenFromThePublic : public testing::Test {
 protected:
  HiddenFromThePublic() { disk.AddFolder("/data"); }

  HiddenNames Again() { return HiddenNames(disk, File); }

  const std::string File = "/data/hidden-names.txt";
  FakeFiles disk;
  HiddenNames names = Again();
};

TEST_F(HiddenFromThePublic, IsNobodyAtFirst) {
  EXPECT_EQ(names.NameShown(Mole), "Mole");
  EXPECT_EQ(names.NameShown(Ann), "Ann");
  EXPECT_FALSE(disk.FileExists(File));
}

TEST_F(HiddenFromThePublic, StaysHiddenInTheNextRun) {
  EXPECT_TRUE(names.Hide(Mole));
  EXPECT_TRUE(names.Hide(Ann));
  HiddenNames again = Again();
  EXPECT_EQ(again.NameShown(Mole), "");
  EXPECT_EQ(again.NameShown(Ann), "");
  EXPECT_TRUE(again.HidesMember(12));
  EXPECT_FALSE(again.HidesMember(13));
  EXPECT_EQ(again.NameShown({.Member = 13, .NickName = "Badger"}), "Badger");
}

TEST_F(HiddenFromThePublic, IsShownAgainForGood) {
  names.Hide(Mole);
  names.Hide(Ann);
  names.ShowMember(12);
  names.ShowGuest("Ann");
  EXPECT_EQ(names.NameShown(Mole), "Mole");
  EXPECT_EQ(Again().NameShown(Ann), "Ann");
}

TEST_F(HiddenFromThePublic, MayNotBeCalledByAnotherNameInstead) {
  names.Hide(Mole);
  EXPECT_EQ(names.NameShown({.Member = 12, .NickName = "", .GuestName = "Mole as guest"}), "");
  names.Hide(Ann);
  EXPECT_EQ(names.NameShown({.Member = 13, .NickName = "Ann"}), "");
}

TEST_F(HiddenFromThePublic, IsNoGunWithoutAName) {
  EXPECT_FALSE(names.Hide({}));
  EXPECT_FALSE(disk.FileExists(File));
}

TEST_F(HiddenFromThePublic, IsToldToTheScreensAtOnce) {
  std::string seen = "not told";
  names.OnChange = [&] { seen = names.NameShown(Mole); };
  names.Hide(Mole);
  EXPECT_EQ(seen, "");
}

TEST_F(HiddenFromThePublic, AreTheReadableLinesOfADamagedFile) {
  disk.Put(File, "member 12\nmember x\nmember 99999999999\n\x01\nguest\nguest Ann\nmem");
  const HiddenNames again = Again();
  EXPECT_THAT(again.Members(), ElementsAre(12));
  EXPECT_THAT(again.Guests(), ElementsAre("Ann"));
}

TEST(HiddenNames, AreAllNamesWhileTheFileCannotBeRead) {
  FakeFiles disk;
  disk.Put("/data/hidden-names.txt", "member 12\n");
  disk.FailRead("/data/hidden-names.txt", RuntimeError(75));
  HiddenNames names(disk, "/data/hidden-names.txt");
  EXPECT_EQ(names.NameShown(Mole), "");
  EXPECT_TRUE(names.HidesMember(99));
  EXPECT_THROW(names.Hide(Ann), RuntimeError);
  EXPECT_EQ(disk.Replaced.size(), 0U);
}

TEST(HiddenNames, HideAlsoWhatCannotBeWritten) {
  FakeFiles disk;
  HiddenNames names(disk, "/missing/hidden-names.txt");
  EXPECT_THROW(names.Hide(Mole), RuntimeError);
  EXPECT_EQ(names.NameShown(Mole), "");
}

}  // namespace
