#include <gmock/gmock.h>

#include <filesystem>

#include "platform/jet/JetConverter.h"
#include "platform/linux/LinuxFiles.h"
#include "tests/platform/jet/OldFileCopies.h"
#include "tests/support/ConversionAnswers.h"
#include "tests/support/OldFiles.h"
#include "tests/support/TestDatabase.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::UnorderedElementsAre;

/// What a reader writes.
class ReaderWords {
 public:
  ReaderWords& Tag(char tag) {
    bytes_ += tag;
    return *this;
  }
  ReaderWords& Number(std::uint64_t value, std::size_t bytes) {
    for (std::size_t i = 0; i < bytes; ++i) {
      bytes_ += i < sizeof value ? static_cast<char>(value >> (8 * i) & 255U) : '\0';
    }
    return *this;
  }
  ReaderWords& Text(const std::string& text) {
    Tag('S').Number(text.size(), 4);
    bytes_ += text;
    return *this;
  }
  ReaderWords& Table(const std::vector<std::string>& columns) {
    Tag('T').Text("Members").Number(columns.size(), 4);
    for (const std::string& column : columns) {
      Text(column);
    }
    return *this;
  }
  ReaderWords& Row(std::uint64_t key, const std::string& text) {
    return Tag('R').Tag('I').Number(key, 8).Text(text);
  }

  const std::string& Bytes() const { return bytes_; }

 private:
  std::string bytes_;
};

/// Files of which the writing of some fails half-way.
class FailingFiles : public LinuxFiles {
 public:
  std::string FailingPath;
  bool FailsWhenRenamed = false;  ///< as when only the folder cannot be flushed

  void Write(const std::string& path, const std::string& bytes) override {
    LinuxFiles::Write(path, bytes.substr(0, path == FailingPath ? bytes.size() / 2 : bytes.size()));
    ThrowFor(path);
  }
  void Rename(const std::string& path, const std::string& newPath) override {
    if (FailsWhenRenamed) {
      LinuxFiles::Rename(path, newPath);
    }
    ThrowFor(newPath);
    LinuxFiles::Rename(path, newPath);
  }

 private:
  void ThrowFor(const std::string& path) const {
    if (path == FailingPath) {
      throw RuntimeError(Fault::DiskFull, "Disk full: " + path);
    }
  }
};

/// A conversion with a reader that writes what it is told to.
class WithWords : public testing::Test {
 protected:
  WithWords() { WriteFile(path, before); }

  OldDatabaseReport Convert(const ReaderWords& words) {
    WriteFile(folder / "words", words.Bytes());
    WriteFile(reader, "#!/bin/sh\necho 'a word of the library' >&2\ncat '" + (folder / "words") + "'\n");
    std::filesystem::permissions(reader, std::filesystem::perms(0755));
    JetConverter converter(disk, reader);
    const OldDatabaseReport report =
        converter.Convert({path, "Members", EmptyDatabase("members"), folder / "members-new.mdb"}, answers);
    return report;
  }

  OldDatabaseRefused Refusal(const ReaderWords& words) {
    try {
      Convert(words);
    } catch (const OldDatabaseRefused& error) {
      EXPECT_EQ(ReadFile(path), before);
      EXPECT_THAT(disk.FileNames(folder.Path()), UnorderedElementsAre("members.mdb", "reader", "words"));
      return error;
    }
    ADD_FAILURE() << "it was converted";
    return {};
  }

  /// With a reader that goes on without end.
  void ConvertEndlessly(const ReaderWords& words) {
    WriteFile(folder / "words", words.Bytes());
    WriteFile(reader, "#!/bin/sh\ncat '" + (folder / "words") + "'\nexec sleep 1000\n");
    std::filesystem::permissions(reader, std::filesystem::perms(0755));
    JetConverter(disk, reader)
        .Convert({path, "Members", EmptyDatabase("members"), folder / "members-new.mdb"}, answers);
  }

  static ReaderWords OneMember() {
    return ReaderWords().Table({"ContactID", "FirstName"}).Row(7, "Ada").Tag('E');
  }

