#pragma once

#include <string>

#include "core/game/Game.h"
#include "tests/support/RandomGame.h"
#include "web/PublicGame.h"

/// Made games for the tests of pages.
inline constexpr int Red0 = 1;
inline constexpr int Blue7 = 40;
inline constexpr int Yellow3 = 68;

/// Three players, Blue 7 before Red 0 before Yellow 3; Blue 7 is called Mole.
inline PublicGame SmallGame(int number = 1) {
  PublicGame game{.Number = number, .Time = "20:15"};
  game.Players.push_back({.Place = 1,
                          .Gun = Blue7,
                          .Name = "Mole",
                          .Soldiering = 120,
                          .Accuracy = 0.456F,
                          .DamageDealt = 300,
                          .DamageTaken = 50,
                          .Shots = 77,
                          .Wia = 2,
                          .Kia = 1,
                          .AmmoAdds = 4,
                          .HitsGiven = {{.Gun = Red0, .Amount = 200}, {.Gun = Yellow3, .Amount = 100}},
                          .HitsTaken = {{.Gun = Red0, .Amount = 50}}});
  game.Players.push_back({.Place = 2, .Gun = Red0, .Soldiering = 30});
  game.Players.push_back({.Place = 3, .Gun = Yellow3, .Soldiering = -5});
  game.TeamTotals = {30, 120, -5};
  return game;
}

/// A game of that many players, each of whom hit every other, with names of 30 letters.
inline PublicGame FullGameOf(int players, int number = 1) {
  PublicGame game{.Number = number, .Time = "20:15"};
  for (int gun = 1; gun <= players; ++gun) {
    PublicPlayer player{.Place = gun,
                        .Gun = gun,
                        .Name = std::string(27, 'x') + std::to_string(100 + gun),
                        .Soldiering = 12345 - gun,
                        .Accuracy = 0.5F,
                        .DamageDealt = 10000 + gun,
                        .DamageTaken = 20000 + number,
                        .Shots = 1000,
                        .Wia = 10,
                        .Kia = 10,
                        .AmmoAdds = 10};
    for (int other = 1; other <= players; ++other) {
      player.HitsGiven.push_back({.Gun = other, .Amount = 1000 + other});
      player.HitsTaken.push_back({.Gun = other, .Amount = 1000 + other});
    }
    game.Players.push_back(player);
  }
  return game;
}
