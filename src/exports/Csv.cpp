#include "exports/Csv.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <utility>

#include "core/text/TextEncoding.h"

namespace {

constexpr std::string_view CsvMark = "\xEF\xBB\xBF";
constexpr std::array<CsvSeparator, 3> CsvSeparators = {CsvSeparator::Comma, CsvSeparator::Semicolon,
                                                       CsvSeparator::Tab};

/// What spreadsheets pass over before they look for a formula: blanks, no-break and wide ones, and marks.
constexpr std::array<std::string_view, 9> CsvBlanks = {" ",  "\t",       "\r",           "\n",   "\v",
                                                       "\f", "\xC2\xA0", "\xE3\x80\x80", CsvMark};
/// = + - @, the wide forms of them, and the minus sign.
constexpr std::array<std::string_view, 9> FormulaStarts = {
    "=", "+", "-", "@", "\xEF\xBC\x9D", "\xEF\xBC\x8B", "\xEF\xBC\x8D", "\xEF\xBC\xA0", "\xE2\x88\x92"};

/// The one of `texts` that `cell` begins with, or an empty text.
template <std::size_t Count>
std::string_view StartOf(std::string_view cell, const std::array<std::string_view, Count>& texts) {
  const auto* const found =
      std::find_if(texts.begin(), texts.end(), [&](std::string_view text) { return cell.starts_with(text); });
  return found == texts.end() ? std::string_view() : *found;
}

/// True for the first bytes of what NeedsCsvGuard looks for: nearly every cell begins with another one.
bool MayNeedGuard(char first) {
  return static_cast<unsigned char>(first) < '0' || first == '=' || first == '@' ||
         static_cast<unsigned char>(first) >= 0xC2;
}

constexpr std::array<bool, 256> WantsQuotes = [] {
  std::array<bool, 256> wants{};
  for (const char letter : std::string_view("\",;\t\r\n")) {
    wants[static_cast<unsigned char>(letter)] = true;
  }
  return wants;
}();

/// True for an empty text too. All three separators count, so that a program which takes the wrong one still
/// sees the cell as one.
bool NeedsQuotes(std::string_view cell) {
  return cell.empty() || cell.front() == ' ' || cell.back() == ' ' || cell.starts_with(CsvMark) ||
         std::any_of(cell.begin(), cell.end(),
                     [](char letter) { return WantsQuotes[static_cast<unsigned char>(letter)]; });
}

void AppendQuoted(std::string& bytes, std::string_view cell) {
  bytes += '"';
  for (std::size_t at = 0; at < cell.size();) {
    const std::size_t quote = std::min(cell.find('"', at), cell.size());
    bytes.append(cell.substr(at, quote - at));
    if (quote < cell.size()) {
      bytes += "\"\"";
    }
    at = quote + 1;
  }
  bytes += '"';
}

bool IsBreak(char letter) {
  return letter == '\n' || letter == '\r';
}

/// Number of line breaks in `text`, where CR LF is one.
std::size_t BreaksIn(std::string_view text) {
  std::size_t breaks = 0;
  for (std::size_t at = text.find_first_of("\r\n"); at < text.size(); at = text.find_first_of("\r\n", at)) {
    at += text.substr(at).starts_with("\r\n") ? 2 : 1;
    ++breaks;
  }
  return breaks;
}

}  // namespace

bool NeedsCsvGuard(std::string_view cell) {
  if (cell.empty() || !MayNeedGuard(cell.front())) {
    return false;
  }
  cell.remove_prefix(std::min(cell.find_first_not_of('\''), cell.size()));
  if (!cell.empty() && (cell.front() == '\t' || IsBreak(cell.front()))) {
    return true;
  }
  for (std::string_view blank = StartOf(cell, CsvBlanks); !blank.empty(); blank = StartOf(cell, CsvBlanks)) {
    cell.remove_prefix(blank.size());
  }
  return !StartOf(cell, FormulaStarts).empty();
}

