#include "board/ScoreListView.h"

#include <QFocusEvent>
#include <QHeaderView>
#include <QKeyEvent>
#include <QPainter>
#include <QPixmap>
#include <QProxyStyle>
#include <algorithm>
#include <utility>

namespace {

/// Gives cells the same side margin as their headers.
class CellMargin : public QProxyStyle {
 public:
  int pixelMetric(PixelMetric metric, const QStyleOption* option, const QWidget* widget) const override {
    constexpr int sideMargin = 7;
    return metric == PM_FocusFrameHMargin ? sideMargin : QProxyStyle::pixelMetric(metric, option, widget);
  }
};

}  // namespace

ScoreListView::ScoreListView(QWidget* parent) : QTableView(parent) {
  auto* margin = new CellMargin;
  margin->setParent(this);
  setStyle(margin);
  QFont figures = font();
  figures.setPointSizeF(figures.pointSizeF() * 1.5);
  setFont(figures);
  setSelectionBehavior(SelectRows);
  setSelectionMode(ExtendedSelection);
  setEditTriggers(NoEditTriggers);
  setShowGrid(false);
  setWordWrap(false);
  setTabKeyNavigation(false);
  setCornerButtonEnabled(false);
  setHorizontalScrollMode(ScrollPerPixel);
  verticalHeader()->hide();
  verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
  verticalHeader()->setDefaultSectionSize(fontMetrics().height() + 12);
  QFont captions = font();
  captions.setPointSizeF(captions.pointSizeF() * 0.8);
  captions.setBold(true);
  horizontalHeader()->setFont(captions);
  horizontalHeader()->setHighlightSections(false);
  horizontalHeader()->setMinimumSectionSize(40);
  horizontalHeader()->setStretchLastSection(true);
}

void ScoreListView::SetColumnShares(std::vector<double> shares) {
  shares_ = std::move(shares);
  ShareWidth();
}

int ScoreListView::HeightForRows(int rows) const {
  return horizontalHeader()->sizeHint().height() + rows * verticalHeader()->defaultSectionSize() +
         2 * frameWidth();
}

void ScoreListView::resizeEvent(QResizeEvent* event) {
  QTableView::resizeEvent(event);
  ShareWidth();
}

void ScoreListView::paintEvent(QPaintEvent* event) {
  constexpr int smallestForPicture = 160;
  if (model() != nullptr && model()->rowCount() == 0 && viewport()->height() >= smallestForPicture) {
    const int side = std::min({viewport()->width(), viewport()->height(), 256}) * 3 / 4;
    const QRect place(viewport()->width() / 2 - side / 2, viewport()->height() / 2 - side / 2, side, side);
    QPainter painter(viewport());
    painter.setOpacity(0.08);
    painter.setRenderHint(QPainter::SmoothPixmapTransform);
    painter.drawPixmap(place, QPixmap(QStringLiteral(":/pictures/tessarine-256.png")));
  }
  QTableView::paintEvent(event);
}

void ScoreListView::focusInEvent(QFocusEvent* event) {
  QTableView::focusInEvent(event);
  const bool byKey = event->reason() == Qt::TabFocusReason || event->reason() == Qt::BacktabFocusReason;
  if (byKey && selectionModel() != nullptr && !selectionModel()->hasSelection() && currentIndex().isValid()) {
    selectRow(currentIndex().row());
  }
}

void ScoreListView::keyPressEvent(QKeyEvent* event) {
  // On this platform the toolkit handles only the menu key, which many keyboards lack.
  if (event->key() == Qt::Key_F10 && event->modifiers() == Qt::ShiftModifier) {
    emit customContextMenuRequested(visualRect(currentIndex()).center());
    return;
  }
  QTableView::keyPressEvent(event);
}

void ScoreListView::ShareWidth() {
  for (std::size_t column = 0; column < shares_.size(); ++column) {
    setColumnWidth(static_cast<int>(column), static_cast<int>(viewport()->width() * shares_[column]));
  }
}
