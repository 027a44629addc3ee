#include "board/ScoreListView.h"

#include <QFocusEvent>
#include <QHeaderView>
#include <QKeyEvent>
#include <QPainter>
#include <QPixmap>
#include <QProxyStyle>
#include <QScrollBar>
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

/// Sizes of the captions, relative to the figures.
constexpr double LargestCaptions = 0.8;
constexpr double SmallestCaptions = 0.6;

QFont CaptionFont(QFont font, double size) {
  font.setPointSizeF(font.pointSizeF() * size);
  font.setBold(true);
  return font;
}

/// Divides `width` among columns by their `shares`. A column whose share is less than it needs gets that at
/// the cost of the others; if all together need more, so does the list.
std::vector<int> ColumnWidths(int width, const std::vector<double>& shares, const std::vector<int>& needed) {
  std::vector<int> widths = needed;
  std::vector<bool> getsShare(shares.size(), true);
  for (bool settled = false; !settled;) {
    settled = true;
    double rest = width;
    double restShares = 0;
    for (std::size_t i = 0; i < shares.size(); ++i) {
      rest -= getsShare[i] ? 0 : needed[i];
      restShares += getsShare[i] ? shares[i] : 0;
    }
    for (std::size_t i = 0; i < shares.size(); ++i) {
      if (getsShare[i]) {
        const int share = static_cast<int>(rest * shares[i] / restShares);
        getsShare[i] = share >= needed[i];
        settled = settled && getsShare[i];
        widths[i] = std::max(share, needed[i]);
      }
    }
  }
  return widths;
}

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
  horizontalHeader()->setFont(CaptionFont(font(), LargestCaptions));
  horizontalHeader()->setHighlightSections(false);
  horizontalHeader()->setMinimumSectionSize(40);
  horizontalHeader()->setStretchLastSection(true);
}

void ScoreListView::SetColumnShares(std::vector<double> shares) {
  shares_ = std::move(shares);
  ShareWidth();
}

void ScoreListView::ShowWholeRows(int rows) {
  wholeRows_ = rows;
  KeepHeight();
}

void ScoreListView::reset() {
  QTableView::reset();
  for (int column = 0; column < ColumnCount(); ++column) {
    if (columnWidth(column) < NeededWidth(column)) {
      ShareWidth();
      return;
    }
  }
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

int ScoreListView::NeededWidth(int column) const {
  return std::max(horizontalHeader()->sectionSizeHint(column), sizeHintForColumn(column));
}

// Frame and header have their final heights only once the list is shown, and the captions change in size.
void ScoreListView::KeepHeight() {
  if (wholeRows_ > 0) {
    setFixedHeight(horizontalHeader()->sizeHint().height() +
                   wholeRows_ * verticalHeader()->defaultSectionSize() + 2 * frameWidth());
  }
}

void ScoreListView::ShareWidth() {
  FitCaptions();
  KeepHeight();
  std::vector<int> needed;
  needed.reserve(shares_.size());
  for (int column = 0; column < ColumnCount(); ++column) {
    needed.push_back(NeededWidth(column));
  }
  const std::vector<int> widths = ColumnWidths(viewport()->width(), shares_, needed);
  for (int column = 0; column < ColumnCount(); ++column) {
    setColumnWidth(column, widths[static_cast<std::size_t>(column)]);
  }
}

// The room does not depend on whether the scroll bar is shown: other captions may change that.
void ScoreListView::FitCaptions() {
  constexpr double step = 0.05;
  const int room = width() - 2 * frameWidth() - verticalScrollBar()->sizeHint().width();
  double size = LargestCaptions;
  while (size > SmallestCaptions && !CaptionsFit(CaptionFont(font(), size), room)) {
    size -= step;
  }
  const QFont captions = CaptionFont(font(), size);
  if (captions != horizontalHeader()->font()) {
    horizontalHeader()->setFont(captions);
  }
}

bool ScoreListView::CaptionsFit(const QFont& captions, int room) const {
  const QFontMetrics now = horizontalHeader()->fontMetrics();
  const QFontMetrics then(captions);
  for (int column = 0; column < ColumnCount(); ++column) {
    const QString caption = model()->headerData(column, Qt::Horizontal).toString();
    const int width = horizontalHeader()->sectionSizeHint(column) - now.horizontalAdvance(caption) +
                      then.horizontalAdvance(caption);
    if (width > static_cast<int>(room * shares_[static_cast<std::size_t>(column)])) {
      return false;
    }
  }
  return true;
}
