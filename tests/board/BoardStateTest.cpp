#include "board/BoardState.h"

#include <gmock/gmock.h>

#include "platform/Fault.h"
#include "tests/fakes/FakeFiles.h"

namespace {

using testing::DoubleNear;
using testing::ElementsAre;
using testing::IsEmpty;

constexpr const char* Path = "/data/state.ini";

class State : public testing::Test {
 protected:
  State() { files.AddFolder("/data"); }

  FakeFiles files;
  IniReader ini{files, Path};
  BoardState board{ini};
};

TEST_F(State, IsTheUsualOneAtFirst) {
  EXPECT_EQ(board.Letters(), 100);
  EXPECT_THAT(board.ColumnShares("ScoreDisplay"), IsEmpty());
  EXPECT_THAT(files.Contents(), IsEmpty());
}

TEST_F(State, IsRemembered) {
  board.SetLetters(120);
  board.SetColumnShares("ScoreDisplay", {0.25, 0.75});
  board.SetColumnShares("TeamScores", {0.5, 0.5});
  const BoardState nextRun(ini);
  EXPECT_EQ(nextRun.Letters(), 120);
  EXPECT_THAT(nextRun.ColumnShares("ScoreDisplay"),
              ElementsAre(DoubleNear(0.25, 1e-4), DoubleNear(0.75, 1e-4)));
  EXPECT_EQ(files.Read(Path),
            "[board]\nletters=120\nScoreDisplay_columns=2500,7500\nTeamScores_columns=5000,5000\n");
  board.SetColumnShares("ScoreDisplay", {});
  EXPECT_THAT(nextRun.ColumnShares("ScoreDisplay"), IsEmpty());
}

TEST_F(State, IsTheUsualOneWhereTheFileSaysNonsense) {
  for (const char* letters : {"", "x", "-5", "0", "29", "301", "1e9"}) {
    files.Put(Path, std::string("[board]\nletters=") + letters + "\n");
    EXPECT_EQ(board.Letters(), 100) << letters;
  }
  files.Put(Path, "[board]\nScoreDisplay_columns=x,,5\n");
  EXPECT_THAT(board.ColumnShares("ScoreDisplay"), ElementsAre(0, 0, 0.0005));  // which no list takes
}

TEST_F(State, SaysNothingWhereItCannotBeWritten) {
  files.FailReplace(Path, RuntimeError(Fault::PathAccess));
  board.SetLetters(120);
  EXPECT_EQ(board.Letters(), 100);
}

}  // namespace
