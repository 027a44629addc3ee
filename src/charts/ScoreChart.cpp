#include "charts/ScoreChart.h"

#include <QKeyEvent>
#include <QMouseEvent>
#include <QPainter>
#include <algorithm>
#include <cmath>
#include <utility>

#include "charts/ChartKeys.h"
#include "charts/PartLook.h"
#include "charts/PictureFile.h"
#include "core/text/Filled.h"
#include "ui/TeamColours.h"
#include "ui/Text.h"

namespace {

constexpr int SoldieringText = 105;
constexpr double ChartGap = 8;

/// Sum of a player's parts that give points, or of those that take some.
std::int64_t SumOfSide(const PlayerParts& player, bool giving) {
  std::int64_t sum = 0;
  for (const std::int64_t part : player.Hundredths) {
    if ((part > 0) == giving) {
      sum += part;
    }
  }
  return sum;
}

}  // namespace

ScoreChart::ScoreChart(QWidget* parent) : QWidget(parent) {
  setFocusPolicy(Qt::StrongFocus);
  setMouseTracking(true);
  setBackgroundRole(QPalette::Base);
  setAutoFillBackground(true);
}

void ScoreChart::SetUp(const StringTable& strings) {
  strings_ = &strings;
  setAccessibleName(Text(strings, OwnText::ScoreOrigins));
  setAccessibleDescription(Text(strings, OwnText::BarKeys));
}

void ScoreChart::SetPlayers(std::vector<PlayerParts> players) {
  players_ = std::move(players);
  setMinimumHeight(sizeHint().height());
  SetPlace(place_);
}

void ScoreChart::SetPlace(std::optional<int> place) {
  place_ = place && *place < static_cast<int>(players_.size()) ? place : std::nullopt;
  update();
}

int ScoreChart::Pitch() const {
  return fontMetrics().height() + 8;
}

QSize ScoreChart::sizeHint() const {
  constexpr int usual = 480;
  return {usual, Pitch() * static_cast<int>(players_.size()) + 2};
}

int ScoreChart::RowAt(double y) const {
  const int place = static_cast<int>(y / Pitch());
  return y >= 0 && place < static_cast<int>(players_.size()) ? place : -1;
}

QRect ScoreChart::RowOf(int place) const {
  return {0, place * Pitch(), width(), Pitch()};
}

ScoreChart::Scale ScoreChart::ScaleFor(double width) const {
  std::int64_t giving = 1;
  std::int64_t taking = 0;
  double names = 0;
  double totals = 0;
  QFont bold = font();
  bold.setBold(true);
  const QFontMetricsF boldMetrics(bold);
  for (const PlayerParts& player : players_) {
    giving = std::max({giving, SumOfSide(player, true), player.Soldiering * std::int64_t{100}});
    taking = std::min({taking, SumOfSide(player, false), player.Soldiering * std::int64_t{100}});
    names =
        std::max(names, QFontMetricsF(font()).horizontalAdvance(QString::fromStdString(player.Player.Name)));
    totals = std::max(totals, boldMetrics.horizontalAdvance(QString::number(player.Soldiering)));
  }
  constexpr double mostForNames = 0.3;
  const double left = std::min(names, mostForNames * width) + Pitch() + ChartGap;
  const double right = width - totals - 2 * ChartGap;
  const double unit = std::max(right - left, 1.0) / static_cast<double>(giving - taking);
  return {.Names = left - ChartGap,
          .Zero = left - static_cast<double>(taking) * unit,
          .Unit = unit,
          .Right = right};
}

QRectF ScoreChart::AreaOf(int place, ScorePart part, const Scale& scale) const {
  const PlayerParts& player = players_.at(static_cast<std::size_t>(place));
  const std::int64_t amount = player.Of(part);
  if (amount == 0) {
    return {};
  }
  std::int64_t before = 0;
  for (int each = 0; each < static_cast<int>(part); ++each) {
    const std::int64_t other = player.Of(static_cast<ScorePart>(each));
    before += (other > 0) == (amount > 0) ? other : 0;
  }
  const double from = scale.Zero + static_cast<double>(before) * scale.Unit;
  const double length = static_cast<double>(amount) * scale.Unit;
  return QRectF(from, place * Pitch() + 3.5, length, Pitch() - 7).normalized();
}

QRectF ScoreChart::AreaOf(int place, ScorePart part) const {
  return AreaOf(place, part, ScaleFor(width()));
}

QString ScoreChart::PartText(int place, ScorePart part) const {
  const std::string name = NameOfPart(part, *strings_).toStdString();
  const std::string points = PointsText(players_.at(static_cast<std::size_t>(place)).Of(part));
  return QString::fromStdString(Filled(strings_->Text(OwnText::PartOfPoints), {name, points}));
}

QString ScoreChart::TextOf(int place) const {
  const PlayerParts& player = players_.at(static_cast<std::size_t>(place));
  QStringList parts;
  for (int each = 0; each < ScorePartCount; ++each) {
    const auto part = static_cast<ScorePart>(each);
    if (player.Of(part) != 0) {
      parts.append(PartText(place, part));
    }
  }
  QString score =
      QString::fromStdString(Filled(strings_->Text(OwnText::PartOfPoints),
                                    {strings_->Text(SoldieringText), std::to_string(player.Soldiering)}));
  if (!parts.isEmpty()) {
    score += QStringLiteral(" = ") + parts.join(QStringLiteral(", "));
  }
  return QString::fromStdString(
      Filled(strings_->Text(OwnText::PlayerHasPoints), {player.Player.Name, score.toStdString()}));
}

