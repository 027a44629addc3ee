#include "platform/jet/JetConverter.h"

#include <gmock/gmock.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <random>

#include "platform/linux/LinuxFiles.h"
#include "tests/support/ConversionAnswers.h"
#include "tests/support/OldFiles.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/TestDatabase.h"
#include "tests/support/Thrown.h"

namespace {

using namespace std::chrono_literals;
using testing::HasSubstr;
using testing::IsEmpty;

struct OldFile {
  const char* Name;
  const char* Table;
};

constexpr OldFile OldFiles[] = {{"scenarios", "Table1"}, {"members", "Members"}};

class Conversion : public testing::Test {
 protected:
  void SetUp() override { SKIP_WITHOUT_OLD_FILES(); }

  /// A writable copy of an old file.
  std::string Copy(const char* name) const {
    const std::string copy = folder / (std::string(name) + ".mdb");
    WriteFile(copy, ReadFile(std::string(TESSARINE_OLD_FILES "/") + name + ".mdb"));
    return copy;
  }

  static std::string Empty(const char* name) {
    return TESSARINE_PROGRAM_FOLDER "/" + std::string(name) + "_default.mdb";
  }

  std::size_t FilesInFolder() const {
    return static_cast<std::size_t>(std::distance(std::filesystem::directory_iterator(folder.Path()),
                                                  std::filesystem::directory_iterator()));
  }

  /// Number of values in the converted file that differ from the expected ones in `json`.
  static std::string Differences(const std::string& path, const OldFile& old, const std::string& json) {
    OtherConnection connection(path);
    connection.Execute("CREATE TEMP TABLE Json (Text)");
    std::string quoted;
    for (const char letter : json) {
      quoted += letter == '\'' ? "''" : std::string(1, letter);
    }
    connection.Execute("INSERT INTO Json VALUES ('" + quoted + "')");
    const std::string table = "$.tables." + std::string(old.Table);
    std::string differences = connection.Query("SELECT count(*) <> (SELECT json_array_length(Text, '" +
                                               table + ".rows') FROM Json) FROM " + old.Table);
    const int columns =
        std::stoi(connection.Query("SELECT json_array_length(Text, '" + table + ".columns') FROM Json"));
    for (int i = 0; i < columns; ++i) {
      const std::string number = std::to_string(i);
      const std::string name = connection.Query("SELECT json_extract(Text, '" + table + ".columns[" + number +
                                                "].name') FROM Json");
      const std::string expected = "json_extract(value, '$[" + number + "]')";
      const std::string stored = "t.[" + name + "]";
      const std::string same =
          name == "Photograph"
              ? "length(" + stored + ") IS json_extract(value, '$[" + number + "].stored_length')"
              : stored + " IS " + expected + " OR " + stored + " IS replace(" + expected + ", 'T', ' ')";
      differences += connection.Query("SELECT count(*) FROM Json, json_each(Text, '" + table +
                                      ".rows') JOIN " + std::string(old.Table) +
                                      " t ON t.rowid = json_extract(value, '$[0]') WHERE NOT (" + same + ")");
    }
    return differences;
  }

  OldDatabaseReport Convert(const std::string& path, const std::string& table, const std::string& empty) {
    return converter.Convert({path, table, empty, folder / "members-new.mdb"}, answers);
  }

