#pragma once

#include <initializer_list>
#include <utility>

#include "core/text/StringTable.h"

class QAction;
class QWidget;

/// Gives each control its text of the string table: label, button, group box, or a window its title.
void SetCaptions(const StringTable& strings, std::initializer_list<std::pair<QWidget*, int>> captions);

/// The same for menus and their items. Each keeps the letter for the Alt key that it was designed with where
/// the new text has that letter.
void SetCaptions(const StringTable& strings, std::initializer_list<std::pair<QAction*, int>> captions);
