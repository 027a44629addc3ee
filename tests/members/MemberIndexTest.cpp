#include "members/MemberIndex.h"

#include <gtest/gtest.h>

namespace {

using Answer = MemberIndex::Answer;

MemberValues Person(const std::string& button, const std::string& first, const std::string& last,
                    const std::string& birthdate) {
  MemberValues values;
  values[MemberPlace::DallasId] = button.empty() ? Value() : Value(button);
  values[MemberPlace::FirstName] = first;
  values[MemberPlace::LastName] = last;
  values[MemberPlace::Birthdate] = birthdate.empty() ? Value() : Value(birthdate + " 00:00:00");
  return values;
}

class SameMembers : public testing::Test {
 protected:
  SameMembers() {
    index.Add(Person("AB00000000000001", "Rhys", "Morgan", "1961-04-12"), 0);
    index.Add(Person("", "Alice", "Belmont", ""), 1);
    index.Add(Person("CD00000000000001", "Sean", "O'Brien", "1970-01-01"), 2);
  }

  void ExpectFound(const MemberValues& member, Answer answer, MemberIndex::Reference who = 0) {
    const MemberIndex::Match match = index.Find(member);
    EXPECT_EQ(static_cast<int>(match.Found), static_cast<int>(answer));
    if (answer == Answer::One) {
      EXPECT_EQ(match.Who, who);
    }
  }

  MemberIndex index;
};

TEST_F(SameMembers, HaveTheSameButtonWhateverTheirNames) {
  ExpectFound(Person("CD00000000000001", "Rhys", "Morgan", "1961-04-12"), Answer::One, 2);
}

TEST_F(SameMembers, ElseHaveTheSameNamesAndBirthDate) {
  ExpectFound(Person("", "rhys", " MORGAN ", "1961-04-12"), Answer::One, 0);
  ExpectFound(Person("EF00000000000001", "Rhys", "Morgan", "1961-04-12"), Answer::One, 0);
  ExpectFound(Person("", "Alice", "Belmont", ""), Answer::One, 1);
}

TEST_F(SameMembers, AreNotThoseOfAnotherNameOrBirthDate) {
  ExpectFound(Person("", "Rhys", "Morgan", "1961-04-13"), Answer::None);
  ExpectFound(Person("", "Rhys", "Belmont", "1961-04-12"), Answer::None);
  ExpectFound(Person("", "Morgan", "Rhys", "1961-04-12"), Answer::None);
  ExpectFound(Person("", "", "", ""), Answer::None);
}

TEST_F(SameMembers, AreInDoubtWhereOneBirthDateIsMissing) {
  ExpectFound(Person("", "Rhys", "Morgan", ""), Answer::BirthdateMissing);
  ExpectFound(Person("", "Alice", "Belmont", "1990-01-01"), Answer::BirthdateMissing);
}

TEST_F(SameMembers, MayBeSeveral) {
  index.Add(Person("AB00000000000001", "Other", "One", ""), 3);
  index.Add(Person("", "Sean", "O'Brien", "1970-01-01"), 4);
  ExpectFound(Person("AB00000000000001", "Rhys", "Morgan", ""), Answer::Several);
  ExpectFound(Person("", "Sean", "O'Brien", "1970-01-01"), Answer::Several);
}

TEST_F(SameMembers, AreNotThoseWithoutAButton) {
  index.Add(Person("0000000000000000", "Un", "Assigned", "1980-01-01"), 3);
  ExpectFound(Person("0000000000000000", "Some", "Body", "1981-01-01"), Answer::None);
}

TEST_F(SameMembers, AreForgottenPieceByPiece) {
  EXPECT_TRUE(index.ForgetSome(2));
  ExpectFound(Person("CD00000000000001", "", "", ""), Answer::None);
  ExpectFound(Person("", "Rhys", "Morgan", "1961-04-12"), Answer::One, 0);
  EXPECT_TRUE(index.ForgetSome(2));
  EXPECT_FALSE(index.ForgetSome(2));
  ExpectFound(Person("", "Rhys", "Morgan", "1961-04-12"), Answer::None);
  EXPECT_FALSE(index.ForgetSome(1));
}

}  // namespace
