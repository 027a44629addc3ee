#include "ui/Commands.h"

#include <QAction>
#include <QCoreApplication>
#include <QKeyEvent>
#include <QPushButton>
#include <QShortcutEvent>
#include <algorithm>

#include "platform/ErrorReport.h"
#include "ui/CommandEvent.h"

Commands::Commands(QWidget& window, MessageBoxes& boxes) : window_(window), boxes_(boxes) {
  window.installEventFilter(this);
}

bool Commands::Run(const std::function<void()>& command) {
  ++running_;
  const bool done = ReportErrors(boxes_, command);
  --running_;
  if (running_ == 0) {
    CommandsEndedEvent event;
    QCoreApplication::sendEvent(QCoreApplication::instance(), &event);
  }
  if (running_ == 0 && AllUnwound) {
    ReportErrors(boxes_, AllUnwound);
  }
  if (running_ == 0 && closeRequested_) {
    closeRequested_ = false;
    window_.close();
  }
  return done;
}

void Commands::Start(const QObject& control, const std::function<void()>& command, WhileBusy whileBusy) {
  if (whileBusy == WhileBusy::Run || !Running()) {
    CommandEvent event(control.objectName());
    QCoreApplication::sendEvent(QCoreApplication::instance(), &event);
    Run(command);
    if (!Running() && AfterCommand) {
      AfterCommand();
    }
  }
}

void Commands::Connect(QAction& action, std::function<void()> command, WhileBusy whileBusy) {
  connect(&action, &QAction::triggered, this,
          [this, &action, command = std::move(command), whileBusy] { Start(action, command, whileBusy); });
}

void Commands::Connect(QAbstractButton& button, std::function<void()> command, WhileBusy whileBusy) {
  buttons_.emplace_back(&button);
  button.installEventFilter(this);
  connect(&button, &QAbstractButton::clicked, this,
          [this, &button, command = std::move(command), whileBusy] { Press(button, command, whileBusy); });
}

void Commands::Press(QAbstractButton& button, const std::function<void()>& command, WhileBusy whileBusy) {
  if (button.hasFocus()) {
    // The mouse may have moved the focus here so recently that the entry's check is still pending.
    if (EntriesHold && !EntriesHold()) {
      return;
    }
  } else {
    // A key moves the focus before the click, so this is a screen reader. The command uses the entries as
    // they are, and an entry that the command itself would otherwise make the focus leave is left now.
    pressedUnfocused_ = true;
    button.setFocus();
    pressedUnfocused_ = false;
  }
  Start(button, command, whileBusy);
}

bool Commands::TakeFocus(QAbstractButton& button) {
  if (button.hasFocus()) {
    return true;
  }
  button.setFocus(Qt::ShortcutFocusReason);
  return !EntriesHold || EntriesHold();
}

// The toolkit does not focus a button that is pressed by Return or its Alt key.
bool Commands::eventFilter(QObject* watched, QEvent* event) {
  if (event->type() == QEvent::Shortcut && !static_cast<QShortcutEvent*>(event)->isAmbiguous()) {
    if (auto* button = qobject_cast<QAbstractButton*>(watched)) {
      return !TakeFocus(*button);
    }
  }
  if (watched == &window_ && event->type() == QEvent::KeyPress) {
    if (escapeButton_ && static_cast<QKeyEvent*>(event)->matches(QKeySequence::Cancel)) {
      PressByEscape();
      return true;
    }
    const int key = static_cast<QKeyEvent*>(event)->key();
    if (key == Qt::Key_Return || key == Qt::Key_Enter) {
      QAbstractButton* const button = DefaultButton();
      return button != nullptr && !TakeFocus(*button);
    }
  }
  return QObject::eventFilter(watched, event);
}

void Commands::EscapePresses(QAbstractButton& button) {
  escapeButton_ = &button;
}

void Commands::PressByEscape() {
  if (!Running() && TakeFocus(*escapeButton_)) {
    escapeButton_->click();
  }
}

QAbstractButton* Commands::DefaultButton() const {
  const auto isDefault = [](const QAbstractButton* button) {
    const auto* push = qobject_cast<const QPushButton*>(button);
    return push != nullptr && push->isDefault() && push->isVisible() && push->isEnabled();
  };
  const auto found = std::find_if(buttons_.begin(), buttons_.end(), isDefault);
  return found == buttons_.end() ? nullptr : *found;
}

bool Commands::MayClose() {
  if (!Running()) {
    return true;
  }
  closeRequested_ = true;
  if (EndWaits) {
    EndWaits();
  }
  return false;
}
