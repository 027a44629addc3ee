#pragma once

#include <QImage>
#include <QWidget>
#include <optional>

#include "charts/HitMapPainter.h"

/// Who hit whom as a heat map. The pointer and the arrow keys go from cell to cell.
class HitMap : public QWidget {
  Q_OBJECT

 public:
  explicit HitMap(QWidget* parent = nullptr);

  /// Must be called first; `strings` must outlive this.
  void SetUp(const StringTable& strings);

  /// The cell that is told stays the same place if there still is one.
  void SetMatrix(HitMatrix matrix);
  const HitMatrix& Matrix() const { return matrix_; }

  /// The cell that is told at the moment.
  std::optional<HitCell> Cell() const { return cell_; }
  /// Goes to a cell without telling it.
  void SetCell(std::optional<HitCell> cell);

  /// Where a cell is painted.
  QRect PlaceOf(const HitCell& cell) const;

  /// "Blue  7 hit Red  3: damage 120"
  QString TextOf(const HitCell& cell) const;

  /// The whole map on white, with the names whatever their number.
  QImage Picture(const QString& title) const;

 signals:
  /// The operator went to a cell; by keys or a click if `chosen`, else with the pointer.
  void Told(const QString& text, bool chosen);

 protected:
  void paintEvent(QPaintEvent* event) override;
  void resizeEvent(QResizeEvent* event) override;
  void changeEvent(QEvent* event) override;
  void keyPressEvent(QKeyEvent* event) override;
  void mouseMoveEvent(QMouseEvent* event) override;
  void mousePressEvent(QMouseEvent* event) override;
  void focusInEvent(QFocusEvent* event) override;
  void focusOutEvent(QFocusEvent* event) override;

 private:
  HitMapLayout Layout() const;
  std::optional<HitCell> CellAt(const QPointF& point) const;
  void GoTo(const HitCell& cell, bool chosen);
  /// Draws all but what marks the cell that is told.
  void DrawMap();
  void DrawMark(QPainter& painter, const HitCell& cell) const;

  const StringTable* strings_ = nullptr;
  HitMatrix matrix_;
  std::optional<HitCell> cell_;
  QImage map_;  ///< null once something about it has changed
};
