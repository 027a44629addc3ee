#include "charts/PartLook.h"

#include <QFontMetricsF>
#include <array>
#include <cmath>
#include <utility>

#include "ui/Text.h"

namespace {

constexpr double SwatchWidth = 26;
constexpr double SwatchGap = 6;
constexpr double EntryGap = 18;

struct Look {
  QRgb Ground;
  QRgb Ink;
  Qt::BrushStyle Pattern;
};

/// By ScorePart. Neighbours differ in lightness as well.
constexpr std::array<Look, ScorePartCount> Looks = {{
    {qRgb(38, 92, 150), qRgb(38, 92, 150), Qt::SolidPattern},
    {qRgb(176, 48, 48), qRgb(255, 225, 220), Qt::BDiagPattern},
    {qRgb(240, 190, 80), qRgb(120, 80, 0), Qt::Dense6Pattern},
    {qRgb(95, 95, 95), qRgb(235, 235, 235), Qt::DiagCrossPattern},
    {qRgb(214, 160, 200), qRgb(90, 20, 80), Qt::HorPattern},
    {qRgb(150, 110, 70), qRgb(255, 240, 215), Qt::VerPattern},
    {qRgb(90, 175, 150), qRgb(0, 60, 45), Qt::FDiagPattern},
    {qRgb(205, 225, 120), qRgb(70, 90, 0), Qt::CrossPattern},
    {qRgb(120, 110, 190), qRgb(240, 240, 255), Qt::Dense5Pattern},
    {qRgb(175, 205, 235), qRgb(20, 60, 110), Qt::Dense7Pattern},
    {qRgb(250, 250, 250), qRgb(250, 250, 250), Qt::NoBrush},
    {qRgb(20, 20, 20), qRgb(255, 255, 255), Qt::Dense4Pattern},
}};

}  // namespace

QString NameOfPart(ScorePart part, const StringTable& strings) {
  constexpr int accuracy = 106;
  constexpr int damage = 107;
  constexpr int wia = 109;
  constexpr int kia = 110;
  constexpr int ammoAdds = 111;
  const std::array<int, ScorePartCount> texts = {damage,
                                                 static_cast<int>(OwnText::HitsOnOwnTeam),
                                                 accuracy,
                                                 kia,
                                                 wia,
                                                 ammoAdds,
                                                 static_cast<int>(OwnText::BonusOfPlayer),
                                                 static_cast<int>(OwnText::MissionObjectives),
                                                 static_cast<int>(OwnText::RespawnPenalty),
                                                 static_cast<int>(OwnText::HealPenalty),
                                                 static_cast<int>(OwnText::RoundingOfPoints),
                                                 static_cast<int>(OwnText::OtherPoints)};
  return Text(strings, texts.at(static_cast<std::size_t>(part)));
}

void FillWithPart(QPainter& painter, const QRectF& area, ScorePart part) {
  const Look& look = Looks.at(static_cast<std::size_t>(part));
  painter.fillRect(area, QColor(look.Ground));
  painter.setBrushOrigin(area.topLeft());
  painter.fillRect(area, QBrush(QColor(look.Ink), look.Pattern));
  painter.save();
  painter.setPen(QPen(QColor(60, 60, 60), 1));
  painter.setBrush(Qt::NoBrush);
  painter.drawRect(area);
  painter.restore();
}

void DrawScoreMark(QPainter& painter, const QPointF& centre, double size) {
  painter.save();
  painter.setRenderHint(QPainter::Antialiasing);
  painter.setPen(QPen(Qt::white, 1.5));
  painter.setBrush(Qt::black);
  const double half = size / 2;
  painter.drawPolygon(QPolygonF({centre - QPointF(0, half), centre + QPointF(half, 0),
                                 centre + QPointF(0, half), centre - QPointF(half, 0)}));
  painter.restore();
}

PartKey::PartKey(std::vector<ScorePart> parts, const StringTable& strings, const QFont& font)
    : parts_(std::move(parts)), strings_(strings), font_(font) {}

double PartKey::Arrange(double width, std::vector<Entry>& entries) const {
  constexpr int soldiering = 105;
  entries.push_back({-1, Text(strings_, soldiering), {}});
  for (const ScorePart part : parts_) {
    entries.push_back({static_cast<int>(part), NameOfPart(part, strings_), {}});
  }
  const QFontMetricsF metrics(font_);
  const double line = std::ceil(metrics.height() * 1.35);
  QPointF place;
  for (Entry& entry : entries) {
    const double needed = SwatchWidth + SwatchGap + metrics.horizontalAdvance(entry.Name);
    if (place.x() > 0 && place.x() + needed > width) {
      place = {0, place.y() + line};
    }
    entry.Place = place;
    place.rx() += needed + EntryGap;
  }
  return place.y() + line;
}

double PartKey::HeightFor(double width) const {
  std::vector<Entry> entries;
  return Arrange(width, entries);
}

void PartKey::Draw(QPainter& painter, const QRectF& area) const {
  std::vector<Entry> entries;
  Arrange(area.width(), entries);
  painter.setFont(font_);
  const double height = QFontMetricsF(font_).height();
  for (const Entry& entry : entries) {
    const QPointF at = area.topLeft() + entry.Place;
    const QRectF swatch(at.x() + 0.5, at.y() + 2.5, SwatchWidth, std::floor(height) - 4);
    if (entry.Part < 0) {
      DrawScoreMark(painter, swatch.center(), height * 0.7);
    } else {
      FillWithPart(painter, swatch, static_cast<ScorePart>(entry.Part));
    }
    painter.drawText(QRectF(swatch.right() + SwatchGap, at.y(), area.width(), height),
                     Qt::AlignLeft | Qt::AlignVCenter, entry.Name);
  }
}

PartLegend::PartLegend(QWidget* parent) : QWidget(parent) {
  QSizePolicy policy(QSizePolicy::Expanding, QSizePolicy::Minimum);
  policy.setHeightForWidth(true);
  setSizePolicy(policy);
}

void PartLegend::SetParts(std::vector<ScorePart> parts, const StringTable& strings) {
  parts_ = std::move(parts);
  strings_ = &strings;
  updateGeometry();
  update();
}

int PartLegend::heightForWidth(int width) const {
  return strings_ == nullptr
             ? 0
             : static_cast<int>(std::ceil(PartKey(parts_, *strings_, font()).HeightFor(width)));
}

QSize PartLegend::sizeHint() const {
  constexpr int usual = 480;
  return {usual, heightForWidth(usual)};
}

QSize PartLegend::minimumSizeHint() const {
  constexpr int least = 200;
  return {least, fontMetrics().height()};
}

void PartLegend::paintEvent(QPaintEvent* /*event*/) {
  if (strings_ != nullptr) {
    QPainter painter(this);
    painter.setPen(palette().color(QPalette::WindowText));
    PartKey(parts_, *strings_, font()).Draw(painter, rect());
  }
}
