#include <gtest/gtest.h>

#include <cerrno>
#include <chrono>
#include <memory>
#include <new>
#include <string>
#include <vector>

#include "core/game/CommitGame.h"
#include "platform/sqlite/SqliteDatabase.h"
#include "tests/fakes/FakeClock.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/faults/FaultLoop.h"
#include "tests/support/DatabaseContents.h"
#include "tests/support/MadeDatabase.h"
#include "tests/support/ScoredGame.h"
#include "tests/support/TestDatabase.h"

namespace {

constexpr int Members = 40;

const std::string& MembersBytes() {
  return MadeDatabase(
      "members",
      "WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < 40) "
      "INSERT INTO Members (ContactID, FirstName, LastName) SELECT i, 'First', 'Last' FROM n");
}

/// A game of forty members.
class FortyPlayers {
 public:
  FortyPlayers() {
    WriteFile(Path, MembersBytes());
    opened_ = SqliteEngine(std::chrono::milliseconds(0)).OpenDatabase(Path);
    rows_ = opened_->OpenRecordset("Members");
    lookup_ = std::make_unique<MemberLookup>(*rows_, Boxes);
    for (int index = 1; index <= Members; ++index) {
      Player& player = Game.Players(index);
      player.Active = true;
      player.MemberIndex = index;
      player.TotalDamage = 10;
      player.Soldiering = 20;
      player.Accuracy = 0.5F;
    }
  }

  CommitResult Commit(const Clock& clock) { return CommitPlayers(Game, *opened_, *rows_, *lookup_, clock); }
  CommitResult Commit() { return Commit(FakeClock()); }

  /// Games of each member, from the first one on.
  std::vector<int> Games() const {
    EXPECT_EQ(OtherConnection(Path).Query("PRAGMA integrity_check"), "ok");
    EXPECT_EQ(OtherConnection(Path).Query("SELECT count(*) FROM Members WHERE TotalDamage <> 10 * "
                                          "TotalGamesPlayed OR AverageSoldiering <> 20 * TotalGamesPlayed"),
              "0");
    std::vector<int> games;
    for (int member = 1; member <= Members; ++member) {
      games.push_back(std::stoi(OtherConnection(Path).Query(
          "SELECT TotalGamesPlayed FROM Members WHERE ContactID = " + std::to_string(member))));
    }
    return games;
  }

  /// Players whose mark and row disagree; nobody may have played twice.
  int Wrong() const {
    const std::vector<int> games = Games();
    int wrong = 0;
    for (int index = 1; index <= Members; ++index) {
      const int played = games[static_cast<std::size_t>(index) - 1];
      EXPECT_LE(played, 1) << "member " << index;
      EXPECT_TRUE(played == 0 || Game.Players(index).Committed) << "member " << index << " will count twice";
      wrong += Game.Players(index).Committed && played == 0 ? 1 : 0;
    }
    return wrong;
  }

  const TemporaryFolder Folder;
  const std::string Path = Folder / "members.mdb";
  FakeMessageBoxes Boxes;
  const StringTable Strings{Language::English};
  ::Game Game{Strings};

 private:
  std::unique_ptr<Database> opened_;
  std::unique_ptr<Recordset> rows_;
  std::unique_ptr<MemberLookup> lookup_;
};

/// One run with a fault; returns false if it ended before call `first`.
bool CommitWithFault(const FileFault& fault, int first, SystemFaults::Lasting lasting) {
  FortyPlayers venue;
  CommitResult result;
  std::string call;
  {
    const SystemFaults faults(venue.Folder.Path(), fault, first, lasting);
    result = venue.Commit();
    if (!faults.Failed()) {
      return false;
    }
    call = faults.FailedCall();
  }
  SCOPED_TRACE(fault.Name + (lasting == SystemFaults::Lasting::Once ? ", once: " : ", from then on: ") +
               call + " (call " + std::to_string(first) + ")");
  // The player at whose row the database failed stays marked, since its game is not to be tried again.
  const int lost = venue.Wrong();
  EXPECT_LE(lost, result == CommitResult::Failed ? 1 : 0);
  EXPECT_TRUE(venue.Boxes.Boxes.empty());
  const SystemFaults none(venue.Folder.Path(), fault);
  EXPECT_NE(venue.Commit(), CommitResult::Failed);
  EXPECT_EQ(venue.Wrong(), lost) << "after the next try";
  int marked = 0;
  for (const Player& player : venue.Game.Players) {
    marked += player.Committed ? 1 : 0;
  }
  EXPECT_EQ(marked, Members);
  return !testing::Test::HasFailure();
}

TEST(CommitUnderFaults, CountsNobodyTwiceAndLosesNobodyButTheOneAtWhichItFailed) {
  int failures = 0;
  for (const FileFault& fault : AllFileFaults()) {
    for (const auto lasting : {SystemFaults::Lasting::Once, SystemFaults::Lasting::FromThenOn}) {
      for (int first = 1; CommitWithFault(fault, first, lasting); ++first) {
        ++failures;
      }
    }
  }
  EXPECT_GT(failures, 50);
}

TEST(CommitUnderFaults, SucceedsWhereOnlyTheFlushOfTheFolderFails) {
  for (const int error : {EIO, EINVAL, ENOSPC}) {
    for (const auto lasting : {SystemFaults::Lasting::Once, SystemFaults::Lasting::FromThenOn}) {
      for (const int first : {1, 2}) {  // behind the making of the journal, and behind its deletion
        FortyPlayers venue;
        const SystemFaults faults(venue.Folder.Path(), {"", Only(FileCall::FlushFolder), error}, first,
                                  lasting);
        EXPECT_EQ(venue.Commit(), CommitResult::Committed);
        EXPECT_TRUE(faults.Failed());
        EXPECT_EQ(venue.Games(), std::vector<int>(Members, 1));
      }
    }
  }
}

/// A clock behind which memory runs out, as anything may that is needed for a player's figures.
class ClockWithoutMemory : public FakeClock {
 public:
  explicit ClockWithoutMemory(int calls) : left_(calls) {}

  std::string Now() const override {
    if (--left_ < 0) {
      throw std::bad_alloc();
    }
    return FakeClock::Now();
  }

 private:
  mutable int left_;
};

TEST(CommitOutOfMemory, MarksNobodyWhoseRowWasTakenBack) {
  for (const int players : {0, 1, 39}) {
    FortyPlayers venue;
    EXPECT_THROW(venue.Commit(ClockWithoutMemory(players)), std::bad_alloc);
    EXPECT_EQ(venue.Wrong(), 0);
    EXPECT_EQ(venue.Commit(), CommitResult::Committed);
    EXPECT_EQ(venue.Games(), std::vector<int>(Members, 1));
  }
}

TEST(CommitOutOfMemory, KeepsThePlayersBeforeWhenTheyAreCommittedOneByOne) {
  FortyPlayers venue;
  ExecuteSql(
      venue.Path,
      "CREATE TRIGGER Refuse BEFORE UPDATE ON Members WHEN old.ContactID = 40 BEGIN SELECT RAISE(ABORT, "
      "'no'); END");
  // All forty in the group that fails at the last one, then two by themselves.
  EXPECT_THROW(venue.Commit(ClockWithoutMemory(42)), std::bad_alloc);
  EXPECT_EQ(venue.Wrong(), 0);
  EXPECT_EQ(OtherConnection(venue.Path).Query("SELECT sum(TotalGamesPlayed) FROM Members"), "2");
}

}  // namespace
