#include "charts/HitMap.h"

#include <QKeyEvent>
#include <QMouseEvent>
#include <algorithm>
#include <utility>

#include "charts/ChartKeys.h"
#include "charts/PictureFile.h"
#include "core/text/Filled.h"
#include "ui/Text.h"

namespace {

/// Where a key leads from a cell; nothing for any other key.
std::optional<HitCell> CellByKey(const HitCell& from, const QKeyEvent& key, int size) {
  const bool isEnd = key.key() == Qt::Key_Home || key.key() == Qt::Key_End;
  const bool isDown = key.key() == Qt::Key_Up || key.key() == Qt::Key_Down || key.key() == Qt::Key_PageUp ||
                      key.key() == Qt::Key_PageDown;
  const std::optional<int> place = isDown ? PlaceByKey(key.key(), from.Shooter, size, ChartOrder::Down)
                                          : PlaceByKey(key.key(), from.Victim, size, ChartOrder::Across);
  if (!place) {
    return std::nullopt;
  }
  if (isEnd && key.modifiers().testFlag(Qt::ControlModifier)) {
    return HitCell{*place, *place};
  }
  return isDown ? HitCell{*place, from.Victim} : HitCell{from.Shooter, *place};
}

}  // namespace

HitMap::HitMap(QWidget* parent) : QWidget(parent) {
  setFocusPolicy(Qt::StrongFocus);
  setMouseTracking(true);
  constexpr int least = 240;
  setMinimumSize(least, least);
  setBackgroundRole(QPalette::Base);
  setAutoFillBackground(true);
}

void HitMap::SetUp(const StringTable& strings) {
  strings_ = &strings;
  setAccessibleName(Text(strings, OwnText::WhoHitWhom));
  setAccessibleDescription(Text(strings, OwnText::ChartKeys));
}

void HitMap::SetMatrix(HitMatrix matrix) {
  matrix_ = std::move(matrix);
  map_ = {};
  SetCell(cell_);
}

void HitMap::SetCell(std::optional<HitCell> cell) {
  const bool isThere = cell && std::max(cell->Shooter, cell->Victim) < matrix_.Size();
  cell_ = isThere ? cell : std::nullopt;
  update();
}

HitMapLayout HitMap::Layout() const {
  return HitMapPainter(matrix_, *strings_, font(), palette().color(QPalette::Text))
      .LayoutFor(size(), devicePixelRatioF());
}

QRect HitMap::PlaceOf(const HitCell& cell) const {
  return Layout().Place(cell).toAlignedRect();
}

std::optional<HitCell> HitMap::CellAt(const QPointF& point) const {
  const HitMapLayout layout = Layout();
  if (!layout.Cells.contains(point)) {
    return std::nullopt;
  }
  const auto placeOf = [&](double along) {
    return std::min(static_cast<int>(along / layout.Cell), matrix_.Size() - 1);
  };
  return HitCell{placeOf(point.y() - layout.Cells.top()), placeOf(point.x() - layout.Cells.left())};
}

QString HitMap::TextOf(const HitCell& cell) const {
  const std::string& shooter = matrix_.PlayerAt(cell.Shooter).Name;
  const std::string& victim = matrix_.PlayerAt(cell.Victim).Name;
  const std::int32_t damage = matrix_.Damage(cell.Shooter, cell.Victim);
  const std::string amount = std::to_string(damage);
  const auto filled = [this](OwnText text, std::initializer_list<std::string_view> values) {
    return QString::fromStdString(Filled(strings_->Text(text), values));
  };
  if (cell.Shooter == cell.Victim) {
    return damage == 0 ? filled(OwnText::TheyDidNotHitThemselves, {shooter})
                       : filled(OwnText::TheyHitThemselves, {shooter, amount});
  }
  if (damage == 0) {
    return filled(OwnText::TheyDidNotHit, {shooter, victim});
  }
  const bool isOwnTeam = matrix_.IsOwnTeam(cell.Shooter, cell.Victim);
  return filled(isOwnTeam ? OwnText::TheyHitOwnTeam : OwnText::TheyHit, {shooter, victim, amount});
}

