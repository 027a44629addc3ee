#pragma once

#include <QFont>
#include <QRectF>
#include <QString>

class QPainter;

/// The application's font with capitals of this height in pixels, or the least more.
QFont FontWithCapitals(double capital, bool bold);

/// Width of a text in heights of a capital.
double WidthInCapitals(const QString& text, bool bold);

/// Draws a line of text with its capitals in the middle of `area`: narrower where it does not fit, by `least`
/// at most, and then shortened. Alignment is left, right or centred.
void DrawLine(QPainter& painter, const QRectF& area, const QString& text, const QFont& font,
              Qt::AlignmentFlag alignment, double least = 0.8);

/// The largest height of capitals, at most `most`, with which the text is no wider than `width`.
double CapitalFor(const QString& text, double width, double most, bool bold);
