#include "exports/GameCsv.h"

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

PlayersCsv::PlayersCsv(const CsvForm& form, const PersonalData& personal)
    : writer_(form.Separator, form.ByteOrderMark), personal_(personal) {
  const ExportedGame model = GameWithoutPlayers();
  AddHeaders(writer_, HeadOf(model, 0));
  AddHeaders(writer_, PlayerOf(model, {.Index = 1}, personal_));
  AddHeaders(writer_, RestOf(model));
  writer_.EndRow();
}

void PlayersCsv::Add(const ExportedGame& game) {
  const NamedValues head = HeadOf(game, ++number_);
  const NamedValues rest = RestOf(game);
  for (const Standing& standing : game.Standings) {
    AddCells(writer_, head);
    AddCells(writer_, PlayerOf(game, standing, personal_));
    AddCells(writer_, rest);
    writer_.EndRow();
  }
}

HitsCsv::HitsCsv(const CsvForm& form) : writer_(form.Separator, form.ByteOrderMark) {
  const ExportedGame model = GameWithoutPlayers();
  AddHeaders(writer_, HeadOf(model, 0));
  AddHeaders(writer_, HitOf(model, {1, 1, 0}));
  writer_.EndRow();
}

void HitsCsv::Add(const ExportedGame& game) {
  const NamedValues head = HeadOf(game, ++number_);
  for (const ExportedHit& hit : HitsOf(game.Game)) {
    AddCells(writer_, head);
    AddCells(writer_, HitOf(game, hit));
    writer_.EndRow();
  }
}

FiguresCsv::FiguresCsv(const CsvForm& form, const PersonalData& personal)
    : writer_(form.Separator, form.ByteOrderMark), personal_(personal) {
  for (const std::string_view name : FigureColumns(personal_)) {
    writer_.Text(name);
  }
  writer_.EndRow();
}

void FiguresCsv::Add(const ExportedGame& game) {
  const std::int64_t gameId = gameId_ + 1;
  for (const Standing& standing : game.Standings) {
    Add(FiguresOf(game, standing, gameId, personal_.FullNames));
  }
}

void FiguresCsv::Add(const PlayerFigures& figures) {
  if (figures.GameId != gameId_) {
    gameId_ = figures.GameId;
    ++number_;
  }
  WriteFigures(writer_, figures, number_, personal_);
  writer_.EndRow();
}
