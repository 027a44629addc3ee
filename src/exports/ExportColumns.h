#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

#include "exports/Csv.h"
#include "exports/ExportedGame.h"

// What exported tables and JSON hold. Both are written from these lists, so that neither holds anything that
// the other one does not.

/// A value; std::monostate for none.
using ExportValue = std::variant<std::monostate, bool, std::int64_t, double, std::string>;

/// A value with its name, which is the header of its column and its key in JSON.
struct NamedValue {
  const char* Name;
  ExportValue Value;
};

using NamedValues = std::vector<NamedValue>;

/// The game's number in the export, counted from 1, and what tells it from others. Stands in every row.
NamedValues HeadOf(const ExportedGame& game, int number);

/// Teams and objectives of the game.
NamedValues RestOf(const ExportedGame& game);

/// A player: both places, the public name, the record, and `personal` data.
NamedValues PlayerOf(const ExportedGame& game, const Standing& standing, const PersonalData& personal);

NamedValues HitOf(const ExportedGame& game, const ExportedHit& hit);

/// A player's main figures. Texts are in UTF-8 and valid as long as what they were made of.
struct PlayerFigures {
  std::int64_t GameId = 0;  ///< the same in all rows of a game, and another one in the next game's
  std::string_view Received = {};
  std::string_view GameDate = {};
  std::string_view Mission = {};
  int Place = 0;
  int Index = 0;               ///< record of the player, 1 to 224
  std::string_view Name = {};  ///< the public one
  FullName Person = {};        ///< only where the operator wants full names
  std::int64_t Member = 0;
  std::string_view Button = {};
  std::int64_t Soldiering = 0;
  std::optional<float> Accuracy = {};  ///< fraction; none where the board shows no figure
  std::int64_t Damage = 0;
  std::int64_t Shots = 0;
  std::int64_t Heals = 0;
  std::int64_t Deaths = 0;
  std::int64_t AmmoAdds = 0;
  bool Committed = false;
  std::int64_t DamageTaken = 0;
};

/// The figures of one of the game's standings, with first and last name only where they are wanted; valid as
/// long as both are.
PlayerFigures FiguresOf(const ExportedGame& game, const Standing& standing, std::int64_t gameId,
                        bool fullNames);

/// The names of the columns that WriteFigures fills.
std::vector<std::string_view> FigureColumns(const PersonalData& personal);

/// Writes the cells of a row. `number` is that of the game.
void WriteFigures(CsvWriter& writer, const PlayerFigures& figures, int number, const PersonalData& personal);
