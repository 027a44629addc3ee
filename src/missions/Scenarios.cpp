#include "missions/Scenarios.h"

#include <QLineEdit>
#include <QListWidget>
#include <QSignalBlocker>
#include <memory>
#include <vector>

#include "core/data/FieldValue.h"
#include "core/data/Rows.h"
#include "core/text/NumberForms.h"
#include "missions/MissionNameEntry.h"
#include "missions/ScenarioNotes.h"
#include "ui/Captions.h"
#include "ui/Text.h"
#include "ui_Scenarios.h"

namespace {

void Show(QPlainTextEdit& box, const std::string& text) {
  box.setPlainText(QString::fromStdString(text));
}

void Show(QLineEdit& box, const std::string& text) {
  box.setText(QString::fromStdString(text));
  box.setCursorPosition(0);
}

/// Read-only entries have the background of the window.
template <typename Entry>
void SetReadOnly(Entry& entry, bool flag) {
  entry.setReadOnly(flag);
  entry.setStyleSheet(flag ? QStringLiteral("background: palette(window)") : QString());
}

}  // namespace

Scenarios::Scenarios(Database& dbScenarios, Recordset& rsScenarios, MessageBoxes& boxes,
                     const StringTable& strings, QWidget* parent)
    : QDialog(parent),
      ui_(std::make_unique<Ui::Scenarios>()),
      dbScenarios_(dbScenarios),
      rsScenarios_(rsScenarios),
      boxes_(boxes),
      strings_(strings),
      commands_(*this, boxes) {
  ui_->setupUi(this);
  objectives_ = {{{ui_->PrimaryObjectiveDescription0, ui_->SecondaryObjectiveDescription0,
                   ui_->PrimaryPoints0, ui_->SecondaryPoints0},
                  {ui_->PrimaryObjectiveDescription1, ui_->SecondaryObjectiveDescription1,
                   ui_->PrimaryPoints1, ui_->SecondaryPoints1},
                  {ui_->PrimaryObjectiveDescription2, ui_->SecondaryObjectiveDescription2,
                   ui_->PrimaryPoints2, ui_->SecondaryPoints2}}};
  ShowTexts();
  ShowNotes();
  LoadMissionList();
  SelectMission(0);
  BringToFront(0);
  SetLocked(true);
  ConnectCommands();
  ui_->MissionSelection1->setFocus();
}

Scenarios::~Scenarios() = default;

void Scenarios::ShowTexts() {
  SetCaptions(strings_, {{this, 180},
                         {ui_->Frame1, 183},
                         {ui_->Frame2, 184},
                         {ui_->Frame5, 189},
                         {ui_->General, 195},
                         {ui_->NewButton, 185},
                         {ui_->Edit, 186},
                         {ui_->Save, 187},
                         {ui_->Delete, 188},
                         {ui_->SelectExit, 140},
                         {ui_->Label2, 190},
                         {ui_->Label6, 191},
                         {ui_->Label4, 192},
                         {ui_->Label1, 193},
                         {ui_->Label3, 193},
                         {ui_->Label5, 194},
                         {ui_->Label7, 196},
                         {ui_->Label8, 197}});
  for (const int number : {198, 199, 200}) {
    ui_->ObjectivesTab->addTab(Text(strings_, number));
  }
  ui_->MissionSelection1->setAccessibleName(Text(strings_, 183));
  ui_->Description->setAccessibleName(Text(strings_, 184));
  // Screen readers use a buddy label's text only within the same parent, and these boxes lie on other pages.
  for (const ObjectiveBoxes& boxes : objectives_) {
    boxes.PrimaryDescription->setAccessibleName(Text(strings_, 192));
    boxes.PrimaryPoints->setAccessibleName(Text(strings_, 193));
    boxes.SecondaryDescription->setAccessibleName(Text(strings_, 194));
    boxes.SecondaryPoints->setAccessibleName(Text(strings_, 193));
    boxes.PrimaryPoints->setAccessibleDescription(Text(strings_, 192));
    boxes.SecondaryPoints->setAccessibleDescription(Text(strings_, 194));
  }
}

void Scenarios::ShowNotes() {
  const auto boxes = [this](QLineEdit* ObjectiveBoxes::*kind) {
    return std::array{objectives_[0].*kind, objectives_[1].*kind, objectives_[2].*kind};
  };
  new ScenarioNotes({.Description = ui_->Description,
                     .DescriptionCount = ui_->DescriptionCount,
                     .DescriptionNote = ui_->DescriptionNote,
                     .RespawnPenalty = ui_->RespawnPenalty,
                     .RespawnNote = ui_->RespawnNote,
                     .HealPenalty = ui_->HealPenalty,
                     .HealNote = ui_->HealNote,
                     .PrimaryPoints = boxes(&ObjectiveBoxes::PrimaryPoints),
                     .PrimaryNote = ui_->PrimaryNote,
                     .SecondaryPoints = boxes(&ObjectiveBoxes::SecondaryPoints),
                     .SecondaryNote = ui_->SecondaryNote,
                     .Tabs = ui_->ObjectivesTab},
                    strings_, this);
}

