#include "core/data/LogText.h"

#include <gtest/gtest.h>

namespace {

constexpr const char* Data = "/home/jane doe/.local/share/Orvalin/Tessarine";

std::string Shown(const std::string& text) {
  return LogText(text, Data);
}

TEST(LogText, KeepsFixedTexts) {
  for (const char* text :
       {"", "Scores have been committed to the Database", "Run-time error '13': Type mismatch",
        "Run-time error '75': Path/File access error", "This photo is large. Large photo's will do",
        "Yes/No, 3/4, N/A", "无法打开文件"}) {
    EXPECT_EQ(Shown(text), text);
  }
}

TEST(LogText, StandsInOneLine) {
  EXPECT_EQ(Shown("one\n\ntwo\r\nthree\tfour\n"), "one | two | three four");
}

TEST(LogText, LosesNumbersOfButtons) {
  EXPECT_EQ(Shown("Membership button read sucessfully, code = 01A2B3C4D5E6F708"),
            "Membership button read sucessfully, code = (number)");
  EXPECT_EQ(Shown("01a2b3c4d5e6f708."), "(number).");
  EXPECT_EQ(Shown("0123456789ABCDE"), "0123456789ABCDE") << "15 digits";
}

TEST(LogText, NamesTheProgramsOwnFiles) {
  const std::string data = Data;
  EXPECT_EQ(Shown("The database " + data + "/members.mdb cannot be used."),
            "The database members.mdb cannot be used.");
  EXPECT_EQ(Shown("creating new database in " + data + "."), "creating new database in (data folder).");
  EXPECT_EQ(Shown("kept as " + data + "/scenarios.mdb.jet2."), "kept as scenarios.mdb.jet2.");
  EXPECT_EQ(Shown("a fresh database, " + data + "/members-new.mdb, or Cancel"),
            "a fresh database, members-new.mdb, or Cancel");
}

TEST(LogText, LosesAllOtherPaths) {
  const std::string data = Data;
  EXPECT_EQ(Shown("Disk full: /home/jane doe/Jane Doe.xml"), "Disk full: (a .xml file)");
  EXPECT_EQ(Shown("File not found: " + data + "/scores/2026 Jane Doe.doc."), "File not found: (a .doc file)");
  EXPECT_EQ(Shown("File not found: " + data + "/members/Jane"), "File not found: (a path)");
  EXPECT_EQ(Shown("Disk full: " + data + "/Jane Doe's.xml\nTry again."),
            "Disk full: (a .xml file) | Try again.");
  EXPECT_EQ(Shown("Disk full: " + data + "/membersJane.mdb"), "Disk full: (a .mdb file)");
  EXPECT_EQ(Shown("Path not found: " + data + "2/Jane"), "Path not found: (a path)");
  EXPECT_EQ(Shown("Path not found: /home/J.Doe"), "Path not found: (a path)");
  EXPECT_EQ(Shown("(url=file:///home/jane) is bad"), "(url=file:(a path)");
  EXPECT_EQ(Shown("打开/home/jane/得分.xml"), "打开(a .xml file)");
}

TEST(LogText, LosesWhatIsQuoted) {
  EXPECT_EQ(Shown("Syntax error in query '[Name] LIKE 'O'Brien''."), "Syntax error in query '...'.");
  EXPECT_EQ(Shown("Could not find file '" + std::string(Data) + "/members.mdb'."),
            "Could not find file '...'.");
  EXPECT_EQ(Shown("Run-time error '3075': Syntax error in query 'Jane'."),
            "Run-time error '3075': Syntax error in query '...'.");
}

TEST(LogText, TakesAnEmptyDataFolderForNone) {
  EXPECT_EQ(LogText("Disk full: /a.xml", ""), "Disk full: (a .xml file)");
}

}  // namespace