  const std::string before = std::string(4096, 'x');
  TemporaryFolder folder;
  const std::string path = folder / "members.mdb";
  const std::string reader = folder / "reader";
  FailingFiles disk;
  ConversionAnswers answers;
};

TEST_F(WithWords, IsStoppedInTheMiddleWithoutAnyChange) {
  answers.StopAt = 3;
  const auto words = ReaderWords().Table({"ContactID", "FirstName"}).Row(7, "Ada");
  EXPECT_THROW(ConvertEndlessly(words), OldDatabaseStopped);
  EXPECT_EQ(answers.Asked, 3);
  EXPECT_EQ(ReadFile(path), before);
  EXPECT_THAT(disk.FileNames(folder.Path()), UnorderedElementsAre("members.mdb", "reader", "words"));
}

TEST_F(WithWords, ReportsWhatWasNotTakenOver) {
  ReaderWords words;
  words.Tag('O').Text("Extras").Number(3, 8);
  words.Table({"ContactID", "Shoe size", "TotalGamesPlayed"});
  words.Tag('R').Tag('I').Number(7, 8).Text("44").Text("many").Tag('E');
  const OldDatabaseReport report = Convert(words);
  EXPECT_EQ(report.Rows, 1);
  const auto has = [&report](const NotTakenOver& what) {
    return std::count(report.NotTaken.begin(), report.NotTaken.end(), what) == 1;
  };
  EXPECT_TRUE(has({NotTakenOver::Table, "Extras", 3}));
  EXPECT_TRUE(has({NotTakenOver::Column, "Shoe size"}));
  EXPECT_TRUE(has({NotTakenOver::TextsOfColumn, "TotalGamesPlayed"}));
  EXPECT_TRUE(has({NotTakenOver::MissingColumn, "FirstName"}));
  EXPECT_TRUE(has({NotTakenOver::MissingColumn, "Photograph"}));
  EXPECT_FALSE(has({NotTakenOver::MissingColumn, "ContactID"}));
  EXPECT_EQ(report.NotTaken.size(), 26U);
}

TEST_F(WithWords, NamesTheValueThatTheTableRefuses) {
  const ReaderWords words = ReaderWords().Table({"ContactID", "FirstName"}).Row(7, "Ada").Row(7, "Eve");
  EXPECT_THAT(Refusal(words).Parts(), ElementsAre(NotTakenOver{.What = NotTakenOver::OneValue,
                                                               .Name = "ContactID",
                                                               .InTable = "Members",
                                                               .InRow = "2 (ContactID 7)"}));
}

TEST_F(WithWords, TellsNothingInTheWordsOfTheLibrary) {
  for (const ReaderWords& words :
       {ReaderWords(), ReaderWords().Tag('x'), ReaderWords().Tag('F').Text("").Number(0, 16)}) {
    const OldDatabaseRefused error = Refusal(words);
    EXPECT_THAT(error.Parts(), IsEmpty());
    EXPECT_EQ(error.Failure(), "");
  }
}

TEST_F(WithWords, LeavesNoNewFileWhenItCannotBeWritten) {
  disk.FailingPath = path + ".new";
  EXPECT_THAT(Refusal(OneMember()).Failure(), HasSubstr("Disk full"));
}

TEST_F(WithWords, TakesEverythingBackWhenTheNewFileCannotTakeItsPlace) {
  disk.FailingPath = path;
  EXPECT_THAT(Refusal(OneMember()).Failure(), HasSubstr("Disk full"));
  disk.FailingPath.clear();
  EXPECT_EQ(Convert(OneMember()).KeptAs, path + ".jet");
}

TEST_F(WithWords, KeepsTheOldFileWhenTheNewOneHasTakenItsPlaceAllTheSame) {
  disk.FailingPath = path;
  disk.FailsWhenRenamed = true;
  EXPECT_EQ(Convert(OneMember()).KeptAs, path + ".jet");
  EXPECT_EQ(ReadFile(path + ".jet"), before);
  EXPECT_EQ(OtherConnection(path).Query("SELECT FirstName FROM Members"), "Ada");
}

