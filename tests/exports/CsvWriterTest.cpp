#include <gtest/gtest.h>

#include <limits>

#include "exports/Csv.h"

namespace {

/// The line that holds `text` as its second cell, without the first cell and the line's end.
std::string Written(std::string_view text, CsvSeparator separator = CsvSeparator::Comma) {
  CsvWriter writer(separator);
  writer.Text("a");
  writer.Text(text);
  writer.EndRow();
  const std::string line = writer.Take();
  EXPECT_EQ(line.substr(0, 2), std::string("a") + static_cast<char>(separator));
  EXPECT_EQ(line.substr(line.size() - 2), "\r\n");
  return line.substr(2, line.size() - 4);
}

TEST(CsvWriter, EndsRowsWithCarriageReturnAndLineFeed) {
  CsvWriter writer;
  writer.Text("Name");
  writer.Text("Games");
  writer.EndRow();
  writer.Text("Mole");
  writer.Number(std::int64_t{12});
  writer.EndRow();
  EXPECT_EQ(writer.Take(), "Name,Games\r\nMole,12\r\n");
  EXPECT_EQ(writer.Take(), "");
}

TEST(CsvWriter, SeparatesByCommaSemicolonOrTab) {
  EXPECT_EQ(Written("b", CsvSeparator::Comma), "b");
  EXPECT_EQ(Written("b", CsvSeparator::Semicolon), "b");
  EXPECT_EQ(Written("b", CsvSeparator::Tab), "b");
}

TEST(CsvWriter, BeginsWithAByteOrderMarkWhereAsked) {
  CsvWriter writer(CsvSeparator::Semicolon, true);
  writer.Text("é");
  writer.EndRow();
  writer.Text("b");
  writer.EndRow();
  EXPECT_EQ(writer.Take(), "\xEF\xBB\xBF\xC3\xA9\r\nb\r\n");
}

TEST(CsvWriter, QuotesWhatWouldBreakTheRow) {
  EXPECT_EQ(Written("Mole"), "Mole");
  EXPECT_EQ(Written("12\" gun"), "\"12\"\" gun\"");
  EXPECT_EQ(Written("a,b"), "\"a,b\"");
  EXPECT_EQ(Written("a;b"), "\"a;b\"");
  EXPECT_EQ(Written("a\tb"), "\"a\tb\"");
  EXPECT_EQ(Written("a\nb\rc\r\nd"), "\"a\nb\rc\r\nd\"");
  EXPECT_EQ(Written(" a"), "\" a\"");
  EXPECT_EQ(Written("a "), "\"a \"");
  EXPECT_EQ(Written("a,b", CsvSeparator::Tab), "\"a,b\"");
}

TEST(CsvWriter, TellsNoValueFromAnEmptyText) {
  CsvWriter writer;
  writer.Empty();
  writer.Text("");
  writer.Empty();
  writer.EndRow();
  EXPECT_EQ(writer.Take(), ",\"\",\r\n");
}

TEST(CsvWriter, WritesARowOfOneEmptyCellAsALineWithSomethingInIt) {
  CsvWriter writer;
  writer.Empty();
  writer.EndRow();
  EXPECT_EQ(writer.Take(), "\"\"\r\n");
}

TEST(CsvWriter, PutsAnApostropheBeforeWhatASpreadsheetWouldRun) {
  for (const std::string text : {"=1+1", "+49 123", "-5", "@SUM(A1)", "＝1", "＋1", "－1", "＠A1", "−1"}) {
    EXPECT_EQ(Written(text), "'" + text);
    EXPECT_EQ(Written("\xC2\xA0" + text), "'\xC2\xA0" + text);
    EXPECT_EQ(Written("\xE3\x80\x80 " + text), "'\xE3\x80\x80 " + text);
    EXPECT_EQ(Written("  " + text), "\"'  " + text + "\"");
  }
  EXPECT_EQ(Written("\ta"), "\"'\ta\"");
  EXPECT_EQ(Written("\ra"), "\"'\ra\"");
  EXPECT_EQ(Written("\na"), "\"'\na\"");
  EXPECT_EQ(Written("=\"x\""), "\"'=\"\"x\"\"\"");
}

TEST(CsvWriter, LeavesOtherTextsWithoutAnApostrophe) {
  for (const std::string text : {"a=b", "1-2", "a@b.c", "O'Brien", "'t Hart", "'", "''", "0123", "王"}) {
    EXPECT_EQ(Written(text), text);
  }
}

TEST(CsvWriter, PutsAnApostropheBeforeWhatWouldReadAsGuarded) {
  EXPECT_EQ(Written("'=1"), "''=1");
  EXPECT_EQ(Written("''-1"), "'''-1");
}

TEST(CsvWriter, WritesNumbersAsNumbers) {
  CsvWriter writer;
  writer.Number(std::int64_t{-12});
  writer.Number(std::numeric_limits<std::int64_t>::min());
  writer.Number(-0.5);
  writer.Number(12.0);
  writer.Number(0.1);
  writer.Number(1e300);
  writer.Number(std::numeric_limits<double>::infinity());
  writer.EndRow();
  EXPECT_EQ(writer.Take(), "-12,-9223372036854775808,-0.5,12,0.1,1e+300,\r\n");
}

TEST(CsvWriter, TakesATextThatIsNotUtf8ForWindows1252) {
  EXPECT_EQ(Written("Ren\xE9"), "René");
}

}  // namespace
