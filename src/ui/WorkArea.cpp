#include "ui/WorkArea.h"

#include <QBoxLayout>
#include <QEvent>
#include <QFileDialog>
#include <QFontMetrics>
#include <QGridLayout>
#include <QMainWindow>
#include <QMessageBox>
#include <QPushButton>
#include <QScreen>
#include <QScrollArea>
#include <QScrollBar>
#include <algorithm>

namespace {

/// Of the usual window managers, the one with the largest frame. The real one is known only afterwards.
constexpr QSize Frame(10, 40);

/// A dialog appears on the screen of its parent.
const QScreen& ScreenOf(const QWidget& window) {
  const QWidget* parent = window.parentWidget();
  return *(parent != nullptr ? parent->window() : &window)->screen();
}

/// Width of a window that shows its title whole, beside the buttons of its frame.
int WidthForTitle(const QWidget& window) {
  QFont font = window.font();
  font.setBold(true);
  const QFontMetrics metrics(font);
  return metrics.horizontalAdvance(window.windowTitle()) + 8 * metrics.height();
}

/// Least height of a layout that is `width` wide. The toolkit gives lines that wrap no less than the height
/// that they want.
int LeastHeight(const QLayout& layout, int width) {
  const int least = layout.totalMinimumSize().height();
  return layout.hasHeightForWidth() ? std::max(least, layout.totalHeightForWidth(width)) : least;
}

QScrollArea* NewScrollArea(QWidget& window) {
  auto* area = new QScrollArea(&window);
  area->setWidgetResizable(true);
  area->setFrameShape(QFrame::NoFrame);
  area->setFocusPolicy(Qt::NoFocus);  // it follows the focus of its contents
  return area;
}

/// Takes the row of buttons at the bottom out of a dialog's layout; null where there is none.
QLayout* TakeButtonRow(QLayout& layout, int width) {
  auto* column = qobject_cast<QVBoxLayout*>(&layout);
  QLayout* row = column != nullptr ? column->itemAt(column->count() - 1)->layout() : nullptr;
  if (row == nullptr || row->minimumSize().width() > width) {
    return nullptr;
  }
  for (int i = 0; i < row->count(); ++i) {
    if (qobject_cast<QPushButton*>(row->itemAt(i)->widget()) != nullptr) {
      column->takeAt(column->count() - 1);
      return row;
    }
  }
  return nullptr;
}

/// Shows as much of its contents as the room allows.
void SetLeastSize(QScrollArea& area, const QLayout& content, const QSize& room) {
  QSize least = content.totalMinimumSize();
  const int bar = area.verticalScrollBar()->sizeHint().width();
  const bool scrollsAcross = least.width() + bar > room.width();
  least.setWidth(std::min(least.width() + bar, room.width()));
  least.setHeight(LeastHeight(content, least.width() - bar) + (scrollsAcross ? bar : 0));
  area.setMinimumSize(least.boundedTo(room));
}

void MakeScroll(QWidget& dialog, const QSize& room) {
  QWidget* focus = dialog.focusWidget();
  QLayout* layout = dialog.layout();
  const QMargins margins = layout->contentsMargins();
  QLayout* buttons = TakeButtonRow(*layout, room.width() - margins.left() - margins.right());
  QScrollArea* area = NewScrollArea(dialog);
  auto* content = new QWidget;
  area->setWidget(
      content);  // while it is empty: the controls must not leave the window, or lose their Tab order
  content->setLayout(layout);
  auto* outer = new QVBoxLayout(&dialog);
  outer->setContentsMargins(0, 0, 0, 0);
  outer->addWidget(area);
  QSize rest = room;
  if (buttons != nullptr) {
    buttons->setContentsMargins(margins.left(), 0, margins.right(), margins.bottom());
    outer->addLayout(buttons);
    rest.rheight() -= buttons->minimumSize().height() + outer->spacing();
  }
  SetLeastSize(*area, *layout, rest);
  if (focus != nullptr) {
    focus->setFocus();
  }
}

void FitMainWindow(QMainWindow& window, const QSize& room) {
  const QSize least = window.minimumSizeHint();
  if (least.width() <= room.width() && least.height() <= room.height()) {
    return;
  }
  QScrollArea* area = NewScrollArea(window);
  area->setWidget(window.takeCentralWidget());
  window.setCentralWidget(area);
}

bool Fits(const QLayout& layout, const QSize& room) {
  const int width = std::min(layout.totalSizeHint().width(), room.width());
  return layout.totalMinimumSize().width() <= room.width() && LeastHeight(layout, width) <= room.height();
}

void FitDialog(QWidget& dialog, const QSize& room) {
  if (!Fits(*dialog.layout(), room)) {
    MakeScroll(dialog, room);
  }
  if (dialog.testAttribute(Qt::WA_Resized)) {
    dialog.resize(dialog.size().boundedTo(room));
  }
  const int width = std::min(WidthForTitle(dialog), room.width());
  const int least = std::max(dialog.layout()->totalMinimumSize().width(), dialog.minimumWidth());
  if (width > least) {  // else the layout's own would no longer count
    dialog.setMinimumWidth(width);
  }
}

/// A message box reckons its size from its layout alone.
void WidenForTitle(QMessageBox& box, const QSize& room) {
  if (auto* grid = qobject_cast<QGridLayout*>(box.layout())) {
    const int width = std::min(WidthForTitle(box), room.width());
    grid->addItem(new QSpacerItem(width, 0), grid->rowCount(), 0, 1, grid->columnCount());
  }
}

void Fit(QWidget& window) {
  const QSize room = RoomOn(ScreenOf(window));
  if (auto* box = qobject_cast<QMessageBox*>(&window)) {
    WidenForTitle(*box, room);
  } else if (auto* mainWindow = qobject_cast<QMainWindow*>(&window)) {
    FitMainWindow(*mainWindow, room);
  } else if (qobject_cast<QDialog*>(&window) != nullptr && qobject_cast<QFileDialog*>(&window) == nullptr &&
             window.layout() != nullptr) {
    FitDialog(window, room);
  }
}

}  // namespace

QSize RoomIn(const QSize& area) {
  return area - Frame;
}

QSize RoomOn(const QScreen& screen) {
  return RoomIn(screen.availableSize());
}

bool WorkArea::eventFilter(QObject* watched, QEvent* event) {
  if (event->type() == QEvent::Polish && watched->isWidgetType()) {
    auto& widget = *static_cast<QWidget*>(watched);
    if (widget.isWindow()) {
      Fit(widget);
    }
  }
  return QObject::eventFilter(watched, event);
}
