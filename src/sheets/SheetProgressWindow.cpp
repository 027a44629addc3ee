#include "sheets/SheetProgressWindow.h"

#include <QKeyEvent>

#include "core/text/Filled.h"
#include "ui/Text.h"
#include "ui_SheetProgressWindow.h"

SheetProgressWindow::SheetProgressWindow(const StringTable& strings, QWidget* parent)
    : QDialog(parent), ui_(std::make_unique<Ui::SheetProgressWindow>()), strings_(strings) {
  ui_->setupUi(this);
  setWindowTitle(Text(strings, 131));
  ui_->Stop->setText(Text(strings, OwnText::Stop));
}

SheetProgressWindow::~SheetProgressWindow() = default;

void SheetProgressWindow::Open() {
  stopped_ = false;
  cursor_.emplace();
  ui_->Stop->setEnabled(true);
  ui_->SheetLabel->setText(Text(strings_, OwnText::StartingWordProcessor));
  ui_->PlayerLabel->clear();
  ui_->Progress->setRange(0, 0);
  show();
}

void SheetProgressWindow::ShowSheet(int number, int count, const std::string& name) {
  if (!stopped_) {
    ui_->SheetLabel->setText(QString::fromStdString(
        Filled(strings_.Text(OwnText::SheetOfSheets), {std::to_string(number), std::to_string(count)})));
  }
  ui_->PlayerLabel->setText(QString::fromStdString(name));
  ui_->Progress->setRange(0, count);
  ui_->Progress->setValue(number - 1);
}

void SheetProgressWindow::Close() {
  hide();
  cursor_.reset();
}

void SheetProgressWindow::keyPressEvent(QKeyEvent* event) {
  if (!event->matches(QKeySequence::Cancel)) {
    QDialog::keyPressEvent(event);
  }
}

void SheetProgressWindow::reject() {
  stopped_ = true;
  ui_->Stop->setEnabled(false);
  ui_->SheetLabel->setText(Text(strings_, OwnText::StoppingAfterThisSheet));
}
