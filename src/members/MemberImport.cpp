#include "members/MemberImport.h"

#include <algorithm>
#include <utility>

#include "core/data/FieldValue.h"
#include "core/text/TextEncoding.h"
#include "platform/RuntimeError.h"

namespace {

constexpr std::size_t RowsAtOnce = 64;
constexpr std::size_t MembersForgottenAtOnce = 4096;
constexpr std::size_t RowsFlushedAtOnce = 4096;  // or the end waits for all of them

double ShareOf(const CsvReader& reader) {
  return reader.Size() == 0 ? 1 : static_cast<double>(reader.Position()) / static_cast<double>(reader.Size());
}

/// The part of a run from `from` to `to` of the whole, as the whole sees it.
GoOn PartOf(const GoOn& goOn, double from, double to) {
  return [&goOn, from, to](double done) { return goOn(from + done * (to - from)); };
}

/// Converted once, since the file is read several times.
std::string AsUtf8(std::string bytes) {
  if (IsUtf8(bytes) || bytes.starts_with("\xFF\xFE") || bytes.starts_with("\xFE\xFF")) {
    return bytes;
  }
  return Windows1252ToUtf8(bytes);
}

bool IsSame(const Value& stored, const Value& given, ColumnKind kind) {
  const bool isFigure = kind == ColumnKind::Number || kind == ColumnKind::Count;
  if (isFigure && !std::holds_alternative<std::monostate>(stored)) {
    return NumberOf(stored) == NumberOf(given);
  }
  return stored == given;
}

}  // namespace

MemberImport::MemberImport(std::string bytes, Database& dbMembers, std::string now)
    : bytes_(AsUtf8(std::move(bytes))),
      dbMembers_(dbMembers),
      now_(std::move(now)),
      separator_(CsvReader(bytes_).Separator()) {}

std::vector<MemberImport::FileColumn> MemberImport::Columns() const {
  constexpr int mostCells = 3;
  std::vector<FileColumn> columns;
  CsvReader reader(bytes_, separator_);
  if (reader.Next()) {
    for (const CsvCell& cell : reader.Row()) {
      columns.push_back({std::string(cell.Text), {}});
    }
  }
  for (int row = 0; row < mostCells && reader.Next(); ++row) {
    for (std::size_t column = 0; column < columns.size() && column < reader.Row().size(); ++column) {
      columns[column].Cells.emplace_back(reader.Row()[column].Text);
    }
  }
  return columns;
}

std::vector<std::optional<std::size_t>> MemberImport::Match(const std::vector<FileColumn>& columns) {
  std::vector<std::optional<std::size_t>> matched;
  for (const FileColumn& column : columns) {
    const std::optional<std::size_t> meant = ColumnOfHeading(column.Heading);
    const bool isTaken = meant && std::find(matched.begin(), matched.end(), meant) != matched.end();
    matched.push_back(isTaken ? std::nullopt : meant);
  }
  return matched;
}

std::optional<DateFinding> MemberImport::FindDateOrder(const ColumnUse& use, const GoOn& goOn) const {
  std::vector<std::size_t> dates;  // the file's columns
  for (std::size_t place = 0; place < use.Columns.size(); ++place) {
    const std::optional<std::size_t> column = use.Columns[place];
    if (column && MemberColumns[*column].Kind == ColumnKind::Moment && use.Gives(*column)) {
      dates.push_back(place);
    }
  }
  DateFinding finding;
  CsvReader reader(bytes_, separator_);
  reader.Next();
  for (std::size_t row = 0; reader.Next(); ++row) {
    for (const std::size_t place : dates) {
      const DateSign sign = place < reader.Row().size() ? SignOf(reader.Row()[place].Text) : DateSign::NoDate;
      finding.IsOpen |= sign == DateSign::Open;
      if (sign == DateSign::DayFirst && finding.DayFirst == 0) {
        finding.DayFirst = reader.Line();
      } else if (sign == DateSign::MonthFirst && finding.MonthFirst == 0) {
        finding.MonthFirst = reader.Line();
      }
    }
    if (row % RowsAtOnce == 0 && !goOn(ShareOf(reader))) {
      return std::nullopt;
    }
  }
  const bool tells = finding.DayFirst != 0 || finding.MonthFirst != 0;
  const bool contradicts = finding.DayFirst != 0 && finding.MonthFirst != 0;
  finding.IsOpen = contradicts || (finding.IsOpen && !tells);
  return finding;
}

bool MemberImport::IndexMembers(MemberIndex& index, const GoOn& goOn) {
  using namespace MemberPlace;
  const auto count = static_cast<std::size_t>(rows_->RecordCount());
  takenBy_.assign(count, 0);
  MemberValues values;
  rows_->MoveFirst();
  for (std::size_t position = 0; position < count; ++position, rows_->MoveNext()) {
    try {
      for (const std::size_t column : {DallasId, FirstName, LastName, Birthdate}) {
        values[column] = rows_->Fields(MemberColumns[column].Name);
      }
      index.Add(values, position);
    } catch (const RuntimeError& error) {
      if (error.Number() != Fault::RecordDeleted) {
        throw;
      }
    }
    if (position % RowsAtOnce == 0 && !goOn(static_cast<double>(position) / static_cast<double>(count))) {
      return false;
    }
  }
  return true;
}

