#include "exports/ExportRun.h"

#include <gmock/gmock.h>

#include <nlohmann/json.hpp>
#include <numeric>

#include "tests/exports/CsvRows.h"
#include "tests/exports/FakeExportSource.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/support/Thrown.h"

namespace {

using testing::ElementsAre;

class PastExport : public testing::Test {
 protected:
  PastExport() {
    disk.AddFolder("/home");
    disk.Put("/home/a", "before");
    past.Games.resize(450);
    std::iota(past.Games.begin(), past.Games.end(), 1);
  }

  ExportOutcome Run(
      ExportFormat format, const ExportStep& goOn = [](double) { return true; }) {
    const auto file = disk.BeginReplace("/home/a", FileReaders::AsBefore);
    return ExportPastGames(past, past.Games, {.Format = format, .Csv = {CsvSeparator::Comma, false}}, strings,
                           *file, goOn);
  }
  const std::string& Bytes() const { return disk.Contents().at("/home/a"); }

  StringTable strings{Language::English};
  FakeExportSource past;
  FakeFiles disk;
};

TEST_F(PastExport, WritesAllGamesInTheirOrder) {
  for (const ExportFormat format : {ExportFormat::Players, ExportFormat::Figures, ExportFormat::Hits}) {
    const ExportOutcome outcome = Run(format);
    EXPECT_TRUE(outcome.Complete);
    EXPECT_EQ(outcome.Written, 450U);
    EXPECT_EQ(outcome.LeftOut, 0U);
    const auto rows = CsvRecords(Bytes());
    ASSERT_EQ(rows.size(), 450U * (format == ExportFormat::Hits ? 4 : 3));
    EXPECT_EQ(rows.front().at("game"), "1");
    EXPECT_EQ(rows.front().at("mission"), "Game 1");
    EXPECT_EQ(rows.back().at("game"), "450");
    EXPECT_EQ(rows.back().at("mission"), "Game 450");
  }
}

TEST_F(PastExport, WritesOneDocumentOfJsonAndOnePage) {
  Run(ExportFormat::Json);
  const auto document = nlohmann::json::parse(Bytes());
  ASSERT_EQ(document.at("games").size(), 450U);
  EXPECT_EQ(document["games"][449]["mission"], "Game 450");
  Run(ExportFormat::Page);
  EXPECT_THAT(Bytes(), testing::StartsWith("<!DOCTYPE html>"));
  EXPECT_THAT(Bytes(), testing::EndsWith("</html>\n"));
  EXPECT_THAT(Bytes(), testing::HasSubstr("Game 450"));
}

TEST_F(PastExport, LeavesOutGamesThatCannotBeRead) {
  past.Games = {3, 4, 5};
  past.Damaged = {4};
  const ExportOutcome outcome = Run(ExportFormat::Players);
  EXPECT_TRUE(outcome.Complete);
  EXPECT_EQ(outcome.Written, 2U);
  EXPECT_EQ(outcome.LeftOut, 1U);
  const auto rows = CsvRecords(Bytes());
  EXPECT_EQ(rows.back().at("game"), "2");
  EXPECT_EQ(rows.back().at("mission"), "Game 5");
}

TEST_F(PastExport, LeavesTheOldFileWhenItIsStopped) {
  for (const ExportFormat format : {ExportFormat::Players, ExportFormat::Figures}) {
    std::vector<double> parts;
    const ExportOutcome outcome = Run(format, [&parts](double part) {
      parts.push_back(part);
      return part < 0.4;
    });
    EXPECT_FALSE(outcome.Complete);
    EXPECT_EQ(Bytes(), "before");
    EXPECT_TRUE(std::is_sorted(parts.begin(), parts.end()));
    EXPECT_LE(parts.back(), 0.5);
  }
}

TEST_F(PastExport, LeavesTheOldFileWhenTheArchiveFails) {
  past.Failure = RuntimeError(Fault::DatabaseLocked);
  for (const ExportFormat format : {ExportFormat::Players, ExportFormat::Figures}) {
    EXPECT_EQ(ThrownBy([&] { Run(format); }).Number, 3050);
    EXPECT_EQ(Bytes(), "before");
  }
}

TEST_F(PastExport, HoldsOneGameAtATime) {
  /// Pieces in which the file is written.
  class Pieces : public NewFile {
   public:
    std::vector<std::size_t> Sizes;
    bool Finished = false;
    void Write(std::string_view bytes) override { Sizes.push_back(bytes.size()); }
    void Finish() override { Finished = true; }
  };
  for (const ExportFormat format : {ExportFormat::Players, ExportFormat::Json, ExportFormat::Figures}) {
    Pieces pieces;
    ExportPastGames(past, past.Games, {.Format = format}, strings, pieces, [](double) { return true; });
    EXPECT_GE(pieces.Sizes.size(), 3U);
    EXPECT_LT(*std::max_element(pieces.Sizes.begin(), pieces.Sizes.end()), 100'000U);
    EXPECT_TRUE(pieces.Finished);
  }
}

}  // namespace
