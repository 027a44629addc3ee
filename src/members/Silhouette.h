#pragma once

class QColor;
class QPainter;
class QRect;

/// Draws a head and shoulders in place of a missing photo.
void DrawSilhouette(QPainter& painter, const QRect& place, const QColor& colour);
