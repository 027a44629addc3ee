#include "archive/history/LifetimeSums.h"

#include <cmath>

#include "core/data/FieldValue.h"
#include "core/text/Filled.h"
#include "core/text/NumberForms.h"

namespace {

std::string CountText(std::int64_t count) {
  return std::to_string(count);
}

/// One of the texts that tell a number of games and their soldiering.
std::string SumsText(const StringTable& strings, OwnText text, const GameSums& sums) {
  return Filled(strings.Text(text), {CountText(sums.Games), PlainDecimal(sums.Soldiering)});
}

/// What the committed games that are kept or were deleted leave unexplained.
void TellRest(const LifetimeSums& sums, const StringTable& strings, std::vector<std::string>& texts) {
  const std::int64_t games = sums.Lifetime->Games - sums.Committed.Games - sums.DeletedCommitted.Games;
  const double points =
      sums.Lifetime->Soldiering - sums.Committed.Soldiering - sums.DeletedCommitted.Soldiering;
  constexpr double leastDifference = 0.5;
  if (games > 0) {
    texts.push_back(Filled(strings.Text(OwnText::LifetimeNotKept), {CountText(games)}));
  } else if (games < 0) {
    texts.push_back(Filled(strings.Text(OwnText::LifetimeMoreKept), {CountText(-games)}));
  } else if (std::abs(points) >= leastDifference) {
    texts.push_back(Filled(strings.Text(OwnText::LifetimePointsDiffer), {PlainDecimal(points)}));
  }
}

}  // namespace

LifetimeSums ReadLifetimeSums(const std::vector<MemberGame>& games, std::int32_t member, Sql& archive,
                              Sql& members) {
  LifetimeSums sums;
  for (const MemberGame& game : games) {
    GameSums& of = game.Committed ? sums.Committed : sums.Uncommitted;
    ++of.Games;
    of.Soldiering += static_cast<double>(game.Soldiering);
  }
  archive.Query(
      "SELECT count(*), sum(p.Soldiering) FROM GamePlayers p JOIN Games g ON g.GameID = p.GameID "
      "WHERE p.MemberID = $1 AND p.Committed <> 0 AND g.Deleted IS NOT NULL",
      {std::int64_t{member}}, [&sums](const SqlRow& row) {
        sums.DeletedCommitted = {row.Integer(0), row.Real(1)};
      });
  members.Query("SELECT TotalGamesPlayed, TotalSoldiering FROM Members WHERE ContactID = $1",
                {std::int64_t{member}}, [&sums](const SqlRow& row) {
                  sums.Lifetime = {static_cast<std::int64_t>(NumberOf(row[0])), NumberOf(row[1])};
                });
  return sums;
}

std::vector<std::string> LifetimeTexts(const LifetimeSums& sums, const StringTable& strings) {
  if (!sums.Lifetime) {
    return {strings.Text(OwnText::LifetimeNone)};
  }
  std::vector<std::string> texts{SumsText(strings, OwnText::LifetimeFigures, *sums.Lifetime),
                                 SumsText(strings, OwnText::LifetimeKept, sums.Committed)};
  if (sums.Uncommitted.Games > 0) {
    texts.push_back(SumsText(strings, OwnText::LifetimeUncommitted, sums.Uncommitted));
  }
  if (sums.DeletedCommitted.Games > 0) {
    texts.push_back(SumsText(strings, OwnText::LifetimeDeleted, sums.DeletedCommitted));
  }
  TellRest(sums, strings, texts);
  if (texts.size() == 2) {
    texts.push_back(strings.Text(OwnText::LifetimeAgrees));
  }
  return texts;
}
