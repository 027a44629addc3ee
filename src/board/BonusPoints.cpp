#include "board/BonusPoints.h"

#include "core/text/NumberForms.h"
#include "platform/ErrorReport.h"
#include "ui_BonusPoints.h"

BonusPoints::BonusPoints(std::int32_t value, MessageBoxes& boxes, QWidget* parent)
    : QDialog(parent), ui_(std::make_unique<Ui::BonusPoints>()), value_(value) {
  ui_->setupUi(this);
  ui_->BonusPointsEntry->setText(QString::fromStdString(Str(value)));
  ui_->BonusPointsEntry->selectAll();
  connect(ui_->OK, &QPushButton::clicked, this, [this, &boxes] {
    ReportErrors(boxes, [this] {
      value_ = RoundToInt32(Val(ui_->BonusPointsEntry->text().toStdString()));
      accept();
    });
  });
}

BonusPoints::~BonusPoints() = default;
