#include <gmock/gmock.h>

#include <chrono>
#include <filesystem>
#include <set>

#include "platform/jet/JetConverter.h"
#include "platform/linux/LinuxFiles.h"
#include "tests/platform/jet/OldFileCopies.h"
#include "tests/support/ConversionAnswers.h"
#include "tests/support/OldFiles.h"
#include "tests/support/TestDatabase.h"
#include "tests/support/Thrown.h"

namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;
using testing::IsEmpty;

struct OldFile {
  const char* Name;
  const char* Table;
  const char* Key;
};

constexpr OldFile OldFiles[] = {{"scenarios", "Table1", "ID"}, {"members", "Members", "ContactID"}};

/// What became of damaged files.
struct Outcomes {
  int Refused = 0;
  int Named = 0;  ///< converted without values that were named
  int Equal = 0;  ///< converted whole: what was damaged is not read
};

class DamagedFile : public testing::Test {
 protected:
  void SetUp() override { SKIP_WITHOUT_OLD_FILES(); }

  std::string PathOf(const OldFile& old) const { return folder / (std::string(old.Name) + ".mdb"); }

  OldDatabaseReport Convert(const OldFile& old, const std::string& bytes) {
    const std::string path = PathOf(old);
    WriteFile(path, bytes);
    std::filesystem::remove(path + ".jet");
    answers.Unread.clear();
    return converter.Convert({path, old.Table, EmptyDatabase(old.Name), folder / "none"}, answers);
  }

  /// The keys of the rows that differ from those of the whole file, each behind a blank.
  std::string DifferingKeys(const OldFile& old) const {
    OtherConnection connection(PathOf(old));
    connection.Execute("ATTACH '" + folder / "whole.mdb" + "' AS Whole");
    const std::string rows = "SELECT * FROM main." + std::string(old.Table);
    const std::string whole = "SELECT * FROM Whole." + std::string(old.Table);
    const std::string key = old.Key;
    return connection.Query("SELECT coalesce(group_concat(DISTINCT ' ' || " + key + "), '') FROM (SELECT " +
                            key + " FROM (" + rows + " EXCEPT " + whole + ") UNION ALL SELECT " + key +
                            " FROM (" + whole + " EXCEPT " + rows + "))");
  }

  std::string NamedKeys(const OldFile& old) const {
    std::string keys;
    for (const NotTakenOver& value : answers.Unread) {
      const std::string mark = "(" + std::string(old.Key) + " ";
      const std::size_t at = value.InRow.find(mark) + mark.size();
      keys += (keys.empty() ? " " : ", ") + value.InRow.substr(at, value.InRow.find(')') - at);
    }
    return keys;
  }

  void Try(const OldFile& old, const std::string& bytes, Outcomes& outcomes) {
    try {
      Convert(old, bytes);
    } catch (const OldDatabaseRefused&) {
      ++outcomes.Refused;
      EXPECT_TRUE(ReadFile(PathOf(old)) == bytes);
      return;
    }
    std::string differing = DifferingKeys(old);
    for (std::size_t at = 0; (at = differing.find(", ", at)) != std::string::npos;) {
      differing.erase(at, 1);
    }
    std::string named = NamedKeys(old);
    for (std::size_t at = 0; (at = named.find(", ", at)) != std::string::npos;) {
      named.erase(at, 1);
    }
    EXPECT_EQ(differing, named);
    ++(named.empty() ? outcomes.Equal : outcomes.Named);
  }

  void KeepWholeFile(const OldFile& old) {
    Convert(old, OldFileBytes(old.Name));
    std::filesystem::rename(PathOf(old), folder / "whole.mdb");
  }

  TemporaryFolder folder;
  LinuxFiles disk;
  JetConverter converter{disk, JetReaderPath(), 1s};
  ConversionAnswers answers;
};

TEST_F(DamagedFile, LosesNothingSilentlyWithAnyPageZeroed) {
  Outcomes outcomes;
  for (const OldFile& old : OldFiles) {
    KeepWholeFile(old);
    const std::string whole = OldFileBytes(old.Name);
    for (std::size_t at = JetPageSize; at < whole.size(); at += JetPageSize) {
      SCOPED_TRACE(std::string(old.Name) + " page " + std::to_string(at / JetPageSize));
      std::string damaged = whole;
      damaged.replace(at, JetPageSize, JetPageSize, '\0');
      Try(old, damaged, outcomes);
    }
  }
  std::printf("zeroed pages: %d refused, %d named, %d equal\n", outcomes.Refused, outcomes.Named,
              outcomes.Equal);
  EXPECT_GE(outcomes.Refused, 10);
  EXPECT_GE(outcomes.Named, 30);  // each page of a photograph
  EXPECT_GE(outcomes.Equal, 10);  // indexes, properties, what was deleted
}

TEST_F(DamagedFile, LosesNothingSilentlyWhenItIsCutAtAnyPage) {
  Outcomes outcomes;
  for (const OldFile& old : OldFiles) {
    KeepWholeFile(old);
    const std::string whole = OldFileBytes(old.Name);
    for (std::size_t size = JetPageSize; size < whole.size(); size += JetPageSize) {
      SCOPED_TRACE(std::string(old.Name) + " pages " + std::to_string(size / JetPageSize));
      Try(old, whole.substr(0, size), outcomes);
    }
  }
  std::printf("cut files: %d refused, %d named, %d equal\n", outcomes.Refused, outcomes.Named,
              outcomes.Equal);
  EXPECT_GE(outcomes.Refused, 60);
  EXPECT_GE(outcomes.Named, 5);
}

// The length of the first photograph, 37,000, in its row.
constexpr const char* PhotoLength = "\x88\x90";

