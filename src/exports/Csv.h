#pragma once

#include <cstddef>
#include <cstdint>
#include <deque>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

/// Tables as text, in the form that spreadsheets and other programs exchange (RFC 4180): UTF-8, rows that end
/// with CR LF, quotes around a cell where it needs them.
///
/// Two additions, which a writer and a reader of this file agree on:
/// * An empty cell is no value (NULL); an empty text is `""`.
/// * A text that a spreadsheet would run as a formula gets an apostrophe in front of it, and so does a text
///   that would read like one so guarded ("'=1"). Reading takes that apostrophe off, and no other: "'t Hart"
///   is written and read as it stands.
enum class CsvSeparator : char { Comma = ',', Semicolon = ';', Tab = '\t' };

/// True if a text cell needs an apostrophe in front: if, behind any apostrophes, it begins with a tab or a
/// line break, or with one of = + - @ (also the wide ones of East Asia), with or without blanks before it.
bool NeedsCsvGuard(std::string_view cell);

/// Writes a table row by row: for each row its cells, then EndRow.
class CsvWriter {
 public:
  explicit CsvWriter(CsvSeparator separator = CsvSeparator::Comma, bool byteOrderMark = false);

  /// A text in UTF-8; one that is not is taken for Windows-1252.
  void Text(std::string_view cell);
  void Number(std::int64_t cell);
  /// With the fewest digits that read back as the same value, and a point; an infinity or a NaN is an empty
  /// cell.
  void Number(double cell);
  /// With the fewest digits that read back as the same float.
  void Number(float cell);
  /// No value.
  void Empty();
  void EndRow();

  /// Returns what was written since the last call.
  std::string Take();

 private:
  template <typename Type>
  void AddFraction(Type cell);
  void Begin();

  const char separator_;
  std::string bytes_;
  std::size_t cells_ = 0;   // of the present row
  bool onlyEmpty_ = false;  // its one cell is Empty
};

/// A cell as it was read. The text is valid until the next row is read.
struct CsvCell {
  std::string_view Text;
  bool Quoted = false;

  /// True for an empty cell without quotes.
  bool IsNull() const { return Text.empty() && !Quoted; }
};

/// Why a table cannot be read further.
enum class CsvFault {
  UnclosedQuote,    ///< the line is the one in which the quoted cell begins
  TextBehindQuote,  ///< something other than a separator or a line's end stands behind a closing quote
  CellTooLong,
  RowTooLong,
  TooManyCells,
  OtherEncoding,  ///< the file is in UTF-16
};

/// What a row may hold at most.
struct CsvLimits {
  std::size_t CellBytes = 1U << 20U;
  std::size_t RowBytes = 4U << 20U;
  std::size_t Cells = 1000;
};

/// Reads a table row by row from bytes that outlive the reader: UTF-8 with or without a byte-order mark, else
/// Windows-1252; lines that end with CR LF, LF or CR. Lines without any text are no rows. A quote within a
/// cell that does not begin with one is a letter like any other.
class CsvReader {
 public:
  /// The separator is found from the first rows, or told by a first line "sep=;".
  explicit CsvReader(std::string_view bytes, CsvLimits limits = {});
  CsvReader(std::string_view bytes, CsvSeparator separator, CsvLimits limits = {});
  CsvReader(const CsvReader&) = delete;
  CsvReader& operator=(const CsvReader&) = delete;

  CsvSeparator Separator() const { return separator_; }

  /// Reads the next row. Returns false at the end, and where the table cannot be read further.
  bool Next();
  const std::vector<CsvCell>& Row() const { return row_; }
  /// The line, counted from 1, in which the row or the fault begins.
  std::size_t Line() const { return line_; }
  /// Why Next returned false; nothing at the end of the table.
  std::optional<CsvFault> Fault() const { return fault_; }

  /// Bytes read so far, and all of them.
  std::size_t Position() const { return at_; }
  std::size_t Size() const { return text_.size(); }

 private:
  void TakeText(std::string_view bytes);
  bool TakeSeparatorLine();
  void FindSeparator();
  std::size_t RowsAlike(CsvSeparator separator, std::size_t& cells) const;

  bool ReadRow();
  bool ReadCell();
  bool ReadQuoted(CsvCell& cell);
  void ReadPlain(CsvCell& cell);
  bool AtRowEnd() const;
  void SkipRowEnd();
  bool Fail(CsvFault fault, std::size_t line);

  const CsvLimits limits_;
  CsvSeparator separator_ = CsvSeparator::Comma;
  std::string converted_;  // the text, where it did not come in UTF-8
  std::string_view text_;
  std::size_t at_ = 0;
  std::size_t nextLine_ = 1;  // the line that at_ is in
  std::size_t line_ = 1;
  std::vector<CsvCell> row_;
  std::deque<std::string> joined_;  // texts of the row that had quotes in them
  std::optional<CsvFault> fault_;
};
