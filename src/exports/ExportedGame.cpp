#include "exports/ExportedGame.h"

#include <algorithm>

std::string NameInGame(const ExportedGame& game, int index) {
  const auto standing = std::find_if(game.Standings.begin(), game.Standings.end(),
                                     [index](const Standing& each) { return each.Index == index; });
  return standing != game.Standings.end() ? standing->PublicName : GunName(game.Game, index);
}

FullName FullNameIn(const ExportedGame& game, int index) {
  const std::int32_t contactId = game.Game.Players(index).MemberIndex;
  return contactId != 0 && game.FullNameOf ? game.FullNameOf(contactId) : FullName();
}

std::vector<ExportedHit> HitsOf(const Game& game) {
  std::vector<ExportedHit> hits;
  for (int shooter = 1; shooter <= PlayerCount; ++shooter) {
    for (int victim = 1; victim <= PlayerCount; ++victim) {
      if (const std::int32_t damage = game.Players(victim).HitByPlayer(shooter); damage != 0) {
        hits.push_back({shooter, victim, damage});
      }
    }
  }
  return hits;
}
