#include "audience/AudienceViews.h"

#include <QPainter>
#include <algorithm>
#include <optional>
#include <utility>
#include <vector>

#include "audience/AudienceColours.h"
#include "audience/AudienceText.h"
#include "ui/QrCode.h"

namespace {

constexpr double WidthShare = 0.9;  ///< of the screen, for texts and pictures

/// A band across the screen, from and to these shares of its height.
QRectF Band(const AudiencePlace& place, double from, double to) {
  return {place.Width * (1 - WidthShare) / 2, place.Height * from, place.Width * WidthShare,
          place.Height * (to - from)};
}

double LegibleCapital(const AudiencePlace& place) {
  constexpr double spare = 1.02;  // a font's heights are whole pixels
  return spare * CapitalMillimetres(place.Metres) / place.MillimetresPerPixel;
}

/// Draws a text as large as fits, at most `usual` where that can be read, and tells the height of its
/// capitals.
double DrawLarge(QPainter& painter, const AudiencePlace& place, const QRectF& area, const QString& text,
                 double usual) {
  const double legible = LegibleCapital(place);
  const TextBlock block = BlockFor(text, area.size(), legible, std::max(usual, legible), true);
  DrawBlock(painter, area, block, true);
  return block.Capital;
}

/// Code, heading and address on the screen. An empty heading's area has no height.
struct CodeLayout {
  QRectF Code;
  QRectF Heading;
  QRectF Address;
  QString AddressText;
};

constexpr double SpareOfArea = 1.03;  ///< what `BlockFor` needs besides

double HeightOf(const QStringList& lines, double capital) {
  return SpareOfArea * BrokenPitch * static_cast<double>(lines.size()) * capital;
}

/// What a text in so many lines takes.
QSizeF SizeOf(const QString& text, int lines, double capital) {
  if (text.isEmpty()) {
    return {0, 0};
  }
  const QStringList broken = BrokenInto(text, lines, true);
  return {SpareOfArea * WidestInCapitals(broken, true) * capital, HeightOf(broken, capital)};
}

/// The code between the texts, as large as they leave it; nothing if they are too wide.
std::optional<CodeLayout> BelowEachOther(const QRectF& page, const QSizeF& heading, const QSizeF& address) {
  const double side = page.height() - heading.height() - address.height();
  if (heading.width() > page.width() || address.width() > page.width() || side <= 0) {
    return std::nullopt;
  }
  CodeLayout layout;
  layout.Heading = QRectF(page.left(), page.top(), page.width(), heading.height());
  layout.Code = QRectF(page.left(), layout.Heading.bottom(), page.width(), side);
  layout.Address = QRectF(page.left(), layout.Code.bottom(), page.width(), address.height());
  return layout;
}

/// The code beside the texts.
std::optional<CodeLayout> SideBySide(const QRectF& page, const QSizeF& heading, const QSizeF& address) {
  constexpr double gapShare = 0.02;
  const double gap = gapShare * page.width();
  const double texts = std::max(heading.width(), address.width());
  const double side = std::min(page.width() - gap - texts, page.height());
  const double height = heading.height() + address.height();
  if (side <= 0 || height > page.height()) {
    return std::nullopt;
  }
  const double left = page.left() + side + gap;
  const double spare = (page.height() - height) / 2;
  CodeLayout layout;
  layout.Code = QRectF(page.left(), page.top(), side, page.height());
  layout.Heading =
      QRectF(left, page.top(), page.right() - left, heading.isEmpty() ? 0 : heading.height() + spare);
  layout.Address =
      QRectF(left, layout.Heading.bottom(), page.right() - left, page.bottom() - layout.Heading.bottom());
  return layout;
}

double SideOf(const CodeLayout& layout) {
  return std::min(layout.Code.width(), layout.Code.height());
}

/// Sizes of a text in one line, two, ...; one empty size of no text.
std::vector<QSizeF> SizesOf(const QString& text, double capital) {
  constexpr int mostLines = 4;
  std::vector<QSizeF> sizes;
  for (int lines = 1; lines <= (text.isEmpty() ? 1 : mostLines); ++lines) {
    sizes.push_back(SizeOf(text, lines, capital));
  }
  return sizes;
}

/// The arrangement of these texts with the largest code.
std::optional<CodeLayout> Arranged(const AudiencePlace& place, const QString& heading,
                                   const QString& address) {
  constexpr double margin = 0.02;
  const QRectF page(margin * place.Width, margin * place.Height, (1 - 2 * margin) * place.Width,
                    (1 - 2 * margin) * place.Height);
  const double capital = LegibleCapital(place);
  std::optional<CodeLayout> best;
  const auto keepLarger = [&best](std::optional<CodeLayout> layout) {
    if (layout && (!best || SideOf(*layout) > SideOf(*best))) {
      best = std::move(layout);
    }
  };
  const std::vector<QSizeF> addressSizes = SizesOf(address, capital);
  for (const QSizeF& headingSize : SizesOf(heading, capital)) {
    for (const QSizeF& addressSize : addressSizes) {
      keepLarger(BelowEachOther(page, headingSize, addressSize));
      keepLarger(SideBySide(page, headingSize, addressSize));
    }
  }
  if (best) {
    best->AddressText = address;
  }
  return best;
}

/// With a code of at least half of the screen's height the texts are shown whole.
CodeLayout LayOutCode(const AudiencePlace& place, const QString& heading, const QString& address) {
  constexpr double largeEnough = 0.5;
  const QString withoutScheme = QString(address).remove(QStringLiteral("http://"));
  for (const QString& text : {address, withoutScheme}) {
    const std::optional<CodeLayout> layout = Arranged(place, heading, text);
    if (layout && SideOf(*layout) >= largeEnough * place.Height) {
      return *layout;
    }
  }
  if (const std::optional<CodeLayout> layout = Arranged(place, {}, withoutScheme)) {
    return *layout;
  }
  return {.Code = Band(place, 0.02, 0.86),
          .Heading = {},
          .Address = Band(place, 0.87, 0.99),
          .AddressText = withoutScheme};
}

}  // namespace

