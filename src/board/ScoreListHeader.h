#pragma once

#include <QHeaderView>

/// The headers of a score list. The column that orders the rows has a small triangle above its caption, with
/// the point towards the largest figure's end.
class ScoreListHeader : public QHeaderView {
  Q_OBJECT

 public:
  explicit ScoreListHeader(QWidget* parent);

  /// Where the sign stands in a column's section at this place: above the caption.
  QRect SignPlace(int column, const QRect& section) const;

  /// Takes the captions and the margins of their sections, before CaptionWidth.
  void MeasureCaptions();
  /// Width that a column's section needs with captions in this font.
  int CaptionWidth(int column, const QFont& captions) const;

 signals:
  /// The operator has given columns other widths.
  void WidthsDragged();

 protected:
  void paintSection(QPainter* painter, const QRect& rect, int logicalIndex) const override;
  void mousePressEvent(QMouseEvent* event) override;
  void mouseReleaseEvent(QMouseEvent* event) override;

 private:
  QList<int> Sizes() const;

  struct Caption {
    QString Text;
    int Margins;
  };
  QList<Caption> captions_;
  QList<int> sizesBefore_;  ///< when the mouse was pressed
};