std::optional<ImportPlan> MemberImport::Plan(const ImportChoices& choices, const GoOn& goOn) {
  constexpr double indexShare = 0.3;
  MemberIndex index;
  rows_ = dbMembers_.OpenRecordset("Members");
  if (!IndexMembers(index, PartOf(goOn, 0, indexShare))) {
    return std::nullopt;
  }
  const GoOn readOn = PartOf(goOn, indexShare, 1);
  ImportPlan plan;
  plan.KeepsNumbers = takenBy_.empty();
  lineOfNumber_.clear();
  CsvReader reader(bytes_, separator_);
  reader.Next();
  MemberValues values;
  while (reader.Next()) {
    PlannedRow row;
    row.Line = reader.Line();
    row.Trouble = ReadMemberRow(reader.Row(), choices.Use, values);
    row.Name = NameOf(values);
    const auto* number = values[MemberPlace::ContactId]
                             ? std::get_if<std::int64_t>(&*values[MemberPlace::ContactId])
                             : nullptr;
    if (row.Trouble.Fault == RowFault::None && plan.KeepsNumbers && number != nullptr) {
      PlanNumberedRow(*number, row);
    } else if (row.Trouble.Fault == RowFault::None) {
      PlanRow(values, choices, index, row);
    }
    ++plan.Counts[static_cast<std::size_t>(row.Fate)];
    plan.Rows.push_back(std::move(row));
    if (plan.Rows.size() % RowsAtOnce == 0 && !readOn(ShareOf(reader))) {
      return std::nullopt;
    }
  }
  plan.Fault = reader.Fault();
  plan.FaultLine = reader.Line();
  while (index.ForgetSome(MembersForgottenAtOnce)) {
    readOn(1);
  }
  return plan;
}

void MemberImport::PlanNumberedRow(std::int64_t number, PlannedRow& row) {
  const auto [entry, isFirst] = lineOfNumber_.emplace(number, row.Line);
  if (isFirst) {
    row.Fate = RowFate::New;
  } else {
    row.Trouble = {RowFault::SameAsEarlierLine, 0, entry->second};
  }
}

void MemberImport::PlanRow(const MemberValues& values, const ImportChoices& choices, MemberIndex& index,
                           PlannedRow& row) {
  const auto refuse = [&row](RowFault fault, std::size_t line = 0) {
    row.Fate = RowFate::Refused;
    row.Trouble = {fault, 0, line};
  };
  const MemberIndex::Match match =
      choices.Same == SameMember::Add ? MemberIndex::Match() : index.Find(values);
  switch (match.Found) {
    case MemberIndex::Answer::Several:
      return refuse(RowFault::SeveralMembers);
    case MemberIndex::Answer::BirthdateMissing:
      return refuse(RowFault::BirthdateMissing);
    case MemberIndex::Answer::None:
      row.Fate = RowFate::New;
      index.Add(values, takenBy_.size());
      takenBy_.push_back(row.Line);
      return;
    default:
      break;
  }
  if (takenBy_[match.Who] != 0) {
    return refuse(RowFault::SameAsEarlierLine, takenBy_[match.Who]);
  }
  takenBy_[match.Who] = row.Line;
  row.Position = static_cast<int>(match.Who);
  row.Fate = RowFate::Skipped;
  if (choices.Same == SameMember::Update) {
    Compare(values, row);
  }
}

void MemberImport::Compare(const MemberValues& values, PlannedRow& row) {
  rows_->MoveTo(row.Position);
  for (std::size_t column = 0; column < MemberColumns.size(); ++column) {
    const std::optional<Value>& given = values[column];
    if (column != MemberPlace::ContactId && given && !std::holds_alternative<std::monostate>(*given)) {
      row.Changes[column] =
          !IsSame(rows_->Fields(MemberColumns[column].Name), *given, MemberColumns[column].Kind);
    }
  }
  row.Fate = row.Changes.any() ? RowFate::Changed : RowFate::Unchanged;
}

bool MemberImport::Write(const ImportChoices& choices, const ImportPlan& plan, const GoOn& goOn) {
  const std::unique_ptr<Recordset> kept = std::move(rows_);  // its positions end with this
  rows_ = nullptr;
  WriteScope scope(dbMembers_);
  CsvReader reader(bytes_, separator_);
  reader.Next();
  MemberValues values;
  std::size_t done = 0;
  for (const PlannedRow& row : plan.Rows) {
    reader.Next();
    if (row.Fate == RowFate::New || row.Fate == RowFate::Changed) {
      ReadMemberRow(reader.Row(), choices.Use, values);
      WriteRow(*kept, values, row, plan.KeepsNumbers);
    }
    if (++done % RowsAtOnce == 0 && !goOn(ShareOf(reader))) {
      return false;
    }
    if (done % RowsFlushedAtOnce == 0) {
      dbMembers_.FlushGroup();
    }
  }
  scope.Commit();
  return true;
}

void MemberImport::WriteRow(Recordset& rows, MemberValues& values, const PlannedRow& row,
                            bool keepsNumbers) const {
  const bool isNew = row.Fate == RowFate::New;
  if (isNew) {
    rows.AddNew();
  } else {
    rows.MoveTo(row.Position);
    rows.Edit();
  }
  for (std::size_t column = 0; column < MemberColumns.size(); ++column) {
    if (!values[column]) {
      continue;
    }
    // The table has its own beginnings for figures and numbers.
    const bool isGiven = !std::holds_alternative<std::monostate>(*values[column]) ||
                         !(MemberColumns[column].IsHistory || column == MemberPlace::ContactId);
    const bool isTaken =
        isNew ? isGiven && (keepsNumbers || column != MemberPlace::ContactId) : row.Changes[column];
    if (isTaken) {
      rows.SetField(MemberColumns[column].Name, std::move(*values[column]));
    }
  }
  if (isNew && !values[MemberPlace::DateJoined]) {
    rows.SetField(MemberColumns[MemberPlace::DateJoined].Name, now_);
  }
  rows.Update();
}
