#pragma once

#include <QPainterPath>

/// Outline of the head on a portrait, in pixels: from the crown at (180, 108) to the chin at (180, 316).
inline QPainterPath HeadOutline() {
  QPainterPath path;
  path.moveTo(180, 108);
  path.cubicTo(240, 108, 264, 152, 260, 206);
  path.cubicTo(257, 270, 214, 316, 180, 316);
  path.cubicTo(146, 316, 103, 270, 100, 206);
  path.cubicTo(96, 152, 120, 108, 180, 108);
  path.closeSubpath();
  return path;
}
