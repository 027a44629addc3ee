#pragma once

#include <string>

#include "core/text/StringTable.h"
#include "platform/Database.h"

/// Writes the rows of a table of another program's or an older file into the same table of a file of this
/// program, whose own rows go. The file keeps its keys, types and indexes, so that what it refuses or cannot
/// hold as it should is never taken over. The table's first column is the number of a row; the other file has
/// all columns of it. False if it was stopped; durable if not. Throws RuntimeError 13 with the row and the
/// reason if a row does not fit, else as the operations on databases do.
bool TakeRows(Database& from, Database& into, const std::string& table, const StringTable& strings,
              const KeepOn& keepOn);