CsvWriter::CsvWriter(CsvSeparator separator, bool byteOrderMark) : separator_(static_cast<char>(separator)) {
  if (byteOrderMark) {
    bytes_ = CsvMark;
  }
}

void CsvWriter::Begin() {
  if (cells_ > 0) {
    bytes_ += separator_;
  }
  ++cells_;
  onlyEmpty_ = false;
}

void CsvWriter::Text(std::string_view cell) {
  if (!IsUtf8(cell)) {
    Text(Windows1252ToUtf8(cell));
    return;
  }
  Begin();
  const bool guarded = NeedsCsvGuard(cell);
  if (!NeedsQuotes(cell)) {
    bytes_ += guarded ? "'" : "";
    bytes_ += cell;
  } else if (guarded) {
    AppendQuoted(bytes_, "'" + std::string(cell));
  } else {
    AppendQuoted(bytes_, cell);
  }
}

void CsvWriter::Number(std::int64_t cell) {
  Begin();
  std::array<char, 24> digits{};
  bytes_.append(digits.data(), std::to_chars(digits.begin(), digits.end(), cell).ptr);
}

void CsvWriter::Number(double cell) {
  AddFraction(cell);
}

void CsvWriter::Number(float cell) {
  AddFraction(cell);
}

template <typename Type>
void CsvWriter::AddFraction(Type cell) {
  if (!std::isfinite(cell)) {
    Empty();
    return;
  }
  Begin();
  std::array<char, 32> digits{};
  bytes_.append(digits.data(), std::to_chars(digits.begin(), digits.end(), cell).ptr);
}

void CsvWriter::Empty() {
  Begin();
  onlyEmpty_ = cells_ == 1;
}

void CsvWriter::EndRow() {
  // A line without anything would be no row.
  bytes_ += onlyEmpty_ ? "\"\"\r\n" : "\r\n";
  cells_ = 0;
  onlyEmpty_ = false;
}

std::string CsvWriter::Take() {
  return std::exchange(bytes_, {});
}

CsvReader::CsvReader(std::string_view bytes, CsvLimits limits) : limits_(limits) {
  TakeText(bytes);
  if (!fault_ && !TakeSeparatorLine()) {
    FindSeparator();
  }
}

CsvReader::CsvReader(std::string_view bytes, CsvSeparator separator, CsvLimits limits)
    : limits_(limits), separator_(separator) {
  TakeText(bytes);
  if (!fault_ && TakeSeparatorLine()) {
    separator_ = separator;
  }
}

void CsvReader::TakeText(std::string_view bytes) {
  if (bytes.starts_with("\xFF\xFE") || bytes.starts_with("\xFE\xFF")) {
    fault_ = CsvFault::OtherEncoding;
    return;
  }
  if (bytes.starts_with(CsvMark)) {
    bytes.remove_prefix(CsvMark.size());
  }
  if (!IsUtf8(bytes)) {
    converted_ = Windows1252ToUtf8(bytes);
    bytes = converted_;
  }
  text_ = bytes;
}

bool CsvReader::TakeSeparatorLine() {
  for (const CsvSeparator separator : CsvSeparators) {
    const std::string line = std::string("sep=") + static_cast<char>(separator);
    if (text_.starts_with(line) && (text_.size() == line.size() || IsBreak(text_[line.size()]))) {
      separator_ = separator;
      at_ = line.size();
      SkipRowEnd();
      return true;
    }
  }
  return false;
}

void CsvReader::FindSeparator() {
  std::size_t mostAlike = 0;
  std::size_t mostCells = 1;
  for (const CsvSeparator separator : CsvSeparators) {
    std::size_t cells = 0;
    const std::size_t alike = RowsAlike(separator, cells);
    if (cells > 1 && (alike > mostAlike || (alike == mostAlike && cells > mostCells))) {
      mostAlike = alike;
      mostCells = cells;
      separator_ = separator;
    }
  }
}

