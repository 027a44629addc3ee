#include "app/UploadProgress.h"

#include <QKeyEvent>

#include "ui/Text.h"
#include "ui_UploadProgress.h"

UploadProgress::UploadProgress(const StringTable& strings, QWidget* parent)
    : QDialog(parent), ui_(std::make_unique<Ui::UploadProgress>()) {
  ui_->setupUi(this);
  setWindowTitle(Text(strings, 172));
  ui_->Stop->setText(Text(strings, OwnText::Stop));
  // Otherwise the next press of the space bar, meant for the button just pressed in the main window, would
  // press Stop.
  setAttribute(Qt::WA_ShowWithoutActivating);
}

UploadProgress::~UploadProgress() = default;

void UploadProgress::Open() {
  closedByOperator_ = false;
  ui_->Progress->setMaximum(PlayerCount);
  ui_->Progress->setValue(0);
  ui_->UploadIndex->clear();
  StopTransferAnim();
  show();
}

void UploadProgress::Close() {
  StopTransferAnim();
  hide();
}

void UploadProgress::SetStatusText(const std::string& text) {
  ui_->StatusText->setText(QString::fromStdString(text));
}

void UploadProgress::SetMaximum(int maximum) {
  ui_->Progress->setMaximum(maximum);
}

void UploadProgress::SetProgress(int value) {
  ui_->Progress->setValue(value);
  ui_->UploadIndex->setText(QString::number(value));
  if (Received) {
    Received(value - 1, ui_->Progress->maximum());
  }
}

void UploadProgress::StartTransferAnim() {
  ui_->Animation1->Start();
}

void UploadProgress::StopTransferAnim() {
  ui_->Animation1->Stop();
}

void UploadProgress::keyPressEvent(QKeyEvent* event) {
  if (!event->matches(QKeySequence::Cancel)) {
    QDialog::keyPressEvent(event);
  }
}

void UploadProgress::reject() {
  closedByOperator_ = true;
  Close();
}
