#include "sound/SoundListView.h"

#include <QDragMoveEvent>
#include <QHeaderView>
#include <QKeyEvent>
#include <QMimeData>
#include <QStyledItemDelegate>
#include <QTimer>
#include <QUrl>

#include "sound/SoundListModel.h"

namespace {

/// Shortening a text to a cell's width takes as long as the text is, and a play list may hold one of
/// megabytes.
class PathDelegate : public QStyledItemDelegate {
 public:
  using QStyledItemDelegate::QStyledItemDelegate;

 protected:
  void initStyleOption(QStyleOptionViewItem* option, const QModelIndex& index) const override {
    constexpr qsizetype most = 2000;
    QStyledItemDelegate::initStyleOption(option, index);
    if (option->text.size() > most) {
      option->text = option->text.left(most / 2) + QChar(0x2026) + option->text.right(most / 2);
    }
  }
};

QStringList LocalFilesIn(const QMimeData& data) {
  QStringList paths;
  for (const QUrl& url : data.urls()) {
    if (url.isLocalFile()) {
      paths << url.toLocalFile();
    }
  }
  return paths;
}

}  // namespace

SoundListView::SoundListView(QWidget* parent) : QTableView(parent) {
  setItemDelegate(new PathDelegate(this));
  setSelectionMode(SingleSelection);
  setSelectionBehavior(SelectRows);
  setEditTriggers(NoEditTriggers);
  setTabKeyNavigation(false);
  setWordWrap(false);
  setShowGrid(false);
  setTextElideMode(Qt::ElideMiddle);
  setCornerButtonEnabled(false);
  setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
  setAcceptDrops(true);
  verticalHeader()->hide();
  verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
  horizontalHeader()->setHighlightSections(false);
  horizontalHeader()->setSectionResizeMode(QHeaderView::Fixed);
  connect(this, &QTableView::doubleClicked, this,
          [this](const QModelIndex& index) { emit RowActivated(index.row()); });
}

int SoundListView::SelectedRow() const {
  return currentIndex().isValid() ? currentIndex().row() : -1;
}

void SoundListView::SelectRow(int row) {
  selectRow(row);
  scrollTo(model()->index(row, 0));
}

void SoundListView::keyPressEvent(QKeyEvent* event) {
  const bool isReturn = event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter;
  if (!isReturn) {
    QTableView::keyPressEvent(event);
  } else if (SelectedRow() >= 0) {
    event->accept();  // else it would also press the window's default button
    emit RowActivated(SelectedRow());
  }
}

void SoundListView::resizeEvent(QResizeEvent* event) {
  QTableView::resizeEvent(event);
  ShareWidth();
}

void SoundListView::ShareWidth() {
  constexpr double eventShare = 0.22;
  constexpr double fileShare = 0.74;
  int rest = viewport()->width();
  for (const int column : {SoundListModel::SecondsColumn, SoundListModel::PagesColumn}) {
    const int width = horizontalHeader()->sectionSizeHint(column);
    setColumnWidth(column, width);
    rest -= width;
  }
  setColumnWidth(SoundListModel::EventColumn, static_cast<int>(rest * eventShare));
  setColumnWidth(SoundListModel::FileColumn, static_cast<int>(rest * fileShare));
}

void SoundListView::dragEnterEvent(QDragEnterEvent* event) {
  event->setAccepted(!LocalFilesIn(*event->mimeData()).isEmpty());
}

void SoundListView::dragMoveEvent(QDragMoveEvent* event) {
  event->setAccepted(indexAt(event->position().toPoint()).isValid() &&
                     !LocalFilesIn(*event->mimeData()).isEmpty());
}

void SoundListView::dropEvent(QDropEvent* event) {
  const QModelIndex index = indexAt(event->position().toPoint());
  const QStringList paths = LocalFilesIn(*event->mimeData());
  if (!index.isValid() || paths.isEmpty()) {
    event->ignore();
    return;
  }
  // The files stay where they are.
  event->setDropAction(Qt::CopyAction);
  event->accept();
  QTimer::singleShot(0, this, [this, row = index.row(), paths] { emit FilesDropped(row, paths); });
}