/// Number of the first rows that have as many cells as the very first, which has `cells`.
std::size_t CsvReader::RowsAlike(CsvSeparator separator, std::size_t& cells) const {
  constexpr std::size_t mostBytes = 65536;
  constexpr std::size_t mostRows = 20;
  CsvReader reader(FirstBytes(text_, mostBytes), separator, limits_);
  std::size_t alike = 0;
  for (std::size_t rows = 0; rows < mostRows && reader.Next(); ++rows) {
    cells = rows == 0 ? reader.Row().size() : cells;
    alike += reader.Row().size() == cells ? 1 : 0;
  }
  return alike;
}

bool CsvReader::Next() {
  while (!fault_ && at_ < text_.size() && AtRowEnd()) {
    SkipRowEnd();
  }
  row_.clear();
  joined_.clear();
  if (fault_ || at_ == text_.size()) {
    return false;
  }
  line_ = nextLine_;
  return ReadRow();
}

bool CsvReader::ReadRow() {
  const std::size_t start = at_;
  while (true) {
    if (row_.size() == limits_.Cells) {
      return Fail(CsvFault::TooManyCells, line_);
    }
    if (!ReadCell()) {
      return false;
    }
    if (at_ - start > limits_.RowBytes) {
      return Fail(CsvFault::RowTooLong, line_);
    }
    if (AtRowEnd()) {
      SkipRowEnd();
      return true;
    }
    ++at_;  // the separator
  }
}

bool CsvReader::ReadCell() {
  const std::size_t line = nextLine_;
  CsvCell cell;
  if (at_ < text_.size() && text_[at_] == '"') {
    if (!ReadQuoted(cell)) {
      return false;
    }
    if (!AtRowEnd() && text_[at_] != static_cast<char>(separator_)) {
      return Fail(CsvFault::TextBehindQuote, nextLine_);
    }
  } else {
    ReadPlain(cell);
  }
  if (cell.Text.size() > limits_.CellBytes) {
    return Fail(CsvFault::CellTooLong, line);
  }
  if (cell.Text.starts_with('\'') && NeedsCsvGuard(cell.Text)) {
    cell.Text.remove_prefix(1);
  }
  row_.push_back(cell);
  return true;
}

bool CsvReader::ReadQuoted(CsvCell& cell) {
  const std::size_t line = nextLine_;
  cell.Quoted = true;
  ++at_;
  std::string* joined = nullptr;
  while (true) {
    const std::size_t quote = text_.find('"', at_);
    if (quote == std::string_view::npos) {
      return Fail(CsvFault::UnclosedQuote, line);
    }
    const bool isDoubled = quote + 1 < text_.size() && text_[quote + 1] == '"';
    std::string_view part = text_.substr(at_, quote - at_ + (isDoubled ? 1 : 0));
    nextLine_ += BreaksIn(part);
    if (isDoubled && joined == nullptr) {
      joined = &joined_.emplace_back();
    }
    if (joined != nullptr) {
      joined->append(part);
      part = *joined;
    }
    at_ = quote + (isDoubled ? 2 : 1);
    if (!isDoubled) {
      cell.Text = part;
      return true;
    }
    if (part.size() > limits_.CellBytes) {
      return Fail(CsvFault::CellTooLong, line);
    }
  }
}

void CsvReader::ReadPlain(CsvCell& cell) {
  const char separator = static_cast<char>(separator_);
  const auto* const start = text_.begin() + static_cast<std::ptrdiff_t>(at_);
  const auto* const end = std::find_if(
      start, text_.end(), [separator](char letter) { return letter == separator || IsBreak(letter); });
  cell.Text = text_.substr(at_, static_cast<std::size_t>(end - start));
  at_ += cell.Text.size();
}

bool CsvReader::AtRowEnd() const {
  return at_ == text_.size() || IsBreak(text_[at_]);
}

void CsvReader::SkipRowEnd() {
  if (at_ < text_.size()) {
    at_ += text_.substr(at_).starts_with("\r\n") ? 2 : 1;
    ++nextLine_;
  }
}

bool CsvReader::Fail(CsvFault fault, std::size_t line) {
  fault_ = fault;
  line_ = line;
  row_.clear();
  return false;
}
