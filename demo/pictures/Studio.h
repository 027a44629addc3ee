#pragma once

#include <QAction>
#include <QDir>
#include <QMainWindow>
#include <QObject>
#include <QStringList>
#include <QTest>
#include <QTimer>
#include <functional>
#include <optional>

/// Drives the real windows, and keeps pictures of them as PNG files. What does not come about is a fault.
class Studio : public QObject {
 public:
  using Act = std::function<void(QWidget& window)>;
  using Ready = std::function<bool(QWidget& window)>;

  Studio(QMainWindow& window, const QDir& folder);

  QMainWindow& Window() { return window_; }
  const QDir& Folder() const { return folder_; }

  /// Triggers a menu item, acts in the modal window that it opens, and closes that.
  void Open(const char* item, const Act& act);

  /// The same with a button, or anything else that opens a modal window.
  void Open(const std::function<void()>& open, const Act& act);

  /// Takes a picture of a window as it is.
  void Take(QWidget& window, const char* picture);

  /// Takes one of a window that comes and goes by itself, as soon as it is ready, then acts in it. Once only.
  void TakeWhen(const char* window, const char* picture, Ready ready, Act then = {});

  /// What the next file dialog is answered with.
  void AnswerWith(const QString& file) { file_ = file; }

  /// Runs events until the condition holds, for at most a minute.
  void WaitUntil(const char* what, const std::function<bool()>& holds);

  void AddFault(const QString& fault) { faults_.append(fault); }
  const QStringList& Faults() const { return faults_; }

 private:
  struct Awaited {
    const char* Window;
    const char* Picture;
    Ready IsReady;
    Act Then;
  };

  /// Looks for what is awaited, and answers file dialogs and boxes.
  void Watch();

  QMainWindow& window_;
  QDir folder_;
  QString file_;
  QTimer watch_;
  std::optional<Awaited> awaited_;
  QStringList faults_;
};

/// The control of this name, which must be there.
template <typename Control>
Control& In(const QObject& window, const char* name) {
  auto* control = window.findChild<Control*>(QString::fromLatin1(name));
  if (control == nullptr) {
    qFatal("There is no %s", name);
  }
  return *control;
}

/// Presses a button with the mouse.
template <typename Button>
void Press(QWidget& window, const char* name) {
  QTest::mouseClick(&In<Button>(window, name), Qt::LeftButton);
}
