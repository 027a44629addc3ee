#include "app/IdleCopying.h"

#include <QCoreApplication>
#include <QEvent>
#include <utility>

namespace {

constexpr std::chrono::seconds AfterStart(60);
constexpr std::chrono::seconds QuietTime(5);
constexpr std::chrono::milliseconds BetweenSteps(20);  // in which the window does what there is to do
constexpr std::chrono::minutes BetweenCopies(10);

bool IsInput(const QEvent& event) {
  switch (event.type()) {
    case QEvent::KeyPress:
    case QEvent::MouseButtonPress:
    case QEvent::MouseMove:
    case QEvent::Wheel:
    case QEvent::TouchBegin:
      return true;
    default:
      return false;
  }
}

}  // namespace

IdleCopying::IdleCopying(Parts parts) : parts_(std::move(parts)), lastInput_(parts_.Elapsed.Elapsed()) {
  QCoreApplication::instance()->installEventFilter(this);
  timer_.setSingleShot(true);
  connect(&timer_, &QTimer::timeout, this, [this] { timer_.start(Look()); });
  timer_.start(AfterStart);
}

std::chrono::milliseconds IdleCopying::Look() {
  if (parts_.Elapsed.Elapsed() - lastInput_ < QuietTime || parts_.Busy()) {
    return BetweenLooks;
  }
  return parts_.DoAPart() ? BetweenSteps : std::chrono::milliseconds(BetweenCopies);
}

void IdleCopying::End() {
  QCoreApplication::instance()->removeEventFilter(this);
  timer_.stop();
}

bool IdleCopying::eventFilter(QObject* watched, QEvent* event) {
  if (IsInput(*event)) {
    lastInput_ = parts_.Elapsed.Elapsed();
  }
  return QObject::eventFilter(watched, event);
}
