#include "members/MemberColumns.h"

#include <gtest/gtest.h>

#include "tests/members/MemberFile.h"

namespace {

std::string ColumnNamed(std::string_view heading) {
  const std::optional<std::size_t> column = ColumnOfHeading(heading);
  return column ? MemberColumns[*column].Name : "none";
}

TEST(MemberColumns, AreThoseOfTheTableWithoutThePhoto) {
  const MemberFile file;
  std::string names;
  for (const MemberColumn& column : MemberColumns) {
    names += std::string(column.Name) + ",";
  }
  EXPECT_EQ(
      file.Query("SELECT group_concat(name, ',') || ',' FROM pragma_table_info('Members') WHERE name NOT "
                 "LIKE 'Photo%'"),
      names);
}

TEST(MemberColumns, HaveATitleEachInBothLanguages) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    const std::vector<std::string> titles = MemberColumnTitles(StringTable(language));
    ASSERT_EQ(titles.size(), MemberColumns.size());
    for (std::size_t column = 0; column < titles.size(); ++column) {
      EXPECT_EQ(ColumnOfHeading(titles[column]), column) << titles[column];
    }
  }
}

TEST(MemberColumns, AreKnownByTheirNames) {
  for (const MemberColumn& column : MemberColumns) {
    EXPECT_EQ(ColumnNamed(column.Name), column.Name);
  }
}

TEST(MemberColumns, AreKnownByOtherUsualHeadings) {
  EXPECT_EQ(ColumnNamed("first_name"), "FirstName");
  EXPECT_EQ(ColumnNamed(" SURNAME "), "LastName");
  EXPECT_EQ(ColumnNamed("Last-Name"), "LastName");
  EXPECT_EQ(ColumnNamed("E-Mail"), "EmailName");
  EXPECT_EQ(ColumnNamed("Date of Birth:"), "Birthdate");
  EXPECT_EQ(ColumnNamed("DOB"), "Birthdate");
  EXPECT_EQ(ColumnNamed("ZIP"), "PostalCode");
  EXPECT_EQ(ColumnNamed("手机"), "PhoneNumber");
}

TEST(MemberColumns, AreNotGuessedFromOtherHeadings) {
  for (const char* heading : {"", " ", "Name", "Photograph", "Notes", "xFirstName"}) {
    EXPECT_EQ(ColumnNamed(heading), "none") << heading;
  }
}

}  // namespace
