#include "core/game/CommitGame.h"

#include <algorithm>
#include <new>
#include <vector>

#include "core/data/FieldValue.h"
#include "core/text/NumberForms.h"
#include "platform/RuntimeError.h"

namespace {

bool IsDue(const Player& player) {
  return player.MemberIndex != 0 && !player.Committed && player.Active;
}

double Quotient(double sum, double count) {
  if (count == 0) {
    throw RuntimeError(Fault::DivisionByZero);
  }
  return sum / count;
}

/// Adds this player's game to the figures of the current row, which is in edit mode. Later figures use the
/// new values of earlier ones.
void AddFigures(Recordset& row, const Player& player, const Clock& clock) {
  const auto number = [&row](const char* column) { return NumberOf(row.Fields(column)); };
  const auto count = [&row](const char* column) {
    row.SetField(column, std::int64_t{RoundToInt32(NumberOf(row.Fields(column)) + 1)});
  };
  count("TotalGamesPlayed");
  const double games = number("TotalGamesPlayed");
  row.SetField("LastPlayedDate", clock.Now());
  row.SetField("TotalDamage", number("TotalDamage") + player.TotalDamage);
  row.SetField("AverageDamage", Round2(Quotient(number("TotalDamage"), games)));
  row.SetField("TotalSoldiering", number("TotalSoldiering") + player.Soldiering);
  row.SetField("AverageSoldiering", Round2(Quotient(number("TotalSoldiering"), games)));
  if (player.Accuracy == 0) {
    count("PriZeroAccuracyCount");
  }
  row.SetField("TotalPrimaryAccuracy", number("TotalPrimaryAccuracy") + double{player.Accuracy});
  const double accurateGames = games - number("PriZeroAccuracyCount");
  if (accurateGames != 0) {
    row.SetField("AveragePrimAccuracy", number("TotalPrimaryAccuracy") / accurateGames);
  }
  row.SetField("AverageSecAccuracy", 0.0);
}

/// The marks of players whose rows are not committed yet; taken back at the end unless they are kept.
class Marks {
 public:
  explicit Marks(Game& game) : game_(game) {}
  ~Marks() {
    for (const int index : players_) {
      game_.Players(index).Committed = false;
    }
  }
  Marks(const Marks&) = delete;
  Marks& operator=(const Marks&) = delete;

  /// The player is about to be marked.
  void Add(int index) { players_.push_back(index); }
  void Keep() { players_.clear(); }

 private:
  Game& game_;
  std::vector<int> players_;
};

class GameCommit {
 public:
  GameCommit(Game& game, Database& dbMembers, Recordset& rsMembers, MemberLookup& members, const Clock& clock)
      : game_(game), dbMembers_(dbMembers), rsMembers_(rsMembers), members_(members), clock_(clock) {}

  /// Commits all players. Throws RuntimeError at the first one that fails.
  void Run() {
    for (int index = 1; index <= PlayerCount; ++index) {
      if (!CommitTogether(index)) {
        // Nothing of the group was written. One by one, those before the faulty row are still committed.
        for (; index <= PlayerCount; ++index) {
          CommitOne(index);
        }
      } else if (index <= PlayerCount) {
        CommitOne(index);  // shows the box that the member is gone
      }
    }
  }

 private:
  /// Commits the players from `index` up to the first whose member is gone, and sets `index` to that one. The
  /// group ends there because the file must not stay locked while the box is open. Returns false if the
  /// database failed; then nothing is written or marked, and `index` is the first player of the group.
  bool CommitTogether(int& index) {
    while (index <= PlayerCount && !IsDue(game_.Players(index))) {
      ++index;
    }
    if (index > PlayerCount) {
      return true;
    }
    Marks marks(game_);  // taken back whatever ends the group, lack of memory as well
    try {
      WriteScope group(dbMembers_);
      int next = index;
      for (; next <= PlayerCount; ++next) {
        const Player& player = game_.Players(next);
        if (!IsDue(player)) {
          continue;
        }
        if (!rsMembers_.WalkTo("ContactID", std::int64_t{player.MemberIndex})) {
          break;
        }
        marks.Add(next);
        AddGame(next);
      }
      group.Commit();
      marks.Keep();
      index = next;
      return true;
    } catch (const RuntimeError&) {
      return false;
    }
  }

  void CommitOne(int index) {
    const Player& player = game_.Players(index);
    if (IsDue(player) && members_.LoadMember(player.MemberIndex) &&
        rsMembers_.WalkTo("ContactID", std::int64_t{player.MemberIndex})) {
      try {
        AddGame(index);
      } catch (const std::bad_alloc&) {
        // The database did not refuse this player, so the next commit may try again.
        game_.Players(index).Committed = false;
        throw;
      }
    }
  }

  /// Adds a player's game to the member in the cursor's current row.
  void AddGame(int index) {
    rsMembers_.Edit();
    game_.Players(index).Committed = true;
    AddFigures(rsMembers_, game_.Players(index), clock_);
    rsMembers_.Update();
  }

  Game& game_;
  Database& dbMembers_;
  Recordset& rsMembers_;
  MemberLookup& members_;
  const Clock& clock_;
};

}  // namespace

CommitResult CommitPlayers(Game& game, Database& dbMembers, Recordset& rsMembers, MemberLookup& members,
                           const Clock& clock) {
  const bool alreadyCommitted = std::any_of(game.Players.begin(), game.Players.end(),
                                            [](const Player& player) { return player.Committed; });
  try {
    GameCommit(game, dbMembers, rsMembers, members, clock).Run();
  } catch (const RuntimeError&) {
    return CommitResult::Failed;
  }
  return alreadyCommitted ? CommitResult::SomeWereAlready : CommitResult::Committed;
}

void TellCommitResult(CommitResult result, MessageBoxes& boxes) {
  switch (result) {
    case CommitResult::Committed:
      boxes.Show("Scores have been committed to the Database", "Update Success", BoxIcon::Information);
      break;
    case CommitResult::SomeWereAlready:
      boxes.Show(
          "Some Scores have already been committed to the Database. Uncommited scores are now committed.",
          "Update Success", BoxIcon::Information);
      break;
    case CommitResult::Failed:
      boxes.Show("Error occured while saving data to Database", "Database Error", BoxIcon::Exclamation,
                 BoxButtons::OkCancel);
      break;
  }
}
