#pragma once

#include <QFont>
#include <QRectF>
#include <QString>
#include <QStringList>

class QPainter;

/// The application's font with capitals of this height in pixels, or the least more.
QFont FontWithCapitals(double capital, bool bold);

/// Width of a text in heights of a capital.
double WidthInCapitals(const QString& text, bool bold);

/// Draws a line of text with its capitals in the middle of `area`: narrower where it does not fit, by `least`
/// at most, and then shortened. Alignment is left, right or centred.
void DrawLine(QPainter& painter, const QRectF& area, const QString& text, const QFont& font,
              Qt::AlignmentFlag alignment, double least = 0.8);

/// Distance of the lines of a text that is broken, in heights of a capital.
inline constexpr double BrokenPitch = 1.45;

/// A text in lines of much the same width, the widest as narrow as can be: broken between words, and inside
/// of texts that have none (addresses, Chinese). At most `lines`, fewer where a word would have to be cut.
QStringList BrokenInto(const QString& text, int lines, bool bold);

/// Width of the widest line in heights of a capital.
double WidestInCapitals(const QStringList& lines, bool bold);

/// A text in as many lines as its area demands.
struct TextBlock {
  QStringList Lines;
  double Capital = 0;
};

/// The text with capitals as large as fits `area`, `most` at most: in one line where these are legible, else
/// in the fewest lines with which they are, else in those with which they are largest.
TextBlock BlockFor(const QString& text, const QSizeF& area, double legible, double most, bool bold);

/// Draws it in the middle of `area`.
void DrawBlock(QPainter& painter, const QRectF& area, const TextBlock& block, bool bold);
