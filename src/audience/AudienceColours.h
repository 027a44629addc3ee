#pragma once

#include <QColor>

/// Colours of the board for the audience: light letters on a dark page, which does not dazzle in a dark hall.
/// Letters have a contrast of at least 7 : 1 to what is behind them.
namespace AudienceColours {

QColor Page();
QColor Letters();
QColor QuietLetters();  ///< of the heading

/// Behind a row of a team's player.
QColor Row(int team);

/// Of the team, light enough for letters on a row, and for a badge with dark letters.
QColor Team(int team);

/// Letters on a badge.
QColor BadgeLetters();

/// Contrast of two colours: 1 for equal ones, 21 for black and white.
double Contrast(const QColor& one, const QColor& other);

}  // namespace AudienceColours
