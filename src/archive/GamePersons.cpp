#include "archive/GamePersons.h"

#include "core/game/DallasId.h"

void GamePersons::TakeFrom(Player& player) const {
  player.MemberIndex = 0;
  if (TakesButtons) {
    player.DallasID = NoDallasId;
  }
}

bool GamePersons::TakeFrom(Game& game) const {
  bool isIn = false;
  for (Player& player : game.Players) {
    if (Include(player.MemberIndex, player.DallasID)) {
      TakeFrom(player);
      isIn = true;
    }
  }
  return isIn;
}
