#include "members/MemberRow.h"

#include <gtest/gtest.h>

#include <string>

#include "core/game/MemberNumbers.h"

namespace {

using namespace MemberPlace;

constexpr std::size_t Games = 14;
constexpr std::size_t Damage = 15;

class MemberRowRead : public testing::Test {
 protected:
  /// Reads the only row of `csv`, whose cells go to `columns`.
  RowFault Read(std::string_view csv, const std::vector<std::size_t>& columns) {
    use.Columns.assign(columns.begin(), columns.end());
    CsvReader reader(csv, CsvSeparator::Comma);
    EXPECT_TRUE(reader.Next());
    trouble = ReadMemberRow(reader.Row(), use, values);
    return trouble.Fault;
  }

  ColumnUse use;
  MemberValues values;
  RowTrouble trouble;
};

TEST_F(MemberRowRead, TakesEachCellToItsColumn) {
  use.History = true;
  EXPECT_EQ(Read("Morgan,Rhys,3.5.2001,12,7.25", {LastName, FirstName, Birthdate, Games, Damage}),
            RowFault::None);
  EXPECT_EQ(values[FirstName], Value(std::string("Rhys")));
  EXPECT_EQ(values[LastName], Value(std::string("Morgan")));
  EXPECT_EQ(values[Birthdate], Value(std::string("2001-05-03 00:00:00")));
  EXPECT_EQ(values[Games], Value(std::int64_t{12}));
  EXPECT_EQ(values[Damage], Value(7.25));
  EXPECT_FALSE(values[NickName]);
  EXPECT_EQ(NameOf(values), "Rhys Morgan");
}

TEST_F(MemberRowRead, TellsNoValueFromAnEmptyText) {
  EXPECT_EQ(Read("Rhys,,\"\",\"\"", {FirstName, LastName, NickName, Birthdate}), RowFault::None);
  EXPECT_EQ(values[LastName], Value());
  EXPECT_EQ(values[NickName], Value(std::string()));
  EXPECT_EQ(values[Birthdate], Value(std::string()));
}

TEST_F(MemberRowRead, TakesMissingCellsForNoValue) {
  EXPECT_EQ(Read("Rhys", {FirstName, LastName}), RowFault::None);
  EXPECT_EQ(values[LastName], Value());
}

TEST_F(MemberRowRead, TakesTheHistoryOnlyWhereAsked) {
  EXPECT_EQ(Read("Rhys,nonsense", {FirstName, Games}), RowFault::None);
  EXPECT_FALSE(values[Games]);
  EXPECT_FALSE(use.Gives(Games));
  use.History = true;
  EXPECT_TRUE(use.Gives(Games));
  EXPECT_EQ(Read("Rhys,nonsense", {FirstName, Games}), RowFault::NoNumber);
  EXPECT_EQ(trouble.Column, Games);
}

TEST_F(MemberRowRead, RefusesMoreCellsThanHeadingsUnlessTheyAreEmpty) {
  EXPECT_EQ(Read("Rhys,Morgan,x", {FirstName, LastName}), RowFault::TooManyCells);
  EXPECT_EQ(Read("Rhys,Morgan,,", {FirstName, LastName}), RowFault::None);
}

TEST_F(MemberRowRead, RefusesADateThatIsNone) {
  EXPECT_EQ(Read("Rhys,31.4.2001", {FirstName, Birthdate}), RowFault::NoDate);
  EXPECT_EQ(trouble.Column, Birthdate);
  use.Dates = DateOrder::MonthFirst;
  EXPECT_EQ(Read("Rhys,23.5.2001", {FirstName, Birthdate}), RowFault::NoDate);
}

TEST_F(MemberRowRead, RefusesFiguresThatAreNone) {
  use.History = true;
  for (const char* cell : {"x", "1x", "-1", "1.5", "nan", "inf", "99999999999", "\"1,5\"", "\"\""}) {
    EXPECT_EQ(Read("Rhys," + std::string(cell), {FirstName, Games}), RowFault::NoNumber) << cell;
  }
  for (const char* cell : {"0", " 12 ", "12.0", "1e3"}) {
    EXPECT_EQ(Read("Rhys," + std::string(cell), {FirstName, Games}), RowFault::None) << cell;
  }
  EXPECT_EQ(Read("Rhys,-7.5", {FirstName, Damage}), RowFault::None);
  EXPECT_EQ(values[Damage], Value(-7.5));
}

TEST_F(MemberRowRead, TakesButtonsInAnyForm) {
  for (const char* cell : {"AB00000000000001", "ab00000000000001", "AB-00-00-00-00-00-00-01"}) {
    EXPECT_EQ(Read(cell, {DallasId}), RowFault::None) << cell;
    EXPECT_EQ(values[DallasId], Value(std::string("AB00000000000001"))) << cell;
  }
  for (const char* cell : {"AB", "AB000000000000012", "GB00000000000001", "AB00000000000001x"}) {
    EXPECT_EQ(Read(cell, {DallasId}), RowFault::NoButton) << cell;
  }
}

TEST_F(MemberRowRead, RefusesNobody) {
  EXPECT_EQ(Read("\"\",,Cardiff", {FirstName, LastName, 8}), RowFault::Nobody);
  EXPECT_EQ(Read("Mole", {NickName}), RowFault::None);
  EXPECT_EQ(NameOf(values), "Mole");
  EXPECT_EQ(Read("7,", {ContactId, FirstName}), RowFault::None);
  EXPECT_EQ(Read("0,Rhys", {ContactId, FirstName}), RowFault::NoNumber);
  const auto highest = std::to_string(HighestMemberNumber);
  EXPECT_EQ(Read(highest + ",Rhys", {ContactId, FirstName}), RowFault::None);
  const auto impossible = std::to_string(HighestMemberNumber + 1);  // nobody could be entered any more
  EXPECT_EQ(Read(impossible + ",Rhys", {ContactId, FirstName}), RowFault::NoNumber);
}

}  // namespace
