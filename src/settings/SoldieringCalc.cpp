#include "settings/SoldieringCalc.h"

#include "core/text/NumberForms.h"
#include "ui/Text.h"
#include "ui_SoldieringCalc.h"

SoldieringCalc::SoldieringCalc(SoldieringFactors& factors, const StringTable& strings, QWidget* parent)
    : QDialog(parent), ui_(std::make_unique<Ui::SoldieringCalc>()), factors_(factors) {
  ui_->setupUi(this);
  SetCaptions(strings);
  const auto show = [](QLineEdit* box, double factor) {
    box->setText(QString::fromStdString(Str(factor)).trimmed());
  };
  show(ui_->TotalDamage, factors_.Damage);
  show(ui_->Respawns, factors_.Death);
  show(ui_->Heals, factors_.Heal);
  show(ui_->AmmoAdds, factors_.Ammo);
  show(ui_->Accuracy, factors_.Accuracy);
  connect(ui_->SaveExit, &QPushButton::clicked, this, &SoldieringCalc::SaveAndExit);
}

SoldieringCalc::~SoldieringCalc() = default;

void SoldieringCalc::SetCaptions(const StringTable& strings) {
  setWindowTitle(Text(strings, 163));
  ui_->Frame1->setTitle(Text(strings, 164));
  ui_->DamageLabel->setText(Text(strings, 165));
  ui_->DeathLabel->setText(Text(strings, 166));
  ui_->HealLabel->setText(Text(strings, 167));
  ui_->AmmoLabel->setText(Text(strings, 168));
  ui_->AccuracyLabel->setText(Text(strings, 106));
  ui_->Explanation1->setText(Text(strings, 169));
  ui_->Explanation2->setText(Text(strings, 170));
  ui_->Explanation3->setText(Text(strings, 171));
  ui_->SaveExit->setText(Text(strings, 162));
  ui_->Cancel->setText(Text(strings, 141));
}

void SoldieringCalc::SaveAndExit() {
  const auto factorIn = [](const QLineEdit* box) { return Val(box->text().toStdString()); };
  factors_.Damage = factorIn(ui_->TotalDamage);
  factors_.Death = factorIn(ui_->Respawns);
  factors_.Heal = factorIn(ui_->Heals);
  factors_.Ammo = factorIn(ui_->AmmoAdds);
  factors_.Accuracy = factorIn(ui_->Accuracy);
  accept();
}
