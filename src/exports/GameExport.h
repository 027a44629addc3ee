#pragma once

#include <memory>
#include <string>
#include <string_view>

#include "core/text/StringTable.h"
#include "exports/ExportedGame.h"
#include "exports/GameCsv.h"
#include "exports/GameWriter.h"

enum class ExportFormat { Players, Hits, Json, Page, Figures };
inline constexpr int ExportFormatCount = 5;

/// What the operator wants to have exported.
struct ExportChoice {
  ExportFormat Format = ExportFormat::Players;
  CsvForm Csv = {};            ///< for the tables
  PersonalData Personal = {};  ///< a table of hits has none
};

/// What writes games so; `strings` must outlive it.
std::unique_ptr<GameWriter> MakeGameWriter(const ExportChoice& choice, const StringTable& strings);

/// The filter of a file dialog, with the ending of such files: "Tables |*.csv".
std::string ExportFilter(ExportFormat format, const StringTable& strings);

/// `base` with what tells the table and the ending: "2026-11-21 2015 Courier players.csv". The same in every
/// language.
std::string ExportFileName(std::string_view base, ExportFormat format);
