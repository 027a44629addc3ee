#include "exports/GameExport.h"

#include "exports/GameJson.h"
#include "exports/GamePage.h"

std::unique_ptr<GameWriter> MakeGameWriter(const ExportChoice& choice, const StringTable& strings) {
  switch (choice.Format) {
    case ExportFormat::Players:
      return std::make_unique<PlayersCsv>(choice.Csv, choice.Personal);
    case ExportFormat::Hits:
      return std::make_unique<HitsCsv>(choice.Csv);
    case ExportFormat::Json:
      return std::make_unique<GamesJson>(choice.Personal);
    case ExportFormat::Page:
      return std::make_unique<GamesPage>(choice.Personal, strings);
    case ExportFormat::Figures:
      return std::make_unique<FiguresCsv>(choice.Csv, choice.Personal);
  }
  return nullptr;
}

std::string ExportFilter(ExportFormat format, const StringTable& strings) {
  switch (format) {
    case ExportFormat::Players:
    case ExportFormat::Hits:
    case ExportFormat::Figures:
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
    case ExportFormat::Figures:
      return name.append(" figures.csv");
  }
  return name;
}
