#pragma once

#include <QFont>

/// This font, that many times as large.
QFont Grown(QFont font, double growth);

/// The font of a list's captions: bold, that many times as large as the list's.
QFont CaptionFont(const QFont& font, double size);

/// Height of the font's capitals relative to the size of its letters. Of small letters the toolkit knows it
/// in whole pixels only.
double CapitalsOf(QFont font);
