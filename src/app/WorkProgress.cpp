#include "app/WorkProgress.h"

#include <QApplication>

#include "ui/Text.h"
#include "ui/TimeLeftText.h"

namespace {

constexpr int WholeWork = 1000;
constexpr qint64 MillisecondsBetween = 40;

}  // namespace

WorkProgress::WorkProgress(const Parts& parts, OwnText text, std::chrono::milliseconds moment)
    : parts_(parts), text_(text), moment_(moment) {
  sinceBegun_.start();
  sinceShown_.start();
}

bool WorkProgress::GoOn(double done) {
  if (!window_) {
    if (sinceBegun_.elapsed() < moment_.count()) {
      return true;
    }
    Open();
  } else if (sinceShown_.elapsed() < MillisecondsBetween) {
    return !window_->wasCanceled();
  }
  sinceShown_.restart();
  const std::string left =
      TimeLeftText(std::chrono::milliseconds(sinceBegun_.elapsed()), done, parts_.Strings);
  window_->setLabelText(Text(parts_.Strings, text_) + u'\n' + QString::fromStdString(left));
  window_->setValue(static_cast<int>(done * WholeWork));
  parts_.Events.DoEvents();
  return !window_->wasCanceled();
}

void WorkProgress::Open() {
  QWidget* const front = QApplication::activeModalWidget();
  window_ = std::make_unique<QProgressDialog>(front != nullptr ? front : &parts_.Window);
  window_->setWindowTitle(QStringLiteral("Tessarine"));
  window_->setWindowModality(Qt::ApplicationModal);
  window_->setCancelButtonText(Text(parts_.Strings, OwnText::Stop));
  window_->setAutoReset(false);
  window_->setAutoClose(false);
  window_->setMinimumDuration(0);
  window_->setRange(0, WholeWork + 1);  // full is when it closes
  window_->setMinimumWidth(window_->fontMetrics().averageCharWidth() * 60);
  window_->show();
}
