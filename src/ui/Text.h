#pragma once

#include <QString>

#include "core/text/StringTable.h"

/// Text `number` of the string table for a control.
inline QString Text(const StringTable& strings, int number) {
  return QString::fromStdString(strings.Text(number));
}

/// One of the program's own texts for a control.
inline QString Text(const StringTable& strings, OwnText text) {
  return QString::fromStdString(strings.Text(text));
}