namespace AudienceViews {

double PaintVenue(QPainter& painter, const AudiencePlace& place, const QString& name, const QImage& picture) {
  constexpr double mostOfHeight = 0.25;
  constexpr double leastBand = 0.24;
  constexpr double mostBand = 0.5;
  painter.setPen(AudienceColours::Letters());
  if (picture.isNull()) {
    return DrawLarge(painter, place, Band(place, 0.1, 0.9), name, mostOfHeight * place.Height);
  }
  QRectF band = Band(place, 0.05, 0.95);
  double capital = 0;
  if (!name.isEmpty()) {
    // The name gets as much as it needs to be read.
    const QSizeF most(band.width(), mostBand * place.Height);
    const double legible = LegibleCapital(place);
    const TextBlock least = BlockFor(name, most, legible, legible, true);
    const double height = std::max(leastBand * place.Height, HeightOf(least.Lines, least.Capital));
    const QRectF below(band.left(), band.bottom() - height, band.width(), height);
    capital = DrawLarge(painter, place, below, name, leastBand / 2 * place.Height);
    band.setBottom(below.top());
  }
  const QSizeF size = QSizeF(picture.size()).scaled(band.size(), Qt::KeepAspectRatio);
  painter.setRenderHint(QPainter::SmoothPixmapTransform);
  painter.drawImage(QRectF(band.center() - QPointF(size.width(), size.height()) / 2, size), picture);
  return capital;
}

double PaintMessage(QPainter& painter, const AudiencePlace& place, const QString& heading,
                    const QString& message) {
  constexpr double mostOfHeading = 0.12;
  constexpr double mostOfMessage = 0.2;
  painter.setPen(AudienceColours::QuietLetters());
  const double quiet =
      DrawLarge(painter, place, Band(place, 0.05, 0.55), heading, mostOfHeading * place.Height);
  if (message.isEmpty()) {
    return quiet;
  }
  painter.setPen(AudienceColours::Letters());
  return std::min(quiet,
                  DrawLarge(painter, place, Band(place, 0.55, 0.95), message, mostOfMessage * place.Height));
}

double PaintCode(QPainter& painter, const AudiencePlace& place, const QString& heading,
                 const QString& address) {
  constexpr double mostOfHeight = 0.12;
  const CodeLayout layout = LayOutCode(place, heading, address);
  PaintQrCode(painter, layout.Code, address.toStdString());
  painter.setPen(AudienceColours::Letters());
  double capital = DrawLarge(painter, place, layout.Address, layout.AddressText, mostOfHeight * place.Height);
  if (!layout.Heading.isEmpty()) {
    painter.setPen(AudienceColours::QuietLetters());
    capital =
        std::min(capital, DrawLarge(painter, place, layout.Heading, heading, mostOfHeight * place.Height));
  }
  return capital;
}

}  // namespace AudienceViews
