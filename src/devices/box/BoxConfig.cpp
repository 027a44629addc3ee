#include "devices/box/BoxConfig.h"

#include "core/text/NumberForms.h"
#include "ui/FocusTips.h"
#include "ui/Text.h"
#include "ui_BoxConfig.h"

namespace {

constexpr int ResultColumn = 4;

constexpr double MostPoints = 100;
constexpr double MostTime = 255;

struct ResultText {
  OwnText Text;
  bool Success;
};

ResultText TextOf(BoxResult result) {
  switch (result) {
    case BoxResult::Accepted:
      return {OwnText::BoxAccepted, true};
    case BoxResult::Rejected:
      return {OwnText::BoxRejected, false};
    case BoxResult::NoResponse:
      return {OwnText::BoxSilent, false};
    case BoxResult::Unconfirmed:
      return {OwnText::BoxUnconfirmed, false};
    case BoxResult::NotSent:
      break;
  }
  return {OwnText::BoxNotSent, false};
}

std::optional<EntryFault> FaultOf(const QLineEdit& entry, double most) {
  const double value = ToDouble(entry.text().toStdString());
  if (value >= 0 && value <= most) {
    return std::nullopt;
  }
  return EntryFault{"Invalid value, must be between 0 and " + PlainDecimal(most), "Entry Error",
                    BoxIcon::None};
}

}  // namespace

BoxConfig::BoxConfig(const Parts& parts, QWidget* parent)
    : QDialog(parent),
      ui_(std::make_unique<Ui::BoxConfig>()),
      parts_(parts),
      commands_(*this, parts.Boxes),
      checks_(commands_, parts.Boxes),
      programmer_(
          {.MSComm1 = parts.MSComm1,
           .Port = parts.Port,
           .Events = parts.Events,
           .Boxes = parts.Boxes,
           .Stopped = [this] { return commands_.CloseRequested() || !isVisible(); },
           .OnResult = [this](const BoxEntries& entries, BoxResult result) { Note(entries, result); }}) {
  ui_->setupUi(this);
  FillLists();
  SetUpTips();
  SetUpChecks();
  ui_->Signals->SetUp(parts_.Signals);
  SetUpResults();
  commands_.Connect(*this, {{ui_->ProgramButton, &BoxConfig::Program}});
  connect(ui_->Close, &QPushButton::clicked, this, &QDialog::reject);
  commands_.EscapePresses(*ui_->Close);
}

BoxConfig::~BoxConfig() = default;

void BoxConfig::FillLists() {
  for (const std::string_view type : BoxTypes) {
    ui_->BoxType->addItem(QString::fromUtf8(type.data(), static_cast<qsizetype>(type.size())));
  }
  ui_->TeamList->addItem(QStringLiteral("All"));
  for (int team = 1; team <= TeamCount; ++team) {
    ui_->TeamList->addItem(QString::fromStdString(parts_.Game.TeamNames(team)));
  }
}

void BoxConfig::SetUpTips() {
  ui_->PointsPerAct->setToolTip(
      QStringLiteral("Sets the number of Points removed when the device is activated. Set to 0 for a device "
                     "that never runs out."));
  ui_->ActivationAmount->setToolTip(QStringLiteral(
      "Sets the amount of health or ammo clips given to the player when the box is activated."));
  ui_->AutoModeTime->setToolTip(
      QStringLiteral("Sets the time for which the device will automatically activate itself. Set to 0 for a "
                     "manually controlled box. Units are 10 seconds ie value of 2 here sets 20 seconds."));
  ui_->RechargePoints->setToolTip(
      QStringLiteral("Sets the number of points that are added to the boxes points every 10 seconds. Set to "
                     "0 for a box that doesn't recharge itself."));
  ui_->BoxType->setToolTip(QStringLiteral(
      "Sets the type of box; Medic (for healing players), Ammo (for giving ammo clips), "
      "Respawn (for restoring player health and ammo back to full, Repair (for repairing base "
      "devices.), Multi (for all at once), or Multi-Player (for all at once except Respawn)))"));
  ui_->Label6->setToolTip(QStringLiteral("Controls what Team(s) can use this Box."));
  auto* tips = new FocusTips(*this);
  for (QWidget* control :
       {static_cast<QWidget*>(ui_->BoxType), static_cast<QWidget*>(ui_->PointsPerAct),
        static_cast<QWidget*>(ui_->RechargePoints), static_cast<QWidget*>(ui_->ActivationAmount),
        static_cast<QWidget*>(ui_->AutoModeTime)}) {
    tips->Add(*control);
  }
}

