#include "board/ScoreListView.h"

#include <QFocusEvent>
#include <QFontInfo>
#include <QHeaderView>
#include <QKeyEvent>
#include <QPainter>
#include <QPixmap>
#include <QProxyStyle>
#include <QScrollBar>
#include <QtMath>
#include <algorithm>
#include <utility>

#include "board/BoardDelegate.h"
#include "board/ColumnWidths.h"
#include "board/ListFonts.h"
#include "board/PlayerDelegate.h"
#include "board/ScoreListHeader.h"
#include "board/ScoreListModel.h"
#include "ui/RowsAsText.h"

namespace {

/// Gives cells the same side margin as their headers.
class CellMargin : public QProxyStyle {
 public:
  int pixelMetric(PixelMetric metric, const QStyleOption* option, const QWidget* widget) const override {
    constexpr int sideMargin = 7;
    return metric == PM_FocusFrameHMargin ? sideMargin : QProxyStyle::pixelMetric(metric, option, widget);
  }
};

/// Sizes of the captions, relative to the smallest figures.
constexpr double LargestCaptions = 0.8;
constexpr double SmallestCaptions = 0.6;

}  // namespace

ScoreListView::ScoreListView(QWidget* parent)
    : QTableView(parent), header_(new ScoreListHeader(this)), largestCaptions_(LargestCaptions) {
  auto* margin = new CellMargin;
  margin->setParent(this);
  setStyle(margin);
  leastFont_ = Grown(font(), 1.5);
  setFont(leastFont_);
  setHorizontalHeader(header_);
  setSelectionBehavior(SelectRows);
  setSelectionMode(ExtendedSelection);
  setEditTriggers(NoEditTriggers);
  setShowGrid(false);
  setWordWrap(false);
  setTabKeyNavigation(false);
  setCornerButtonEnabled(false);
  setHorizontalScrollMode(ScrollPerPixel);
  setItemDelegate(new BoardDelegate(this));
  leastLetters_ = QFontInfo(leastFont_).pixelSize();
  leastCapitals_ = leastLetters_ * CapitalsOf(leastFont_);
  leastRow_ = fontMetrics().height() + 12;
  verticalHeader()->hide();
  verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
  verticalHeader()->setDefaultSectionSize(leastRow_);
  header_->setFont(CaptionFont(leastFont_, LargestCaptions));
  connect(header_, &ScoreListHeader::WidthsDragged, this, &ScoreListView::TakeDraggedWidths);
}

void ScoreListView::setModel(QAbstractItemModel* newModel) {
  QTableView::setModel(newModel);
  if (newModel != nullptr) {
    // After the model of the selection, which forgets it.
    connect(newModel, &QAbstractItemModel::modelReset, this, &ScoreListView::RestoreSelection);
    leastRow_ = std::max(leastRow_, LeastRowOfMember(leastFont_, SomeLetters()));
    SetRowHeight(leastRow_);
  }
  MeasureTexts();
}

void ScoreListView::SetColumnShares(std::vector<double> shares) {
  shares_ = std::move(shares);
  MeasureTexts();
  ShareWidth();
}

void ScoreListView::SetDraggedShares(std::vector<double> shares) {
  const bool usable = shares.size() == shares_.size() &&
                      std::all_of(shares.begin(), shares.end(), [](double share) { return share > 0; });
  draggedShares_ = usable ? std::move(shares) : std::vector<double>();
  ShareWidth();
}

void ScoreListView::TakeDraggedWidths() {
  std::vector<double> shares;
  shares.reserve(static_cast<std::size_t>(ColumnCount()));
  for (int column = 0; column < ColumnCount(); ++column) {
    shares.push_back(static_cast<double>(columnWidth(column)) / header_->length());
  }
  SetDraggedShares(std::move(shares));
  emit WidthsDragged();
}

void ScoreListView::ShowWholeRows(int rows) {
  wholeRows_ = rows;
  setVerticalScrollBarPolicy(rows > 0 ? Qt::ScrollBarAlwaysOff : Qt::ScrollBarAsNeeded);
  KeepHeight();
}

void ScoreListView::SetLetters(double growth, int rowHeight) {
  if (growth == growth_ && rowHeight == verticalHeader()->defaultSectionSize()) {
    return;
  }
  growth_ = growth;
  setFont(Grown(leastFont_, growth));
  SetRowHeight(rowHeight);
  ShareWidth();
  if (selectionModel() != nullptr && selectionModel()->hasSelection()) {
    scrollTo(currentIndex());
  }
}

void ScoreListView::SetRowHeight(int height) {
  verticalHeader()->setDefaultSectionSize(height);
  gunSize_ = GunSizeIn(height, growth_, leastFont_, SomeLetters());
}

