#include "core/data/LoggedBoxes.h"

#include <gmock/gmock.h>

#include "platform/ErrorReport.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"

namespace {

using testing::ElementsAre;
using testing::HasSubstr;

class Logged : public testing::Test {
 protected:
  Logged() { files.AddFolder("/data"); }

  std::string Rows() const { return files.Read("/data/logs/program.log"); }

  FakeFiles files;
  FakeClock clock;
  FakeMessageBoxes shown;
  ProgramLog log{files, clock, "/data"};
  LoggedBoxes boxes{shown, log};
};

TEST_F(Logged, ShowsTheBoxAndPassesTheAnswerOn) {
  shown.Answers = {BoxAnswer::No, BoxAnswer::Cancel, BoxAnswer::Cancel};
  EXPECT_EQ(boxes.Show("Text 1", "Title", BoxIcon::Question, BoxButtons::YesNo), BoxAnswer::No);
  EXPECT_EQ(boxes.Show("Text 2", "Title", BoxIcon::None, BoxButtons::OkCancel), BoxAnswer::Cancel);
  EXPECT_EQ(boxes.Show("Text 3", "Title", BoxIcon::None, BoxButtons::YesNoCancel), BoxAnswer::Cancel);
  EXPECT_EQ(boxes.Show("Text 4", "Title", BoxIcon::None, BoxButtons::YesNo), BoxAnswer::Yes);
  EXPECT_EQ(boxes.Show("Text 5", "Title", BoxIcon::None), BoxAnswer::Ok);
  EXPECT_THAT(shown.Boxes,
              ElementsAre(FakeMessageBoxes::Box{"Text 1", "Title", BoxIcon::Question, BoxButtons::YesNo},
                          FakeMessageBoxes::Box{"Text 2", "Title", BoxIcon::None, BoxButtons::OkCancel},
                          FakeMessageBoxes::Box{"Text 3", "Title", BoxIcon::None, BoxButtons::YesNoCancel},
                          FakeMessageBoxes::Box{"Text 4", "Title", BoxIcon::None, BoxButtons::YesNo},
                          FakeMessageBoxes::Box{"Text 5", "Title", BoxIcon::None, BoxButtons::Ok}));
  EXPECT_THAT(Rows(), testing::ContainsRegex("Title: Text 1\n.*answer   No\n.*Text 2\n.*answer   Cancel\n.*"
                                             "Text 3\n.*answer   Cancel\n.*Text 4\n.*answer   Yes\n.*"
                                             "Text 5\n.*answer   OK\n$"));
}

TEST_F(Logged, AreLoggedBeforeTheyAreAnswered) {
  std::string rowsMeanwhile;
  shown.WhileOpen = [&](const FakeMessageBoxes::Box&) { rowsMeanwhile = Rows(); };
  boxes.Show("Text", "Title", BoxIcon::None);
  EXPECT_THAT(rowsMeanwhile, testing::EndsWith("box      Title: Text\n"));
}

TEST_F(Logged, TellErrorReportsAsFaults) {
  log.Command("mnuSaveScores");
  ReportErrors(boxes, [] { throw RuntimeError(6); });
  EXPECT_THAT(Rows(), HasSubstr("fault    Run-time error '6': Overflow (latest command mnuSaveScores)\n"));
  EXPECT_THAT(Rows(), testing::Not(HasSubstr("box ")));
  boxes.Show("Checksum failed", "Title", BoxIcon::Critical);
  EXPECT_THAT(Rows(), HasSubstr("box      Title: Checksum failed\n"));
}

}  // namespace
