#include "archive/history/HistoryChart.h"

#include <QKeyEvent>
#include <QMouseEvent>
#include <QPainter>
#include <QPainterPath>
#include <algorithm>
#include <cmath>
#include <utility>

#include "charts/ChartKeys.h"

namespace {

constexpr double AxisGap = 6;

/// A round distance of the lines across: some five of them for `range`.
double RoundTick(double range) {
  constexpr double lines = 5;
  const double rough = std::max(range / lines, 1.0);
  const double power = std::pow(10.0, std::floor(std::log10(rough)));
  for (const double factor : {1.0, 2.0, 5.0}) {
    if (factor * power >= rough) {
      return factor * power;
    }
  }
  return 10 * power;
}

QString AxisText(double value) {
  return QString::number(value, 'f', 0);
}

}  // namespace

HistoryChart::HistoryChart(QWidget* parent) : QWidget(parent) {
  setFocusPolicy(Qt::StrongFocus);
  setMouseTracking(true);
  setBackgroundRole(QPalette::Base);
  setAutoFillBackground(true);
}

void HistoryChart::SetUp(Kind kind, const QString& name, const QString& description) {
  kind_ = kind;
  setAccessibleName(name);
  setAccessibleDescription(description);
}

void HistoryChart::SetPoints(std::vector<HistoryPoint> points) {
  points_ = std::move(points);
  double least = 0;
  double most = 0;
  for (const HistoryPoint& point : points_) {
    least = std::min(least, point.Value);
    most = std::max(most, point.Value);
  }
  tick_ = RoundTick(most - least);
  least_ = std::floor(least / tick_) * tick_;
  most_ = std::max(std::ceil(most / tick_) * tick_, least_ + tick_);
  SetPlace(std::nullopt);
}

void HistoryChart::SetPlace(std::optional<int> place) {
  place_ = place && *place >= 0 && *place < Count() ? place : std::nullopt;
  update();
}

QRectF HistoryChart::Area() const {
  const QFontMetricsF metrics(font());
  const double left =
      std::max(metrics.horizontalAdvance(AxisText(most_)), metrics.horizontalAdvance(AxisText(least_))) +
      2 * AxisGap;
  return QRectF(rect()).adjusted(left, metrics.height() / 2 + 2, -AxisGap, -metrics.height() - AxisGap);
}

double HistoryChart::HeightOf(double value) const {
  const QRectF area = Area();
  return area.bottom() - (value - least_) / (most_ - least_) * area.height();
}

QPointF HistoryChart::SpotOf(int place) const {
  return {Area().left() + (place + 0.5) * Step(), HeightOf(At(place).Value)};
}

QRectF HistoryChart::BarOf(int place) const {
  constexpr double share = 0.6;
  constexpr double widest = 60;
  const double width = std::min(share * Step(), widest);
  const QPointF spot = SpotOf(place);
  return QRectF(QPointF(spot.x() - width / 2, spot.y()), QPointF(spot.x() + width / 2, HeightOf(0)))
      .normalized();
}

int HistoryChart::PlaceAt(double x) const {
  const QRectF area = Area();
  return points_.empty() || x < area.left() || x > area.right()
             ? -1
             : std::min(static_cast<int>((x - area.left()) / Step()), Count() - 1);
}

void HistoryChart::DrawAxes(QPainter& painter) const {
  const QRectF area = Area();
  const QColor ink = palette().color(QPalette::Text);
  QColor faint = ink;
  constexpr int faintness = 50;
  faint.setAlpha(faintness);
  const double line = QFontMetricsF(font()).height();
  const auto lines = static_cast<int>(std::lround((most_ - least_) / tick_));
  for (int each = 0; each <= lines; ++each) {
    const double value = least_ + each * tick_;
    const bool isZero = std::abs(value) < tick_ / 2;
    painter.setPen(isZero ? ink : faint);
    painter.drawLine(QPointF(area.left(), HeightOf(value)), QPointF(area.right(), HeightOf(value)));
    painter.setPen(ink);
    painter.drawText(QRectF(0, HeightOf(value) - line / 2, area.left() - AxisGap, line),
                     Qt::AlignRight | Qt::AlignVCenter, AxisText(isZero ? 0 : value));
  }
}

