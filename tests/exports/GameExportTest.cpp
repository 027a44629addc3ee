#include "exports/GameExport.h"

#include <gmock/gmock.h>

#include "exports/GameJson.h"
#include "exports/GamePage.h"
#include "tests/exports/SampleGame.h"

namespace {

TEST(ExportOfGames, IsInTheChosenFormat) {
  const SampleGame sample;
  const auto exported = [&sample](ExportFormat format) {
    const ExportChoice choice{
        .Format = format, .Csv = {CsvSeparator::Tab, false}, .Personal = EverythingPersonal};
    return ExportBytes(sample.Games(), choice, sample.Strings);
  };
  const CsvForm tabs{CsvSeparator::Tab, false};
  EXPECT_EQ(exported(ExportFormat::Players), PlayersTable(sample.Games(), tabs, EverythingPersonal));
  EXPECT_EQ(exported(ExportFormat::Hits), HitsTable(sample.Games(), tabs));
  EXPECT_EQ(exported(ExportFormat::Json), JsonText(sample.Games(), EverythingPersonal));
  EXPECT_EQ(exported(ExportFormat::Page), PageText(sample.Games(), EverythingPersonal, sample.Strings));
  EXPECT_TRUE(
      exported(ExportFormat::Figures).starts_with("game\treceived\tgame_date\tmission\tplace\tplayer\t"));
}

TEST(ExportOfGames, SuggestsANameForEachFormat) {
  EXPECT_EQ(ExportFileName("2026-11-21 2015 Courier", ExportFormat::Players),
            "2026-11-21 2015 Courier players.csv");
  EXPECT_EQ(ExportFileName("2026-11-21 2015 Courier", ExportFormat::Hits),
            "2026-11-21 2015 Courier hits.csv");
  EXPECT_EQ(ExportFileName("2026-11-21 2015 Courier", ExportFormat::Json), "2026-11-21 2015 Courier.json");
  EXPECT_EQ(ExportFileName("2026-11-21 2015 Courier", ExportFormat::Page), "2026-11-21 2015 Courier.html");
  EXPECT_EQ(ExportFileName("2026-11-21 2015 Courier", ExportFormat::Figures),
            "2026-11-21 2015 Courier figures.csv");
}

TEST(ExportOfGames, LetsTheDialogAddTheEnding) {
  const StringTable english(Language::English);
  EXPECT_EQ(ExportFilter(ExportFormat::Players, english), "CSV files (*.csv)|*.csv");
  EXPECT_EQ(ExportFilter(ExportFormat::Hits, english), "CSV files (*.csv)|*.csv");
  EXPECT_EQ(ExportFilter(ExportFormat::Figures, english), "CSV files (*.csv)|*.csv");
  EXPECT_EQ(ExportFilter(ExportFormat::Json, english), "JSON files (*.json)|*.json");
  EXPECT_EQ(ExportFilter(ExportFormat::Page, english), "Web pages (*.html)|*.html");
  const StringTable chinese(Language::SimplifiedChinese);
  EXPECT_EQ(ExportFilter(ExportFormat::Page, chinese), "网页 (*.html)|*.html");
}

}  // namespace