class CutPhoto : public DamagedFile, public testing::WithParamInterface<const char*> {
 protected:
  std::string Bytes() const {
    std::string bytes = OldFileBytes("members");
    Exchange(bytes, PhotoLength + std::string(2, '\0'), GetParam() + std::string(2, '\0'));
    return bytes;
  }
};

TEST_P(CutPhoto, IsLeftOutAndNamed) {
  const OldDatabaseReport report = Convert(OldFiles[1], Bytes());
  const NotTakenOver photo{
      .What = NotTakenOver::OneValue, .Name = "Photograph", .InTable = "Members", .InRow = "1 (ContactID 1)"};
  EXPECT_THAT(answers.Unread, ElementsAre(photo));
  EXPECT_THAT(report.NotTaken, ElementsAre(photo));
  EXPECT_EQ(report.Rows, 40);
  OtherConnection connection(PathOf(OldFiles[1]));
  EXPECT_EQ(connection.Query("SELECT quote(Photograph) || PhotographLength || FirstName FROM Members "
                             "WHERE ContactID = 1"),
            "NULL0Sean");
  EXPECT_EQ(connection.Query("SELECT count(Photograph) FROM Members"), "5");
}

TEST_P(CutPhoto, LeavesTheFileAsItIsIfTheOperatorWantsThat) {
  answers.Answer = false;
  try {
    Convert(OldFiles[1], Bytes());
    ADD_FAILURE() << "it was converted";
  } catch (const OldDatabaseRefused& error) {
    EXPECT_EQ(error.Parts(), answers.Unread);
    EXPECT_EQ(error.Parts().size(), 1U);
  }
  EXPECT_TRUE(ReadFile(PathOf(OldFiles[1])) == Bytes());
  EXPECT_FALSE(std::filesystem::exists(PathOf(OldFiles[1]) + ".jet"));
}

INSTANTIATE_TEST_SUITE_P(Lengths, CutPhoto, testing::Values("\x87\x90", "\x89\x90", "\x88\x91"));

class OldText : public DamagedFile {
 protected:
  /// The first member's name in hexadecimal UTF-8 after its six bytes in the file were exchanged.
  std::string NameOf(const std::string& bytes) {
    std::string file = OldFileBytes("members");
    Exchange(file, "\xFF\xFESean", bytes);
    Convert(OldFiles[1], file);
    return OtherConnection(PathOf(OldFiles[1]))
        .Query("SELECT hex(FirstName) FROM Members WHERE ContactID = 1");
  }
};

TEST_F(OldText, IsTakenOverToItsEnd) {
  EXPECT_EQ(NameOf(std::string("A\0\0\0B\0", 6)), "410042");
  EXPECT_EQ(NameOf(std::string("\x3D\xD8\x00\xDE"
                               "A\0",
                               6)),
            "F09F988041");
  EXPECT_THAT(answers.Unread, IsEmpty());
}

TEST_F(OldText, IsNamedWhereItHasHalfACharacter) {
  EXPECT_EQ(NameOf(std::string("\x3D\xD8"
                               "A\0B\0",
                               6)),
            "EFBFBD4142");
  ASSERT_EQ(answers.Unread.size(), 1U);
  EXPECT_EQ(answers.Unread[0].Name, "FirstName");
}

TEST_F(DamagedFile, HasARowThatOutgrewItsPageInItsPlace) {
  KeepWholeFile(OldFiles[1]);
  std::string bytes = OldFileBytes("members");
  MembersFile::MoveRow(bytes, 2);
  Convert(OldFiles[1], bytes);
  EXPECT_EQ(DifferingKeys(OldFiles[1]), "");
}

TEST_F(DamagedFile, DoesNotBringADeletedRowBackThatHadOutgrownItsPage) {
  std::string bytes = OldFileBytes("members");
  MembersFile::MoveRow(bytes, 2);
  constexpr unsigned int deleted = 0xC000;
  const std::size_t entry = MembersFile::EntryOf(2);
  PutNumber(bytes, entry, static_cast<std::uint16_t>(NumberAt<std::uint16_t>(bytes, entry) | deleted));
  EXPECT_EQ(NumberThrownBy([&] { Convert(OldFiles[1], bytes); }), 3343);  // the table counts 40 rows
  PutNumber(bytes, MembersFile::RowCount, std::uint32_t{39});
  EXPECT_EQ(Convert(OldFiles[1], bytes).Rows, 39);
}

TEST_F(DamagedFile, IsRefusedWhenItsListOfTablesLacksOne) {
  std::string bytes = OldFileBytes("members");
  const std::size_t entry = MembersFile::CatalogPage * JetPageSize + MembersFile::RowTable + 2 + 2 * 7;
  PutNumber(bytes, entry, static_cast<std::uint16_t>(NumberAt<std::uint16_t>(bytes, entry) | 0xC000U));
  try {
    Convert(OldFiles[1], bytes);
    ADD_FAILURE() << "it was converted";
  } catch (const OldDatabaseRefused& error) {
    EXPECT_THAT(error.Parts(), IsEmpty());
  }
}

TEST_F(DamagedFile, TellsHowManyOfItsRowsCanBeRead) {
  std::string bytes = OldFileBytes("members");
  bytes.replace(MembersFile::FirstDataPage * JetPageSize, JetPageSize, JetPageSize, '\0');
  try {
    Convert(OldFiles[1], bytes);
    ADD_FAILURE() << "it was converted";
  } catch (const OldDatabaseRefused& error) {
    EXPECT_THAT(error.Parts(), ElementsAre(NotTakenOver{NotTakenOver::TableRows, "Members", 24, 40}));
  }
}

}  // namespace
