#pragma once

#include "core/text/StringTable.h"

namespace Ui {
class frmRx;
}

/// Sets the texts of the main window's menus and labels in the program's language. Menus keep the Alt-key
/// letter of the design if the new text has it.
void SetCaptions(Ui::frmRx& ui, const StringTable& strings);
