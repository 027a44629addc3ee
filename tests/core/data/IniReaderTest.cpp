#include "core/data/IniReader.h"

#include <gtest/gtest.h>

#include <string>

#include "tests/fakes/FakeFiles.h"

namespace {

constexpr const char* Path = "/data/tessarine.ini";

class IniReaderTest : public testing::Test {
 protected:
  IniReaderTest() { Store.AddFolder("/data"); }

  /// The value of "comm"/"commport" in a file with these bytes.
  std::string Read(const std::string& bytes) {
    Store.Put(Path, bytes);
    return Ini.ReadIni("comm", "commport", "default");
  }

  /// The file's bytes after writing `value` to "comm"/"commport".
  std::string Written(const std::string& bytes, const std::string& value) {
    Store.Put(Path, bytes);
    Ini.WriteIni("comm", "commport", value);
    return Store.Read(Path);
  }

  FakeFiles Store;
  IniReader Ini{Store, Path};
};

using ReadIni = IniReaderTest;
using ReadSection = IniReaderTest;
using WriteIni = IniReaderTest;

TEST_F(ReadIni, GivesTheValueOfAKeyInItsSection) {
  EXPECT_EQ(Read("[other]\ncommport=9\n[comm]\ncommport=3\n[more]\ncommport=5\n"), "3");
}

TEST_F(ReadIni, GivesTheDefaultWithoutFileSectionOrKey) {
  EXPECT_EQ(Ini.ReadIni("comm", "commport", "default"), "default");
  EXPECT_EQ(Read(""), "default");
  EXPECT_EQ(Read("commport=3\n"), "default");
  EXPECT_EQ(Read("[other]\ncommport=3\n"), "default");
  EXPECT_EQ(Read("[comm]\nport=3\n"), "default");
  EXPECT_EQ(Read("[comm]\ncommport\n"), "default");
}

TEST_F(ReadIni, LeavesTheDefaultAsItStands) {
  EXPECT_EQ(Ini.ReadIni("comm", "commport", "  \"text\"  "), "  \"text\"  ");
  EXPECT_EQ(Ini.ReadIni("comm", "commport", std::string(300, 'd')), std::string(300, 'd'));
}

TEST_F(ReadIni, TellsAnEmptyValueFromAMissingOne) {
  EXPECT_EQ(Read("[comm]\ncommport=\n"), "");
  EXPECT_EQ(Read("[comm]\ncommport=  \t \n"), "");
  EXPECT_EQ(Read("[comm]\ncommport=\"\"\n"), "");
}

TEST_F(ReadIni, FindsNamesInAnyCase) {
  EXPECT_EQ(Read("[COMM]\nCommPort=3\n"), "3");
  Store.Put(Path, "[comm]\ncommport=4\n");
  EXPECT_EQ(Ini.ReadIni("Comm", "COMMPORT", ""), "4");
}

TEST_F(ReadIni, DropsBlanksAroundNamesAndValue) {
  EXPECT_EQ(Read("  [ comm ]  \n \t commport \t = \t 3 \t \n"), "3");
  EXPECT_EQ(Read("[comm]\ncommport= two words \n"), "two words");
}

TEST_F(ReadIni, DropsOnePairOfMatchingQuotes) {
  EXPECT_EQ(Read("[comm]\ncommport=\" 3 \"\n"), " 3 ");
  EXPECT_EQ(Read("[comm]\ncommport=' 3 '\n"), " 3 ");
  EXPECT_EQ(Read("[comm]\ncommport=\"\"3\"\"\n"), "\"3\"");
  EXPECT_EQ(Read("[comm]\ncommport=\"3'\n"), "\"3'");
  EXPECT_EQ(Read("[comm]\ncommport=\"3\n"), "\"3");
  EXPECT_EQ(Read("[comm]\ncommport=\"\n"), "\"");
}

TEST_F(ReadIni, TakesTheFirstOfDuplicateKeys) {
  EXPECT_EQ(Read("[comm]\ncommport=3\ncommport=4\n[comm]\ncommport=5\n"), "3");
}

TEST_F(ReadIni, SearchesAllSectionsOfOneName) {
  EXPECT_EQ(Read("[comm]\nx=1\n[other]\ncommport=4\n[Comm]\ncommport=5\n"), "5");
}

TEST_F(ReadIni, TakesAllBehindTheFirstEqualsSign) {
  EXPECT_EQ(Read("[comm]\ncommport=a=b ; c\n"), "a=b ; c");
}

TEST_F(ReadIni, PassesOverCommentsAndGarbage) {
  EXPECT_EQ(Read("[comm]\n;commport=1\n  ; commport=2\ngarbage\n=4\n[unclosed\ncommport=3\n"), "3");
  EXPECT_EQ(Read("[comm] ; a remark\ncommport=3\n"), "3");
}

TEST_F(ReadIni, KnowsEveryKindOfLineBreak) {
  EXPECT_EQ(Read("[comm]\r\ncommport=3\r\n"), "3");
  EXPECT_EQ(Read("[comm]\rcommport=3\r"), "3");
  EXPECT_EQ(Read("[comm]\n\ncommport=3"), "3");
}

TEST_F(ReadIni, CutsTheValueToTheOldBuffer) {
  const std::string kept(254, 'x');
  EXPECT_EQ(Read("[comm]\ncommport=" + kept + "\n"), kept);
  EXPECT_EQ(Read("[comm]\ncommport=" + kept + "y\n"), kept);
}

TEST_F(ReadIni, NeverCutsACharacterInTwo) {
  const std::string kept(252, 'x');
  EXPECT_EQ(Read("[comm]\ncommport=" + kept + "队\n"), kept);
  EXPECT_EQ(Read("[comm]\ncommport=" + kept + "éa\n"), kept + "é");
  EXPECT_EQ(Read("[comm]\ncommport=" + kept + "aé\n"), kept + "a");
}

TEST_F(ReadIni, ReadsUtf8WithAndWithoutMark) {
  EXPECT_EQ(Read("\xEF\xBB\xBF[comm]\ncommport=Müller 红队\n"), "Müller 红队");
  EXPECT_EQ(Read("[comm]\ncommport=Müller 红队\n"), "Müller 红队");
}

TEST_F(ReadIni, ReadsWindowsTextsToo) {
  EXPECT_EQ(Read("[comm]\ncommport=C:\\M\xFCller\n"), "C:\\Müller");
  Store.Put(Path, "[M\xFCller]\nL\xE4nge=2\n");
  EXPECT_EQ(Ini.ReadIni("Müller", "Länge", ""), "2");
}

TEST_F(ReadIni, NeverFailsOnGarbageOrAnUnreadableFile) {
  for (const char* bytes : {"[", "]", "=", "[]", "[]=", "\r", ";", "\xEF\xBB\xBF", "\xEF\xBB", "[comm]",
                            "[comm\n=", "\xFF\xFE[\0c\0"}) {
    EXPECT_EQ(Read(bytes), "default") << bytes;
  }
  EXPECT_EQ(Read(std::string(1000, '\0')), "default");
  Store.FailRead(Path, RuntimeError(75));
  EXPECT_EQ(Ini.ReadIni("comm", "commport", "default"), "default");
}

TEST_F(ReadSection, GivesAllEntriesInOrder) {
  Store.Put(Path, "[a]\nx= 1 \n;y=2\nX=\"3\"\n[b]\nz=4\n[A]\nw=5\n");
  EXPECT_EQ(Ini.ReadSection("a"), (IniReader::Values{{"x", "1"}, {"X", "3"}, {"w", "5"}}));
  EXPECT_TRUE(Ini.ReadSection("c").empty());
}

TEST_F(WriteIni, ChangesTheValueAndNothingElse) {
  EXPECT_EQ(
      Written("; head\r\n\r\n[Comm]\r\n# odd\r\nCommPort = 3 \r\ngarbage\r\nx = 1\r\n[b]\r\ncommport=8\r\n",
              " 7"),
      "; head\r\n\r\n[Comm]\r\n# odd\r\nCommPort = 7\r\ngarbage\r\nx = 1\r\n[b]\r\ncommport=8\r\n");
}

TEST_F(WriteIni, ChangesTheEntryThatIsRead) {
  EXPECT_EQ(Written("[comm]\nx=1\n[b]\n[comm]\ncommport=3\ncommport=4\n", "7"),
            "[comm]\nx=1\n[b]\n[comm]\ncommport=7\ncommport=4\n");
}

TEST_F(WriteIni, KeepsMarkMissingLastBreakAndOddBytes) {
  EXPECT_EQ(Written("\xEF\xBB\xBF[comm]\ncommport=3", "7"), "\xEF\xBB\xBF[comm]\ncommport=7");
  EXPECT_EQ(Written("[comm]\ncommport=3\nname=M\xFCller\n", "Süd"), "[comm]\ncommport=Süd\nname=M\xFCller\n");
  EXPECT_EQ(Ini.ReadIni("comm", "commport", ""), "Süd");
  EXPECT_EQ(Ini.ReadIni("comm", "name", ""), "Müller");
  const std::string binary("[comm]\ncommport=3\n\0\x01\xFF\n", 21);
  EXPECT_EQ(Written(binary, "3"), binary);
}

TEST_F(WriteIni, AddsAKeyBehindTheLastOfItsSection) {
  EXPECT_EQ(Written("[comm]\nx=1\n\n; about b\n[b]\ny=2\n", "7"),
            "[comm]\nx=1\ncommport=7\n\n; about b\n[b]\ny=2\n");
  EXPECT_EQ(Written("[comm]\n[b]\n", "7"), "[comm]\ncommport=7\n[b]\n");
  EXPECT_EQ(Written("[comm]\nx=1\n[b]\n[comm]\nz=3\n", "7"), "[comm]\nx=1\ncommport=7\n[b]\n[comm]\nz=3\n");
  EXPECT_EQ(Written("[comm]\r\nx=1", "7"), "[comm]\r\nx=1\r\ncommport=7\r\n");
}

TEST_F(WriteIni, AddsASectionAtTheEnd) {
  EXPECT_EQ(Written("[a]\nx=1\n", "7"), "[a]\nx=1\n[comm]\ncommport=7\n");
  EXPECT_EQ(Written("[a]\r\nx=1", "7"), "[a]\r\nx=1\r\n[comm]\r\ncommport=7\r\n");
  EXPECT_EQ(Written("", "7"), "[comm]\ncommport=7\n");
  EXPECT_EQ(Written("\xEF\xBB\xBF", "7"), "\xEF\xBB\xBF[comm]\ncommport=7\n");
}

TEST_F(WriteIni, MakesAMissingFile) {
  Ini.WriteIni("comm", "commport", " 2");
  EXPECT_EQ(Store.Read(Path), "[comm]\ncommport= 2\n");
  EXPECT_EQ(Ini.ReadIni("comm", "commport", ""), "2");
}

TEST_F(WriteIni, ChangesNothingWhenRepeated) {
  const std::string once = Written("[comm]\r\n  commport =  9\r\n", " 2");
  EXPECT_EQ(once, "[comm]\r\n  commport = 2\r\n");
  EXPECT_EQ(Written(once, " 2"), once);
}

TEST_F(WriteIni, WritesSeveralValuesInOneReplacement) {
  Store.Put(Path, "[s]\nb=1\n");
  Ini.WriteIni("s", {{"a", "5"}, {"b", "6"}, {"c", "7"}});
  ASSERT_EQ(Store.Replaced.size(), 1U);
  EXPECT_EQ(Store.Read(Path), "[s]\nb=6\na=5\nc=7\n");
}

TEST_F(WriteIni, RefusesAValueWithALineBreak) {
  const std::string before = "[comm]\ncommport=3\n";
  EXPECT_EQ(Written(before, "7\nx=1"), before);
  EXPECT_EQ(Written(before, "7\r"), before);
  Ini.WriteIni("comm", {{"a", "1"}, {"b", "2\n3"}});
  EXPECT_TRUE(Store.Replaced.empty());
}

TEST_F(WriteIni, LeavesAFileAloneThatCannotBeRead) {
  Store.Put(Path, "[comm]\ncommport=3\n");
  Store.FailRead(Path, RuntimeError(75));
  Ini.WriteIni("comm", "commport", "7");
  EXPECT_TRUE(Store.Replaced.empty());
}

TEST_F(WriteIni, DoesNotReportAFailure) {
  Store.Put(Path, "[comm]\ncommport=3\n");
  Store.FailReplace(Path, RuntimeError(61));
  EXPECT_NO_THROW(Ini.WriteIni("comm", "commport", "7"));
  EXPECT_EQ(Store.Replaced.size(), 1U);
  EXPECT_EQ(Ini.ReadIni("comm", "commport", ""), "3");
}

TEST_F(WriteIni, TellsWhetherTheFileHoldsTheValues) {
  std::vector<bool> told;
  Ini.AfterWrite = [&told](bool written) { told.push_back(written); };
  Ini.WriteIni("comm", "commport", "3");
  Ini.WriteIni("comm", "commport", "3\n4");
  Store.FailReplace(Path, RuntimeError(61));
  Ini.WriteIni("comm", "commport", "5");
  EXPECT_EQ(told, (std::vector<bool>{true, false, false}));
}

}  // namespace
