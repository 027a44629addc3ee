#include "sheets/SheetProgressWindow.h"

#include "ui/Text.h"
#include "ui_SheetProgressWindow.h"

SheetProgressWindow::SheetProgressWindow(const StringTable& strings, QWidget* parent)
    : QDialog(parent), ui_(std::make_unique<Ui::SheetProgressWindow>()), strings_(strings) {
  ui_->setupUi(this);
  setWindowTitle(Text(strings, 131));
  ui_->Stop->setText(Words("Stop", "停止"));
}

SheetProgressWindow::~SheetProgressWindow() = default;

QString SheetProgressWindow::Words(const char* english, const char* chinese) const {
  return QString::fromUtf8(strings_.TextLanguage() == Language::SimplifiedChinese ? chinese : english);
}

void SheetProgressWindow::Open() {
  stopped_ = false;
  cursor_.emplace();
  ui_->Stop->setEnabled(true);
  ui_->SheetLabel->setText(Words("Starting the word processor...", "正在启动文字处理程序……"));
  ui_->PlayerLabel->clear();
  ui_->Progress->setRange(0, 0);
  show();
}

void SheetProgressWindow::ShowSheet(int number, int count, const std::string& name) {
  if (!stopped_) {
    ui_->SheetLabel->setText(Words("Sheet %1 of %2", "第 %1 张，共 %2 张").arg(number).arg(count));
  }
  ui_->PlayerLabel->setText(QString::fromStdString(name));
  ui_->Progress->setRange(0, count);
  ui_->Progress->setValue(number - 1);
}

void SheetProgressWindow::Close() {
  hide();
  cursor_.reset();
}

void SheetProgressWindow::reject() {
  stopped_ = true;
  ui_->Stop->setEnabled(false);
  ui_->SheetLabel->setText(Words("Stopping after this sheet...", "完成本张后停止……"));
}
