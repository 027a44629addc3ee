#pragma once

#include <QApplication>
#include <QDir>
#include <QFileDialog>
#include <QMenu>
#include <QStringList>
#include <QTableView>
#include <QTest>
#include <QTimer>
#include <functional>

/// Hands and eyes of the demo's operator: works in windows that wait for an answer, closes boxes, takes
/// pictures, and remembers what went wrong. Any box that is not a plain message counts as something wrong.
class Operator : public QObject {
  Q_OBJECT

 public:
  /// Pictures go to `folder`.
  explicit Operator(const QDir& folder);

  /// Calls `open`, which shows a modal window of this type and returns when it is closed, and works in it.
  template <typename Window>
  void Within(const std::function<void()>& open, const std::function<void(Window&)>& work) {
    bool worked = false;
    OnceEventsRun(open, [&] {
      auto* window = qobject_cast<Window*>(QApplication::activeModalWidget());
      if (window != nullptr && QTest::qWaitForWindowExposed(window)) {
        worked = true;
        work(*window);
      }
    });
    if (!worked) {
      AddFault(QStringLiteral("No %1 came up.").arg(QLatin1String(Window::staticMetaObject.className())));
    }
  }

  /// Opens the context menu on a row of the list, as with the right mouse button, and calls `choose`.
  void WithPopup(QTableView& list, int row, const std::function<void(QMenu&)>& choose);
  /// Chooses an item of an open menu by key.
  static void Choose(QMenu& menu, QAction& item);

  /// Calls `open`, which shows a file dialog, and enters this path there.
  void EnterFile(const std::function<void()>& open, const QString& path);

  /// Text of the last plain message since the last call, empty if there was none.
  QString TakeMessage();

  void SavePicture(QWidget& window, const QString& name);

  /// The next question is answered with OK, and is nothing wrong.
  void ExpectQuestion() { expectsQuestion_ = true; }

  void AddFault(const QString& fault) { faults_.append(fault); }
  const QStringList& Faults() const { return faults_; }

 private:
  /// Calls `open`, and `act` as soon as events run in there.
  void OnceEventsRun(const std::function<void()>& open, const std::function<void()>& act);
  void CloseBox();

  QDir folder_;
  QTimer watch_;
  QString message_;
  bool expectsQuestion_ = false;
  QStringList faults_;
};

/// Presses a button with the mouse.
template <typename Button>
void Press(QWidget& window, const char* name) {
  QTest::mouseClick(window.findChild<Button*>(QString::fromLatin1(name)), Qt::LeftButton);
}
