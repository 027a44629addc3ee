#include <gtest/gtest.h>

#include "exports/Csv.h"

namespace {

/// All rows, each cell in brackets, one without a value as "[-]"; "!" where the table cannot be read further.
std::string AllOf(CsvReader& reader) {
  std::string rows;
  while (reader.Next()) {
    for (const CsvCell& cell : reader.Row()) {
      rows += cell.IsNull() ? "[-]" : "[" + std::string(cell.Text) + "]";
    }
    rows += "|";
  }
  return rows + (reader.Fault() ? "!" : "");
}

std::string Read(std::string_view text) {
  CsvReader reader(text);
  return AllOf(reader);
}

/// What stops the reading of `text`, and its line.
std::pair<std::optional<CsvFault>, std::size_t> FaultOf(std::string_view text, CsvLimits limits = {}) {
  CsvReader reader(text, limits);
  while (reader.Next()) {
  }
  return {reader.Fault(), reader.Line()};
}

TEST(CsvReader, ReadsRowsWithAnyLineEnd) {
  EXPECT_EQ(Read("a,b\r\nc,d\r\n"), "[a][b]|[c][d]|");
  EXPECT_EQ(Read("a,b\nc,d"), "[a][b]|[c][d]|");
  EXPECT_EQ(Read("a,b\rc,d\r"), "[a][b]|[c][d]|");
  EXPECT_EQ(Read(""), "");
}

TEST(CsvReader, PassesOverLinesWithoutText) {
  EXPECT_EQ(Read("\r\na,b\r\n\r\n\nc,d\n\n"), "[a][b]|[c][d]|");
  EXPECT_EQ(Read("\"\"\r\n"), "[]|");
}

TEST(CsvReader, TellsNoValueFromAnEmptyText) {
  EXPECT_EQ(Read(",\"\",\r\n"), "[-][][-]|");
}

TEST(CsvReader, TakesQuotesOffAndJoinsDoubledOnes) {
  EXPECT_EQ(Read("\"a,b\",\"say \"\"hi\"\"\",\"\"\"\"\n"), "[a,b][say \"hi\"][\"]|");
  EXPECT_EQ(Read("\"a\r\nb\nc\",d"), "[a\r\nb\nc][d]|");
}

TEST(CsvReader, LeavesAQuoteWithinAPlainCell) {
  EXPECT_EQ(Read("12\" gun, \"b\"\n"), "[12\" gun][ \"b\"]|");
}

TEST(CsvReader, FindsTheSeparator) {
  for (const char separator : {',', ';', '\t'}) {
    const std::string by(1, separator);
    const std::string table = "First" + by + "Last" + by + "Note\nA" + by + "B" + by + "\"x,y;z\tw\"\n";
    CsvReader reader(table);
    EXPECT_EQ(static_cast<char>(reader.Separator()), separator);
    EXPECT_EQ(AllOf(reader), "[First][Last][Note]|[A][B][x,y;z\tw]|");
  }
}

TEST(CsvReader, FindsTheSeparatorByTheRowsThatAgree) {
  EXPECT_EQ(Read("Name;Place\nMorgan, Rhys;Cardiff\nBelmont, Alice;Bath\n"),
            "[Name][Place]|[Morgan, Rhys][Cardiff]|[Belmont, Alice][Bath]|");
  EXPECT_EQ(Read("a;b,c;d\n1;2;3\n4;5;6\n"), "[a][b,c][d]|[1][2][3]|[4][5][6]|");
}

TEST(CsvReader, TakesTheCommaForATableOfOneColumn) {
  EXPECT_EQ(Read("Name\nMole\n"), "[Name]|[Mole]|");
}

TEST(CsvReader, TakesASeparatorThatTheFirstLineTells) {
  CsvReader reader("sep=;\r\na,b;c\r\n");
  EXPECT_EQ(AllOf(reader), "[a,b][c]|");
  CsvReader told("sep=;\r\na,b;c\r\n", CsvSeparator::Comma);
  EXPECT_EQ(AllOf(told), "[a][b;c]|");
}

TEST(CsvReader, PassesOverAByteOrderMark) {
  EXPECT_EQ(Read("\xEF\xBB\xBFName,Place\n"), "[Name][Place]|");
  EXPECT_EQ(Read("\xEF\xBB\xBF\"Name\",Place\n"), "[Name][Place]|");
}

TEST(CsvReader, TakesATextThatIsNotUtf8ForWindows1252) {
  EXPECT_EQ(Read("Ren\xE9,\x80\n"), "[René][€]|");
}

TEST(CsvReader, TakesTheApostropheOfAFormulaOff) {
  EXPECT_EQ(Read("'=1,'+49,\"'-1\",'@a,\"'\ta\",' =1\n"), "[=1][+49][-1][@a][\ta][ =1]|");
  EXPECT_EQ(Read("''=1,'''=1\n"), "['=1][''=1]|");
}

TEST(CsvReader, LeavesAnyOtherApostrophe) {
  EXPECT_EQ(Read("'t Hart,',\"''\",O'Brien\n"), "['t Hart]['][''][O'Brien]|");
}

TEST(CsvReader, TellsTheLineInWhichARowBegins) {
  CsvReader reader("a,b\r\n\r\n\"c\r\nd\re\nf\",g\nh,i\n");
  ASSERT_TRUE(reader.Next());
  EXPECT_EQ(reader.Line(), 1U);
  ASSERT_TRUE(reader.Next());
  EXPECT_EQ(reader.Line(), 3U);
  ASSERT_TRUE(reader.Next());
  EXPECT_EQ(reader.Line(), 7U);
  CsvReader told("sep=,\na,b\n");
  ASSERT_TRUE(told.Next());
  EXPECT_EQ(told.Line(), 2U);
}

TEST(CsvReader, TellsHowFarItIs) {
  CsvReader reader("a,b\nc,d\n");
  EXPECT_EQ(reader.Size(), 8U);
  ASSERT_TRUE(reader.Next());
  EXPECT_EQ(reader.Position(), 4U);
  ASSERT_TRUE(reader.Next());
  EXPECT_EQ(reader.Position(), 8U);
}

TEST(CsvReader, StopsAtAQuoteThatIsNotClosed) {
  EXPECT_EQ(FaultOf("a,b\nc,\"d\ne,f\n"), std::pair(std::optional(CsvFault::UnclosedQuote), std::size_t{2}));
  EXPECT_EQ(Read("a,b\nc,\"d\ne,f\n"), "[a][b]|!");
  EXPECT_EQ(Read("a,\""), "!");
}

TEST(CsvReader, StopsAtTextBehindAClosingQuote) {
  EXPECT_EQ(FaultOf("a,b\n\"c\nd\"e,f\n"),
            std::pair(std::optional(CsvFault::TextBehindQuote), std::size_t{3}));
}

TEST(CsvReader, StaysAtItsFault) {
  CsvReader reader("\"a\"b\nc\n");
  EXPECT_FALSE(reader.Next());
  EXPECT_FALSE(reader.Next());
  EXPECT_EQ(reader.Fault(), CsvFault::TextBehindQuote);
}

TEST(CsvReader, HoldsItsLimits) {
  const CsvLimits limits{.CellBytes = 5, .RowBytes = 12, .Cells = 4};
  EXPECT_EQ(FaultOf("12345,12345\n1,2,3,4\n", limits).first, std::nullopt);
  EXPECT_EQ(FaultOf("a\n123456\n", limits), std::pair(std::optional(CsvFault::CellTooLong), std::size_t{2}));
  EXPECT_EQ(FaultOf("a\n\"1\n\"\"\"\"\"\"\"\"6\"\n", limits),
            std::pair(std::optional(CsvFault::CellTooLong), std::size_t{2}));
  EXPECT_EQ(FaultOf("12345,12345,1\n", limits),
            std::pair(std::optional(CsvFault::RowTooLong), std::size_t{1}));
  EXPECT_EQ(FaultOf("1,2,3,4,5\n", limits), std::pair(std::optional(CsvFault::TooManyCells), std::size_t{1}));
}

TEST(CsvReader, RefusesUtf16) {
  using namespace std::string_view_literals;
  EXPECT_EQ(FaultOf("\xFF\xFE"
                    "a\0,\0"sv)
                .first,
            CsvFault::OtherEncoding);
  EXPECT_EQ(FaultOf("\xFE\xFF\0a\0,"sv).first, CsvFault::OtherEncoding);
}

}  // namespace
