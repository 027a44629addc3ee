#include "demo/pictures/Studio.h"

#include <QApplication>
#include <QFileDialog>
#include <QLineEdit>
#include <QMessageBox>
#include <QPushButton>
#include <utility>

namespace {

constexpr int WatchMilliseconds = 30;
constexpr int SettleMilliseconds = 150;
constexpr int LongestWaitMilliseconds = 60000;

QWidget* VisibleWindow(const char* name) {
  for (QWidget* window : QApplication::topLevelWidgets()) {
    if (window->isVisible() && window->objectName() == QLatin1String(name)) {
      return window;
    }
  }
  return nullptr;
}

}  // namespace

Studio::Studio(QMainWindow& window, const QDir& folder) : window_(window), folder_(folder) {
  connect(&watch_, &QTimer::timeout, this, &Studio::Watch);
  watch_.start(WatchMilliseconds);
}

void Studio::Open(const char* item, const Act& act) {
  QAction& action = In<QAction>(window_, item);
  Open([&action] { action.trigger(); }, act);
}

void Studio::Open(const std::function<void()>& open, const Act& act) {
  const QWidget* before = QApplication::activeModalWidget();
  bool opened = false;
  QTimer timer;
  connect(&timer, &QTimer::timeout, this, [&] {
    QWidget* front = QApplication::activeModalWidget();
    if (front == nullptr || front == before || !QTest::qWaitForWindowExposed(front)) {
      return;
    }
    timer.stop();
    opened = true;
    act(*front);
    front->close();
  });
  timer.start(WatchMilliseconds);
  open();
  if (!opened) {
    AddFault(QStringLiteral("A window did not open."));
  }
}

void Studio::Take(QWidget& window, const char* picture) {
  QTest::qWait(SettleMilliseconds);
  const QString path = folder_.absoluteFilePath(QLatin1String(picture) + QStringLiteral(".png"));
  if (!window.grab().save(path)) {
    AddFault(QStringLiteral("%1 could not be written.").arg(path));
  }
}

void Studio::TakeWhen(const char* window, const char* picture, Ready ready, Act then) {
  if (awaited_) {
    AddFault(QStringLiteral("%1 did not come.").arg(QLatin1String(awaited_->Picture)));
  }
  awaited_ = {window, picture, std::move(ready), std::move(then)};
}

void Studio::WaitUntil(const char* what, const std::function<bool()>& holds) {
  if (!QTest::qWaitFor(holds, LongestWaitMilliseconds)) {
    AddFault(QStringLiteral("Waited in vain until %1.").arg(QLatin1String(what)));
  }
}

void Studio::Watch() {
  QWidget* front = QApplication::activeModalWidget();
  if (auto* dialog = qobject_cast<QFileDialog*>(front)) {
    dialog->findChild<QLineEdit*>(QStringLiteral("fileNameEdit"))->setText(file_);
    QMetaObject::invokeMethod(dialog, "accept");
  } else if (auto* box = qobject_cast<QMessageBox*>(front)) {
    if (box->icon() == QMessageBox::Critical || box->icon() == QMessageBox::Warning) {
      AddFault(QStringLiteral("A box came up: %1").arg(box->text()));
    }
    box->defaultButton()->click();
  }
  if (QWidget* window = awaited_ ? VisibleWindow(awaited_->Window) : nullptr;
      window != nullptr && awaited_->IsReady(*window)) {
    const Awaited awaited = *std::exchange(awaited_, std::nullopt);
    if (!window->grab().save(
            folder_.absoluteFilePath(QLatin1String(awaited.Picture) + QStringLiteral(".png")))) {
      AddFault(QStringLiteral("%1 could not be written.").arg(QLatin1String(awaited.Picture)));
    }
    if (awaited.Then) {
      awaited.Then(*window);
    }
  }
}
