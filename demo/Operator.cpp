#include "demo/Operator.h"

#include <QContextMenuEvent>
#include <QLineEdit>
#include <QMessageBox>
#include <QPushButton>

Operator::Operator(const QDir& folder) : folder_(folder) {
  constexpr int watchMilliseconds = 50;
  connect(&watch_, &QTimer::timeout, this, &Operator::CloseBox);
  watch_.start(watchMilliseconds);
}

void Operator::OnceEventsRun(const std::function<void()>& open, const std::function<void()>& act) {
  QTimer first;
  first.setSingleShot(true);
  connect(&first, &QTimer::timeout, this, act);
  first.start(0);
  open();
}

void Operator::WithPopup(QTableView& list, int row, const std::function<void(QMenu&)>& choose) {
  const QModelIndex cell = list.model()->index(row, 1);
  list.scrollTo(cell);
  QWidget& viewport = *list.viewport();
  const QPoint place = list.visualRect(cell).center();
  QTest::mouseClick(&viewport, Qt::RightButton, {}, place);
  bool chosen = false;
  const auto openMenu = [&] {
    QContextMenuEvent event(QContextMenuEvent::Mouse, place, viewport.mapToGlobal(place));
    QApplication::sendEvent(&viewport, &event);
  };
  OnceEventsRun(openMenu, [&] {
    if (auto* menu = qobject_cast<QMenu*>(QApplication::activePopupWidget())) {
      chosen = true;
      choose(*menu);
      menu->close();
    }
  });
  if (!chosen) {
    AddFault(QStringLiteral("Row %1 has no context menu.").arg(row + 1));
  }
}

void Operator::Choose(QMenu& menu, QAction& item) {
  menu.setActiveAction(&item);
  QTest::keyClick(&menu, Qt::Key_Return);
}

void Operator::EnterFile(const std::function<void()>& open, const QString& path) {
  Within<QFileDialog>(open, [&path](QFileDialog& dialog) {
    dialog.findChild<QLineEdit*>(QStringLiteral("fileNameEdit"))->setText(path);
    QMetaObject::invokeMethod(&dialog, "accept");
  });
}

QString Operator::TakeMessage() {
  return std::exchange(message_, QString());
}

void Operator::SavePicture(QWidget& window, const QString& name) {
  constexpr int smallestFile = 0;  // the toolkit's quality of a picture that loses nothing
  if (!window.grab().save(folder_.absoluteFilePath(name), "PNG", smallestFile)) {
    AddFault(QStringLiteral("The picture %1 could not be written.").arg(name));
  }
}

void Operator::CloseBox() {
  auto* box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
  if (box == nullptr) {
    return;
  }
  if (box->icon() == QMessageBox::Question && std::exchange(expectsQuestion_, false)) {
    box->button(QMessageBox::Ok)->click();
    return;
  }
  if (box->icon() == QMessageBox::Information) {
    message_ = box->text();
  } else {
    AddFault(QStringLiteral("A box came up: %1").arg(box->text()));
  }
  box->defaultButton()->click();
}