void Scenarios::ConnectCommands() {
  commands_.Connect(*this, {
                               {ui_->NewButton, &Scenarios::NewMission},
                               {ui_->Edit, &Scenarios::EditMission},
                               {ui_->Save, &Scenarios::SaveMission},
                               {ui_->Delete, &Scenarios::DeleteMission},
                               {ui_->SelectExit, &Scenarios::SelectExit},
                           });
  commands_.EscapePresses(*ui_->SelectExit);
  const auto show = [this] { commands_.Run([this] { ShowSelectedMission(); }); };
  connect(ui_->MissionSelection1, &QListWidget::currentRowChanged, this, show);
  // A click on the entry that is already current also shows its mission again, discarding unsaved changes.
  connect(ui_->MissionSelection1, &QListWidget::itemClicked, this, show);
  connect(ui_->MissionSelection1, &QListWidget::itemSelectionChanged, this, &Scenarios::FollowSelection);
  connect(ui_->ObjectivesTab, &QTabBar::currentChanged, this, &Scenarios::BringToFront);
}

void Scenarios::LoadMissionList() {
  // The old entries stay if the rows cannot be read. Besides, setData on an item in a list searches the whole
  // list for it.
  std::vector<std::unique_ptr<QListWidgetItem>> entries;
  {
    const ReadScope scope(dbScenarios_);
    ForEachRow(rsScenarios_, [this, &entries] {
      const QString name = QString::fromStdString(TextOf(rsScenarios_.Fields("MissionName")));
      const std::int32_t id = RoundToInt32(NumberOf(rsScenarios_.Fields("ID")));
      entries.push_back(std::make_unique<QListWidgetItem>(name));
      entries.back()->setData(Qt::UserRole, id);
    });
  }
  const QSignalBlocker blocker(ui_->MissionSelection1);
  ui_->MissionSelection1->clear();
  for (std::unique_ptr<QListWidgetItem>& entry : entries) {
    ui_->MissionSelection1->addItem(entry.release());
  }
}

void Scenarios::SelectMission(int entry) {
  {
    const QSignalBlocker blocker(ui_->MissionSelection1);
    ui_->MissionSelection1->setCurrentRow(entry);
  }
  ShowSelectedMission();
}

void Scenarios::ShowSelectedMission() {
  try {
    if (FindSelectedMission()) {
      ShowMissionRecord();
    } else {
      ClearMissionFields();
    }
  } catch (const RuntimeError&) {
    // The fields still show another mission, and the next save would put that in the place of this one.
    const QSignalBlocker blocker(ui_->MissionSelection1);
    ui_->MissionSelection1->setCurrentRow(-1);
    ClearMissionFields();
    throw;
  }
}

// Screen readers select an entry without making it the current one.
void Scenarios::FollowSelection() {
  const QList<QListWidgetItem*> selected = ui_->MissionSelection1->selectedItems();
  if (!selected.isEmpty()) {
    ui_->MissionSelection1->setCurrentItem(selected.first());
  }
}

bool Scenarios::FindSelectedMission() {
  const QListWidgetItem* entry = ui_->MissionSelection1->currentItem();
  if (entry == nullptr) {
    return false;
  }
  rsScenarios_.FindFirst("ID=" + Str(entry->data(Qt::UserRole).toInt()));
  return !rsScenarios_.NoMatch();
}

void Scenarios::ShowMissionRecord() {
  ShowMission(ReadMission(rsScenarios_));
}

void Scenarios::ClearMissionFields() {
  ShowMission({});
}

void Scenarios::ShowMission(const MissionRecord& mission) {
  ui_->MissionName->setText(QString::fromStdString(mission.Name));
  Show(*ui_->Description, mission.Description);
  Show(*ui_->RespawnPenalty, mission.RespawnPenalty);
  Show(*ui_->HealPenalty, mission.HealPenalty);
  Show(*ui_->GameDuration, mission.GameDuration);
  for (int set = 0; set < TeamCount; ++set) {
    Show(*objectives_[set].PrimaryDescription, mission.Objectives[set].PrimaryDescription);
    Show(*objectives_[set].SecondaryDescription, mission.Objectives[set].SecondaryDescription);
    Show(*objectives_[set].PrimaryPoints, mission.Objectives[set].PrimaryPoints);
    Show(*objectives_[set].SecondaryPoints, mission.Objectives[set].SecondaryPoints);
  }
  Show(*ui_->TeamRatio, mission.TeamRatio);
}

MissionRecord Scenarios::EnteredMission() const {
  MissionRecord mission;
  mission.Name = ui_->MissionName->text().toStdString();
  mission.Description = TextIn(*ui_->Description);
  mission.RespawnPenalty = ui_->RespawnPenalty->text().toStdString();
  mission.HealPenalty = ui_->HealPenalty->text().toStdString();
  mission.GameDuration = ui_->GameDuration->text().toStdString();
  for (int set = 0; set < TeamCount; ++set) {
    mission.Objectives[set] = {TextIn(*objectives_[set].PrimaryDescription),
                               TextIn(*objectives_[set].SecondaryDescription),
                               objectives_[set].PrimaryPoints->text().toStdString(),
                               objectives_[set].SecondaryPoints->text().toStdString()};
  }
  mission.TeamRatio = ui_->TeamRatio->text().toStdString();
  return mission;
}

