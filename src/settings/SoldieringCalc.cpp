#include "settings/SoldieringCalc.h"

#include "core/text/NumberForms.h"
#include "ui/Captions.h"
#include "ui_SoldieringCalc.h"

SoldieringCalc::SoldieringCalc(SoldieringFactors& factors, const StringTable& strings, QWidget* parent)
    : QDialog(parent), ui_(std::make_unique<Ui::SoldieringCalc>()), factors_(factors) {
  ui_->setupUi(this);
  SetCaptions(strings, {{this, 163},
                        {ui_->Frame1, 164},
                        {ui_->DamageLabel, 165},
                        {ui_->DeathLabel, 166},
                        {ui_->HealLabel, 167},
                        {ui_->AmmoLabel, 168},
                        {ui_->AccuracyLabel, 106},
                        {ui_->Explanation1, 169},
                        {ui_->Explanation2, 170},
                        {ui_->Explanation3, 171},
                        {ui_->SaveExit, 162},
                        {ui_->Cancel, 141}});
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

void SoldieringCalc::SaveAndExit() {
  const auto factorIn = [](const QLineEdit* box) { return Val(box->text().toStdString()); };
  factors_.Damage = factorIn(ui_->TotalDamage);
  factors_.Death = factorIn(ui_->Respawns);
  factors_.Heal = factorIn(ui_->Heals);
  factors_.Ammo = factorIn(ui_->AmmoAdds);
  factors_.Accuracy = factorIn(ui_->Accuracy);
  accept();
}
