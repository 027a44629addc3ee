#include "exports/GameCsv.h"

#include "exports/ExportColumns.h"

namespace {

void WriteCell(CsvWriter& writer, const ExportValue& value) {
  if (const auto* text = std::get_if<std::string>(&value)) {
    writer.Text(*text);
  } else if (const auto* whole = std::get_if<std::int64_t>(&value)) {
    writer.Number(*whole);
  } else if (const auto* fraction = std::get_if<double>(&value)) {
    writer.Number(*fraction);
  } else if (const auto* flag = std::get_if<bool>(&value)) {
    writer.Text(*flag ? "true" : "false");
  } else {
    writer.Empty();
  }
}

void AddHeaders(CsvWriter& writer, const NamedValues& values) {
  for (const NamedValue& each : values) {
    writer.Text(each.Name);
  }
}

void AddCells(CsvWriter& writer, const NamedValues& values) {
  for (const NamedValue& each : values) {
    WriteCell(writer, each.Value);
  }
}

/// Only its headers are used: they stand in a table without rows too.
ExportedGame GameWithoutPlayers() {
  static const Game empty{StringTable(Language::English)};
  return {.Game = empty, .Received = {}, .Mission = {}, .Standings = {}};
}

}  // namespace

std::string PlayersCsv(const ExportedGames& games, const CsvForm& form, const PersonalData& personal) {
  CsvWriter writer(form.Separator, form.ByteOrderMark);
  const ExportedGame model = GameWithoutPlayers();
  AddHeaders(writer, HeadOf(model, 0));
  AddHeaders(writer, PlayerOf(model, {.Index = 1}, personal));
  AddHeaders(writer, RestOf(model));
  writer.EndRow();
  int number = 0;
  games([&](const ExportedGame& game) {
    const NamedValues head = HeadOf(game, ++number);
    const NamedValues rest = RestOf(game);
    for (const Standing& standing : game.Standings) {
      AddCells(writer, head);
      AddCells(writer, PlayerOf(game, standing, personal));
      AddCells(writer, rest);
      writer.EndRow();
    }
  });
  return writer.Take();
}

std::string HitsCsv(const ExportedGames& games, const CsvForm& form) {
  CsvWriter writer(form.Separator, form.ByteOrderMark);
  const ExportedGame model = GameWithoutPlayers();
  AddHeaders(writer, HeadOf(model, 0));
  AddHeaders(writer, HitOf(model, {1, 1, 0}));
  writer.EndRow();
  int number = 0;
  games([&](const ExportedGame& game) {
    const NamedValues head = HeadOf(game, ++number);
    for (const ExportedHit& hit : HitsOf(game.Game)) {
      AddCells(writer, head);
      AddCells(writer, HitOf(game, hit));
      writer.EndRow();
    }
  });
  return writer.Take();
}
