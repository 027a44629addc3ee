#pragma once

#include <vector>

#include "charts/ChartGame.h"

// Records of guns.
inline constexpr int Red0 = 1;
inline constexpr int Red1 = 2;
inline constexpr int Blue0 = 33;
inline constexpr int Yellow0 = 65;
inline constexpr int Red32 = 97;

/// A chart of these records, each named as its gun.
inline ChartGame ChartOf(const Game& game, const std::vector<int>& records) {
  ChartGame chart{.Game = game, .Players = {}, .Factors = {}};
  for (const int index : records) {
    chart.Players.push_back({index, game.DisplayName(index)});
  }
  return chart;
}

/// A chart of all who took part.
inline ChartGame ChartOf(const Game& game) {
  std::vector<int> records;
  for (int index = 1; index <= PlayerCount; ++index) {
    if (game.Players(index).Active) {
      records.push_back(index);
    }
  }
  return ChartOf(game, records);
}
