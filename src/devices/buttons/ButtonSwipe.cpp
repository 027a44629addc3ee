#include "devices/buttons/ButtonSwipe.h"

#include <QShowEvent>

#include "ui/Text.h"
#include "ui_ButtonSwipe.h"

namespace {
constexpr int PollMilliseconds = 100;
}

ButtonSwipe::ButtonSwipe(OneWire& wire, MessageBoxes& boxes, const StringTable& strings, QWidget* parent)
    : QDialog(parent),
      ui_(std::make_unique<Ui::ButtonSwipe>()),
      reader_(wire, boxes),
      commands_(*this, boxes),
      timer1_(new PollTimer(commands_, PollMilliseconds, [this] { Tick(); })) {
  ui_->setupUi(this);
  ui_->Image1->setAccessibleName(Text(strings, OwnText::ButtonPicture));
  ui_->Cancel->setText(Text(strings, 141));
  timer1_->setObjectName(QStringLiteral("Timer1"));
}

ButtonSwipe::~ButtonSwipe() = default;

void ButtonSwipe::showEvent(QShowEvent* event) {
  QDialog::showEvent(event);
  if (!event->spontaneous()) {
    reader_.Activate();
    timer1_->start();
  }
}

void ButtonSwipe::reject() {
  reader_.Cancel();
}

void ButtonSwipe::Tick() {
  if (!reader_.Tick()) {
    timer1_->stop();
    hide();
  }
}
