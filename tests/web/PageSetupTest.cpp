#include "web/PageSetup.h"

#include <gmock/gmock.h>

#include "platform/linux/LinuxFiles.h"
#include "tests/support/TemporaryFolder.h"

namespace {

using testing::HasSubstr;
using testing::Not;

class SetupOfThePage : public testing::Test {
 protected:
  std::string File() const { return folder / "tessarine.ini"; }
  PageSetup ReadFrom(const std::string& text) {
    WriteFile(File(), text);
    return ReadPageSetup(ini);
  }

  LinuxFiles disk;
  TemporaryFolder folder;
  IniReader ini{disk, File()};
};

TEST_F(SetupOfThePage, IsOffAndWithoutNamesAtFirst) {
  EXPECT_EQ(ReadPageSetup(ini), PageSetup());
  EXPECT_FALSE(PageSetup().On);
  EXPECT_EQ(PageSetup().Names, NamesShown::OnBoard);
}

TEST_F(SetupOfThePage, ComesBackAsItWasWritten) {
  for (const NamesShown names : {NamesShown::OnBoard, NamesShown::OnBoardAndPage, NamesShown::Nowhere}) {
    const PageSetup setup{.On = true,
                          .Address = "10.0.0.5",
                          .Port = 9000,
                          .Names = names,
                          .Games = 30,
                          .WithBoard = true,
                          .Ranking = true};
    WritePageSetup(ini, ReadPageSetup(ini), setup);
    EXPECT_EQ(ReadPageSetup(ini), setup);
  }
}

TEST_F(SetupOfThePage, IsWrittenOnlyWhereItDiffers) {
  WriteFile(File(), "");
  WritePageSetup(ini, {}, {});
  EXPECT_EQ(ReadFile(File()), "");
  WritePageSetup(ini, {}, {.Port = 9000});
  EXPECT_THAT(ReadFile(File()), HasSubstr("port=9000"));
  EXPECT_THAT(ReadFile(File()), Not(HasSubstr("games")));
}

TEST_F(SetupOfThePage, HasItsDefaultsForWhatIsWrong) {
  const PageSetup setup = ReadFrom("[results]\non=yes\nport=80\ngames=x\nnames=everybody\n");
  EXPECT_EQ(setup, PageSetup());
  EXPECT_EQ(ReadFrom("[results]\nport=65536\ngames=31\n"), PageSetup());
  EXPECT_EQ(ReadFrom("[results]\nport=65535\ngames=1\n").Port, 65535);
}

}  // namespace
