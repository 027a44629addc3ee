#include "board/MissionResultEntry.h"

#include <QEvent>
#include <QKeyEvent>
#include <string>

#include "core/data/FieldValue.h"
#include "core/text/Pieces.h"
#include "ui/Captions.h"
#include "ui_MissionResultEntry.h"

MissionResultEntry::MissionResultEntry(Game& game, MissionList& missions, const StringTable& strings,
                                       QWidget* parent)
    : QDialog(parent), ui_(std::make_unique<Ui::MissionResultEntry>()), game_(game) {
  ui_->setupUi(this);
  sets_ = {{{ui_->TeamA, ui_->PrimaryCompleted1, ui_->SecondaryCompleted1},
            {ui_->TeamB, ui_->PrimaryCompleted2, ui_->SecondaryCompleted2},
            {ui_->TeamC, ui_->PrimaryCompleted3, ui_->SecondaryCompleted3}}};
  ShowTexts(strings);
  ShowResults();
  ShowObjectives(missions);
  connect(ui_->OK, &QPushButton::clicked, this, [this] {
    StoreResults();
    accept();
  });
}

MissionResultEntry::~MissionResultEntry() = default;

void MissionResultEntry::ShowTexts(const StringTable& strings) {
  SetCaptions(strings, {{this, 142},
                        {ui_->Frame1, 143},
                        {ui_->Frame2, 144},
                        {ui_->Frame3, 145},
                        {ui_->Label2, 113},
                        {ui_->Label3, 113},
                        {ui_->Label4, 113},
                        {ui_->Label1, 148},
                        {ui_->OK, 140}});
  for (const SetControls& set : sets_) {
    SetCaptions(strings, {{set.PrimaryCompleted, 146}, {set.SecondaryCompleted, 147}});
    for (QCheckBox* box : {set.PrimaryCompleted, set.SecondaryCompleted}) {
      box->installEventFilter(this);
    }
  }
}

void MissionResultEntry::ShowResults() {
  for (int k = 1; k <= TeamCount; ++k) {
    const SetControls& set = sets_[static_cast<std::size_t>(k - 1)];
    const ObjectiveTeam& objective = game_.ObjectiveTeams(k);
    set.PrimaryCompleted->setChecked(objective.PrimaryAchieved);
    set.SecondaryCompleted->setChecked(objective.SecondaryAchieved);
    for (const std::string& name : game_.TeamNames) {
      set.Team->addItem(QString::fromStdString(name));
    }
    set.Team->setCurrentIndex(set.Team->findText(QString::fromStdString(objective.Name)));
  }
}

void MissionResultEntry::ShowObjectives(MissionList& missions) {
  if (!missions.ActivateCurrentMissionRecord()) {
    return;
  }
  for (int k = 0; k < TeamCount; ++k) {
    const char letter = static_cast<char>('A' + k);
    const auto objective = [&](const char* column) {
      return QString::fromStdString(
          FirstLineOf(TextOf(missions.Row().Fields(column + std::string(1, letter)))));
    };
    sets_[static_cast<std::size_t>(k)].PrimaryCompleted->setToolTip(objective("PrimaryObjectiveDescription"));
    sets_[static_cast<std::size_t>(k)].SecondaryCompleted->setToolTip(
        objective("SecondaryObjectiveDescription"));
  }
}

void MissionResultEntry::keyPressEvent(QKeyEvent* event) {
  if (event->matches(QKeySequence::Cancel)) {
    ui_->OK->click();
  } else {
    QDialog::keyPressEvent(event);
  }
}

// A touch screen has no hovering, and a screen reader no tool tips.
bool MissionResultEntry::eventFilter(QObject* watched, QEvent* event) {
  if (event->type() == QEvent::FocusIn || event->type() == QEvent::Enter) {
    ui_->ObjectiveText->setText(qobject_cast<QWidget*>(watched)->toolTip());
  }
  return QDialog::eventFilter(watched, event);
}

void MissionResultEntry::StoreResults() {
  for (int k = 1; k <= TeamCount; ++k) {
    const SetControls& set = sets_[static_cast<std::size_t>(k - 1)];
    game_.ObjectiveTeams(k) = {set.Team->currentText().toStdString(), set.PrimaryCompleted->isChecked(),
                               set.SecondaryCompleted->isChecked()};
  }
}
