#include "members/MemberExport.h"

#include <utility>

#include "core/data/FieldValue.h"
#include "members/MemberColumns.h"
#include "members/MemberDates.h"
#include "members/MemberRow.h"
#include "platform/RuntimeError.h"

namespace {

void WriteCell(CsvWriter& writer, const MemberColumn& column, const Value& value) {
  if (const auto* integer = std::get_if<std::int64_t>(&value)) {
    writer.Number(*integer);
  } else if (const auto* number = std::get_if<double>(&value)) {
    writer.Number(*number);
  } else if (const auto* text = std::get_if<std::string>(&value)) {
    writer.Text(column.Kind == ColumnKind::Moment ? ExportedMoment(*text) : std::string_view(*text));
  } else {
    writer.Empty();
  }
}

/// Writes the row at the cursor, or nothing if another program has deleted it.
void WriteMember(CsvWriter& writer, Recordset& rows, bool history, std::vector<std::string>& notReadBack) {
  std::string number;
  try {
    number = TextOf(rows.Fields(MemberColumns.front().Name));
  } catch (const RuntimeError& error) {
    if (error.Number() == Fault::RecordDeleted) {
      return;
    }
    throw;
  }
  bool readsBack = true;
  for (std::size_t place = 0; place < MemberColumns.size(); ++place) {
    const MemberColumn& column = MemberColumns[place];
    if (history || !column.IsHistory) {
      const Value value = rows.Fields(column.Name);
      WriteCell(writer, column, value);
      readsBack = readsBack && ReadsBack(place, value);
    }
  }
  writer.EndRow();
  if (!readsBack) {
    notReadBack.push_back(std::move(number));
  }
}

}  // namespace

std::optional<ExportedMembers> MembersAsCsv(Recordset& rows, const MemberExportForm& form, const GoOn& goOn) {
  constexpr int rowsAtOnce = 100;
  CsvWriter writer(form.Separator, form.ByteOrderMark);
  for (const MemberColumn& column : MemberColumns) {
    if (form.History || !column.IsHistory) {
      writer.Text(column.Name);
    }
  }
  writer.EndRow();
  ExportedMembers members;
  for (rows.MoveFirst(); !rows.Eof(); rows.MoveNext()) {
    WriteMember(writer, rows, form.History, members.NotReadBack);
    if (rows.AbsolutePosition() % rowsAtOnce == 0) {
      members.Csv += writer.Take();
      if (!goOn(static_cast<double>(rows.AbsolutePosition()) / rows.RecordCount())) {
        return std::nullopt;
      }
    }
  }
  members.Csv += writer.Take();
  return members;
}
