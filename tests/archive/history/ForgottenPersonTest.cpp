#include "archive/history/ForgottenPerson.h"

#include <gtest/gtest.h>

#include <filesystem>

#include "archive/MemberCheck.h"
#include "tests/archive/history/HistoryVenue.h"

namespace {

/// Bo, who had number 5, and Di, who has it now. There is a copy of the archive of Bo's time.
class PersonToForget : public testing::Test, protected HistoryVenue {
 protected:
  PersonToForget() {
    Keep("2026-10-01 20:00:00", 100);
    std::filesystem::copy_file(ArchivePath(), CopyPath());
  }

  std::string CopyPath() const { return Folder / "games-2026-10-05-200000.mdb"; }

  void GiveNumberToDi() const {
    InMembers("UPDATE Members SET DallasID = 'DD00000000000001', FirstName = 'Di' WHERE ContactID = 5");
  }

  void Check() {
    const MemberCheck::Parts parts{*ArchiveDatabase, *MembersDatabase, Strings};
    MemberCheck check(parts);
    while (check.Step(parts)) {
    }
  }

  /// The numbers of number 5 of today in the archive and in the copy.
  std::string Numbers() {
    SqliteEngine engine;
    ForgottenPerson person(5, *MembersDatabase);
    for (const std::string& path : {ArchivePath(), CopyPath()}) {
      person.Read(path, engine.OpenDatabase(path));
    }
    person.Finish();
    std::string text;
    for (const std::string& path : {ArchivePath(), CopyPath()}) {
      for (const std::int32_t number : person.In(path).Numbers) {
        text.append(std::to_string(number)).append(" ");
      }
      text += "| ";
    }
    return text;
  }
};

TEST_F(PersonToForget, IsNotWhoHadTheNumberInAnOldCopy) {
  EXPECT_EQ(Numbers(), "5 | 5 | ");
  GiveNumberToDi();
  Check();
  EXPECT_EQ(Numbers(), "5 | | ");
  Keep("2026-10-06 20:00:00", 100);  // Di
  EXPECT_EQ(Numbers(), "5 | | ");
}

TEST_F(PersonToForget, HasTheNumberWhereNobodyWasKnownByIt) {
  OtherConnection(CopyPath())
      .Execute("UPDATE KnownMembers SET DallasID = '', Digest = '' WHERE MemberID = 5");
  GiveNumberToDi();
  Check();
  EXPECT_EQ(Numbers(), "5 | 5 | ");
}

TEST_F(PersonToForget, HasTheNumberInTheLaterGamesOfACopyThatWasMadeDuringACheck) {
  GiveNumberToDi();
  { const MemberCheck check({*ArchiveDatabase, *MembersDatabase, Strings}); }
  std::filesystem::copy_file(ArchivePath(), CopyPath(), std::filesystem::copy_options::overwrite_existing);
  Check();
  EXPECT_EQ(Numbers(), "5 | 5 | ");
}

TEST_F(PersonToForget, IsKnownInAnOldCopyByASharedGameWhenNameAndButtonChangedSince) {
  InMembers("UPDATE Members SET FirstName = 'Bob' WHERE ContactID = 5");
  Archive->Known().NoteChanges();
  InMembers("UPDATE Members SET DallasID = 'DD00000000000001' WHERE ContactID = 5");
  Archive->Known().NoteChanges();
  EXPECT_EQ(Numbers(), "5 | 5 | ");
}

}  // namespace