void ScoreListView::SetLargestCaptions(double size) {
  const double largest = std::max(size, LargestCaptions);
  if (largest == largestCaptions_) {
    return;
  }
  largestCaptions_ = largest;
  const QFontMetrics now = header_->fontMetrics();
  const QFontMetrics then(CaptionFont(leastFont_, largest));
  header_->setMinimumHeight(header_->sizeHint().height() - now.height() + then.height());
  ShareWidth();
}

int ScoreListView::HeightWithoutRows() const {
  return std::max(header_->sizeHint().height(), header_->minimumHeight()) + 2 * frameWidth();
}

double ScoreListView::WidthAt(double growth, Names names, Captions captions) const {
  double width = 2 * frameWidth();
  const QFont font =
      CaptionFont(leastFont_, captions == Captions::Largest ? largestCaptions_ : SmallestCaptions);
  for (int column = 0; column < ColumnCount(); ++column) {
    width += std::max<double>(FigureWidthAt(column, growth, names), header_->CaptionWidth(column, font));
  }
  return width;
}

int ScoreListView::FittingWidth(Columns columns) const {
  int all = 0;
  int widest = 0;
  const QFont captions = CaptionFont(leastFont_, largestCaptions_);
  for (int column = 0; column < ColumnCount(); ++column) {
    const int width = NeededWidth(column, header_->CaptionWidth(column, captions));
    all += width;
    widest = std::max(widest, width);
  }
  return (columns == Columns::Own ? all : widest * ColumnCount()) + 2 * frameWidth();
}

void ScoreListView::reset() {
  QTableView::reset();
  if (model() == nullptr || model()->rowCount() == 0) {
    return;  // for the moment only, if a calculation has emptied it
  }
  MeasureTexts();
  ShareWidth();
}

void ScoreListView::resizeEvent(QResizeEvent* event) {
  const QSignalBlocker once(header_);  // as in ShareWidth
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
    painter.drawPixmap(place,
                       QPixmap(QStringLiteral(":/pictures/tessarine-128.png")));  // the banner has it too
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
  // The toolkit would copy only one cell.
  if (event->matches(QKeySequence::Copy)) {
    CopyRows(*this);
    return;
  }
  if (event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter) {
    if (!event->isAutoRepeat()) {  // which also closes the window that opens
      emit RowChosen();
    }
    return;
  }
  QTableView::keyPressEvent(event);
}

void ScoreListView::mousePressEvent(QMouseEvent* event) {
  const bool extends = event->modifiers().testAnyFlags(Qt::ControlModifier | Qt::ShiftModifier);
  if ((!extends || event->button() == Qt::RightButton) && !indexAt(event->position().toPoint()).isValid()) {
    clearSelection();
  }
  QTableView::mousePressEvent(event);
}

void ScoreListView::mouseDoubleClickEvent(QMouseEvent* event) {
  const bool isOnRow = indexAt(event->position().toPoint()).isValid();
  QTableView::mouseDoubleClickEvent(event);
  if (isOnRow && event->button() == Qt::LeftButton) {
    emit RowChosen();
  }
}

void ScoreListView::selectionChanged(const QItemSelection& selected, const QItemSelection& deselected) {
  QTableView::selectionChanged(selected, deselected);
  Remember();
}

void ScoreListView::currentChanged(const QModelIndex& current, const QModelIndex& previous) {
  QTableView::currentChanged(current, previous);
  Remember();
}

int ScoreListView::KeyAt(int row) const {
  return model()->index(row, 0).data(ScoreListModel::KeyRole).toInt();
}

void ScoreListView::Remember() {
  selectedKeys_.clear();
  for (const QModelIndex& index : selectionModel()->selectedRows()) {
    selectedKeys_.push_back(KeyAt(index.row()));
  }
  const QModelIndex current = currentIndex();
  currentKey_ = current.isValid() ? std::optional(KeyAt(current.row())) : std::nullopt;
  currentColumn_ = std::max(current.column(), 0);
}

void ScoreListView::RestoreSelection() {
  if (selectedKeys_.empty() && !currentKey_) {
    return;
  }
  QItemSelection selection;
  QModelIndex current;
  for (int row = 0; row < model()->rowCount(); ++row) {
    const int key = KeyAt(row);
    const QModelIndex index = model()->index(row, currentColumn_);
    if (std::find(selectedKeys_.begin(), selectedKeys_.end(), key) != selectedKeys_.end()) {
      selection.select(index, index);
    }
    current = key == currentKey_ ? index : current;
  }
  if (current.isValid()) {
    selectionModel()->setCurrentIndex(current, QItemSelectionModel::NoUpdate);
  }
  if (!selection.isEmpty()) {
    selectionModel()->select(selection, QItemSelectionModel::Select | QItemSelectionModel::Rows);
    scrollTo(current.isValid() && selectionModel()->isRowSelected(current.row())
                 ? current
                 : selection.indexes().first());
  }
}

