#pragma once

#include <QDialog>
#include <array>
#include <memory>
#include <optional>

#include "core/game/Game.h"
#include "core/game/MissionList.h"
#include "core/game/MissionPoints.h"
#include "core/text/StringTable.h"

class QCheckBox;
class QComboBox;
class QLabel;

namespace Ui {
class MissionResultEntry;
}

/// Asks which team played each objective set of the active mission, and what was completed. OK and Escape
/// store that, the close box does not. Shows each objective with its points, and what the choices give to the
/// players of each team.
class MissionResultEntry : public QDialog {
  Q_OBJECT

 public:
  /// Shows the results that `game` holds, and changes them on OK.
  MissionResultEntry(Game& game, MissionList& missions, const StringTable& strings, QWidget* parent);
  ~MissionResultEntry() override;

 protected:
  void showEvent(QShowEvent* event) override;
  void keyPressEvent(QKeyEvent* event) override;
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  /// The controls of one objective set.
  struct SetControls {
    QComboBox* Team;
    QCheckBox* PrimaryCompleted;
    QCheckBox* SecondaryCompleted;
    QLabel* PrimaryObjective;
    QLabel* SecondaryObjective;
  };

  void ShowTexts();
  void ShowResults();
  void ShowObjectives(MissionList& missions);
  void ShowPoints(MissionList& missions);
  /// Shows what each team's players get for the results as they are entered now.
  void ShowSums();
  OneBased<ObjectiveTeam, TeamCount> EnteredResults() const;

  std::unique_ptr<Ui::MissionResultEntry> ui_;
  std::array<SetControls, TeamCount> sets_;
  Game& game_;
  const StringTable& strings_;
  std::optional<MissionPoints> points_;  ///< of the active mission
};
