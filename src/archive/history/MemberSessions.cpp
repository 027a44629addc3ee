#include "archive/history/MemberSessions.h"

#include <algorithm>
#include <utility>

namespace {

constexpr std::size_t MonthLength = 7;

void AddToMonth(MonthOfMember& month, const MemberGame& game) {
  month.SoldieringBest = month.Games == 0 ? game.Soldiering : std::max(month.SoldieringBest, game.Soldiering);
  ++month.Games;
  month.SoldieringSum += game.Soldiering;
  month.Damage += game.Damage;
  if (game.Accuracy.value_or(0) > 0) {
    month.AccuracySum += *game.Accuracy;
    ++month.AccuracyGames;
  }
}

/// Takes the game at `place` for the best one if its value is at least that of the best so far, which was
/// played later.
template <typename ValueOf>
void TakeIfBest(const std::vector<MemberGame>& games, std::size_t place, std::optional<std::size_t>& best,
                const ValueOf& valueOf) {
  if (!best || valueOf(games[place]) >= valueOf(games[*best])) {
    best = place;
  }
}

}  // namespace

MemberSessions SessionsFrom(std::vector<MemberGame> games) {
  MemberSessions sessions;
  sessions.Games = std::move(games);
  sessions.MeansSoFar.resize(sessions.Games.size());
  std::int64_t sum = 0;
  for (std::size_t before = 0; before < sessions.Games.size(); ++before) {
    const std::size_t place = sessions.Games.size() - 1 - before;
    sum += sessions.Games[place].Soldiering;
    sessions.MeansSoFar[place] = static_cast<double>(sum) / static_cast<double>(before + 1);
  }
  for (std::size_t place = 0; place < sessions.Games.size(); ++place) {
    const MemberGame& game = sessions.Games[place];
    const std::string month = game.Played.substr(0, MonthLength);
    if (sessions.Months.empty() || sessions.Months.back().Month != month) {
      sessions.Months.push_back({.Month = month});
    }
    AddToMonth(sessions.Months.back(), game);
    TakeIfBest(sessions.Games, place, sessions.BestSoldiering,
               [](const MemberGame& each) { return each.Soldiering; });
    TakeIfBest(sessions.Games, place, sessions.MostDamage,
               [](const MemberGame& each) { return each.Damage; });
    if (game.Accuracy) {
      TakeIfBest(sessions.Games, place, sessions.BestAccuracy,
                 [](const MemberGame& each) { return each.Accuracy.value_or(0); });
    }
  }
  return sessions;
}
