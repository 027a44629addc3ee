#include "audience/AudienceSetup.h"

#include <gtest/gtest.h>

#include "tests/fakes/FakeFiles.h"

namespace {

class AudienceSettingsFile : public testing::Test {
 protected:
  AudienceSetup ReadFrom(const std::string& text) {
    files.Put("/tessarine.ini", text);
    return ReadAudienceSetup(ini);
  }

  FakeFiles files;
  IniReader ini{files, "/tessarine.ini"};
};

TEST_F(AudienceSettingsFile, GivesDefaultsWithoutASection) {
  EXPECT_EQ(ReadFrom("[comm]\ncommport=4\n"), AudienceSetup());
}

TEST_F(AudienceSettingsFile, HoldsWhatWasSet) {
  const AudienceSetup set{"HDMI-1", 7.5, 55, 12, "靶场 North", "/home/a b.png", false};
  ini.WriteIni(Keys::CommPort, "4");
  WriteAudienceSetup(ini, AudienceSetup(), set);
  EXPECT_EQ(ReadAudienceSetup(ini), set);
}

TEST_F(AudienceSettingsFile, IsWrittenOnlyWhereSomethingHasChanged) {
  AudienceSetup setup;
  WriteAudienceSetup(ini, setup, setup);
  EXPECT_FALSE(files.FileExists("/tessarine.ini"));
  const AudienceSetup before = setup;
  setup.Seconds = 20;
  WriteAudienceSetup(ini, before, setup);
  EXPECT_EQ(ini.ReadSection("audience"), (IniReader::Values{{"seconds", "20"}}));
}

TEST_F(AudienceSettingsFile, CountsTheNearestNumberInRange) {
  const AudienceSetup least = ReadFrom("[audience]\ndistance=0\ndiagonal=3\nseconds=-5\n");
  EXPECT_EQ(least.Metres, 1);
  EXPECT_EQ(least.Inches, 10);
  EXPECT_EQ(least.Seconds, 3);
  const AudienceSetup most = ReadFrom("[audience]\ndistance=1e30\ndiagonal=99999\nseconds=1e300\n");
  EXPECT_EQ(most.Metres, 50);
  EXPECT_EQ(most.Inches, 300);
  EXPECT_EQ(most.Seconds, 60);
}

TEST_F(AudienceSettingsFile, CountsTheDefaultForWhatIsNoNumber) {
  const AudienceSetup setup = ReadFrom("[audience]\ndistance=far\ndiagonal=\nseconds=1e999\nfollow=x\n");
  EXPECT_EQ(setup.Metres, 5);
  EXPECT_EQ(setup.Inches, 0);
  EXPECT_EQ(setup.Seconds, 8);
  EXPECT_TRUE(setup.Follows);
}

}  // namespace
