#include "audience/AudiencePages.h"

#include <QPainter>
#include <algorithm>

#include "audience/AudienceColours.h"
#include "audience/AudienceText.h"

namespace {

// In heights of a capital.
constexpr double BadgeSide = 1.5;
constexpr double TotalSignGap = 0.4;
constexpr double TotalGapAtLeast = 0.6;
constexpr double ColumnsGap = 1.2;
constexpr double Inset = 0.25;  ///< of a row's texts
constexpr double TextGap = 0.45;
constexpr double NarrowGap = 0.3;

constexpr double LeastSqueezeOfText = 0.8;
constexpr double LeastSqueezeOfGuns = 0.5;

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

/// A badge in the middle of `area`, lower where its line is low.
QRectF BadgeIn(const QRectF& area, double capital) {
  constexpr double tight = 0.96;
  const double height = std::min(BadgeSide * capital, area.height() * tight);
  return {area.left(), area.center().y() - height / 2, area.width(), height};
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
  const Style large = StyleOf(layout_.Capital * layout_.WinnerScale);
  const std::vector<PlacedRow> rows = RowsOn(page, large);
  const std::vector<PlacedTotal> totals = TotalsOn(page);
  // All grounds first: letters reach down into the next line.
  for (const PlacedTotal& total : totals) {
    painter.fillRect(total.Badge, AudienceColours::Team(total.Total.Team));
  }
  for (const PlacedRow& row : rows) {
    painter.fillRect(row.Area, AudienceColours::Row(row.Texts.Team));
    painter.fillRect(PartsOf(row).Badge, AudienceColours::Team(row.Texts.Team));
  }
  PaintHeading(painter, page);
  for (const PlacedTotal& total : totals) {
    PaintTotal(painter, total);
  }
  for (const PlacedRow& row : rows) {
    PaintTexts(painter, row);
  }
}

std::vector<AudiencePages::PlacedRow> AudiencePages::RowsOn(int page, const Style& large) const {
  const AudienceRows rows = RowsOfPage(layout_, contents_.Players, page);
  const int winners = rows.First == 0 ? layout_.Winners : 0;
  const std::vector<QRectF> areas = AreasOf(page);
  std::vector<PlacedRow> placed;
  for (int i = 0; i < rows.Count; ++i) {
    const bool isWinner = i < winners;
    placed.push_back({rows_[static_cast<std::size_t>(rows.First) + static_cast<std::size_t>(i)],
                      areas[static_cast<std::size_t>(i)], isWinner ? large : style_, isWinner});
  }
  return placed;
}

void AudiencePages::PaintHeading(QPainter& painter, int page) const {
  QRectF area(layout_.Margin, layout_.Margin, place_.Width - 2 * layout_.Margin, layout_.Pitch);
  painter.setPen(AudienceColours::QuietLetters());
  if (layout_.RowPages > 1) {
    const QString number = QNumber(page % layout_.RowPages + 1) + u'/' + QNumber(layout_.RowPages);
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

std::vector<AudiencePages::PlacedTotal> AudiencePages::TotalsOn(int page) const {
  const int teams = contents_.Teams;
  const int first = FirstTotalOfPage(layout_, teams, page);
  const double capital = layout_.Capital;
  const int shown = std::min(teams, layout_.TotalLines * layout_.TotalsPerLine);
  std::vector<PlacedTotal> placed;
  for (int i = 0; i < shown; ++i) {
    const AudienceTotal& total = results_.Totals[static_cast<std::size_t>((first + i) % teams)];
    const int line = 1 + i / layout_.TotalsPerLine;  // below the header
    const double left = layout_.Margin + (i % layout_.TotalsPerLine) * layout_.TotalWidth;
    const double top = layout_.Margin + line * layout_.Pitch;
    QRectF area(left, top, layout_.TotalWidth - TotalGapAtLeast * capital, layout_.Pitch);
    const QRectF badge = TakeLeft(area, BadgeSide * capital, TotalSignGap * capital);
    placed.push_back({total, BadgeIn(badge, capital), area});
  }
  return placed;
}

void AudiencePages::PaintTotal(QPainter& painter, const PlacedTotal& total) const {
  PaintLetter(painter, total.Badge, total.Total.Team, style_);
  painter.setPen(AudienceColours::Team(total.Total.Team));
  DrawLine(painter, total.Points, QNumber(total.Total.Points), style_.Bold, Qt::AlignLeft);
}

std::vector<QRectF> AudiencePages::AreasOf(int page) const {
  std::vector<QRectF> areas;
  const double width = place_.Width - 2 * layout_.Margin;
  double top = layout_.Margin + (1 + layout_.TotalLines) * layout_.Pitch;
  const bool isFirst = page % layout_.RowPages == 0;
  if (isFirst) {
    const double pitch = layout_.Pitch * layout_.WinnerScale;
    for (int i = 0; i < layout_.Winners; ++i) {
      areas.emplace_back(layout_.Margin, top, width, pitch * RowShare);
      top += pitch;
    }
  }
  const double gap = ColumnsGap * layout_.Capital;
  const double column = (width - (layout_.Columns - 1) * gap) / layout_.Columns;
  for (int i = 0; i < layout_.Columns; ++i) {
    for (int row = 0; row < (isFirst ? layout_.FirstRows : layout_.Rows); ++row) {
      areas.emplace_back(layout_.Margin + i * (column + gap), top + row * layout_.Pitch, column,
                         layout_.Pitch * RowShare);
    }
  }
  return areas;
}

AudiencePages::Parts AudiencePages::PartsOf(const PlacedRow& row) const {
  const double unit = row.Letters.Capital * layout_.Squeeze;
  Parts parts;
  if (!layout_.Names) {
    QRectF rest = row.Area;
    parts.Points = TakeRight(rest, contents_.Points * unit, NarrowGap * unit);
    parts.Place = TakeLeft(rest, contents_.Place * unit, NarrowGap * unit);
    parts.Name = rest;
    return parts;
  }
  QRectF rest = row.Area.adjusted(Inset * unit, 0, -Inset * unit, 0);
  parts.Points = TakeRight(rest, contents_.Points * unit * 1.02, TextGap * unit);
  parts.Place = TakeLeft(rest, contents_.Place * unit * 1.02, TextGap * unit);
  parts.Badge = BadgeIn(TakeLeft(rest, BadgeSide * unit, TextGap * unit), row.Letters.Capital);
  parts.Name = rest;
  return parts;
}

void AudiencePages::PaintTexts(QPainter& painter, const PlacedRow& row) const {
  const Parts parts = PartsOf(row);
  const Style& style = row.Letters;
  const double least = layout_.Names ? LeastSqueezeOfText : LeastSqueezeOfGuns;
  painter.setPen(AudienceColours::Letters());
  DrawLine(painter, parts.Points, row.Texts.Points, style.Bold, Qt::AlignRight, least);
  DrawLine(painter, parts.Place, row.Texts.Place, style.Plain, Qt::AlignRight, least);
  if (!layout_.Names) {
    painter.setPen(AudienceColours::Team(row.Texts.Team));
    DrawLine(painter, parts.Name, row.Texts.Gun, style.Bold, Qt::AlignLeft, least);
    return;
  }
  PaintLetter(painter, parts.Badge, row.Texts.Team, style);
  painter.setPen(row.IsWinner ? AudienceColours::Team(row.Texts.Team) : AudienceColours::Letters());
  DrawLine(painter, parts.Name, row.Texts.Name, row.IsWinner ? style.Bold : style.Plain, Qt::AlignLeft,
           least);
}

void AudiencePages::PaintLetter(QPainter& painter, const QRectF& badge, int team, const Style& style) const {
  painter.setPen(AudienceColours::BadgeLetters());
  DrawLine(painter, badge, letters_[static_cast<std::size_t>(team - 1)], style.Bold, Qt::AlignHCenter);
}
