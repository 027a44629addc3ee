#pragma once

#include <QColor>
#include <QFont>
#include <QPainter>
#include <QStringList>

#include "charts/HitMatrix.h"
#include "core/text/StringTable.h"

/// A cell of the map, by the places of its players.
struct HitCell {
  int Shooter = 0;
  int Victim = 0;
  bool operator==(const HitCell&) const = default;
};

/// Where the parts of a heat map lie, in the painter's units.
struct HitMapLayout {
  QRectF Cells;        ///< all of them
  double Cell = 0;     ///< side of one
  int CellPixels = 0;  ///< the same in pixels of the screen
  double Labels = 0;   ///< room for names beside the cells and above them; 0 if they do not fit
  QSizeF Whole;        ///< with headings and key

  QRectF Place(const HitCell& cell) const {
    return {Cells.left() + cell.Victim * Cell, Cells.top() + cell.Shooter * Cell, Cell, Cell};
  }
};

/// Draws the heat map of a matrix: bands of the teams and, where they fit, names beside the cells and the
/// damage in them, and a key of the colours below.
class HitMapPainter {
 public:
  /// `matrix` and `strings` must outlive this. It draws in `ink` on a ground of its user's.
  HitMapPainter(const HitMatrix& matrix, const StringTable& strings, const QFont& font, QColor ink);

  /// The largest layout for that room, on a screen with that many pixels to a unit.
  HitMapLayout LayoutFor(QSizeF room, double pixelRatio) const;
  /// The layout with cells of that side and with names.
  HitMapLayout LayoutWith(double cell, double pixelRatio) const;

  void Draw(QPainter& painter, const HitMapLayout& layout) const;

 private:
  HitMapLayout Layout(int cellPixels, double pixelRatio, double labels) const;
  double LineHeight() const;
  /// What the longest name takes in the font of names.
  double LongestName(double cell) const;
  QFont NameFont(double cell) const;
  double KeyWidth() const;
  void DrawHeadings(QPainter& painter, const HitMapLayout& layout) const;
  void DrawNames(QPainter& painter, const HitMapLayout& layout) const;
  void DrawNumbers(QPainter& painter, const HitMapLayout& layout) const;
  void DrawLines(QPainter& painter, const HitMapLayout& layout) const;
  void DrawKey(QPainter& painter, const HitMapLayout& layout) const;
  void DrawOwnTeamSample(QPainter& painter, const QRectF& sample, const HitMapLayout& layout) const;

  const HitMatrix& matrix_;
  const StringTable& strings_;
  const QFont font_;
  const QColor ink_;
  QStringList names_;
};
