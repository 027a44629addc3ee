#pragma once

#include <QDialog>
#include <QPlainTextEdit>
#include <array>
#include <memory>

#include "core/text/StringTable.h"
#include "missions/MissionRecord.h"
#include "platform/Database.h"
#include "platform/MessageBoxes.h"
#include "ui/Commands.h"

class QLineEdit;

namespace Ui {
class Scenarios;
}

/// The mission editor. It works on the cursor shared by the whole program, and leaves it on the first
/// mission.
class Scenarios : public QDialog {
  Q_OBJECT

 public:
  Scenarios(Database& dbScenarios, Recordset& rsScenarios, MessageBoxes& boxes, const StringTable& strings,
            QWidget* parent);
  ~Scenarios() override;

 private:
  /// The boxes of one objective set.
  struct ObjectiveBoxes {
    QPlainTextEdit* PrimaryDescription;
    QPlainTextEdit* SecondaryDescription;
    QLineEdit* PrimaryPoints;
    QLineEdit* SecondaryPoints;
  };

  void ShowTexts();
  void ShowNotes();
  void ConnectCommands();

  void LoadMissionList();
  /// Selects an entry and shows its mission, like a click on it.
  void SelectMission(int entry);
  void ShowSelectedMission();
  void FollowSelection();
  bool FindSelectedMission();
  void ShowMissionRecord();
  void ClearMissionFields();
  void ShowMission(const MissionRecord& mission);
  MissionRecord EnteredMission() const;
  void SetLocked(bool flag);
  void BringToFront(int set);

  void NewMission();
  void EditMission();
  void SaveMission();
  void SaveRow();
  void StartRow();
  void DeleteMission();
  void SelectExit();

  std::unique_ptr<Ui::Scenarios> ui_;
  std::array<ObjectiveBoxes, TeamCount> objectives_;
  Database& dbScenarios_;
  Recordset& rsScenarios_;
  MessageBoxes& boxes_;
  const StringTable& strings_;
  Commands commands_;
  bool isNewRecord_ = false;  ///< the next save adds a row
  bool locked_ = true;        ///< the entries are read-only
  bool silentSave_ = false;   ///< the next save shows no box
};
