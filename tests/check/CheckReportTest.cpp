#include "check/CheckReport.h"

#include <gtest/gtest.h>

namespace {

TEST(ReportOfTheCheck, NamesEachSubjectInBothLanguages) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    const StringTable strings(language);
    for (int subject = 0; subject < CheckSubjectCount; ++subject) {
      EXPECT_NE(NameOf(static_cast<CheckSubject>(subject), strings), "");
    }
    EXPECT_THROW(NameOf(static_cast<CheckSubject>(CheckSubjectCount), strings), std::out_of_range);
  }
  EXPECT_EQ(NameOf(CheckSubject::Games, StringTable(Language::English)), "Past games");
  EXPECT_EQ(NameOf(CheckSubject::Games, StringTable(Language::SimplifiedChinese)), "历史比赛");
}

TEST(ReportOfTheCheck, HasALineForEachItem) {
  EXPECT_EQ(
      CheckReport({"Tessarine 3.54", "Qt 6"},
                  {{CheckSubject::Disk, true, "900 MB are free"}, {CheckSubject::Printer, false, "Add one."}},
                  StringTable(Language::English)),
      "Tessarine 3.54\nQt 6\n\nDisk space: Fine: 900 MB are free\nPrinter: To do: Add one.\n");
}

TEST(ReportOfTheCheck, DoesNotTellTheUser) {
  EXPECT_EQ(WithoutUser("cannot open /home/anna/.local/x.mdb", "/home/anna", "anna"),
            "cannot open ~/.local/x.mdb");
  EXPECT_EQ(WithoutUser("'/home/anna' (/home/anna): /home/anna", "/home/anna", "anna"), "'~' (~): ~");
  EXPECT_EQ(WithoutUser("/media/anna/STICK and /run/user/anna", "/home/anna", "anna"),
            "/media/~/STICK and /run/user/~");
}

TEST(ReportOfTheCheck, LeavesOtherNamesAlone) {
  EXPECT_EQ(WithoutUser("/home/annabel/x /media/annabel", "/home/anna", "anna"),
            "/home/annabel/x /media/annabel");
  EXPECT_EQ(WithoutUser("/root and root", "/", ""), "/root and root");
  EXPECT_EQ(WithoutUser("/a/b", "", ""), "/a/b");
}

}  // namespace