void Scenarios::SetLocked(bool flag) {
  ui_->Edit->setText(flag ? QStringLiteral("Edit") : QStringLiteral("Editing"));
  locked_ = flag;
  SetReadOnly(*ui_->Description, flag);
  for (QLineEdit* entry : {ui_->RespawnPenalty, ui_->HealPenalty, ui_->GameDuration, ui_->TeamRatio}) {
    SetReadOnly(*entry, flag);
  }
  for (const ObjectiveBoxes& boxes : objectives_) {
    SetReadOnly(*boxes.PrimaryDescription, flag);
    SetReadOnly(*boxes.SecondaryDescription, flag);
    SetReadOnly(*boxes.PrimaryPoints, flag);
    SetReadOnly(*boxes.SecondaryPoints, flag);
  }
}

void Scenarios::BringToFront(int set) {
  for (QStackedWidget* stack :
       {ui_->primaryDescriptions, ui_->secondaryDescriptions, ui_->primaryPoints, ui_->secondaryPoints}) {
    stack->setCurrentIndex(set);
  }
  const ObjectiveBoxes& front = objectives_[static_cast<std::size_t>(set)];
  ui_->Label4->setBuddy(front.PrimaryDescription);
  ui_->Label1->setBuddy(front.PrimaryPoints);
  ui_->Label5->setBuddy(front.SecondaryDescription);
  ui_->Label3->setBuddy(front.SecondaryPoints);
}

void Scenarios::NewMission() {
  MissionNameEntry entry(strings_, this);
  entry.exec();
  const std::string name = entry.EnteredName();
  if (name.empty()) {
    return;
  }
  {
    const QSignalBlocker blocker(ui_->MissionSelection1);  // the entry has no row to show yet
    ui_->MissionSelection1->addItem(QString::fromStdString(name));
    ui_->MissionSelection1->setCurrentRow(ui_->MissionSelection1->count() - 1);
  }
  MissionRecord mission;
  mission.Name = name;
  mission.Description = "Enter Mission Details";
  ShowMission(mission);
  isNewRecord_ = true;
  silentSave_ = true;
  SaveMission();
  isNewRecord_ = false;
  SetLocked(false);
}

void Scenarios::EditMission() {
  SetLocked(false);
}

void Scenarios::SaveMission() {
  if (const int fault = FaultOf(EnteredMission()); fault != 0) {
    boxes_.Show(strings_.Text(fault), strings_.Text(176), BoxIcon::Exclamation);
    return;
  }
  try {
    SaveRow();
  } catch (const RuntimeError&) {
    boxes_.Show("Error occured when saving Mission. Please check the entered data.", "Mission Save Error",
                BoxIcon::Exclamation);
  }
}

void Scenarios::SaveRow() {
  StartRow();
  for (const ObjectiveBoxes& boxes : objectives_) {
    for (QLineEdit* points : {boxes.PrimaryPoints, boxes.SecondaryPoints}) {
      if (points->text().isEmpty()) {
        points->setText(QStringLiteral("0"));
      }
    }
  }
  WriteMission(rsScenarios_, EnteredMission());
  rsScenarios_.Update();
  LoadMissionList();
  SelectMission(ui_->MissionSelection1->count() - 1);
  if (!silentSave_) {
    boxes_.Show(strings_.Text(179), strings_.Text(180), BoxIcon::Information);
  }
  silentSave_ = false;
  SetLocked(true);
}

void Scenarios::StartRow() {
  if (isNewRecord_) {
    rsScenarios_.AddNew();
  } else if (rsScenarios_.EditMode() != EditMode::Add) {
    // After a failed insertion the new row is still pending. Any other save goes to the row selected in the
    // list.
    if (!FindSelectedMission()) {
      throw RuntimeError(Fault::NoCurrentRecord);
    }
    rsScenarios_.Edit();
  }
}

void Scenarios::DeleteMission() {
  const BoxAnswer answer =
      boxes_.Show(strings_.Text(173), strings_.Text(174), BoxIcon::Question, BoxButtons::OkCancel);
  if (answer != BoxAnswer::Ok) {
    return;
  }
  if (FindSelectedMission()) {
    rsScenarios_.Delete();
  }
  rsScenarios_.MoveFirst();
  {
    const QSignalBlocker blocker(ui_->MissionSelection1);
    delete ui_->MissionSelection1->takeItem(ui_->MissionSelection1->currentRow());
  }
  SelectMission(0);
}

void Scenarios::SelectExit() {
  if (isNewRecord_ || !locked_) {
    const BoxAnswer answer =
        boxes_.Show(strings_.Text(181), strings_.Text(182), BoxIcon::Exclamation, BoxButtons::YesNo);
    if (answer == BoxAnswer::Yes) {
      SaveMission();
    }
  }
  rsScenarios_.MoveFirst();
  accept();
}