void BoxConfig::SetUpChecks() {
  for (QLineEdit* entry : {ui_->PointsPerAct, ui_->RechargePoints, ui_->ActivationAmount}) {
    checks_.Add(*entry, [entry] { return FaultOf(*entry, MostPoints); });
  }
  checks_.Add(*ui_->AutoModeTime, [this] { return FaultOf(*ui_->AutoModeTime, MostTime); });
  checks_.Add(*ui_->BoxType, [this] { return FaultOfBoxType(); });
  checks_.LeaveFreelyFor(*ui_->Close);
}

std::optional<EntryFault> BoxConfig::FaultOfBoxType() {
  const int type = ui_->BoxType->currentIndex();
  if (type < 0 || type >= static_cast<int>(BoxTypes.size())) {
    ui_->BoxType->setCurrentIndex(0);
  }
  return std::nullopt;
}

void BoxConfig::SetUpResults() {
  const StringTable& strings = parts_.Strings;
  ui_->ResultsLabel->setText(Text(strings, OwnText::BoxesOfThisRun));
  ui_->Results->SetCaptions(
      {Text(strings, OwnText::ResultNumber), Text(strings, OwnText::ResultTime),
       Text(strings, OwnText::ResultKind), Text(strings, 113), Text(strings, OwnText::Result), QString()},
      ResultColumn);
  std::size_t number = parts_.Programmed.Count() - parts_.Programmed.All().size();
  for (const ProgrammedBox& box : parts_.Programmed.All()) {
    AddRow(++number, box);
  }
}

void BoxConfig::AddRow(std::size_t number, const ProgrammedBox& box) {
  const auto [text, success] = TextOf(box.Result);
  ui_->Results->AddRow(
      {QString::number(number), QString::fromStdString(box.Time), ui_->BoxType->itemText(box.Entries.BoxType),
       ui_->TeamList->itemText(box.Entries.TeamList), Text(parts_.Strings, text)},
      success, ProgrammedBoxes::Most);
  auto* again = new QPushButton(Text(parts_.Strings, OwnText::SendAgain));
  again->setObjectName(QStringLiteral("SendAgain%1").arg(number));
  commands_.Connect(
      *again, [this, entries = box.Entries] { ProgramAgain(entries); }, WhileBusy::Ignore);
  ui_->Results->setCellWidget(0, ui_->Results->columnCount() - 1, again);
  setTabOrder(ui_->Results, again);
}

BoxEntries BoxConfig::Entries() const {
  return {.BoxType = ui_->BoxType->currentIndex(),
          .TeamList = ui_->TeamList->currentIndex(),
          .PointsPerAct = ui_->PointsPerAct->text().toStdString(),
          .RechargePoints = ui_->RechargePoints->text().toStdString(),
          .ActivationAmount = ui_->ActivationAmount->text().toStdString(),
          .AutoModeTime = ui_->AutoModeTime->text().toStdString(),
          .Destroyable = ui_->Destroyable->isChecked()};
}

void BoxConfig::Show(const BoxEntries& entries) {
  ui_->BoxType->setCurrentIndex(entries.BoxType);
  ui_->TeamList->setCurrentIndex(entries.TeamList);
  ui_->PointsPerAct->setText(QString::fromStdString(entries.PointsPerAct));
  ui_->RechargePoints->setText(QString::fromStdString(entries.RechargePoints));
  ui_->ActivationAmount->setText(QString::fromStdString(entries.ActivationAmount));
  ui_->AutoModeTime->setText(QString::fromStdString(entries.AutoModeTime));
  ui_->Destroyable->setChecked(entries.Destroyable);
}

void BoxConfig::Program() {
  ui_->Signals->Clear();
  programmer_.Program(Entries());
}

void BoxConfig::ProgramAgain(const BoxEntries& entries) {
  Show(entries);
  Program();
}

void BoxConfig::Note(const BoxEntries& entries, BoxResult result) {
  if (!commands_.CloseRequested()) {
    const auto [text, success] = TextOf(result);
    ui_->Signals->Tell(success, Text(parts_.Strings, text));
  }
  if (result != BoxResult::NotSent) {
    const std::string time = parts_.Time.Now();
    parts_.Programmed.Add({time.substr(time.find(' ') + 1), entries, result});
    AddRow(parts_.Programmed.Count(), parts_.Programmed.All().back());
    // The list measured its row before the button was there.
    ui_->Results->resizeColumnToContents(ui_->Results->columnCount() - 1);
  }
}

void BoxConfig::reject() {
  if (commands_.MayClose()) {
    QDialog::reject();
  }
}
