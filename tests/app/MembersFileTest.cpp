#include <filesystem>
#include <fstream>

#include "tests/members/MembersSteps.h"
#include "tests/support/FileSizeLimit.h"
#include "tests/support/OrdinaryUser.h"
#include "tests/support/Venue.h"

namespace {

using testing::IsEmpty;

/// The window of the members, opened from the main window on a file that the program cannot use as it likes.
class MembersWindow : public MembersSteps<Venue> {
 protected:
  MembersWindow() { venue.Start(); }

  void Execute() override { venue.Trigger("mnuManageMembers"); }
};

TEST_F(MembersWindow, ShowsTheMembersOfAReadOnlyFile) {
  const std::string path = venue.DataFile("members.mdb");
  venue.Window.reset();
  std::filesystem::permissions(path, std::filesystem::perms(0444));
  const OrdinaryUser user;
  venue.MakeWindow().FormLoad();
  Open([this] {
    SearchFor("mole");
    EXPECT_EQ(Text("LastNameEntry"), "Belmont");
    EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
    Press("NewMember");
    Press("Delete");
    swiped = "EFCDAB8967452301";
    Press("ChangeID");
    EXPECT_EQ(Shown("MemberIDDisplay"), "");
  });
  ASSERT_EQ(venue.Boxes.Boxes.size(), 4U);  // including the question
  for (const std::size_t box : {0, 2, 3}) {
    EXPECT_THAT(venue.Boxes.Boxes[box].Text, testing::StartsWith("Run-time error '3027': "));
  }
  venue.Window.reset();
}

TEST_F(MembersWindow, KeepsTheOldRowsOfAFullDisk) {
  Open([this] {
    Line("AddressEntry").setText(QString(255, u'明'));
    {
      const FileSizeLimit full(1024);
      Press("DataNext");
      Press("Delete");
    }
    EXPECT_EQ(Text("LastNameEntry"), "Morgan");
    EXPECT_EQ(Stored("Address", 1), "NULL");
    Press("DataNext");
  });
  ASSERT_EQ(venue.Boxes.Boxes.size(), 4U);
  EXPECT_THAT(venue.Boxes.Boxes[0].Text, testing::StartsWith("Run-time error '3026': "));
  EXPECT_THAT(venue.Boxes.Boxes[2].Text, testing::StartsWith("Run-time error '3026': "));
  EXPECT_THAT(venue.Boxes.Boxes[3].Text, testing::StartsWith("The backup copies of "));
  EXPECT_EQ(Stored("length(Address)", 1), "255");
}

TEST_F(MembersWindow, SaysThatAPageOfTheFileIsDamagedAndStaysUsable) {
  for (int row = 0; row < 200; ++row) {
    Sql("INSERT INTO Members (FirstName, LastName, Address) VALUES ('a', 'b', '" + std::string(200, 'x') +
        "')");
  }
  const std::string path = venue.DataFile("members.mdb");
  const int pageSize = std::stoi(Query("PRAGMA page_size"));
  const auto size = static_cast<int>(std::filesystem::file_size(path));
  venue.Window.reset();
  {
    std::fstream file(path, std::ios::binary | std::ios::in | std::ios::out);
    file.seekp(size - pageSize);
    file << std::string(static_cast<std::size_t>(pageSize), '\xEE');
  }
  venue.MakeWindow().FormLoad();
  Open([this] {
    Press("DataLast");
    EXPECT_TRUE(window->isVisible());
    Press("DataFirst");
    EXPECT_EQ(Text("LastNameEntry"), "Morgan");
  });
  ASSERT_FALSE(venue.Boxes.Boxes.empty());
  EXPECT_THAT(venue.Boxes.Boxes[0].Text, testing::StartsWith("Run-time error '3343': "));
}

}  // namespace
