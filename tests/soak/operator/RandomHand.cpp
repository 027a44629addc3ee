#include "tests/soak/operator/RandomHand.h"

#include <QAbstractButton>
#include <QAction>
#include <QApplication>
#include <QComboBox>
#include <QLineEdit>
#include <QMenu>
#include <QPlainTextEdit>
#include <QScreen>
#include <QTest>

namespace {

std::string Named(const QObject& object) {
  return object.metaObject()->className() + (" " + object.objectName().toStdString());
}

std::vector<QWidget*> VisibleIn(const QWidget& window) {
  std::vector<QWidget*> visible;
  for (QWidget* widget : window.findChildren<QWidget*>()) {
    if (widget->isVisible() && widget->isEnabled() && widget->window() == &window) {
      visible.push_back(widget);
    }
  }
  return visible;
}

void SendText(QWidget& widget, const QString& text) {
  const QPointer<QWidget> typed(&widget);
  for (const QChar letter : text) {
    for (const QEvent::Type type : {QEvent::KeyPress, QEvent::KeyRelease}) {
      if (typed) {
        QKeyEvent key(type, 0, Qt::NoModifier, letter);
        QApplication::sendEvent(typed, &key);
      }
    }
  }
}

}  // namespace

RandomHand::RandomHand(std::filesystem::path folder, unsigned seed,
                       std::function<void(const std::string&)> note)
    : folder_(std::move(folder)), random_(seed), note_(std::move(note)) {}

QWidget* RandomHand::WindowInFront() {
  if (QWidget* popup = QApplication::activePopupWidget()) {
    return popup;
  }
  if (QWidget* modal = QApplication::activeModalWidget()) {
    return modal;
  }
  std::vector<QWidget*> windows;
  for (QWidget* window : QApplication::topLevelWidgets()) {
    if (window->isVisible() && window->windowType() != Qt::ToolTip) {
      windows.push_back(window);
    }
  }
  return windows.empty() ? nullptr : AnyOf(windows);
}

void RandomHand::DoSomething() {
  QWidget* window = WindowInFront();
  if (window == nullptr) {
    return;
  }
  if (auto* box = qobject_cast<QMessageBox*>(window)) {
    Answer(*box);
  } else if (auto* dialog = qobject_cast<QFileDialog*>(window)) {
    Answer(*dialog);
  } else {
    UseWindow(*window);
  }
}

void RandomHand::Answer(QMessageBox& box) {
  const int choice = Below(10);
  if (choice == 0) {
    note_("Escape in the box " + box.text().toStdString());
    QTest::keyClick(&box, Qt::Key_Escape);
  } else if (choice == 1) {
    note_("close the box " + box.text().toStdString());
    box.close();
  } else {
    const QList<QAbstractButton*> buttons = box.buttons();
    QAbstractButton* button = buttons[Below(static_cast<int>(buttons.size()))];
    note_(button->text().toStdString() + " in the box " + box.text().toStdString());
    button->click();
  }
}

// Only by a name, never by keys and clicks: with those this dialog can delete and rename files anywhere.
void RandomHand::Answer(QFileDialog& dialog) {
  auto* name = dialog.findChild<QLineEdit*>(QStringLiteral("fileNameEdit"));
  if (name == nullptr || Below(4) == 0) {
    note_("Cancel in the file dialog");
    dialog.reject();
    return;
  }
  name->setText(AnyFileName());
  note_("file dialog: " + name->text().left(100).toStdString());
  QDialog& accepting = dialog;
  accepting.accept();
}

QString RandomHand::AnyFileName() {
  const QString folder = QString::fromStdString(folder_.string()) % QLatin1Char('/');
  static const std::vector<QString> names = {QStringLiteral("game.xml"),
                                             QStringLiteral("other game"),
                                             QStringLiteral("photo.png"),
                                             QStringLiteral("noise.bin"),
                                             QStringLiteral("empty"),
                                             QStringLiteral("no such folder/game.xml"),
                                             QStringLiteral("folder"),
                                             QStringLiteral("a<b>|c?.xml"),
                                             QStringLiteral("\u67aa.xml"),
                                             QString(300, QLatin1Char('n')),
                                             QString()};
  return folder % AnyOf(names);
}

void RandomHand::UseWindow(QWidget& window) {
  const int choice = Below(100);
  if (choice < 45) {
    Click(window);
  } else if (choice < 65) {
    PressKey(window);
  } else if (choice < 78) {
    TypeText(window);
  } else if (choice < 90) {
    TriggerMenu(window);
  } else if (choice < 94) {
    Resize(window);
  } else {
    Close(window);
  }
}

