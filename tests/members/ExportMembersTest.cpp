#include "members/ExportMembers.h"

#include <sys/stat.h>

#include <QCheckBox>
#include <QProgressBar>

#include "tests/members/MemberFiles.h"
#include "tests/support/CaredFor.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

class ExportWindow : public MemberFiles {
 protected:
  /// The window, shown.
  ExportMembers& Open(Language language = Language::English) {
    strings = std::make_unique<StringTable>(language);
    window = std::make_unique<ExportMembers>(
        ExportMembers::Parts{*database, venue.Boxes, venue.Dialog, venue.Disk, events, venue.Time, *strings},
        nullptr);
    Show(*window);
    return *window;
  }

  void PressExport(const std::string& path) {
    venue.Dialog.Answers = {path};
    ::Press(*window, "Export");
  }

  std::unique_ptr<StringTable> strings;
  std::unique_ptr<ExportMembers> window;
};

TEST_F(ExportWindow, WritesAFileThatOnlyThisUserCanRead) {
  Open();
  EXPECT_EQ(LabelText(*window, "State"), "4 members, all columns but the photo");
  const std::string path = venue.Folder / "out.csv";
  PressExport(path);
  EXPECT_THAT(venue.Dialog.Calls,
              ElementsAre(FakeFileDialog::Call{true, "CSV Files|*.csv|All Files|*", "members-2013-05-21.csv",
                                               "", "Export Members"}));
  const std::string csv = ReadFile(path);
  EXPECT_TRUE(
      csv.starts_with("\xEF\xBB\xBF"
                      "ContactID,DallasID,FirstName,"));
  EXPECT_THAT(csv, HasSubstr("\r\n1,,Rhys,Morgan,"));
  EXPECT_EQ(csv.find("TotalGamesPlayed"), std::string::npos);
  struct stat info {};
  ASSERT_EQ(stat(path.c_str(), &info), 0);
  EXPECT_EQ(info.st_mode & 0777U, 0600U);
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_THAT(venue.Boxes.Boxes[0].Text, HasSubstr("4 members were exported to " + path));
  EXPECT_FALSE(window->isVisible());
}

TEST_F(ExportWindow, TellsOfWhomAnImportWouldNotMakeTheSame) {
  database->Statements().Change("UPDATE Members SET DallasID = '12' WHERE ContactID < 3", {});
  Open();
  PressExport(venue.Folder / "out.csv");
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_THAT(venue.Boxes.Boxes[0].Text,
              testing::EndsWith("\n\nAn import would refuse or change a button, a date or a number of these "
                                "members: 1, 2"));
}

TEST_F(ExportWindow, FollowsItsChoices) {
  Open();
  EXPECT_FALSE(Find<QCheckBox>(*window, "History").isChecked());
  Choose(*window, "Separator", 1);
  Find<QCheckBox>(*window, "Mark").click();
  Find<QCheckBox>(*window, "History").click();
  PressExport(venue.Folder / "out.csv");
  const std::string csv = ReadFile(venue.Folder / "out.csv");
  EXPECT_TRUE(csv.starts_with("ContactID;DallasID;FirstName;"));
  EXPECT_THAT(csv, HasSubstr(";AverageSecAccuracy\r\n"));
}

TEST_F(ExportWindow, AsksBeforeItReplacesAFile) {
  Open();
  const std::string path = venue.Folder / "out.csv";
  WriteFile(path, "old");
  venue.Boxes.Answers = {BoxAnswer::Cancel};
  PressExport(path);
  EXPECT_EQ(ReadFile(path), "old");
  EXPECT_EQ(venue.Boxes.Boxes.back().Text, path + " exists already. Replace it?");
  EXPECT_TRUE(window->isVisible());
  PressExport(path);
  EXPECT_NE(ReadFile(path), "old");
}

TEST_F(ExportWindow, GivesANameWithoutEndingOne) {
  Open();
  PressExport(venue.Folder / "out");
  EXPECT_TRUE(venue.Disk.FileExists(venue.Folder / "out.csv"));
}

TEST_F(ExportWindow, WritesNothingWithoutAName) {
  Open();
  ::Press(*window, "Export");
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
  EXPECT_TRUE(window->isVisible());
}

TEST_F(ExportWindow, ReportsAFileThatCannotBeWritten) {
  Open();
  PressExport(venue.Folder / "missing/out.csv");
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
  EXPECT_THAT(venue.Boxes.Boxes[0].Text, HasSubstr("Run-time error '76'"));
  EXPECT_TRUE(window->isVisible());
  EXPECT_TRUE(Find<QPushButton>(*window, "Export").isEnabled());
}

TEST_F(ExportWindow, IsCaredForInBothLanguages) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    ExpectCaredFor(Open(language));
    EXPECT_EQ(window->windowTitle().toStdString(),
              language == Language::English ? "Export Members" : "导出会员");
  }
}

}  // namespace
