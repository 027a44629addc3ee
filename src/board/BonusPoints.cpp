#include "board/BonusPoints.h"

#include "core/text/NumberForms.h"
#include "ui_BonusPoints.h"

BonusPoints::BonusPoints(std::int32_t value, MessageBoxes& boxes, QWidget* parent, const std::string& player)
    : QDialog(parent), ui_(std::make_unique<Ui::BonusPoints>()), value_(value), commands_(*this, boxes) {
  ui_->setupUi(this);
  ui_->PlayerName->setText(QString::fromStdString(player));
  ui_->PlayerName->setVisible(!player.empty());
  ui_->BonusPointsEntry->setText(QString::fromStdString(Str(value)));
  ui_->BonusPointsEntry->selectAll();
  commands_.Connect(*this, {{ui_->OK, &BonusPoints::TakeValue}});
}

BonusPoints::~BonusPoints() = default;

void BonusPoints::TakeValue() {
  value_ = RoundToInt32(Val(ui_->BonusPointsEntry->text().toStdString()));
  accept();
}
