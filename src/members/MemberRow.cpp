#include "members/MemberRow.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <limits>

#include "core/data/FieldValue.h"
#include "core/game/MemberNumbers.h"
#include "core/text/Pieces.h"
#include "platform/Letters.h"

namespace {

constexpr std::size_t ButtonDigits = 16;

std::optional<Value> NumberValue(std::string_view text) {
  text = Trimmed(text, IsBlank);
  const char* const end = text.data() + text.size();
  std::int64_t integer = 0;
  if (const auto [rest, error] = std::from_chars(text.data(), end, integer);
      error == std::errc() && rest == end) {
    return integer;
  }
  double number = 0;
  const auto [rest, error] = std::from_chars(text.data(), end, number);
  const bool isNumber = error == std::errc() && rest == end && std::isfinite(number);
  return isNumber ? std::optional<Value>(number) : std::nullopt;
}

/// A whole number from `least` to `most`.
std::optional<Value> CountValue(std::string_view text, std::int32_t least, std::int32_t most) {
  const std::optional<Value> value = NumberValue(text);
  if (!value) {
    return std::nullopt;
  }
  const double number = NumberOf(*value);
  if (number < least || number > most || number != std::floor(number)) {
    return std::nullopt;
  }
  return static_cast<std::int64_t>(number);
}

/// Upper-case digits; other programs write them in small letters, or with blanks and marks between.
std::optional<Value> ButtonValue(std::string_view text) {
  std::string digits;
  for (const char letter : text) {
    const char lower = LowerAscii(letter);
    if (IsDigit(letter)) {
      digits += letter;
    } else if (lower >= 'a' && lower <= 'f') {
      digits += static_cast<char>(lower - 'a' + 'A');
    } else if (letter != ' ' && letter != '-' && letter != ':' && letter != '.') {
      return std::nullopt;
    }
  }
  return digits.size() == ButtonDigits || text.empty() ? std::optional<Value>(std::move(digits))
                                                       : std::nullopt;
}

std::optional<Value> MomentValue(std::string_view text, DateOrder order) {
  std::optional<std::string> moment = text.empty() ? std::optional(std::string()) : StoredMoment(text, order);
  return moment ? std::optional<Value>(std::move(*moment)) : std::nullopt;
}

std::optional<Value> ValueOf(std::string_view text, ColumnKind kind, DateOrder order) {
  switch (kind) {
    case ColumnKind::Number:
      return NumberValue(text);
    case ColumnKind::Count:
      return CountValue(text, 0, std::numeric_limits<std::int32_t>::max());
    case ColumnKind::MemberNumber:
      return CountValue(text, 1, HighestMemberNumber);
    case ColumnKind::Button:
      return ButtonValue(text);
    case ColumnKind::Moment:
      return MomentValue(text, order);
    default:
      return Value(std::string(text));
  }
}

RowFault FaultOf(ColumnKind kind) {
  return kind == ColumnKind::Moment   ? RowFault::NoDate
         : kind == ColumnKind::Button ? RowFault::NoButton
                                      : RowFault::NoNumber;
}

bool HasAny(const MemberValues& values, std::initializer_list<std::size_t> columns) {
  return std::any_of(columns.begin(), columns.end(),
                     [&](std::size_t column) { return !TextIn(values, column).empty(); });
}

}  // namespace

bool ColumnUse::Gives(std::size_t column) const {
  return (History || !MemberColumns[column].IsHistory) &&
         std::find(Columns.begin(), Columns.end(), std::optional(column)) != Columns.end();
}

RowTrouble ReadMemberRow(const std::vector<CsvCell>& row, const ColumnUse& use, MemberValues& values) {
  values.fill(std::nullopt);
  if (std::any_of(row.begin() + static_cast<std::ptrdiff_t>(std::min(row.size(), use.Columns.size())),
                  row.end(), [](const CsvCell& cell) { return !cell.IsNull(); })) {
    return {RowFault::TooManyCells};
  }
  for (std::size_t place = 0; place < use.Columns.size(); ++place) {
    if (!use.Columns[place] || (MemberColumns[*use.Columns[place]].IsHistory && !use.History)) {
      continue;
    }
    const std::size_t column = *use.Columns[place];
    if (place >= row.size() || row[place].IsNull()) {
      values[column] = Value();
      continue;
    }
    values[column] = ValueOf(row[place].Text, MemberColumns[column].Kind, use.Dates);
    if (!values[column]) {
      return {FaultOf(MemberColumns[column].Kind), column};
    }
  }
  using namespace MemberPlace;
  if (!HasAny(values, {FirstName, LastName, NickName, DallasId, ContactId})) {
    return {RowFault::Nobody};
  }
  return {};
}

bool ReadsBack(std::size_t column, const Value& stored) {
  const ColumnKind kind = MemberColumns.at(column).Kind;
  const bool isText = std::holds_alternative<std::string>(stored);
  if (std::holds_alternative<std::monostate>(stored) || kind == ColumnKind::Text ||
      (kind == ColumnKind::Number && !isText)) {
    return true;
  }
  if (std::holds_alternative<Blob>(stored)) {
    return false;
  }
  const std::string text = TextOf(stored);
  const std::string_view written = kind == ColumnKind::Moment ? ExportedMoment(text) : text;
  const std::optional<Value> read = ValueOf(written, kind, DateOrder::DayFirst);
  return read && TextOf(*read) == text;
}

std::string NameOf(const MemberValues& values) {
  using namespace MemberPlace;
  const std::string first = TextIn(values, FirstName);
  const std::string last = TextIn(values, LastName);
  if (!first.empty() || !last.empty()) {
    return first.empty() ? last : last.empty() ? first : first + " " + last;
  }
  const std::string nick = TextIn(values, NickName);
  return nick.empty() ? TextIn(values, DallasId) : nick;
}

std::string TextIn(const MemberValues& values, std::size_t column) {
  return values[column] ? TextOf(*values[column]) : std::string();
}