void RandomHand::Click(QWidget& window) {
  const std::vector<QWidget*> visible = VisibleIn(window);
  std::vector<QWidget*> buttons;
  std::copy_if(visible.begin(), visible.end(), std::back_inserter(buttons),
               [](QWidget* widget) { return qobject_cast<QAbstractButton*>(widget) != nullptr; });
  // Most of what is visible are labels; half of all clicks go to buttons.
  const std::vector<QWidget*>& candidates = buttons.empty() || Below(2) == 0 ? visible : buttons;
  const QPointer<QWidget> target(candidates.empty() ? &window : AnyOf(candidates));
  const QPoint place(Below(std::max(1, target->width())), Below(std::max(1, target->height())));
  const Qt::MouseButton button = Below(12) == 0 ? Qt::RightButton : Qt::LeftButton;
  note_("click " + Named(*target) + " in " + Named(window));
  QTest::mousePress(target, button, {}, place);
  if (target) {
    QTest::mouseRelease(target, button, {}, place);
  }
  if (target && Below(8) == 0) {
    QTest::mouseDClick(target, button, {}, place);
  }
}

void RandomHand::PressKey(QWidget& window) {
  static const std::vector<Qt::Key> keys = {
      Qt::Key_Tab,    Qt::Key_Backtab, Qt::Key_Return, Qt::Key_Enter,    Qt::Key_Escape,   Qt::Key_Space,
      Qt::Key_Up,     Qt::Key_Down,    Qt::Key_Left,   Qt::Key_Right,    Qt::Key_Home,     Qt::Key_End,
      Qt::Key_F1,     Qt::Key_F2,      Qt::Key_F4,     Qt::Key_F5,       Qt::Key_F10,      Qt::Key_F11,
      Qt::Key_Delete, Qt::Key_Menu,    Qt::Key_PageUp, Qt::Key_PageDown, Qt::Key_Backspace};
  Qt::Key key = AnyOf(keys);
  Qt::KeyboardModifiers modifiers;
  if (Below(2) == 0) {
    key = static_cast<Qt::Key>(Qt::Key_A + Below(26));
    modifiers = Below(2) == 0 ? Qt::AltModifier : Qt::ControlModifier;
  }
  QWidget* focus = QApplication::focusWidget();
  QWidget* target = focus != nullptr && focus->window() == &window ? focus : &window;
  note_("key " + QKeySequence(key | modifiers).toString().toStdString() + " to " + Named(*target));
  QTest::keyClick(target, key, modifiers);
}

void RandomHand::TypeText(QWidget& window) {
  static const std::vector<QString> texts = {QStringLiteral("0"),       QStringLiteral("12"),
                                             QStringLiteral("-5"),      QStringLiteral("+-5"),
                                             QStringLiteral("1e400"),   QStringLiteral("0.5"),
                                             QStringLiteral("32768"),   QStringLiteral("99999999999"),
                                             QStringLiteral("O'Brien"), QStringLiteral("\"*[#?"),
                                             QStringLiteral("<b>"),     QStringLiteral("\u7ea2\u961f"),
                                             QStringLiteral("Ann"),     QStringLiteral("None"),
                                             QStringLiteral(" "),       QString(300, QLatin1Char('x')),
                                             QStringLiteral("%n %1 &")};
  std::vector<QWidget*> entries;
  for (QWidget* widget : VisibleIn(window)) {
    if (qobject_cast<QLineEdit*>(widget) != nullptr || qobject_cast<QPlainTextEdit*>(widget) != nullptr) {
      entries.push_back(widget);
    }
  }
  if (entries.empty()) {
    PressKey(window);
    return;
  }
  const QPointer<QWidget> entry(AnyOf(entries));
  const QString text = AnyOf(texts);
  note_("type " + text.left(20).toStdString() + " into " + Named(*entry));
  entry->setFocus();
  if (entry && Below(2) == 0) {
    QTest::keyClick(entry, Qt::Key_A, Qt::ControlModifier);
  }
  if (entry) {
    SendText(*entry, text);
  }
}

void RandomHand::TriggerMenu(QWidget& window) {
  std::vector<QAction*> actions;
  for (QAction* action : window.findChildren<QAction*>()) {
    if (action->isEnabled() && action->isVisible() && action->menu() == nullptr &&
        !action->objectName().isEmpty()) {
      actions.push_back(action);
    }
  }
  if (actions.empty()) {
    Click(window);
    return;
  }
  QAction* action = AnyOf(actions);
  note_("menu " + Named(*action));
  action->trigger();
}

void RandomHand::Resize(QWidget& window) {
  note_("resize " + Named(window));
  window.resize(1 + Below(1400), 1 + Below(1000));
}

// The main window only seldom: a start takes as long as many commands.
void RandomHand::Close(QWidget& window) {
  if (window.parentWidget() == nullptr && Below(10) != 0) {
    Click(window);
    return;
  }
  note_("close " + Named(window));
  window.close();
}

bool RandomHand::Leave() {
  QWidget* window = WindowInFront();
  if (window == nullptr) {
    return false;
  }
  note_("leave " + Named(*window));
  if (auto* box = qobject_cast<QMessageBox*>(window)) {
    box->buttons().first()->click();
  } else {
    window->close();
  }
  return true;
}
