#include "core/game/Game.h"

#include <utility>

#include "core/text/NumberForms.h"

void Player::Clear() {
  Player cleared;
  cleared.AbsoluteDamage = AbsoluteDamage;
  cleared.Accuracy = Accuracy;
  *this = std::move(cleared);
}

Game::Game(const StringTable& strings) {
  for (int team = 1; team <= TeamCount; ++team) {
    TeamNames(team) = strings.Text(113 + team);
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

std::string Game::DisplayName(int index) const {
  const std::uint8_t id = IdFromIndex(index);
  std::string name = TeamNames(TeamFromId(id));
  name += ' ';
  name += Str(std::int32_t{PlayerNumberFromId(id)});
  return name;
}
