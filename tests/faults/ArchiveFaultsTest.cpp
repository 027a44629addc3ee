#include <gtest/gtest.h>

#include <chrono>
#include <memory>
#include <string>

#include "archive/GameArchive.h"
#include "platform/sqlite/SqliteDatabase.h"
#include "tests/faults/FaultLoop.h"
#include "tests/support/DatabaseContents.h"
#include "tests/support/MadeDatabase.h"
#include "tests/support/RandomGame.h"

namespace {

/// On an archive with one game. The member table lies elsewhere and stays sound.
class OnArchive : public FaultyOperation {
 public:
  OnArchive() : Path(*this / "games.mdb") {
    WriteFile(Path, MadeDatabase("games", "INSERT INTO ArchiveKey VALUES (1, 'key')"));
    WriteFile(elsewhere_ / "members.mdb",
              MadeDatabase("members", "INSERT INTO Members (FirstName) VALUES ('A')"));
    SqliteEngine engine(std::chrono::milliseconds(0));
    opened_ = engine.OpenDatabase(Path);
    members_ = engine.OpenDatabase(elsewhere_ / "members.mdb");
    Archive = std::make_unique<GameArchive>(*opened_, *members_, Strings);
    FillRandomly(Game, 12, 3);
    for (Player& player : Game.Players) {
      player.MemberIndex = player.Active ? 1 : 0;
    }
    Archive->Keep(GameNow());
    ++Game.Players(FirstPlayer()).BonusPoints;
  }

  std::string State() const override { return WholeContents(Path); }
  bool Fits(const FileFault& fault, const std::string& call, const Thrown& told) const override {
    return DatabaseFaultFits(fault, call, told, Path);
  }

  GameState GameNow() const { return {.Game = Game, .Mission = "Flag", .Played = "2026-11-21 20:15:30"}; }

  const std::string Path;
  StringTable Strings{Language::English};
  ::Game Game{Strings};
  std::unique_ptr<GameArchive> Archive;

 private:
  int FirstPlayer() const {
    int index = 1;
    while (!Game.Players(index).Active) {
      ++index;
    }
    return index;
  }

  TemporaryFolder elsewhere_;
  std::unique_ptr<Database> opened_;
  std::unique_ptr<Database> members_;
};

struct GameKept : OnArchive {
  void Act() override { Archive->Keep(GameNow()); }
};

struct GameKeptAgain : OnArchive {
  void Act() override { Archive->KeepAgain(1, GameNow(), FormerState::KeptToo); }
};

TEST(FaultsOfTheArchive, LeaveAGameKeptWholeOrNotAtAll) {
  EXPECT_GT(FailAtEveryCall<GameKept>().Failures, 100);
}

TEST(FaultsOfTheArchive, LeaveTheFormerOrTheLaterStateOfAGame) {
  EXPECT_GT(FailAtEveryCall<GameKeptAgain>().Failures, 100);
}

}  // namespace
