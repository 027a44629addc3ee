#pragma once

#include <QColor>
#include <QIcon>

/// Colour of team 1 to 3 (red, blue, yellow).
QColor TeamColour(int team);

/// A light tint of that colour over `base`, for the background of a row.
QColor TeamTint(int team, const QColor& base);

/// A round badge in the team's colour, with a white ring where its row is selected.
const QIcon& TeamBadge(int team);
