#pragma once

#include <QString>
#include <QStringList>

#include "core/text/Pieces.h"
#include "core/text/StringTable.h"

/// Text `number` of the string table for a control.
inline QString Text(const StringTable& strings, int number) {
  return QString::fromStdString(strings.Text(number));
}

/// One of the program's own texts for a control.
inline QString Text(const StringTable& strings, OwnText text) {
  return QString::fromStdString(strings.Text(text));
}

/// The parts of one of them that is a list, with bars between them.
inline QStringList TextList(const StringTable& strings, OwnText list) {
  QStringList texts;
  for (const std::string& text : PartsOf(strings.Text(list), '|')) {
    texts << QString::fromStdString(text);
  }
  return texts;
}
