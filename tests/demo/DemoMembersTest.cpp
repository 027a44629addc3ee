#include "demo/DemoMembers.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <set>

namespace {

bool IsChinese(const std::string& name) {
  // The first byte of the characters from U+4000 to U+9FFF.
  return std::any_of(name.begin(), name.end(), [](char c) {
    return static_cast<unsigned char>(c) >= 0xE4 && static_cast<unsigned char>(c) <= 0xE9;
  });
}

TEST(DemoMembers, AreADozenWithDifferentNames) {
  std::set<std::string> full;
  std::set<std::string> shown;
  for (const DemoMember& member : DemoMembers()) {
    full.insert(member.FullName());
    shown.insert(member.ShownName());
  }
  EXPECT_EQ(DemoMembers().size(), 12U);
  EXPECT_EQ(full.size(), 12U);
  EXPECT_EQ(shown.size(), 12U);
}

TEST(DemoMembers, ShowTheNicknameOrElseTheNames) {
  DemoMember member;
  member.Details.FirstName = "Ada";
  member.Details.LastName = "Byron";
  EXPECT_EQ(member.ShownName(), "Ada Byron");
  member.Details.NickName = "Count";
  EXPECT_EQ(member.ShownName(), "Count");
  EXPECT_EQ(member.FullName(), "Ada Byron");
}

TEST(DemoMembers, HaveChineseNamesAmongThem) {
  const auto chinese = std::count_if(DemoMembers().begin(), DemoMembers().end(),
                                     [](const DemoMember& member) { return IsChinese(member.FullName()); });
  EXPECT_EQ(chinese, 3);
}

TEST(DemoMembers, AreFoundByTheirFirstNamesAlone) {
  for (const DemoMember& wanted : DemoMembers()) {
    const std::string& search = wanted.Details.FirstName;
    EXPECT_FALSE(search.empty());
    EXPECT_EQ(search.find('\''), std::string::npos) << "the search takes no apostrophe";
    for (const DemoMember& other : DemoMembers()) {
      const MemberDetails& details = other.Details;
      const bool found = details.FirstName.starts_with(search) || details.LastName.starts_with(search) ||
                         details.NickName.starts_with(search);
      EXPECT_EQ(found, &other == &wanted) << search << " finds " << other.FullName();
    }
  }
}

TEST(DemoMembers, HavePlayedBefore) {
  for (const DemoMember& member : DemoMembers()) {
    EXPECT_GT(member.Games, 0) << member.FullName();
    EXPECT_GT(member.DaysSincePlayed, 0) << member.FullName();
    EXPECT_GT(member.Accuracy, 0) << member.FullName();
    EXPECT_LT(member.Accuracy, 1) << member.FullName();
  }
}

}  // namespace