void HistoryChart::DrawLabels(QPainter& painter) const {
  const QRectF area = Area();
  const QFontMetricsF metrics(font());
  painter.setPen(palette().color(QPalette::Text));
  double free = 0;
  for (int place = 0; place < Count(); ++place) {
    const double width = metrics.horizontalAdvance(At(place).Label);
    const double left = std::clamp(SpotOf(place).x() - width / 2, 0.0, std::max(area.right() - width, 0.0));
    if (left >= free) {
      painter.drawText(QRectF(left, area.bottom() + AxisGap / 2, width + 1, metrics.height()),
                       Qt::AlignCenter, At(place).Label);
      free = left + width + 2 * AxisGap;
    }
  }
}

void HistoryChart::DrawBars(QPainter& painter) const {
  const QColor ink = palette().color(QPalette::Text);
  for (int place = 0; place < Count(); ++place) {
    painter.setPen(ink);
    const bool isHollow = At(place).Value < 0;
    painter.setBrush(isHollow ? QBrush(ink, Qt::BDiagPattern) : palette().brush(QPalette::Highlight));
    painter.drawRect(BarOf(place));
  }
}

void HistoryChart::DrawCurve(QPainter& painter) const {
  const QColor ink = palette().color(QPalette::Text);
  constexpr double largestDot = 4;
  const double dot = std::clamp(Step() / 3, 1.0, largestDot);
  QPainterPath line;
  painter.setPen(QPen(ink, 1));
  for (int place = 0; place < Count(); ++place) {
    const QPointF spot = SpotOf(place);
    painter.setBrush(At(place).Value < 0 ? palette().brush(QPalette::Base) : QBrush(ink));
    painter.drawEllipse(spot, dot, dot);
    if (const std::optional<double> mean = At(place).Mean) {
      const QPointF point(spot.x(), HeightOf(*mean));
      if (line.elementCount() == 0) {
        line.moveTo(point);
      } else {
        line.lineTo(point);
      }
    }
  }
  constexpr double lineWidth = 2.5;
  painter.setBrush(Qt::NoBrush);
  painter.setPen(QPen(palette().color(QPalette::Highlight), lineWidth));
  painter.drawPath(line);
}

void HistoryChart::paintEvent(QPaintEvent* /*event*/) {
  if (points_.empty()) {
    return;
  }
  QPainter painter(this);
  painter.setRenderHint(QPainter::Antialiasing);
  if (place_) {
    QColor strip = palette().color(QPalette::Highlight);
    constexpr int faint = 40;
    strip.setAlpha(hasFocus() ? 2 * faint : faint);
    constexpr double narrowest = 5;
    const double width = std::max(Step(), narrowest);
    const QRectF area = Area();
    painter.fillRect(QRectF(SpotOf(*place_).x() - width / 2, area.top(), width, area.height()), strip);
  }
  DrawAxes(painter);
  DrawLabels(painter);
  if (kind_ == Kind::Bars) {
    DrawBars(painter);
  } else {
    DrawCurve(painter);
  }
}

void HistoryChart::GoTo(int place, bool chosen) {
  if (place_ != place || chosen) {
    SetPlace(place);
    emit Told(At(place).Text, chosen);
  }
}

void HistoryChart::keyPressEvent(QKeyEvent* event) {
  if (!points_.empty()) {
    if (const auto place =
            PlaceByKey(event->key(), place_.value_or(Count() - 1), Count(), ChartOrder::Across)) {
      GoTo(*place, true);
      return;
    }
  }
  QWidget::keyPressEvent(event);
}

void HistoryChart::mouseMoveEvent(QMouseEvent* event) {
  if (const int place = PlaceAt(event->position().x()); place >= 0) {
    setToolTip(At(place).Text);
    GoTo(place, false);
  }
}

void HistoryChart::mousePressEvent(QMouseEvent* event) {
  if (const int place = PlaceAt(event->position().x()); place >= 0) {
    GoTo(place, true);
  }
}

void HistoryChart::focusInEvent(QFocusEvent* event) {
  if (!points_.empty() &&
      (event->reason() == Qt::TabFocusReason || event->reason() == Qt::BacktabFocusReason)) {
    GoTo(place_.value_or(Count() - 1), true);
  }
  QWidget::focusInEvent(event);
  update();
}

void HistoryChart::focusOutEvent(QFocusEvent* event) {
  QWidget::focusOutEvent(event);
  update();
}
