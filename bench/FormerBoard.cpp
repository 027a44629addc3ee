#include "bench/FormerBoard.h"

#include <QHeaderView>
#include <QPainter>
#include <QProxyStyle>
#include <QScrollBar>
#include <algorithm>
#include <utility>

#include "board/PlayerDelegate.h"
#include "board/ScoreListModel.h"

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

constexpr double PlayerSize = 0.72;  ///< relative to the cell's font size
constexpr double NameSize = 0.68;

QFont Smaller(QFont font, double size) {
  font.setPointSizeF(font.pointSizeF() * size);
  return font;
}

void DrawLine(QPainter& painter, const QRect& place, Qt::Alignment alignment, const QString& text) {
  painter.drawText(place, static_cast<int>(Qt::AlignLeft | alignment) | Qt::TextSingleLine, text);
}

}  // namespace

FormerView::FormerView(QWidget* parent) : QTableView(parent) {
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

void FormerView::SetColumnShares(std::vector<double> shares) {
  shares_ = std::move(shares);
  ShareWidth();
}

void FormerView::ShowWholeRows(int rows) {
  wholeRows_ = rows;
  KeepHeight();
}

void FormerView::reset() {
  QTableView::reset();
  for (int column = 0; column < ColumnCount(); ++column) {
    if (columnWidth(column) < NeededWidth(column)) {
      ShareWidth();
      return;
    }
  }
}

void FormerView::resizeEvent(QResizeEvent* event) {
  QTableView::resizeEvent(event);
  ShareWidth();
}

int FormerView::NeededWidth(int column) const {
  return std::max(horizontalHeader()->sectionSizeHint(column), sizeHintForColumn(column));
}

// Frame and header have their final heights only once the list is shown, and the captions change in size.
void FormerView::KeepHeight() {
  if (wholeRows_ > 0) {
    setFixedHeight(horizontalHeader()->sizeHint().height() +
                   wholeRows_ * verticalHeader()->defaultSectionSize() + 2 * frameWidth());
  }
}

void FormerView::ShareWidth() {
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
void FormerView::FitCaptions() {
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

bool FormerView::CaptionsFit(const QFont& captions, int room) const {
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

// The gun's name alone decides how wide the column must be.
void FormerDelegate::initStyleOption(QStyleOptionViewItem* option, const QModelIndex& index) const {
  QStyledItemDelegate::initStyleOption(option, index);
  option->text = index.data(ScoreListModel::NameRole).toString();
}

void FormerDelegate::paint(QPainter* painter, const QStyleOptionViewItem& option,
                           const QModelIndex& index) const {
  QStyleOptionViewItem cell = option;
  initStyleOption(&cell, index);
  const QString gun = cell.text;
  const QString memberName = index.data(ScoreListModel::MemberNameRole).toString();
  const QStyle& style = *cell.widget->style();
  const QRect place = style.subElementRect(QStyle::SE_ItemViewItemText, &cell, cell.widget);
  const int margin = style.pixelMetric(QStyle::PM_FocusFrameHMargin, &cell, cell.widget) + 1;
  if (memberName.isEmpty()) {
    cell.text = FittingGunName(gun, QFontMetrics(cell.font), place.width() - 2 * margin);
    style.drawControl(QStyle::CE_ItemViewItem, &cell, painter, cell.widget);
    return;
  }
  cell.text.clear();
  style.drawControl(QStyle::CE_ItemViewItem, &cell, painter, cell.widget);
  const QRect lines(place.left() + margin, cell.rect.top() + 1, place.width() - margin,
                    cell.rect.height() - 2);
  const bool selected = cell.state.testFlag(QStyle::State_Selected);
  painter->save();
  painter->setPen(cell.palette.color(selected ? QPalette::HighlightedText : QPalette::Text));
  painter->setFont(Smaller(cell.font, PlayerSize));
  DrawLine(*painter, lines, Qt::AlignTop, FittingGunName(gun, painter->fontMetrics(), lines.width()));
  painter->setFont(Smaller(cell.font, NameSize));
  DrawLine(*painter, lines, Qt::AlignBottom,
           painter->fontMetrics().elidedText(memberName, Qt::ElideRight, lines.width()));
  painter->restore();
}