void ScoreChart::DrawRow(QPainter& painter, int place, const Scale& scale, const QColor& ink) const {
  const PlayerParts& player = players_.at(static_cast<std::size_t>(place));
  const double top = place * Pitch();
  const double badge = Pitch() * 0.55;
  TeamBadge(player.Team)
      .paint(&painter, QRectF(2, top + (Pitch() - badge) / 2, badge, badge).toAlignedRect());
  painter.setFont(font());
  painter.setPen(ink);
  const QRectF nameArea(Pitch(), top, scale.Names - Pitch(), Pitch());
  painter.drawText(nameArea, Qt::AlignLeft | Qt::AlignVCenter,
                   QFontMetricsF(font()).elidedText(QString::fromStdString(player.Player.Name),
                                                    Qt::ElideRight, nameArea.width() + 1));
  for (int each = 0; each < ScorePartCount; ++each) {
    const auto part = static_cast<ScorePart>(each);
    if (const QRectF area = AreaOf(place, part, scale); !area.isEmpty()) {
      FillWithPart(painter, area, part);
    }
  }
  painter.setPen(ink);
  painter.drawLine(QPointF(scale.Zero, top), QPointF(scale.Zero, top + Pitch()));
  DrawScoreMark(painter, {scale.Zero + player.Soldiering * 100.0 * scale.Unit, top + Pitch() / 2.0},
                Pitch() * 0.5);
  QFont bold = font();
  bold.setBold(true);
  painter.setFont(bold);
  painter.drawText(QRectF(scale.Right, top, 500, Pitch()), Qt::AlignLeft | Qt::AlignVCenter,
                   QStringLiteral("  ") + QString::number(player.Soldiering));
}

QImage ScoreChart::Picture(const QString& title) const {
  constexpr int barsWidth = 1000;
  constexpr int margin = 16;
  constexpr double ratio = 2;
  const PartKey key(PartsInUse(players_), *strings_, font());
  QFont heading = font();
  heading.setBold(true);
  const int titleHeight = QFontMetrics(heading).height() + margin / 2;
  const int keyHeight = static_cast<int>(std::ceil(key.HeightFor(barsWidth))) + margin / 2;
  const int bars = Pitch() * static_cast<int>(players_.size());
  QImage picture =
      WhitePicture(QSizeF(barsWidth + 2 * margin, titleHeight + keyHeight + bars + 2 * margin), ratio);
  if (picture.isNull()) {
    return picture;
  }
  QPainter painter(&picture);
  painter.setPen(Qt::black);
  painter.setFont(heading);
  painter.drawText(QRect(margin, margin, barsWidth, titleHeight), Qt::AlignLeft | Qt::AlignTop, title);
  key.Draw(painter, QRectF(margin, margin + titleHeight, barsWidth, keyHeight));
  painter.translate(margin, margin + titleHeight + keyHeight);
  const Scale scale = ScaleFor(barsWidth);
  for (int place = 0; place < static_cast<int>(players_.size()); ++place) {
    DrawRow(painter, place, scale, Qt::black);
  }
  return picture;
}

void ScoreChart::GoTo(int place, bool chosen) {
  if (place_ == place && !chosen) {
    return;
  }
  SetPlace(place);
  if (chosen) {
    emit Reached(RowOf(place));
  }
  emit Told(TextOf(place), chosen);
}

void ScoreChart::paintEvent(QPaintEvent* event) {
  if (strings_ == nullptr || players_.empty()) {
    return;
  }
  QPainter painter(this);
  const Scale scale = ScaleFor(width());
  const int first = event->rect().top() / Pitch();
  const int last = std::min(event->rect().bottom() / Pitch(), static_cast<int>(players_.size()) - 1);
  for (int place = first; place <= last; ++place) {
    if (place_ == place) {
      QColor strip = palette().color(QPalette::Highlight);
      constexpr int faint = 45;
      strip.setAlpha(hasFocus() ? 2 * faint : faint);
      painter.fillRect(RowOf(place), strip);
    }
    DrawRow(painter, place, scale, palette().color(QPalette::Text));
  }
}

void ScoreChart::changeEvent(QEvent* event) {
  if (event->type() == QEvent::FontChange) {
    setMinimumHeight(sizeHint().height());
  }
  QWidget::changeEvent(event);
}

void ScoreChart::keyPressEvent(QKeyEvent* event) {
  if (!players_.empty()) {
    if (const auto place = PlaceByKey(event->key(), place_.value_or(0), static_cast<int>(players_.size()),
                                      ChartOrder::Down)) {
      GoTo(*place, true);
      return;
    }
  }
  QWidget::keyPressEvent(event);
}

void ScoreChart::mouseMoveEvent(QMouseEvent* event) {
  const int place = RowAt(event->position().y());
  QString tip;
  for (int each = 0; place >= 0 && each < ScorePartCount; ++each) {
    const auto part = static_cast<ScorePart>(each);
    if (AreaOf(place, part).contains(event->position())) {
      tip = PartText(place, part);
    }
  }
  setToolTip(tip);
  if (place >= 0) {
    GoTo(place, false);
  }
}

void ScoreChart::mousePressEvent(QMouseEvent* event) {
  if (const int place = RowAt(event->position().y()); place >= 0) {
    GoTo(place, true);
  }
}

void ScoreChart::focusInEvent(QFocusEvent* event) {
  if (!players_.empty() &&
      (event->reason() == Qt::TabFocusReason || event->reason() == Qt::BacktabFocusReason)) {
    GoTo(place_.value_or(0), true);
  }
  QWidget::focusInEvent(event);
  update();
}

void ScoreChart::focusOutEvent(QFocusEvent* event) {
  QWidget::focusOutEvent(event);
  update();
}
