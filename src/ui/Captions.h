#pragma once

#include <initializer_list>
#include <utility>

#include "core/text/StringTable.h"

class QAction;
class QWidget;

/// Sets the text of each control from the string table: a label, button or group box, or a window's title.
void SetCaptions(const StringTable& strings, std::initializer_list<std::pair<QWidget*, int>> captions);

/// The same for menus and their items. Each keeps the Alt-key letter of its design if the new text has that
/// letter.
void SetCaptions(const StringTable& strings, std::initializer_list<std::pair<QAction*, int>> captions);