  TemporaryFolder folder;
  LinuxFiles disk;
  JetConverter converter{disk, JetReaderPath(), 1s};
  ConversionAnswers answers;
};

TEST_F(Conversion, ConvertsEveryValue) {
  for (const OldFile& old : OldFiles) {
    const std::string path = Copy(old.Name);
    EXPECT_TRUE(converter.IsOld(path));
    const OldDatabaseReport report = Convert(path, old.Table, Empty(old.Name));
    EXPECT_THAT(report.NotTaken, IsEmpty());
    EXPECT_FALSE(converter.IsOld(path));
    const std::string json = ReadFile(std::string(TESSARINE_OLD_FILES "/") + old.Name + ".json");
    EXPECT_THAT(Differences(path, old, json), testing::MatchesRegex("0+"));
  }
}

TEST_F(Conversion, KeepsTheOldFileUnderAnUnusedName) {
  const std::string path = Copy("members");
  const std::string before = ReadFile(path);
  WriteFile(path + ".jet", "an older one");
  const OldDatabaseReport report = Convert(path, "Members", Empty("members"));
  EXPECT_EQ(report.KeptAs, path + ".jet2");
  EXPECT_TRUE(ReadFile(path + ".jet2") == before);
  EXPECT_EQ(ReadFile(path + ".jet"), "an older one");
  EXPECT_EQ(FilesInFolder(), 3U);
}

TEST_F(Conversion, OfADamagedFileChangesNothing) {
  std::mt19937 random(7);
  for (const OldFile& old : OldFiles) {
    const std::string whole = ReadFile(Copy(old.Name));
    for (const std::size_t length : {std::size_t{5000}, whole.size() / 2, whole.size() - 1000}) {
      const std::string path = folder / (std::string(old.Name) + ".mdb");
      WriteFile(path, whole.substr(0, length));
      EXPECT_EQ(NumberThrownBy([&] { Convert(path, old.Table, Empty(old.Name)); }), 3343) << length;
      EXPECT_TRUE(ReadFile(path) == whole.substr(0, length)) << length;
    }
    const std::string path = folder / (std::string(old.Name) + ".mdb");
    for (int round = 0; round < 5; ++round) {
      std::string damaged = whole;
      for (int i = 0; i < 400; ++i) {
        damaged[4096 + random() % (damaged.size() - 4096)] = static_cast<char>(random());
      }
      WriteFile(path, damaged);
      try {
        Convert(path, old.Table, Empty(old.Name));
        std::filesystem::remove(path + ".jet");
      } catch (const RuntimeError& error) {
        EXPECT_EQ(error.Number(), 3343);
        EXPECT_TRUE(ReadFile(path) == damaged);
      }
      EXPECT_FALSE(std::filesystem::exists(path + ".new"));
    }
  }
}

TEST_F(Conversion, WithoutItsTableFails) {
  const std::string path = Copy("scenarios");
  EXPECT_THAT(ThrownBy([&] { Convert(path, "Members", Empty("members")); }).Text, HasSubstr("Members"));
  EXPECT_EQ(FilesInFolder(), 1U);
}

TEST_F(Conversion, IntoADatabaseWithoutTheTableFails) {
  const std::string path = Copy("members");
  // The new file is a copy of the other empty database, which has no such table.
  EXPECT_EQ(NumberThrownBy([&] { Convert(path, "Members", Empty("scenarios")); }), 3343);
  EXPECT_TRUE(converter.IsOld(path));
}

TEST(OldFormat, IsKnownByItsMark) {
  const TemporaryFolder folder;
  LinuxFiles disk;
  const JetConverter converter(disk, JetReaderPath());
  const auto isOld = [&](const std::string& bytes) {
    WriteFile(folder / "x.mdb", bytes);
    return converter.IsOld(folder / "x.mdb");
  };
  const std::string start("\0\1\0\0", 4);
  EXPECT_TRUE(isOld(start + "Standard Jet DB" + std::string(40, '\0')));
  EXPECT_TRUE(isOld(start + "Standard ACE DB" + std::string(40, '\0')));
  EXPECT_FALSE(isOld(start + "Standard"));
  EXPECT_FALSE(isOld("SQLite format 3" + std::string(40, '\0')));
  EXPECT_FALSE(isOld(std::string(4096, '\0')));
  EXPECT_FALSE(isOld(""));
  EXPECT_FALSE(converter.IsOld(folder / "none.mdb"));
}

TEST(OldFormat, ThatCannotBeReadWithoutTheReaderIsReported) {
  const TemporaryFolder folder;
  WriteFile(folder / "x.mdb", std::string("\0\1\0\0", 4) + "Standard Jet DB" + std::string(4096 - 19, '\0'));
  LinuxFiles disk;
  JetConverter converter(disk, "/nowhere/tessarine-jet-reader");
  ConversionAnswers answers;
  const Thrown thrown = ThrownBy([&] {
    converter.Convert({folder / "x.mdb", "Members", TESSARINE_PROGRAM_FOLDER "/members_default.mdb", ""},
                      answers);
  });
  EXPECT_THAT(thrown.Text, HasSubstr("/nowhere/tessarine-jet-reader"));
}

TEST(OldFormat, IsReadByTheReaderThatWasThereAtFirst) {
  const TemporaryFolder folder;
  const std::string reader = folder / "reader";
  const auto install = [&](const std::string& name) {
    WriteFile(reader + ".new", "#!/bin/sh\ntouch '" + folder / name + "'\nexit 1\n");
    std::filesystem::permissions(reader + ".new", std::filesystem::perms::owner_all);
    std::filesystem::rename(reader + ".new", reader);
  };
  WriteFile(folder / "x.mdb", std::string("\0\1\0\0", 4) + "Standard Jet DB" + std::string(4096 - 19, '\0'));
  LinuxFiles disk;
  install("first");
  JetConverter converter(disk, reader);
  install("second");
  ConversionAnswers answers;
  const Thrown thrown = ThrownBy([&] {
    converter.Convert({folder / "x.mdb", "Members", TESSARINE_PROGRAM_FOLDER "/members_default.mdb", ""},
                      answers);
  });
  EXPECT_NE(thrown.Text, "");
  EXPECT_TRUE(std::filesystem::exists(folder / "first"));
  EXPECT_FALSE(std::filesystem::exists(folder / "second"));
}

}  // namespace
