#include "ui/EntryChecks.h"

#include <QAbstractButton>
#include <QApplication>
#include <QFocusEvent>
#include <QLineEdit>
#include <QTimer>
#include <algorithm>
#include <utility>

#include "ui/Commands.h"

EntryChecks::EntryChecks(Commands& commands, MessageBoxes& boxes) : commands_(commands), boxes_(boxes) {
  commands.EntriesHold = [this] { return CheckLeft(); };
}

void EntryChecks::Add(QWidget& entry, Check check) {
  checks_[&entry] = std::move(check);
  entry.installEventFilter(this);
}

void EntryChecks::LeaveFreelyFor(const QAbstractButton& button) {
  freeButtons_.push_back(&button);
}

bool EntryChecks::eventFilter(QObject* watched, QEvent* event) {
  if (event->type() == QEvent::FocusOut && IsLeft(*event)) {
    left_.push_back(qobject_cast<QWidget*>(watched));
    // A box opened in the middle of a focus change would upset both.
    QTimer::singleShot(0, this, [this] { CheckLeft(); });
  }
  return QObject::eventFilter(watched, event);
}

bool EntryChecks::IsLeft(const QEvent& focusOut) const {
  const auto reason = static_cast<const QFocusEvent&>(focusOut).reason();
  const bool staysInWindow = reason != Qt::ActiveWindowFocusReason && reason != Qt::PopupFocusReason;
  const bool leavesForFreeButton =
      std::find(freeButtons_.begin(), freeButtons_.end(), QApplication::focusWidget()) != freeButtons_.end();
  return !returning_ && !commands_.PressedUnfocused() && staysInWindow && !leavesForFreeButton &&
         commands_.Window().isVisible();
}

bool EntryChecks::CheckLeft() {
  if (checking_) {
    return false;
  }
  checking_ = true;
  bool hold = true;
  for (std::size_t i = 0; hold && i < left_.size() && commands_.Window().isVisible(); ++i) {
    bool holds = false;
    commands_.Run([&] { holds = Holds(*left_[i]); });
    hold = holds;
  }
  left_.clear();
  checking_ = false;
  return hold;
}

bool EntryChecks::Holds(QWidget& entry) {
  const std::optional<EntryFault> fault = checks_.at(&entry)();
  if (!fault) {
    return true;
  }
  boxes_.Show(fault->Text, fault->Title, fault->Icon);
  // If the focus was in another entry meanwhile, that one is not checked now.
  returning_ = true;
  entry.setFocus();
  returning_ = false;
  if (auto* line = qobject_cast<QLineEdit*>(&entry)) {
    line->selectAll();
  }
  return false;
}