void ScoreListView::SelectKey(int key) {
  for (int row = 0; row < model()->rowCount(); ++row) {
    if (KeyAt(row) == key) {
      selectRow(row);
      scrollTo(model()->index(row, currentColumn_));
    }
  }
}

void ScoreListView::ForgetSelection() {
  clearSelection();
  selectedKeys_.clear();
  currentKey_.reset();
}

int ScoreListView::Margins(int column, double growth) const {
  const int margin = 2 * (style()->pixelMetric(QStyle::PM_FocusFrameHMargin, nullptr, this) + 1);
  constexpr int rounding = 3;  // of texts and badge; a pixel less, and the text is cut
  const bool hasBadge = column == static_cast<int>(BoardColumn::Player);
  return rounding + margin + (hasBadge ? BadgeSize(leastCapitals_ * growth) + margin : 0);
}

void ScoreListView::MeasureTexts() {
  if (model() != nullptr) {
    contents_.Measure(*model(), leastFont_);
  }
}

double ScoreListView::FigureWidthAt(int column, double growth, Names names) const {
  const ColumnContents::Column& contents = contents_[column];
  const double letters = leastLetters_ * growth;
  const double name = names == Names::Whole ? contents.NameWidth : 0;
  constexpr double rounding = 1.02;  // of each letter to whole pixels
  return std::max({contents.Width, contents.GunWidth * GunSize(growth), name}) * letters * rounding +
         Margins(column, growth);
}

int ScoreListView::NeededWidth(int column, int caption) const {
  const ColumnContents::Column& contents = contents_[column];
  const int text = fontMetrics().horizontalAdvance(contents.Text);
  const int gun = QFontMetrics(Grown(font(), gunSize_)).horizontalAdvance(contents.Gun);
  return std::max(std::max(text, gun) + Margins(column, growth_), caption);
}

// Frame and header have their final heights only once the list is shown, and the captions change in size.
void ScoreListView::KeepHeight() {
  if (wholeRows_ > 0) {
    setFixedHeight(HeightWithoutRows() + wholeRows_ * verticalHeader()->defaultSectionSize());
  }
}

void ScoreListView::ShareWidth() {
  FitCaptions();
  KeepHeight();
  const bool dragged = !draggedShares_.empty();
  std::vector<int> least;
  std::vector<int> wanted;
  for (int column = 0; column < ColumnCount(); ++column) {
    const double share = viewport()->width() * shares_[static_cast<std::size_t>(column)];
    least.push_back(dragged ? header_->minimumSectionSize()
                            : NeededWidth(column, header_->CaptionWidth(column, header_->font())));
    wanted.push_back(dragged ? 0 : WantedWidth(column, share));
  }
  const std::vector<int> widths =
      ColumnWidths(viewport()->width(), dragged ? draggedShares_ : shares_, least, wanted);
  // If it heard of its columns, the toolkit would paint once more a moment later.
  const QSignalBlocker once(header_);
  for (int column = 0; column < ColumnCount(); ++column) {
    setColumnWidth(column, widths[static_cast<std::size_t>(column)]);
  }
  updateGeometries();
  viewport()->update();
}

int ScoreListView::WantedWidth(int column, double share) const {
  const ColumnContents::Column& contents = contents_[column];
  const double letters = leastLetters_ * growth_;
  const int margins = Margins(column, growth_);
  if (growth_ <= 1 || contents.NameWidth * letters + margins <= share) {
    return 0;
  }
  return qCeil(contents.LongestName * letters) + margins;
}

// The room does not depend on whether the scroll bar is shown: other captions may change that.
void ScoreListView::FitCaptions() {
  header_->MeasureCaptions();
  constexpr double step = 0.05;
  const int scrollBar = wholeRows_ > 0 ? 0 : verticalScrollBar()->sizeHint().width();
  const int room = width() - 2 * frameWidth() - scrollBar;
  double size = largestCaptions_;
  while (size > SmallestCaptions && !CaptionsFit(CaptionFont(leastFont_, size), room)) {
    size -= step;
  }
  if (const QFont captions = CaptionFont(leastFont_, size); captions != header_->font()) {
    header_->setFont(captions);
  }
}

bool ScoreListView::CaptionsFit(const QFont& captions, int room) const {
  int needed = 0;
  for (int column = 0; column < ColumnCount(); ++column) {
    const int caption = header_->CaptionWidth(column, captions);
    needed += NeededWidth(column, caption);
    if (caption > static_cast<int>(room * shares_[static_cast<std::size_t>(column)])) {
      return false;
    }
  }
  return needed <= room;
}
