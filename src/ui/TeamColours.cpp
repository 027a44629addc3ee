#include "ui/TeamColours.h"

#include <QGuiApplication>
#include <QIconEngine>
#include <QPainter>
#include <QPolygonF>
#include <algorithm>
#include <array>

#include "core/game/TeamColour.h"

QColor TeamColour(int team) {
  const Rgb& colour = TeamRgb.at(static_cast<std::size_t>(team - 1));
  return {colour.Red, colour.Green, colour.Blue};
}

QColor TeamTint(int team, const QColor& base, double share) {
  const QColor colour = TeamColour(team);
  const auto mix = [share](int over, int under) {
    return static_cast<int>(over * share + under * (1 - share));
  };
  return {mix(colour.red(), base.red()), mix(colour.green(), base.green()), mix(colour.blue(), base.blue())};
}

namespace {

/// The edge of a badge on a light ground, dark enough for the badge to be seen on a selected row of its own
/// colour.
QColor DarkEdge(int team) {
  constexpr int darker = 190;
  return TeamColour(team).darker(darker);
}

/// Draws the badge anew for each size, so that it is sharp on every screen.
class BadgeEngine : public QIconEngine {
 public:
  explicit BadgeEngine(int team) : team_(team) {}

  void paint(QPainter* painter, const QRect& rect, QIcon::Mode mode, QIcon::State /*state*/) override {
    constexpr double units = 64;  // to a side
    constexpr double ring = 4;
    const QRectF body(6, 6, units - 12, units - 12);
    painter->save();
    painter->setRenderHint(QPainter::Antialiasing);
    // In a room that is no square the badge keeps its shape.
    const double side = std::min(rect.width(), rect.height());
    painter->translate(QRectF(rect).center() - QPointF(side, side) / 2);
    painter->scale(side / units, side / units);
    painter->setBrush(TeamColour(team_));
    const bool onDark =
        mode == QIcon::Selected || QGuiApplication::palette().base().color().lightness() < 128;
    const QColor edge = onDark ? QColor(Qt::white) : DarkEdge(team_);
    painter->setPen(QPen(edge, ring, Qt::SolidLine, Qt::SquareCap, Qt::MiterJoin));
    switch (team_) {
      case 1:
        painter->drawEllipse(body);
        break;
      case 2:
        painter->drawRect(body);
        break;
      default:
        painter->drawPolygon(
            QPolygonF({body.topLeft(), {body.right(), body.center().y()}, body.bottomLeft()}));
        break;
    }
    painter->restore();
  }

  QSize actualSize(const QSize& size, QIcon::Mode /*mode*/, QIcon::State /*state*/) override {
    const int side = std::min(size.width(), size.height());
    return {side, side};
  }

  QPixmap pixmap(const QSize& size, QIcon::Mode mode, QIcon::State state) override {
    QPixmap picture(size);
    picture.fill(Qt::transparent);
    QPainter painter(&picture);
    paint(&painter, QRect(QPoint(0, 0), size), mode, state);
    return picture;
  }

  QIconEngine* clone() const override { return new BadgeEngine(team_); }

 private:
  const int team_;
};

}  // namespace

const QIcon& TeamBadge(int team) {
  static const std::array<QIcon, 3> badges = {QIcon(new BadgeEngine(1)), QIcon(new BadgeEngine(2)),
                                              QIcon(new BadgeEngine(3))};
  return badges.at(static_cast<std::size_t>(team - 1));
}
