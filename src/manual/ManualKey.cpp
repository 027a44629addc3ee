#include "manual/ManualKey.h"

#include <QApplication>
#include <QDialog>
#include <QKeyEvent>
#include <utility>

namespace {

/// `window`, or the window of progress in front of it, which leaves it the keyboard.
const QWidget& InFrontOf(const QWidget& window) {
  for (const QDialog* dialog : window.findChildren<QDialog*>(Qt::FindDirectChildrenOnly)) {
    if (dialog->isVisible()) {
      return *dialog;
    }
  }
  return window;
}

}  // namespace

ManualKey::ManualKey(const StringTable& strings, QString folder, const QWidget& mainWindow)
    : strings_(strings), folder_(std::move(folder)), mainWindow_(mainWindow) {
  qApp->installEventFilter(this);
}

void ManualKey::Open() {
  const QWidget* front = QApplication::activeModalWidget();
  if (front == nullptr) {
    front = QApplication::activeWindow();
  }
  if (front == nullptr || front == window_.get()) {
    front = &mainWindow_;
  }
  Window().ShowPageOf(InFrontOf(*front));
}

void ManualKey::OpenPage(const QString& title) {
  Window().ShowPageTitled(title);
}

ManualWindow& ManualKey::Window() {
  if (!window_) {
    window_ = std::make_unique<ManualWindow>(strings_, folder_);
  }
  return *window_;
}

bool ManualKey::eventFilter(QObject* watched, QEvent* event) {
  if (event->type() == QEvent::KeyPress && watched->isWidgetType()) {
    const auto& key = *static_cast<QKeyEvent*>(event);
    if (key.key() == Qt::Key_F1 && key.modifiers() == Qt::NoModifier) {
      if (static_cast<const QWidget*>(watched)->window() != window_.get()) {
        Open();
      }
      return true;
    }
  }
  return QObject::eventFilter(watched, event);
}
