#pragma once

#include <array>
#include <bitset>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <unordered_map>
#include <vector>

#include "exports/Csv.h"
#include "members/MemberExport.h"
#include "members/MemberIndex.h"
#include "members/MemberRow.h"
#include "platform/Database.h"

/// What happens with a row whose member is in the table already.
enum class SameMember { Skip, Update, Add };

struct ImportChoices {
  ColumnUse Use;
  SameMember Same = SameMember::Skip;
};

/// What becomes of a row of the file.
enum class RowFate { New, Changed, Unchanged, Skipped, Refused };
inline constexpr std::size_t RowFateCount = 5;

struct PlannedRow {
  std::size_t Line = 0;  ///< in the file, from 1
  RowFate Fate = RowFate::Refused;
  RowTrouble Trouble;
  std::bitset<MemberColumns.size()> Changes;  ///< columns that a changed member gets anew
  int Position = -1;                          ///< of the member in the table, where it is there
  std::string Name;
};

/// What an import will do: the result of its dry run.
struct ImportPlan {
  std::vector<PlannedRow> Rows;
  std::array<std::size_t, RowFateCount> Counts{};
  std::optional<CsvFault> Fault;  ///< the file cannot be read further, and nothing of it will be imported
  std::size_t FaultLine = 0;
  /// The table is empty, so members keep the numbers that the file gives, and lines with different numbers
  /// are about different members.
  bool KeepsNumbers = false;

  std::size_t Count(RowFate fate) const { return Counts[static_cast<std::size_t>(fate)]; }
  bool ChangesAnything() const { return !Fault && Count(RowFate::New) + Count(RowFate::Changed) > 0; }
};

/// What the dates of a file tell about the order of day and month.
struct DateFinding {
  bool IsOpen = false;       ///< some can be read in both orders, and no other date tells
  std::size_t DayFirst = 0;  ///< the first line whose date has its day first; 0 for none
  std::size_t MonthFirst = 0;
};

/// Members from a CSV file whose first row has the headings.
class MemberImport {
 public:
  /// `dbMembers` must outlive this object. `now` is the joining date of members for whom the file has no
  /// column of it.
  MemberImport(std::string bytes, Database& dbMembers, std::string now);

  /// Reads the file with this separator from now on; at first it is the one found in it.
  void SetSeparator(CsvSeparator separator) { separator_ = separator; }
  CsvSeparator Separator() const { return separator_; }

  /// The headings, each with its first cells below it (at most three). None for an empty file.
  struct FileColumn {
    std::string Heading;
    std::vector<std::string> Cells;
  };
  std::vector<FileColumn> Columns() const;

  /// For each of them the member column that its heading means; of two that mean the same one only the first.
  static std::vector<std::optional<std::size_t>> Match(const std::vector<FileColumn>& columns);

  /// Looks at the dates of the file. Nothing if it was stopped.
  std::optional<DateFinding> FindDateOrder(const ColumnUse& use, const GoOn& goOn) const;

  /// The dry run. Nothing if it was stopped. Throws RuntimeError as the database does.
  std::optional<ImportPlan> Plan(const ImportChoices& choices, const GoOn& goOn);

  /// Does what the last plan, made with the same choices, tells: all of it or, if it is stopped or fails,
  /// nothing. Returns false if it was stopped. Throws RuntimeError as the database does.
  bool Write(const ImportChoices& choices, const ImportPlan& plan, const GoOn& goOn);

 private:
  bool IndexMembers(MemberIndex& index, const GoOn& goOn);
  void PlanRow(const MemberValues& values, const ImportChoices& choices, MemberIndex& index, PlannedRow& row);
  void PlanNumberedRow(std::int64_t number, PlannedRow& row);
  void Compare(const MemberValues& values, PlannedRow& row);
  void WriteRow(Recordset& rows, MemberValues& values, const PlannedRow& row, bool keepsNumbers) const;

  const std::string bytes_;
  Database& dbMembers_;
  const std::string now_;
  CsvSeparator separator_;
  std::unique_ptr<Recordset> rows_;   // of the last plan, whose positions it holds
  std::vector<std::size_t> takenBy_;  // for each member the line that is about it, 0 for none
  std::unordered_map<std::int64_t, std::size_t> lineOfNumber_;  // of members who keep their numbers
};
