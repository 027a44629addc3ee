#pragma once

#include <cstdint>
#include <string>

#include "exports/Csv.h"
#include "exports/ExportColumns.h"
#include "exports/GameWriter.h"

/// Separator and byte-order mark of a table.
struct CsvForm {
  CsvSeparator Separator = CsvSeparator::Comma;
  bool ByteOrderMark = true;  ///< without it, some spreadsheets take UTF-8 for an older encoding
};

/// A row of headers, then one for each player of each game, in the order of their places.
class PlayersCsv : public GameWriter {
 public:
  PlayersCsv(const CsvForm& form, const PersonalData& personal);

  void Add(const ExportedGame& game) override;
  std::string Take() override { return writer_.Take(); }

 private:
  CsvWriter writer_;
  const PersonalData personal_;
  int number_ = 0;
};

/// A row of headers, then one for each shooter and victim of each game.
class HitsCsv : public GameWriter {
 public:
  explicit HitsCsv(const CsvForm& form);

  void Add(const ExportedGame& game) override;
  std::string Take() override { return writer_.Take(); }

 private:
  CsvWriter writer_;
  int number_ = 0;
};

/// The same as PlayersCsv with the main figures alone, which are known without reading a game's file. Columns
/// that both have are the same.
class FiguresCsv : public GameWriter {
 public:
  FiguresCsv(const CsvForm& form, const PersonalData& personal);

  void Add(const ExportedGame& game) override;
  /// Writes one player's row. A game's rows follow one another; the number rises with each other `GameId`.
  void Add(const PlayerFigures& figures);
  std::string Take() override { return writer_.Take(); }

  /// How many games have rows.
  int Games() const { return number_; }

 private:
  CsvWriter writer_;
  const PersonalData personal_;
  int number_ = 0;
  std::int64_t gameId_ = 0;  ///< of the last row
};
