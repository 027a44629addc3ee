#pragma once

#include <string>

#include "exports/Csv.h"
#include "exports/ExportedGame.h"

/// Separator and byte-order mark of a table.
struct CsvForm {
  CsvSeparator Separator = CsvSeparator::Comma;
  bool ByteOrderMark = true;  ///< without it, some spreadsheets take UTF-8 for an older encoding
};

/// A row of headers, then one for each player of each game, in the order of their places.
std::string PlayersCsv(const ExportedGames& games, const CsvForm& form, const PersonalData& personal);

/// A row of headers, then one for each shooter and victim of each game.
std::string HitsCsv(const ExportedGames& games, const CsvForm& form);
