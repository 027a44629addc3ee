#include "exports/GameExport.h"

#include "exports/GameJson.h"
#include "exports/GamePage.h"

std::string ExportBytes(const ExportedGames& games, const ExportChoice& choice, const StringTable& strings) {
  switch (choice.Format) {
    case ExportFormat::Players:
      return PlayersCsv(games, choice.Csv, choice.Personal);
    case ExportFormat::Hits:
      return HitsCsv(games, choice.Csv);
    case ExportFormat::Json:
      return GamesJson(games, choice.Personal);
    case ExportFormat::Page:
      return GamesPage(games, choice.Personal, strings);
  }
  return {};
}

std::string ExportFilter(ExportFormat format, const StringTable& strings) {
  switch (format) {
    case ExportFormat::Players:
    case ExportFormat::Hits:
      return strings.Text(OwnText::GameExportCsvFiles) + " (*.csv)|*.csv";
    case ExportFormat::Json:
      return strings.Text(OwnText::GameExportJsonFiles) + " (*.json)|*.json";
    case ExportFormat::Page:
      return strings.Text(OwnText::GameExportHtmlFiles) + " (*.html)|*.html";
  }
  return {};
}

std::string ExportFileName(std::string_view base, ExportFormat format) {
  std::string name(base);
  switch (format) {
    case ExportFormat::Players:
      return name.append(" players.csv");
    case ExportFormat::Hits:
      return name.append(" hits.csv");
    case ExportFormat::Json:
      return name.append(".json");
    case ExportFormat::Page:
      return name.append(".html");
  }
  return name;
}
