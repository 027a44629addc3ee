#pragma once

#include "platform/Database.h"
#include "platform/RuntimeError.h"

/// Calls `act` on each row from the first to the last, except rows that another program has deleted since the
/// recordset was opened.
template <typename Act>
void ForEachRow(Recordset& rows, const Act& act) {
  for (rows.MoveFirst(); !rows.Eof(); rows.MoveNext()) {
    try {
      act();
    } catch (const RuntimeError& error) {
      if (error.Number() != Fault::RecordDeleted) {
        throw;
      }
    }
  }
}
