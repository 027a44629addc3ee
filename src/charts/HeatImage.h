#pragma once

#include <QColor>
#include <QImage>

#include "charts/HitMatrix.h"

/// Colour of a cell with that damage; `most` is the greatest damage of all.
QRgb HeatOf(std::int32_t damage, std::int32_t most);

/// Letters or marks that can be read on that colour: black or white.
QColor InkOn(QRgb colour);

/// The heat map as an image with `cell` pixels to a side of each cell. Cells of hits on the own team have a
/// corner marked, or a stroke across them where they are small; the cells of own teams without hits are
/// greyish. Larger cells have lines between them.
QImage HeatImage(const HitMatrix& matrix, int cell);
