#include "core/game/Game.h"

#include <utility>

void Player::Clear() {
  Player cleared;
  cleared.AbsoluteDamage = AbsoluteDamage;
  cleared.Accuracy = Accuracy;
  *this = std::move(cleared);
}

Game::Game(const StringTable& strings) {
  for (std::int16_t team = 1; team <= TeamCount; ++team) {
    TeamNames(team) = TeamNameFromNumber(strings, team);
    ObjectiveTeams(team).Name = TeamNames(team);
  }
}

void Game::Clear() {
  for (Player& player : Players) {
    player.Clear();
  }
  GameDate.clear();
  DataPresent = false;
}
