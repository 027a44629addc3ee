#include "board/MissionResultEntry.h"

#include <QEvent>
#include <QKeyEvent>
#include <QStringList>
#include <algorithm>
#include <cmath>
#include <string>

#include "core/data/FieldValue.h"
#include "core/text/Filled.h"
#include "core/text/NumberForms.h"
#include "core/text/Pieces.h"
#include "platform/RuntimeError.h"
#include "ui/Announce.h"
#include "ui/Captions.h"
#include "ui/TeamColours.h"
#include "ui/Text.h"
#include "ui_MissionResultEntry.h"

namespace {

/// What a player of the team gets, reckoned as for the score; "-" if no score can hold it.
std::string SumText(const MissionPoints& points, const OneBased<ObjectiveTeam, TeamCount>& results,
                    const std::string& team) {
  try {
    return std::to_string(WithObjectivePoints(0, points, results, team));
  } catch (const RuntimeError&) {
    return "-";
  }
}

/// The table's numbers may be infinite.
std::string PointsText(double points) {
  return std::isfinite(points) ? PlainDecimal(points) : "-";
}

/// Shows an objective's first line, which is also the tip of its box, and its points if they are known.
void ShowObjective(QLabel& label, const QCheckBox& box, const double* points, const StringTable& strings) {
  QStringList lines;
  if (!box.toolTip().isEmpty()) {
    lines << box.toolTip();
  }
  if (points != nullptr) {
    lines << QString::fromStdString(Filled(strings.Text(OwnText::ObjectivePoints), {PointsText(*points)}));
  }
  label.setText(lines.join(u'\n'));
}

void ShowSum(QLabel& label, const QString& text) {
  const bool changed = label.text() != text;
  label.setText(text);
  if (changed && label.isVisible()) {
    Announce(label);
  }
}

}  // namespace

MissionResultEntry::MissionResultEntry(Game& game, MissionList& missions, const StringTable& strings,
                                       QWidget* parent)
    : QDialog(parent), ui_(std::make_unique<Ui::MissionResultEntry>()), game_(game), strings_(strings) {
  ui_->setupUi(this);
  sets_ = {{{ui_->TeamA, ui_->PrimaryCompleted1, ui_->SecondaryCompleted1, ui_->PrimaryObjective1,
             ui_->SecondaryObjective1},
            {ui_->TeamB, ui_->PrimaryCompleted2, ui_->SecondaryCompleted2, ui_->PrimaryObjective2,
             ui_->SecondaryObjective2},
            {ui_->TeamC, ui_->PrimaryCompleted3, ui_->SecondaryCompleted3, ui_->PrimaryObjective3,
             ui_->SecondaryObjective3}}};
  ShowTexts();
  ShowResults();
  ShowObjectives(missions);
  ShowSums();
  connect(ui_->OK, &QPushButton::clicked, this, [this] {
    game_.ObjectiveTeams = EnteredResults();
    accept();
  });
  for (const SetControls& set : sets_) {
    connect(set.Team, &QComboBox::currentIndexChanged, this, &MissionResultEntry::ShowSums);
    connect(set.PrimaryCompleted, &QCheckBox::toggled, this, &MissionResultEntry::ShowSums);
    connect(set.SecondaryCompleted, &QCheckBox::toggled, this, &MissionResultEntry::ShowSums);
  }
}

MissionResultEntry::~MissionResultEntry() = default;

void MissionResultEntry::ShowTexts() {
  SetCaptions(strings_, {{this, 142},
                         {ui_->Frame1, 143},
                         {ui_->Frame2, 144},
                         {ui_->Frame3, 145},
                         {ui_->Label2, 113},
                         {ui_->Label3, 113},
                         {ui_->Label4, 113},
                         {ui_->Label1, 148},
                         {ui_->OK, 140}});
  for (const SetControls& set : sets_) {
    SetCaptions(strings_, {{set.PrimaryCompleted, 146}, {set.SecondaryCompleted, 147}});
    for (QCheckBox* box : {set.PrimaryCompleted, set.SecondaryCompleted}) {
      box->installEventFilter(this);
    }
    constexpr int belowTheCaption = 24;  // of the box, right of its mark
    constexpr int beforeTheNextBox = 8;
    constexpr int lettersInLine = 24;
    for (QLabel* objective : {set.PrimaryObjective, set.SecondaryObjective}) {
      objective->setContentsMargins(belowTheCaption, 0, 0, beforeTheNextBox);
      objective->setMinimumWidth(belowTheCaption + lettersInLine * fontMetrics().averageCharWidth());
    }
  }
  ui_->PointsCaption->setText(Text(strings_, OwnText::PointsOfTeams));
  int team = 0;
  for (QLabel* badge : {ui_->Badge1, ui_->Badge2, ui_->Badge3}) {
    constexpr int badgeSize = 16;
    badge->setPixmap(TeamBadge(++team).pixmap(badgeSize));
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
  ShowPoints(missions);
  for (int k = 0; k < TeamCount; ++k) {
    const char letter = static_cast<char>('A' + k);
    const auto objective = [&](const char* column) {
      return QString::fromStdString(
          FirstLineOf(TextOf(missions.Row().Fields(column + std::string(1, letter)))));
    };
    const SetControls& set = sets_[static_cast<std::size_t>(k)];
    set.PrimaryCompleted->setToolTip(objective("PrimaryObjectiveDescription"));
    set.SecondaryCompleted->setToolTip(objective("SecondaryObjectiveDescription"));
    ShowObjective(*set.PrimaryObjective, *set.PrimaryCompleted, points_ ? &points_->Primary[k] : nullptr,
                  strings_);
    ShowObjective(*set.SecondaryObjective, *set.SecondaryCompleted,
                  points_ ? &points_->Secondary[k] : nullptr, strings_);
  }
}

void MissionResultEntry::ShowPoints(MissionList& missions) {
  try {
    points_ = ReadMissionPoints(missions.Row());
  } catch (const RuntimeError&) {
    points_.reset();  // results can be entered without them; the calculation reports what is wrong
  }
}

void MissionResultEntry::ShowSums() {
  QLabel* const sums[] = {ui_->TeamSum1, ui_->TeamSum2, ui_->TeamSum3};
  const OneBased<ObjectiveTeam, TeamCount> results = EnteredResults();
  for (int team = 1; points_ && team <= TeamCount; ++team) {
    const std::string& name = game_.TeamNames(team);
    ShowSum(*sums[team - 1], QString::fromStdString(Filled(strings_.Text(OwnText::PointsOfTeam),
                                                           {name, SumText(*points_, results, name)})));
  }
  ui_->PointsFrame->setVisible(points_.has_value());
}

// The toolkit makes no new window higher than two thirds of the screen, which would cut long objectives.
void MissionResultEntry::showEvent(QShowEvent* event) {
  QDialog::showEvent(event);
  resize(width(), std::max(height(), layout()->totalHeightForWidth(width())));
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

OneBased<ObjectiveTeam, TeamCount> MissionResultEntry::EnteredResults() const {
  OneBased<ObjectiveTeam, TeamCount> results;
  for (int k = 1; k <= TeamCount; ++k) {
    const SetControls& set = sets_[static_cast<std::size_t>(k - 1)];
    results(k) = {set.Team->currentText().toStdString(), set.PrimaryCompleted->isChecked(),
                  set.SecondaryCompleted->isChecked()};
  }
  return results;
}
