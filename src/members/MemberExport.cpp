#include "members/MemberExport.h"

#include "members/MemberColumns.h"
#include "members/MemberDates.h"
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
void WriteMember(CsvWriter& writer, Recordset& rows, bool history) {
  try {
    rows.Fields(MemberColumns.front().Name);
  } catch (const RuntimeError& error) {
    if (error.Number() == Fault::RecordDeleted) {
      return;
    }
    throw;
  }
  for (const MemberColumn& column : MemberColumns) {
    if (history || !column.IsHistory) {
      WriteCell(writer, column, rows.Fields(column.Name));
    }
  }
  writer.EndRow();
}

}  // namespace

std::optional<std::string> MembersAsCsv(Recordset& rows, const MemberExportForm& form, const GoOn& goOn) {
  constexpr int rowsAtOnce = 100;
  CsvWriter writer(form.Separator, form.ByteOrderMark);
  for (const MemberColumn& column : MemberColumns) {
    if (form.History || !column.IsHistory) {
      writer.Text(column.Name);
    }
  }
  writer.EndRow();
  std::string csv;
  for (rows.MoveFirst(); !rows.Eof(); rows.MoveNext()) {
    WriteMember(writer, rows, form.History);
    if (rows.AbsolutePosition() % rowsAtOnce == 0) {
      csv += writer.Take();
      if (!goOn(static_cast<double>(rows.AbsolutePosition()) / rows.RecordCount())) {
        return std::nullopt;
      }
    }
  }
  csv += writer.Take();
  return csv;
}
