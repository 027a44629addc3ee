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

QPixmap PaintBadge(int team, const QColor& ring) {
  constexpr int size = 64;  // four times the shown size, for screens of any density
  QPixmap badge(size, size);
  badge.fill(Qt::transparent);
  QPainter painter(&badge);
  painter.setRenderHint(QPainter::Antialiasing);
  painter.setBrush(TeamColour(team));
  painter.setPen(QPen(ring, 4));
  painter.drawEllipse(6, 6, size - 12, size - 12);
  badge.setDevicePixelRatio(4);
  return badge;
}

QIcon NewBadge(int team) {
  QIcon badge(PaintBadge(team, TeamColour(team).darker(130)));
  // Else the style mixes in the selection's colour, in which a blue badge cannot be seen.
  badge.addPixmap(PaintBadge(team, Qt::white), QIcon::Selected);
  return badge;
}

}  // namespace

const QIcon& TeamBadge(int team) {
  static const std::array<QIcon, 3> badges = {NewBadge(1), NewBadge(2), NewBadge(3)};
  return badges.at(static_cast<std::size_t>(team - 1));
}
