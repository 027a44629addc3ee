#include "sim/game/Evening.h"

#include <array>
#include <cstddef>

#include "sim/game/GameMaker.h"

namespace sim {
namespace {

using ButtonId = std::array<std::uint8_t, 8>;

// Far apart, so that the evenings of neighbouring seeds have no game in common.
std::uint32_t SeedOf(std::uint32_t first, int number) {
  constexpr std::uint32_t distance = 0x9E3779B9;
  return first + static_cast<std::uint32_t>(number - 1) * distance;
}

std::vector<ButtonId> ButtonsIn(const std::vector<GunScores>& game) {
  std::vector<ButtonId> buttons;
  for (const GunScores& scores : game) {
    if (scores.ButtonId != ButtonId{}) {
      buttons.push_back(scores.ButtonId);
    }
  }
  return buttons;
}

}  // namespace

int Evening::NumberAt(std::chrono::microseconds elapsed) const {
  return every_.count() > 0 ? 1 + static_cast<int>(elapsed / every_) : 1;
}

std::vector<GunScores> Evening::Game(int number) const {
  std::vector<GunScores> first = MakeGame(players_, seed_);
  if (number == 1) {
    return first;
  }
  // The guns of a game report in no order, so whoever comes first is anybody.
  std::vector<GunScores> game = MakeGame(players_, SeedOf(seed_, number));
  const std::vector<ButtonId> buttons = ButtonsIn(first);
  for (std::size_t gun = 0; gun < game.size(); ++gun) {
    game[gun].ButtonId = gun < buttons.size() ? buttons[gun] : ButtonId{};
  }
  return game;
}

}  // namespace sim
