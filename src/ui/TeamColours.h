#pragma once

#include <QColor>
#include <QIcon>

/// Colour of team 1 to 3 (red, blue, yellow).
QColor TeamColour(int team);

/// How much of the team's colour is in the background of its rows.
inline constexpr double RowTint = 0.13;
inline constexpr double SelectedRowTint = 0.4;

/// A tint of that colour over `base`, for the background of a row.
QColor TeamTint(int team, const QColor& base, double share = RowTint);

/// A badge in the team's colour and of the team's own shape (circle, square, triangle), at any size. Its edge
/// is white on dark desktops and where the toolkit paints it on its own selection, else dark.
const QIcon& TeamBadge(int team);
