#include "devices/charging/ChargeiButton.h"

#include <QScopeGuard>

#include "ui/Text.h"
#include "ui_ChargeiButton.h"

namespace {

constexpr int ResultColumn = 4;

constexpr int PollMilliseconds = 200;
constexpr int MissingReaderMilliseconds = 2000;

OwnText TextOf(ChargeResult result) {
  switch (result) {
    case ChargeResult::Charged:
      return OwnText::ButtonCharged;
    case ChargeResult::Different:
      return OwnText::ButtonDiffers;
    case ChargeResult::NotReadBack:
      return OwnText::ButtonNotReadBack;
    case ChargeResult::NotRead:
      return OwnText::ButtonNotRead;
    case ChargeResult::Unknown:
      break;
  }
  return OwnText::ButtonUnknown;
}

}  // namespace

ChargeiButton::ChargeiButton(const Parts& parts, QWidget* parent)
    : QDialog(parent),
      ui_(std::make_unique<Ui::ChargeiButton>()),
      parts_(parts),
      charger_({.Wire = parts.Wire,
                .Events = parts.Events,
                .Boxes = parts.Boxes,
                .Time = parts.Time,
                .Display = *this}),
      commands_(*this, parts.Boxes),
      timer1_(new PollTimer(commands_, PollMilliseconds, [this] { Tick(); })) {
  ui_->setupUi(this);
  ui_->Picture1->setAccessibleName(Text(parts.Strings, OwnText::ChargePicture));
  ui_->ReaderLabel->setText(Text(parts.Strings, OwnText::NoReader));
  QSizePolicy place = ui_->ReaderLabel->sizePolicy();
  place.setRetainSizeWhenHidden(true);
  ui_->ReaderLabel->setSizePolicy(place);
  ui_->ReaderLabel->hide();
  ui_->Signals->SetUp(parts.Signals);
  SetUpResults();
  parts_.Charged.BeginTouch();
  // Escape works at any time, unlike in windows that it would take out of a job: a poll is soon over.
  connect(ui_->Close, &QPushButton::clicked, this, &QDialog::reject);
  timer1_->setObjectName(QStringLiteral("Timer1"));
  timer1_->start();
}

ChargeiButton::~ChargeiButton() = default;

void ChargeiButton::SetUpResults() {
  const StringTable& strings = parts_.Strings;
  ui_->ResultsLabel->setText(Text(strings, OwnText::ButtonsOfThisRun));
  ui_->Results->SetCaptions({Text(strings, OwnText::ResultNumber), Text(strings, OwnText::ResultTime),
                             Text(strings, OwnText::ResultKind), Text(strings, OwnText::ResultButton),
                             Text(strings, OwnText::Result)},
                            ResultColumn);
  std::size_t number = parts_.Charged.Count() - parts_.Charged.All().size();
  for (const ChargedButton& button : parts_.Charged.All()) {
    AddRow(++number, button);
  }
}

QString ChargeiButton::KindOf(const ChargedButton& button) const {
  if (!button.Kind) {
    return {};
  }
  switch (*button.Kind) {
    case ButtonKind::AmmoMag:
      return Text(parts_.Strings, OwnText::AmmoMag);
    case ButtonKind::Bandage:
      return Text(parts_.Strings, OwnText::Bandage);
    default:
      return QString::number(*button.Kind);
  }
}

void ChargeiButton::AddRow(std::size_t number, const ChargedButton& button) {
  ui_->Results->AddRow({QString::number(number), QString::fromStdString(button.Time), KindOf(button),
                        QString::fromStdString(button.DallasID), Text(parts_.Strings, TextOf(button.Result))},
                       button.Result == ChargeResult::Charged, ChargedButtons::Most);
}

void ChargeiButton::Tick() {
  const auto paceTimer = qScopeGuard([this] {
    const int pace = charger_.ReaderMissing() ? MissingReaderMilliseconds : PollMilliseconds;
    if (timer1_->interval() != pace) {
      timer1_->setInterval(pace);
    }
  });
  charger_.Tick();
}

void ChargeiButton::SetStatus(const std::string& text) {
  ui_->StatusLabel->setText(QString::fromStdString(text));
}

void ChargeiButton::BeginButton() {
  ui_->Signals->Clear();
}

void ChargeiButton::SetReader(bool present) {
  ui_->ReaderLabel->setVisible(!present);
}

void ChargeiButton::Note(const ChargedButton& button) {
  if (!parts_.Charged.Add(button)) {
    return;
  }
  AddRow(parts_.Charged.Count(), button);
  if (!Closing()) {
    ui_->Signals->Tell(button.Result == ChargeResult::Charged, Text(parts_.Strings, TextOf(button.Result)));
  }
}

void ChargeiButton::reject() {
  if (commands_.MayClose()) {
    QDialog::reject();
  }
}
