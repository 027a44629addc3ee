#include <filesystem>
#include <regex>

#include "tests/platform/libreoffice/FlatDocument.h"
#include "tests/platform/libreoffice/Writer.h"

namespace {

/// Few hits in larger letters, on the default template and on others.
class LargeHits : public Writer {
 protected:
  /// Makes a sheet of the default template with this many hits in both tables, and returns its path.
  std::string Sheet(const std::string& name, int hits, const RowSizes& sizes) {
    const auto document = Office().Add(DefaultSheetTemplate);
    std::vector<std::string> texts;
    for (int i = 1; i <= hits; ++i) {
      texts.push_back("Yellow " + std::to_string(i) + ":  240  (Wolfgang Schmidthuber)");
    }
    for (const int table : {4, 5}) {
      document->WriteCells(table, 2, 20, texts);
      document->ResizeRows(table, 2, 20, sizes);
    }
    document->SaveAs(folder / (name + ".doc"));
    document->ExportPdf(folder / (name + ".pdf"));
    document->Close();
    return folder / (name + ".doc");
  }

  static std::size_t Count(const std::string& text, const std::string& pattern) {
    const std::regex part(pattern);
    return static_cast<std::size_t>(
        std::distance(std::sregex_iterator(text.begin(), text.end(), part), std::sregex_iterator()));
  }

  std::size_t PagesOf(const std::string& name) {
    return Count(ReadFile(folder / (name + ".pdf")), "/Type\\s*/Page[^s]");
  }
};

TEST_F(LargeHits, StandInTheSameCellsOfAOnePageSheet) {
  const std::string plain = Sheet("plain", 5, {.Used = 5});
  const std::string large =
      Sheet("large", 5, {.Used = 5, .Letters = 1.8, .UsedHeight = 1.6, .RestHeight = 0.8});
  const std::string full = Sheet("full", 20, {.Used = 20, .Letters = 1.15});
  EXPECT_EQ(PagesOf("plain"), 1U);
  EXPECT_EQ(PagesOf("large"), 1U);
  EXPECT_EQ(PagesOf("full"), 1U);
  EXPECT_EQ(TextOf(large), TextOf(plain));
  Convert({plain, large}, "fodt");
  const std::string before = ReadFile(folder / "plain.fodt");
  const std::string after = ReadFile(folder / "large.fodt");
  for (const char* part : {"<table:table-row", "<table:table-cell"}) {
    EXPECT_EQ(Count(after, part), Count(before, part)) << part;
  }
  EXPECT_THAT(before, testing::Not(testing::HasSubstr("fo:font-size=\"13.5pt\"")));
  EXPECT_THAT(after, testing::HasSubstr("fo:font-size=\"13.5pt\""));
}

TEST_F(LargeHits, StayInSmallLettersInATemplateLaidOutInAnotherWay) {
  WriteFile(folder / "other.fodt", FlatDocument({.Body = FlatTable(21)}));
  const auto document = Office().Add(folder / "other.fodt");
  document->WriteCells(1, 2, 20, {"One."});
  document->SaveAs(folder / "before.doc");
  document->ResizeRows(1, 2, 20, {.Used = 1, .Letters = 1.8, .UsedHeight = 1.6, .RestHeight = 0.9});
  document->SaveAs(folder / "after.doc");
  document->Close();
  Convert({folder / "before.doc", folder / "after.doc"}, "fodt");
  const auto sizes = [this](const char* name) { return Count(ReadFile(folder / name), "fo:font-size"); };
  EXPECT_EQ(sizes("after.fodt"), sizes("before.fodt"));
}

}  // namespace
