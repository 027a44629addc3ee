#pragma once

#include <cstdint>
#include <string>
#include <variant>
#include <vector>

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
