#include "check/SystemCheck.h"

#include <QClipboard>
#include <QGuiApplication>
#include <QHeaderView>
#include <QTimer>
#include <utility>

#include "ui/Announce.h"
#include "ui/Captions.h"
#include "ui/Text.h"
#include "ui_SystemCheck.h"

SystemCheck::SystemCheck(Parts parts, QWidget* parent)
    : QDialog(parent),
      ui_(std::make_unique<Ui::SystemCheck>()),
      parts_(std::move(parts)),
      commands_(*this, parts_.Boxes) {
  ui_->setupUi(this);
  SetCaptions(parts_.Strings, {{this, static_cast<int>(OwnText::SystemCheckTitle)},
                               {ui_->CopyReport, static_cast<int>(OwnText::CheckCopyReport)},
                               {ui_->Close, 137}});
  ui_->CheckTable->setAccessibleName(windowTitle());
  ui_->CheckTable->horizontalHeader()->hide();
  ui_->CheckTable->verticalHeader()->hide();
  ui_->CheckTable->horizontalHeader()->setSectionResizeMode(QHeaderView::ResizeToContents);
  ui_->CheckTable->horizontalHeader()->setSectionResizeMode(2, QHeaderView::Stretch);
  ui_->CheckTable->verticalHeader()->setSectionResizeMode(QHeaderView::ResizeToContents);
  ui_->CopyReport->setEnabled(false);
  commands_.Connect(*ui_->CopyReport, [this] { CopyReport(); });
  connect(ui_->Close, &QPushButton::clicked, this, &QDialog::reject);
  commands_.EscapePresses(*ui_->Close);
  commands_.EndWaits = [this] { stop_ = true; };
  QTimer::singleShot(0, this, [this] { commands_.Run([this] { Run(); }); });
}

SystemCheck::~SystemCheck() = default;

void SystemCheck::Run() {
  ShowStatus(Text(parts_.Strings, OwnText::CheckRuns));
  sinceEvents_.start();
  for (int subject = 0; subject < CheckSubjectCount && !stop_; ++subject) {
    parts_.Events.DoEvents();
    for (const CheckItem& item :
         parts_.Checks.Look(static_cast<CheckSubject>(subject), [this] { return KeepOn(); })) {
      Add(item);
    }
  }
  ShowStatus({});
  ui_->CopyReport->setEnabled(!stop_);
}

bool SystemCheck::KeepOn() {
  constexpr qint64 eventMilliseconds = 40;
  if (sinceEvents_.elapsed() >= eventMilliseconds) {
    parts_.Events.DoEvents();
    sinceEvents_.restart();
  }
  return !stop_;
}

void SystemCheck::Add(const CheckItem& item) {
  items_.push_back(item);
  const int row = ui_->CheckTable->rowCount();
  ui_->CheckTable->insertRow(row);
  int column = 0;
  for (const std::string& text :
       {NameOf(item.Subject, parts_.Strings), StateOf(item, parts_.Strings), item.Text}) {
    auto* cell = new QTableWidgetItem(QString::fromStdString(text));
    QFont font = cell->font();
    font.setBold(!item.Fine && column == 1);
    cell->setFont(font);
    ui_->CheckTable->setItem(row, column++, cell);
  }
}

void SystemCheck::CopyReport() {
  QGuiApplication::clipboard()->setText(
      QString::fromStdString(CheckReport(parts_.Facts, items_, parts_.Strings)));
  ShowStatus(Text(parts_.Strings, OwnText::CheckCopied));
}

void SystemCheck::ShowStatus(const QString& text) {
  ui_->Status->setText(text);
  if (!text.isEmpty()) {
    Announce(*ui_->Status);
  }
}

void SystemCheck::reject() {
  if (commands_.MayClose()) {
    QDialog::reject();
  }
}
