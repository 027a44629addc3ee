#include "ui/TeamColours.h"

#include <QPainter>
#include <array>

#include "core/game/TeamColour.h"

QColor TeamColour(int team) {
  const Rgb& colour = TeamRgb.at(static_cast<std::size_t>(team - 1));
  return {colour.Red, colour.Green, colour.Blue};
}

QColor TeamTint(int team, const QColor& base) {
  constexpr double share = 0.13;
  const QColor colour = TeamColour(team);
  const auto mix = [](int over, int under) { return static_cast<int>(over * share + under * (1 - share)); };
  return {mix(colour.red(), base.red()), mix(colour.green(), base.green()), mix(colour.blue(), base.blue())};
}

namespace {

QPixmap PaintBadge(int team) {
  constexpr int size = 64;  // four times the shown size, for screens of any density
  QPixmap badge(size, size);
  badge.fill(Qt::transparent);
  QPainter painter(&badge);
  painter.setRenderHint(QPainter::Antialiasing);
  painter.setBrush(TeamColour(team));
  painter.setPen(QPen(TeamColour(team).darker(130), 4));
  painter.drawEllipse(6, 6, size - 12, size - 12);
  badge.setDevicePixelRatio(4);
  return badge;
}

}  // namespace

const QPixmap& TeamBadge(int team) {
  static const std::array<QPixmap, 3> badges = {PaintBadge(1), PaintBadge(2), PaintBadge(3)};
  return badges.at(static_cast<std::size_t>(team - 1));
}