QImage HitMap::Picture(const QString& title) const {
  constexpr int many = 60;
  constexpr double mostPixels = 1400;
  constexpr double leastCell = 13;
  constexpr double mostCell = 36;
  constexpr int margin = 16;
  const double ratio = matrix_.Size() > many ? 1 : 2;
  const HitMapPainter map(matrix_, *strings_, font(), Qt::black);
  const HitMapLayout layout =
      map.LayoutWith(std::clamp(mostPixels / std::max(matrix_.Size(), 1), leastCell, mostCell), ratio);
  QFont heading = font();
  heading.setBold(true);
  const int titleHeight = QFontMetrics(heading).height() + margin / 2;
  const int titleWidth = QFontMetrics(heading).horizontalAdvance(title);
  const QSizeF size(std::max(layout.Whole.width(), static_cast<double>(titleWidth)) + 2 * margin,
                    layout.Whole.height() + titleHeight + 2 * margin);
  QImage picture = WhitePicture(size, ratio);
  if (picture.isNull()) {
    return picture;
  }
  QPainter painter(&picture);
  painter.setFont(heading);
  painter.drawText(QRectF(margin, margin, size.width(), titleHeight), Qt::AlignLeft | Qt::AlignTop, title);
  painter.translate(margin, margin + titleHeight);
  map.Draw(painter, layout);
  return picture;
}

void HitMap::GoTo(const HitCell& cell, bool chosen) {
  if (cell_ == cell && !chosen) {
    return;
  }
  SetCell(cell);
  emit Told(TextOf(cell), chosen);
}

void HitMap::DrawMap() {
  const double ratio = devicePixelRatioF();
  map_ = QImage(size() * ratio, QImage::Format_RGB32);
  map_.setDevicePixelRatio(ratio);
  map_.fill(palette().color(QPalette::Base));
  QPainter painter(&map_);
  HitMapPainter(matrix_, *strings_, font(), palette().color(QPalette::Text)).Draw(painter, Layout());
}

void HitMap::paintEvent(QPaintEvent* /*event*/) {
  if (strings_ == nullptr || matrix_.Size() == 0) {
    return;
  }
  if (map_.isNull() || map_.devicePixelRatio() != devicePixelRatioF()) {
    DrawMap();
  }
  QPainter painter(this);
  painter.drawImage(0, 0, map_);
  if (!cell_) {
    return;
  }
  DrawMark(painter, *cell_);
}

void HitMap::DrawMark(QPainter& painter, const HitCell& cell) const {
  const HitMapLayout layout = Layout();
  const QRectF place = layout.Place(cell);
  const QRectF& cells = layout.Cells;
  const QColor colour = palette().color(QPalette::Highlight);
  QColor strip = colour;
  constexpr int faint = 90;
  strip.setAlpha(faint);
  // Not over cells: that would change what their colours say.
  painter.fillRect(QRectF(cells.left() - layout.Labels, place.top(), layout.Labels, layout.Cell), strip);
  painter.fillRect(QRectF(place.left(), cells.top() - layout.Labels, layout.Cell, layout.Labels), strip);
  painter.setPen(QPen(colour, 1));
  painter.drawRect(QRectF(cells.left(), place.top(), cells.width(), layout.Cell));
  painter.drawRect(QRectF(place.left(), cells.top(), layout.Cell, cells.height()));
  painter.setPen(QPen(Qt::white, hasFocus() ? 5 : 3));
  painter.drawRect(place);
  painter.setPen(QPen(Qt::black, hasFocus() ? 3 : 1));
  painter.drawRect(place);
}

void HitMap::resizeEvent(QResizeEvent* event) {
  map_ = {};
  QWidget::resizeEvent(event);
}

void HitMap::changeEvent(QEvent* event) {
  map_ = {};
  QWidget::changeEvent(event);
}

void HitMap::keyPressEvent(QKeyEvent* event) {
  if (matrix_.Size() > 0) {
    if (const auto cell = CellByKey(cell_.value_or(HitCell{}), *event, matrix_.Size())) {
      GoTo(*cell, true);
      return;
    }
  }
  QWidget::keyPressEvent(event);
}

void HitMap::mouseMoveEvent(QMouseEvent* event) {
  const auto cell = CellAt(event->position());
  setToolTip(cell ? TextOf(*cell) : QString());
  if (cell) {
    GoTo(*cell, false);
  }
}

void HitMap::mousePressEvent(QMouseEvent* event) {
  if (const auto cell = CellAt(event->position())) {
    GoTo(*cell, true);
  }
}

void HitMap::focusInEvent(QFocusEvent* event) {
  if (matrix_.Size() > 0 &&
      (event->reason() == Qt::TabFocusReason || event->reason() == Qt::BacktabFocusReason)) {
    GoTo(cell_.value_or(HitCell{}), true);
  }
  QWidget::focusInEvent(event);
  update();
}

void HitMap::focusOutEvent(QFocusEvent* event) {
  QWidget::focusOutEvent(event);
  update();
}
