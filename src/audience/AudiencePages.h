#pragma once

#include <QFont>
#include <QRectF>
#include <QString>
#include <vector>

#include "audience/AudienceLayout.h"
#include "audience/AudienceResults.h"

class QPainter;

/// The pages with a game's results, for one place. Painted in pixels of the screen.
class AudiencePages {
 public:
  /// All must outlive this object.
  AudiencePages(const AudienceResults& results, const StringTable& strings, const AudiencePlace& place);

  const AudienceLayout& Layout() const { return layout_; }
  int Count() const { return layout_.Pages; }

  /// `page` counts from 0. The painter's page must be filled.
  void Paint(QPainter& painter, int page) const;

 private:
  /// What a row's texts are drawn with.
  struct Style {
    double Capital;
    QFont Plain;
    QFont Bold;
  };

  struct Row {
    QString Place;
    QString Gun;
    QString Name;
    QString Points;
    int Team;
  };

  AudienceContents Measure() const;
  Style StyleOf(double capital) const;
  void PaintHeading(QPainter& painter, int page) const;
  void PaintTotals(QPainter& painter, int page) const;
  void PaintRow(QPainter& painter, const Row& row, const QRectF& area, const Style& style,
                bool isWinner) const;
  void PaintNamed(QPainter& painter, const Row& row, const QRectF& area, const Style& style,
                  bool isWinner) const;
  void PaintBadge(QPainter& painter, const QRectF& area, int team, const Style& style) const;
  /// Places of the rows of a page, from the top of each column down.
  std::vector<QRectF> AreasOf(int page) const;

  const AudienceResults& results_;
  const AudiencePlace place_;
  std::vector<QString> letters_;  ///< of the teams
  std::vector<Row> rows_;
  AudienceContents contents_;
  AudienceLayout layout_;
  Style style_;
};
