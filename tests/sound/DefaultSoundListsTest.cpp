#include <gtest/gtest.h>

#include <set>

#include "sound/SoundDefinition.h"
#include "tests/support/TemporaryFolder.h"

namespace {

/// The lists that the program comes with.
class SoundListOf : public testing::TestWithParam<const char*> {};

INSTANTIATE_TEST_SUITE_P(EachProduct, SoundListOf,
                         testing::Values("sound_list_mainboard.xml", "sound_list_maltrone.xml"));

TEST_P(SoundListOf, NamesEachEventOnce) {
  const auto events = ReadSoundDefinition(ReadFile(std::string(TESSARINE_PROGRAM_FOLDER "/") + GetParam()));
  ASSERT_TRUE(events.has_value());
  EXPECT_GE(events->size(), 20U);
  EXPECT_LE(events->size(), 60U);
  const std::set<std::string> names(events->begin(), events->end());
  EXPECT_EQ(names.size(), events->size());
  EXPECT_FALSE(names.contains(""));
  EXPECT_FALSE(names.contains("0"));
}

}  // namespace
