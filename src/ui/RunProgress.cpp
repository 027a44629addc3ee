#include "ui/RunProgress.h"

#include <QAbstractButton>
#include <QProgressBar>

namespace {

constexpr int WholeRun = 1000;

}  // namespace

RunProgress::RunProgress(QProgressBar& bar, QAbstractButton& stop, EventPump& events, bool& stopped)
    : bar_(bar), stop_(stop), events_(events), stopped_(stopped) {
  stopped_ = false;
  bar_.setRange(0, WholeRun);
  bar_.setValue(0);
  bar_.setVisible(true);
  stop_.setEnabled(true);
  sinceEvents_.start();
}

RunProgress::~RunProgress() {
  bar_.setVisible(false);
  stop_.setEnabled(false);
}

bool RunProgress::GoOn(double done) {
  constexpr qint64 milliseconds = 30;
  if (sinceEvents_.elapsed() >= milliseconds) {
    bar_.setValue(static_cast<int>(done * WholeRun));
    events_.DoEvents();
    sinceEvents_.restart();
  }
  return !stopped_;
}
