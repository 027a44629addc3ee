#pragma once

#include "core/text/StringTable.h"

namespace Ui {
class frmRx;
}

/// Gives the menus and labels of the main window their texts in the program's language. The letter for the
/// Alt key stays that of the design where the new text has it.
void SetCaptions(Ui::frmRx& ui, const StringTable& strings);
