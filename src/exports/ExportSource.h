#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "exports/ExportColumns.h"
#include "exports/ExportedGame.h"

/// Past games, as an export takes them. All operations throw RuntimeError as a database does.
class ExportSource {
 public:
  /// The most games whose figures are read at once.
  static constexpr std::size_t FiguresAtOnce = 200;

  virtual ~ExportSource() = default;

  /// The numbers of the games of these days, "YYYY-MM-DD", both included; the earliest first.
  virtual std::vector<std::int64_t> Of(const std::string& firstDay, const std::string& lastDay) = 0;

  /// Hands over one of them. Throws RuntimeError 53 if there is no such game, 6 or 321 if its file is
  /// damaged.
  virtual void Read(std::int64_t gameId, const std::function<void(const ExportedGame&)>& take) = 0;

  /// Hands over the players of at most FiguresAtOnce of them, game after game in the order of their times and
  /// numbers, each game's in the order of their places. A game that has gone has none. First and last names
  /// only with `fullNames`.
  virtual void ReadFigures(const std::vector<std::int64_t>& games, bool fullNames,
                           const std::function<void(const PlayerFigures&)>& take) = 0;
};
