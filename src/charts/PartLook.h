#pragma once

#include <QPainter>
#include <QWidget>
#include <vector>

#include "charts/ScoreParts.h"
#include "core/text/StringTable.h"

/// How the operator reads a part of the points.
QString NameOfPart(ScorePart part, const StringTable& strings);

/// Fills the area with the part's colour and pattern; no two parts share their pattern.
void FillWithPart(QPainter& painter, const QRectF& area, ScorePart part);

/// The mark at a player's score: a rhombus.
void DrawScoreMark(QPainter& painter, const QPointF& centre, double size);

/// Which colour and pattern is what, and the mark of the score; in lines of that width.
class PartKey {
 public:
  PartKey(std::vector<ScorePart> parts, const StringTable& strings, const QFont& font);

  double HeightFor(double width) const;
  void Draw(QPainter& painter, const QRectF& area) const;

 private:
  struct Entry {
    int Part;  ///< -1 for the mark of the score
    QString Name;
    QPointF Place;
  };
  /// Places of all entries, and the height that they take.
  double Arrange(double width, std::vector<Entry>& entries) const;

  const std::vector<ScorePart> parts_;
  const StringTable& strings_;
  const QFont font_;
};

/// The key as a control.
class PartLegend : public QWidget {
  Q_OBJECT

 public:
  explicit PartLegend(QWidget* parent = nullptr);

  /// `strings` must outlive this.
  void SetParts(std::vector<ScorePart> parts, const StringTable& strings);

  bool hasHeightForWidth() const override { return true; }
  int heightForWidth(int width) const override;
  QSize sizeHint() const override;
  QSize minimumSizeHint() const override;

 protected:
  void paintEvent(QPaintEvent* event) override;

 private:
  std::vector<ScorePart> parts_;
  const StringTable* strings_ = nullptr;
};
