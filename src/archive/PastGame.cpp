#include "archive/PastGame.h"

#include "platform/RuntimeError.h"

namespace {

void AddInto(std::int32_t& sum, std::int32_t amount) {
  if (__builtin_add_overflow(sum, amount, &sum)) {
    throw RuntimeError(Fault::Overflow);
  }
}

}  // namespace

void CompleteScores(Game& game) {
  for (Player& player : game.Players) {
    player.AbsoluteDamage = 0;
  }
  for (std::int32_t& total : game.TeamTotals) {
    total = 0;
  }
  for (int index = 1; index <= PlayerCount; ++index) {
    const Player& player = game.Players(index);
    for (int shooter = 1; shooter <= PlayerCount; ++shooter) {
      AddInto(game.Players(shooter).AbsoluteDamage, player.HitByPlayer(shooter));
    }
    if (player.Active) {
      AddInto(game.TeamTotals(TeamFromId(IdFromIndex(index))), player.Soldiering);
    }
  }
}
