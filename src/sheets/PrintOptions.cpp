#include "sheets/PrintOptions.h"

#include "core/game/PlayerId.h"
#include "core/text/NumberForms.h"
#include "platform/ErrorReport.h"
#include "ui/Captions.h"
#include "ui_PrintOptions.h"

PrintOptions::PrintOptions(const StringTable& strings, MessageBoxes& boxes, QWidget* parent)
    : QDialog(parent), ui_(std::make_unique<Ui::PrintOptions>()), boxes_(boxes) {
  ui_->setupUi(this);
  SetCaptions(strings, {{this, 159},
                        {ui_->Frame1, 149},
                        {ui_->Frame2, 150},
                        {ui_->Frame3, 151},
                        {ui_->PrintActive, 152},
                        {ui_->PrintAll, 153},
                        {ui_->PrintTeam, 154},
                        {ui_->PrintOne, 155},
                        {ui_->PrintPrinter, 156},
                        {ui_->PrintFile, 157},
                        {ui_->HideRank, 158},
                        {ui_->OK, 140},
                        {ui_->Cancel, 141},
                        {ui_->TeamLabel, 113},
                        {ui_->TeamLabel2, 113},
                        {ui_->PlayerLabel, 104}});
  FillLists(strings);
  for (const QRadioButton* option : {ui_->PrintActive, ui_->PrintAll, ui_->PrintTeam, ui_->PrintOne}) {
    connect(option, &QRadioButton::toggled, this, &PrintOptions::EnableLists);
  }
  EnableLists();
}

PrintOptions::~PrintOptions() = default;

void PrintOptions::FillLists(const StringTable& strings) {
  constexpr std::int16_t teams = 3;
  for (std::int16_t team = 1; team <= teams; ++team) {
    const QString name = QString::fromStdString(TeamNameFromNumber(strings, team));
    ui_->TeamID->addItem(name);
    ui_->TeamID2->addItem(name);
  }
  for (std::int32_t number = 0; number <= MaxPlayerNumber(1); ++number) {
    ui_->PlayerID->addItem(QString::fromStdString(Str(number)));
  }
}

void PrintOptions::EnableLists() {
  const bool one = ui_->PrintOne->isChecked();
  const bool team = ui_->PrintTeam->isChecked();
  for (QWidget* control :
       std::initializer_list<QWidget*>{ui_->TeamID, ui_->TeamLabel, ui_->PlayerID, ui_->PlayerLabel}) {
    control->setEnabled(one);
  }
  ui_->TeamID2->setEnabled(team);
  ui_->TeamLabel2->setEnabled(team);
}

void PrintOptions::accept() {
  const std::pair<const QRadioButton*, std::int16_t> selections[] = {
      {ui_->PrintActive, SheetSelection::Active},
      {ui_->PrintAll, SheetSelection::All},
      {ui_->PrintOne, SheetSelection::OnePlayer},
      {ui_->PrintTeam, SheetSelection::Team}};
  PrintEntries entries{choice_.SheetSelection,        ui_->TeamID->currentIndex(),
                       ui_->PlayerID->currentIndex(), ui_->TeamID2->currentIndex(),
                       ui_->PrintFile->isChecked(),   ui_->HideRank->isChecked()};
  for (const auto& [option, selection] : selections) {
    if (option->isChecked()) {
      entries.SheetSelection = selection;
    }
  }
  ReportErrors(boxes_, [&] {
    if (!TakeEntries(entries, choice_)) {
      boxes_.Show("Invalid player ID selected for this Team", DefaultBoxTitle, BoxIcon::Exclamation,
                  BoxButtons::OkCancel);
    }
  });
  QDialog::accept();
}

void PrintOptions::reject() {
  choice_.SheetSelection = SheetSelection::Nothing;
  QDialog::reject();
}
