#include "board/ScoreListHeader.h"

#include <QMouseEvent>
#include <QPainter>
#include <QStyle>
#include <algorithm>

#include "board/ScoreListModel.h"

namespace {

/// As the style reckons it; the text's advance is rounded in another way.
int WidthOf(const QString& text, const QFontMetrics& metrics) {
  return metrics.size(0, text).width();
}

}  // namespace

ScoreListHeader::ScoreListHeader(QWidget* parent) : QHeaderView(Qt::Horizontal, parent) {
  setSectionsClickable(true);
  setHighlightSections(false);
  setMinimumSectionSize(40);
  setStretchLastSection(true);
  connect(this, &QHeaderView::sectionHandleDoubleClicked, this, &ScoreListHeader::WidthsDragged,
          Qt::QueuedConnection);  // not before the list has given the column its new width
}

QRect ScoreListHeader::SignPlace(int column, const QRect& section) const {
  constexpr int gap = 3;
  const QFontMetrics letters = fontMetrics();
  const QString caption = model()->headerData(column, orientation()).toString();
  const int width = letters.horizontalAdvance(caption);
  const int margin = (sectionSizeHint(column) - width) / 2;
  const auto alignment = model()->headerData(column, orientation(), Qt::TextAlignmentRole).toInt();
  const QRect line =
      QStyle::alignedRect(layoutDirection(), Qt::Alignment(alignment), QSize(width, letters.height()),
                          section.adjusted(margin, 0, -margin, 0));
  const int inkTop = line.top() + letters.ascent() + letters.tightBoundingRect(caption).top();
  const int height = std::max(letters.height() / 3, 5);
  return {line.center().x() - height, std::max(inkTop - gap - height, section.top() + 1), 2 * height, height};
}

void ScoreListHeader::paintSection(QPainter* painter, const QRect& rect, int logicalIndex) const {
  painter->save();
  QHeaderView::paintSection(painter, rect, logicalIndex);
  painter->restore();
  const QVariant order = model()->headerData(logicalIndex, orientation(), ScoreListModel::SortRole);
  if (!order.isValid()) {
    return;
  }
  const QRectF sign = SignPlace(logicalIndex, rect);
  const bool upwards = order.value<Qt::SortOrder>() == Qt::AscendingOrder;
  const double base = upwards ? sign.bottom() : sign.top();
  const double point = upwards ? sign.top() : sign.bottom();
  painter->save();
  painter->setRenderHint(QPainter::Antialiasing);
  painter->setPen(Qt::NoPen);
  painter->setBrush(palette().buttonText());
  painter->drawPolygon(QPolygonF({{sign.left(), base}, {sign.right(), base}, {sign.center().x(), point}}));
  painter->restore();
}

// The style takes its time for each section, and needs the same margins for all sizes of letters.
void ScoreListHeader::MeasureCaptions() {
  captions_.clear();
  for (int column = 0; column < count(); ++column) {
    const QString text = model()->headerData(column, orientation()).toString();
    captions_.append({text, sectionSizeHint(column) - WidthOf(text, fontMetrics())});
  }
}

int ScoreListHeader::CaptionWidth(int column, const QFont& captions) const {
  const Caption& caption = captions_.at(column);
  return WidthOf(caption.Text, QFontMetrics(captions)) + caption.Margins;
}

void ScoreListHeader::mousePressEvent(QMouseEvent* event) {
  sizesBefore_ = Sizes();
  QHeaderView::mousePressEvent(event);
}

void ScoreListHeader::mouseReleaseEvent(QMouseEvent* event) {
  QHeaderView::mouseReleaseEvent(event);
  if (!sizesBefore_.isEmpty() && Sizes() != sizesBefore_) {
    emit WidthsDragged();
  }
  sizesBefore_.clear();
}

QList<int> ScoreListHeader::Sizes() const {
  QList<int> sizes;
  for (int section = 0; section < count(); ++section) {
    sizes.append(sectionSize(section));
  }
  return sizes;
}
