#pragma once

#include <cstddef>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "exports/Csv.h"
#include "platform/Database.h"

/// Told during a long run, with how far it is (0 to 1); false stops the run.
using GoOn = std::function<bool(double done)>;

/// How members are exported.
struct MemberExportForm {
  CsvSeparator Separator = CsvSeparator::Comma;
  bool ByteOrderMark = true;
  bool History = false;  ///< with the columns of the playing history
};

struct ExportedMembers {
  std::string Csv;  ///< with a heading
  /// Numbers of the members of whom an import would refuse a value, or make another one of it.
  std::vector<std::string> NotReadBack;
};

/// All members of `rows`. Nothing if `goOn` has stopped it. Throws RuntimeError as the database does; a
/// member deleted meanwhile by another program is left out.
std::optional<ExportedMembers> MembersAsCsv(Recordset& rows, const MemberExportForm& form, const GoOn& goOn);
