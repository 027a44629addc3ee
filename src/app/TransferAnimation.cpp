#include "app/TransferAnimation.h"

#include <QPainter>

#include "ui/TeamColours.h"

namespace {

constexpr int PhaseCount = 12;
constexpr int StepMilliseconds = 80;  // a few frames a second look alive and cost next to nothing
constexpr int PacketDistance = 48;
constexpr int PacketSize = 10;

}  // namespace

TransferAnimation::TransferAnimation(QWidget* parent) : QWidget(parent) {
  step_.setInterval(StepMilliseconds);
  connect(&step_, &QTimer::timeout, this, [this] {
    phase_ = (phase_ + 1) % PhaseCount;
    update();
  });
}

void TransferAnimation::Start() {
  if (!step_.isActive()) {
    step_.start();
  }
}

void TransferAnimation::Stop() {
  step_.stop();
  phase_ = 0;
  update();
}

void TransferAnimation::paintEvent(QPaintEvent* /*event*/) {
  QPainter painter(this);
  painter.setRenderHint(QPainter::Antialiasing);
  const int middle = height() / 2;
  const int left = 36;
  const int right = width() - 36;
  painter.setPen(QPen(palette().mid().color(), 2));
  painter.drawLine(left, middle, right, middle);
  painter.setPen(Qt::NoPen);
  painter.setBrush(palette().dark());
  painter.drawRoundedRect(8, middle - 12, 24, 12, 3, 3);  // a gun
  painter.drawRoundedRect(8, middle - 4, 9, 18, 3, 3);
  painter.drawRoundedRect(width() - 32, middle - 14, 26, 19, 3, 3);  // the desk
  painter.drawRoundedRect(width() - 26, middle + 8, 14, 4, 2, 2);
  if (!step_.isActive()) {
    return;
  }
  int team = 0;
  for (int x = left + phase_ * PacketDistance / PhaseCount; x < right - PacketSize; x += PacketDistance) {
    painter.setBrush(TeamColour(team % 3 + 1));
    painter.drawEllipse(x, middle - PacketSize / 2, PacketSize, PacketSize);
    ++team;
  }
}
