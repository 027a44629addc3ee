#include "ui/OutcomeSignals.h"

#include "platform/RuntimeError.h"
#include "ui/Announce.h"
#include "ui/OutcomeTones.h"
#include "ui/Text.h"
#include "ui_OutcomeSignals.h"

namespace {

constexpr const char* On = "1";
constexpr const char* Off = "0";

}  // namespace

OutcomeSignals::OutcomeSignals(QWidget* parent)
    : QWidget(parent), ui_(std::make_unique<Ui::OutcomeSignals>()) {
  ui_->setupUi(this);
}

OutcomeSignals::~OutcomeSignals() = default;

void OutcomeSignals::SetUp(const Parts& parts) {
  parts_.emplace(parts);
  ui_->SignSwitch->setText(Text(parts.Strings, OwnText::LargeSign));
  ui_->SoundSwitch->setText(Text(parts.Strings, OwnText::OutcomeSound));
  ui_->SignSwitch->setChecked(parts.Ini.ReadIni(Keys::OutcomeSign) != Off);
  ui_->SoundSwitch->setChecked(parts.Ini.ReadIni(Keys::OutcomeSound) != Off);
  ui_->SoundSwitch->setEnabled(parts.Sounds != nullptr);
  ui_->Sign->setVisible(ui_->SignSwitch->isChecked());
  connect(ui_->SignSwitch, &QCheckBox::toggled, ui_->Sign, &QWidget::setVisible);
  connect(ui_->SignSwitch, &QCheckBox::clicked, this, &OutcomeSignals::KeepChoices);
  connect(ui_->SoundSwitch, &QCheckBox::clicked, this, &OutcomeSignals::KeepChoices);
}

void OutcomeSignals::KeepChoices() {
  const auto keep = [this](const Setting& setting, const QCheckBox& choice) {
    const char* const value = choice.isChecked() ? On : Off;
    if (parts_->Ini.ReadIni(setting) != value) {
      parts_->Ini.WriteIni(setting, value);
    }
  };
  keep(Keys::OutcomeSign, *ui_->SignSwitch);
  keep(Keys::OutcomeSound, *ui_->SoundSwitch);
}

void OutcomeSignals::Tell(bool success, const QString& text) {
  const QString mark = success ? QStringLiteral("\u2713 ") : QStringLiteral("\u2717 ");
  ui_->Sign->setText(mark + text);
  ui_->Sign->setStyleSheet(success ? QStringLiteral("background: #1e7d3c; color: white;")
                                   : QStringLiteral("background: #b3261e; color: white;"));
  if (ui_->Sign->isVisible()) {
    Announce(*ui_->Sign);
  }
  if (ui_->SoundSwitch->isChecked() && parts_->Sounds != nullptr) {
    Play(success);
  }
}

void OutcomeSignals::Play(bool success) {
  OwnText caption = OwnText::OutcomeSound;
  try {
    parts_->Sounds->Play(success ? OutcomeTones::Success() : OutcomeTones::Failure(),
                         OutcomeTones::SamplesPerSecond);
  } catch (const RuntimeError&) {
    caption = OwnText::OutcomeSoundMissing;
  }
  ui_->SoundSwitch->setText(Text(parts_->Strings, caption));
}

void OutcomeSignals::Clear() {
  ui_->Sign->clear();
  ui_->Sign->setStyleSheet({});
}
