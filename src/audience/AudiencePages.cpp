#include "audience/AudiencePages.h"

#include <QPainter>
#include <algorithm>

#include "audience/AudienceColours.h"
#include "audience/AudienceText.h"

namespace {

// In heights of a capital.
constexpr double BadgeSide = 1.5;
constexpr double TotalSignGap = 0.4;
constexpr double TotalsGap = 1.2;
constexpr double ColumnsGap = 1.2;
constexpr double Inset = 0.25;  ///< of a row's texts
constexpr double TextGap = 0.45;
constexpr double NarrowGap = 0.3;

constexpr double RowShare = 0.93;  ///< of the pitch, the rest is between rows

QString QText(const std::string& text) {
  return QString::fromStdString(text);
}

QString QNumber(std::int64_t number) {
  return QString::number(number);
}

/// A part of `area` from its left, which loses it and the gap behind it.
QRectF TakeLeft(QRectF& area, double width, double gap) {
  const QRectF taken(area.topLeft(), QSizeF(width, area.height()));
  area.setLeft(area.left() + width + gap);
  return taken;
}

QRectF TakeRight(QRectF& area, double width, double gap) {
  const QRectF taken(area.right() - width, area.top(), width, area.height());
  area.setRight(area.right() - width - gap);
  return taken;
}

}  // namespace

AudiencePages::AudiencePages(const AudienceResults& results, const StringTable& strings,
                             const AudiencePlace& place)
    : results_(results), place_(place) {
  for (int team = 1; team <= TeamCount; ++team) {
    letters_.push_back(QText(TeamLetter(strings, team)));
  }
  for (const Standing& player : results.Players) {
    rows_.push_back({QNumber(player.Place), QText(ShortGunName(strings, player)), QText(player.PublicName),
                     QNumber(player.Soldiering), player.Team});
  }
  contents_ = Measure();
  layout_ = LayOut(place, contents_);
  style_ = StyleOf(layout_.Capital);
}

AudienceContents AudiencePages::Measure() const {
  AudienceContents contents;
  contents.Players = static_cast<int>(rows_.size());
  contents.Teams = static_cast<int>(results_.Totals.size());
  const auto grow = [](double& width, const QString& text, bool bold) {
    width = std::max(width, WidthInCapitals(text, bold));
  };
  for (const Row& row : rows_) {
    grow(contents.Place, row.Place, false);
    grow(contents.Gun, row.Gun, true);
    grow(contents.Name, row.Name, true);  // as a winner's
    grow(contents.Points, row.Points, true);
  }
  for (const AudienceTotal& total : results_.Totals) {
    grow(contents.Total, QNumber(total.Points), true);
  }
  return contents;
}

AudiencePages::Style AudiencePages::StyleOf(double capital) const {
  return {capital, FontWithCapitals(capital, false), FontWithCapitals(capital, true)};
}

void AudiencePages::Paint(QPainter& painter, int page) const {
  PaintHeading(painter, page);
  PaintTotals(painter, page);
  const AudienceRows rows = RowsOfPage(layout_, contents_.Players, page);
  const int winners = page == 0 ? layout_.Winners : 0;
  const Style large = winners > 0 ? StyleOf(layout_.Capital * layout_.WinnerScale) : style_;
  const std::vector<QRectF> areas = AreasOf(page);
  for (int i = 0; i < rows.Count; ++i) {
    const bool isWinner = i < winners;
    PaintRow(painter, rows_[static_cast<std::size_t>(rows.First) + static_cast<std::size_t>(i)],
             areas[static_cast<std::size_t>(i)], isWinner ? large : style_, isWinner);
  }
}

void AudiencePages::PaintHeading(QPainter& painter, int page) const {
  QRectF area(layout_.Margin, layout_.Margin, place_.Width - 2 * layout_.Margin, layout_.Pitch);
  painter.setPen(AudienceColours::QuietLetters());
  if (layout_.Pages > 1) {
    const QString number = QNumber(page + 1) + u'/' + QNumber(layout_.Pages);
    const double width = std::min(area.width(), WidthInCapitals(number, true) * layout_.Capital * 1.02);
    DrawLine(painter, TakeRight(area, width, layout_.Capital), number, style_.Bold, Qt::AlignRight);
  }
  // A few letters of a long heading tell nothing.
  const double shortest = 6 * layout_.Capital;
  if (area.width() >= shortest) {
    const std::string& heading = results_.Mission.empty() ? results_.Time : results_.Mission;
    DrawLine(painter, area, QText(heading), style_.Plain, Qt::AlignLeft);
  }
}