TEST_F(WithWords, TakesEverythingBackWhenItsListCannotBeWritten) {
  answers.FailBeforeReplacing = "no room for the list";
  EXPECT_EQ(Refusal(OneMember()).Failure(), "no room for the list");
}

class WithInterimRows : public WithWords {
 protected:
  WithInterimRows() {
    disk.Write(interim, disk.Read(EmptyDatabase("members")));
    OtherConnection(interim).Execute(
        "INSERT INTO Members (ContactID, FirstName) VALUES (7, 'Eve'), (8, 'Zoe'), (9, 'Rhys')");
  }

  std::string Members() const {
    return OtherConnection(path).Query(
        "SELECT group_concat(ContactID || FirstName, ' ') FROM (SELECT * FROM Members ORDER BY ContactID)");
  }

  static ReaderWords TwoMembers() {
    return ReaderWords().Table({"ContactID", "FirstName"}).Row(7, "Ada").Row(8, "Sean").Tag('E');
  }

  const std::string interim = folder / "members-new.mdb";
};

TEST_F(WithInterimRows, AddsThemUnderNewKeysWhereTheirsAreTaken) {
  Convert(TwoMembers());
  EXPECT_EQ(answers.InterimRows, 3);
  EXPECT_EQ(Members(), "7Ada 8Sean 9Rhys 10Eve 11Zoe");
  EXPECT_FALSE(disk.FileExists(interim));
  EXPECT_TRUE(disk.FileExists(interim + ".joined"));
}

TEST_F(WithInterimRows, LeavesThemIfTheOperatorWantsThat) {
  answers.Answer = false;
  Convert(TwoMembers());
  EXPECT_EQ(Members(), "7Ada 8Sean");
  EXPECT_TRUE(disk.FileExists(interim));
}

TEST_F(WithInterimRows, DoesNotAddThemWhenTheConversionFails) {
  disk.FailingPath = path;
  EXPECT_EQ(NumberThrownBy([this] { Convert(TwoMembers()); }), 3343);
  EXPECT_EQ(OtherConnection(interim).Query("SELECT count(*) FROM Members"), "3");
  EXPECT_EQ(ReadFile(path), before);
}

TEST_F(WithInterimRows, DoesNotAskForAnEmptyOrDamagedFile) {
  OtherConnection(interim).Execute("DELETE FROM Members");
  Convert(TwoMembers());
  EXPECT_EQ(answers.InterimRows, 0);
  WriteFile(interim, std::string(4096, 'y'));
  WriteFile(path, before);
  Convert(TwoMembers());
  EXPECT_EQ(Members(), "7Ada 8Sean");
  EXPECT_EQ(ReadFile(interim), std::string(4096, 'y'));
}

class OldMissions : public testing::Test {
 protected:
  void SetUp() override { SKIP_WITHOUT_OLD_FILES(); }
};

TEST_F(OldMissions, GetOnlyTheMissionsThatWereEnteredMeanwhile) {
  const TemporaryFolder folder;
  LinuxFiles disk;
  disk.Write(folder / "scenarios.mdb", OldFileBytes("scenarios"));
  const std::string interim = folder / "scenarios-new.mdb";
  disk.Write(interim, disk.Read(EmptyDatabase("scenarios")));
  OtherConnection(interim).Execute("INSERT INTO Table1 (MissionName) VALUES ('Ours')");
  ConversionAnswers answers;
  JetConverter converter(disk, JetReaderPath());
  converter.Convert({folder / "scenarios.mdb", "Table1", EmptyDatabase("scenarios"), interim}, answers);
  EXPECT_EQ(answers.InterimRows, 1);
  OtherConnection connection(folder / "scenarios.mdb");
  EXPECT_EQ(connection.Query("SELECT count(*) FROM Table1"), "7");
  EXPECT_EQ(connection.Query("SELECT MissionName FROM Table1 ORDER BY ID DESC"), "Ours");
}

}  // namespace
