#include "ui/CalmList.h"

#include <QAbstractItemView>
#include <QComboBox>
#include <QKeyEvent>
#include <QTimer>
#include <utility>

namespace {

bool IsLetter(const QKeyEvent& key) {
  const QString text = key.text();
  return !text.isEmpty() && text.front().isPrint() && !text.front().isSpace();
}

bool IsCommand(const QKeyEvent& key) {
  return (key.modifiers() & (Qt::ControlModifier | Qt::AltModifier | Qt::MetaModifier)) != 0;
}

/// The list's own child: it is gone with the list.
class CalmList : public QObject {
 public:
  CalmList(QComboBox& list, std::function<void()> leave)
      : QObject(&list), list_(list), leave_(std::move(leave)) {
    list.installEventFilter(this);
  }

 protected:
  bool eventFilter(QObject* watched, QEvent* event) override {
    if (event->type() == QEvent::FocusIn &&
        static_cast<QFocusEvent*>(event)->reason() == Qt::PopupFocusReason) {
      QTimer::singleShot(0, this, leave_);  // a choice is told only after this
    }
    if (event->type() == QEvent::Wheel && IsClosed()) {
      event->ignore();
      return true;
    }
    if (event->type() == QEvent::KeyPress && IsLetter(*static_cast<QKeyEvent*>(event)) && IsClosed()) {
      TakeLetter(*static_cast<QKeyEvent*>(event));
      return true;
    }
    return QObject::eventFilter(watched, event);
  }

 private:
  void TakeLetter(QKeyEvent& key) {
    if (IsCommand(key)) {
      key.ignore();  // whose Alt letter is unknown here; the list itself would choose by it
      return;
    }
    list_.showPopup();
    list_.view()->keyboardSearch(key.text());
  }

  /// Not to be asked while the list is being destroyed: the toolkit would make its view anew.
  bool IsClosed() const { return !list_.view()->isVisible(); }

  QComboBox& list_;
  const std::function<void()> leave_;
};

}  // namespace

void KeepCalm(QComboBox& list, std::function<void()> leave) {
  new CalmList(list, std::move(leave));
}
