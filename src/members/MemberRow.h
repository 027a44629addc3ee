#pragma once

#include <array>
#include <cstddef>
#include <optional>
#include <string>
#include <vector>

#include "exports/Csv.h"
#include "members/MemberColumns.h"
#include "members/MemberDates.h"
#include "platform/Database.h"

/// A member's values in the order of MemberColumns; nothing for a column that the file does not give. NULL
/// stands for an empty cell.
using MemberValues = std::array<std::optional<Value>, MemberColumns.size()>;

/// Why a row of a file is refused.
enum class RowFault {
  None,
  TooManyCells,       ///< more than there are headings
  NoDate,             ///< a date that is none, or not in this order of day and month
  NoNumber,           ///< a figure or a member number that is none
  NoButton,           ///< not 16 hexadecimal digits
  Nobody,             ///< neither a name nor a nickname, a button or a member number
  SeveralMembers,     ///< more than one member is the same
  BirthdateMissing,   ///< a member of this name is there, and one of both has no birth date
  SameAsEarlierLine,  ///< an earlier line is about the same member
};

/// A fault with what its message names.
struct RowTrouble {
  RowFault Fault = RowFault::None;
  std::size_t Column = 0;  ///< in MemberColumns, of a cell that is refused
  std::size_t Line = 0;    ///< of the earlier line
};

/// How the columns of a file are read.
struct ColumnUse {
  /// For each column of the file the place in MemberColumns, or nothing if it is not used. None twice.
  std::vector<std::optional<std::size_t>> Columns;
  DateOrder Dates = DateOrder::DayFirst;
  bool History = false;  ///< takes the playing history over

  /// True if a column of the file goes to `column` and is read.
  bool Gives(std::size_t column) const;
};

/// Reads a row into `values`. Returns why it is refused, if it is.
RowTrouble ReadMemberRow(const std::vector<CsvCell>& row, const ColumnUse& use, MemberValues& values);

/// True if a file holds what an export writes of a stored value, and an import makes just that value of it.
bool ReadsBack(std::size_t column, const Value& stored);

/// First and last name, else the nickname, else the button: what tells the operator who it is.
std::string NameOf(const MemberValues& values);

/// The text of a value; empty for none and for NULL.
std::string TextIn(const MemberValues& values, std::size_t column);
