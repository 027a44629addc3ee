#include "app/SystemFacts.h"

#include <gmock/gmock.h>

#include <QtGlobal>

#include "app/Version.h"

namespace {

using testing::Contains;
using testing::HasSubstr;
using testing::MatchesRegex;
using testing::StartsWith;

TEST(SystemFacts, TellVersionsAndScreens) {
  const std::vector<std::string> facts = SystemFacts();
  EXPECT_EQ(facts.front(), std::string("Tessarine ") + VersionText);
  EXPECT_THAT(facts, Contains(HasSubstr(std::string("Qt ") + qVersion())));
  EXPECT_THAT(facts, Contains(HasSubstr("linux ")));
  EXPECT_THAT(facts, Contains(StartsWith("Locale ")));
  EXPECT_THAT(facts, Contains(MatchesRegex("Screen [0-9]+ x [0-9]+, scale [0-9.]+")));
  EXPECT_THAT(facts, Contains("Screen 1920 x 1080, scale 2"));
  EXPECT_THAT(facts, Contains("Screen 1024 x 768, scale 1.5"));
}

}  // namespace