void AudiencePages::PaintTotals(QPainter& painter, int page) const {
  const int teams = contents_.Teams;
  const int first = FirstTotalOfPage(layout_, teams, page);
  const double capital = layout_.Capital;
  const double whole = place_.Width - 2 * layout_.Margin;
  const double width =
      std::min(whole, (BadgeSide + TotalSignGap + contents_.Total * 1.02 + TotalsGap) * capital);
  const int shown = std::min(teams, layout_.TotalLines * layout_.TotalsPerLine);
  for (int i = 0; i < shown; ++i) {
    const AudienceTotal& total = results_.Totals[static_cast<std::size_t>((first + i) % teams)];
    const int line = i / layout_.TotalsPerLine;
    const double left = layout_.Margin + (i % layout_.TotalsPerLine) * width;
    const double top = layout_.Margin + (1 + line) * layout_.Pitch;
    QRectF area(left, top, width, layout_.Pitch);
    PaintBadge(painter, TakeLeft(area, BadgeSide * capital, TotalSignGap * capital), total.Team, style_);
    painter.setPen(AudienceColours::Team(total.Team));
    DrawLine(painter, area, QNumber(total.Points), style_.Bold, Qt::AlignLeft);
  }
}

std::vector<QRectF> AudiencePages::AreasOf(int page) const {
  std::vector<QRectF> areas;
  const double width = place_.Width - 2 * layout_.Margin;
  double top = layout_.Margin + (1 + layout_.TotalLines) * layout_.Pitch;
  if (page == 0) {
    const double pitch = layout_.Pitch * layout_.WinnerScale;
    for (int i = 0; i < layout_.Winners; ++i) {
      areas.emplace_back(layout_.Margin, top, width, pitch * RowShare);
      top += pitch;
    }
  }
  const double gap = ColumnsGap * layout_.Capital;
  const double column = (width - (layout_.Columns - 1) * gap) / layout_.Columns;
  for (int i = 0; i < layout_.Columns; ++i) {
    for (int row = 0; row < (page == 0 ? layout_.FirstRows : layout_.Rows); ++row) {
      areas.emplace_back(layout_.Margin + i * (column + gap), top + row * layout_.Pitch, column,
                         layout_.Pitch * RowShare);
    }
  }
  return areas;
}

void AudiencePages::PaintRow(QPainter& painter, const Row& row, const QRectF& area, const Style& style,
                             bool isWinner) const {
  painter.fillRect(area, AudienceColours::Row(row.Team));
  if (layout_.Names) {
    PaintNamed(painter, row, area, style, isWinner);
    return;
  }
  const double unit = style.Capital * layout_.Squeeze;
  constexpr double least = 0.5;
  QRectF rest = area;
  painter.setPen(AudienceColours::Letters());
  DrawLine(painter, TakeRight(rest, contents_.Points * unit, NarrowGap * unit), row.Points, style.Bold,
           Qt::AlignRight, least);
  DrawLine(painter, TakeLeft(rest, contents_.Place * unit, NarrowGap * unit), row.Place, style.Plain,
           Qt::AlignRight, least);
  painter.setPen(AudienceColours::Team(row.Team));
  DrawLine(painter, rest, row.Gun, style.Bold, Qt::AlignLeft, least);
}

void AudiencePages::PaintNamed(QPainter& painter, const Row& row, const QRectF& area, const Style& style,
                               bool isWinner) const {
  const double unit = style.Capital * layout_.Squeeze;
  QRectF rest = area.adjusted(Inset * unit, 0, -Inset * unit, 0);
  painter.setPen(AudienceColours::Letters());
  DrawLine(painter, TakeRight(rest, contents_.Points * unit * 1.02, TextGap * unit), row.Points, style.Bold,
           Qt::AlignRight);
  DrawLine(painter, TakeLeft(rest, contents_.Place * unit * 1.02, TextGap * unit), row.Place, style.Plain,
           Qt::AlignRight);
  PaintBadge(painter, TakeLeft(rest, BadgeSide * unit, TextGap * unit), row.Team, style);
  painter.setPen(isWinner ? AudienceColours::Team(row.Team) : AudienceColours::Letters());
  DrawLine(painter, rest, row.Name, isWinner ? style.Bold : style.Plain, Qt::AlignLeft);
}

void AudiencePages::PaintBadge(QPainter& painter, const QRectF& area, int team, const Style& style) const {
  constexpr double tight = 0.96;  // of a low row
  const double height = std::min(BadgeSide * style.Capital, area.height() * tight);
  const QRectF badge(area.left(), area.center().y() - height / 2, area.width(), height);
  painter.fillRect(badge, AudienceColours::Team(team));
  painter.setPen(AudienceColours::BadgeLetters());
  DrawLine(painter, badge, letters_[static_cast<std::size_t>(team - 1)], style.Bold, Qt::AlignHCenter);
}
