#pragma once

#include <QTranslator>

#include "core/text/StringTable.h"

/// Sets the application's name, icon and style, and keeps its windows on the screen; call once before the
/// first window. Needs a QApplication.
void PrepareLook();

/// Has the toolkit's own texts ("OK", "File name:") shown in a language as long as `texts` exists.
void UseDialogTexts(QTranslator& texts, Language language);
