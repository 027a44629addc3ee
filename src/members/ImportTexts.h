#pragma once

#include <string>

#include "core/text/StringTable.h"
#include "members/MemberImport.h"

// What the operator reads about an import.

/// What becomes of a row: "New", "Changed: City, Phone", "Refused: ...".
std::string TextOfRow(const PlannedRow& row, const StringTable& strings);

/// How many rows there are of each kind, or why the file cannot be read.
std::string TextOfPlan(const ImportPlan& plan, const StringTable& strings);

/// Where the order of day and month comes from.
std::string TextOfDates(const DateFinding& finding, const StringTable& strings);
