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

  /// Where a row's texts stand.
  struct Parts {
    QRectF Place;
    QRectF Badge;  ///< empty where the gun stands in the team's colour
    QRectF Name;
    QRectF Points;
  };

  /// A row and where it stands on a page.
  struct PlacedRow {
    const Row& Texts;
    QRectF Area;
    const Style& Letters;
    bool IsWinner;
  };

  /// A team's total and where it stands.
  struct PlacedTotal {
    const AudienceTotal& Total;
    QRectF Badge;
    QRectF Points;
  };

  AudienceContents Measure() const;
  Style StyleOf(double capital) const;
  std::vector<PlacedRow> RowsOn(int page, const Style& large) const;
  std::vector<PlacedTotal> TotalsOn(int page) const;
  Parts PartsOf(const PlacedRow& row) const;
  void PaintHeading(QPainter& painter, int page) const;
  void PaintTotal(QPainter& painter, const PlacedTotal& total) const;
  void PaintTexts(QPainter& painter, const PlacedRow& row) const;
  void PaintLetter(QPainter& painter, const QRectF& badge, int team, const Style& style) const;
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
