#pragma once

#include <QDialog>
#include <array>
#include <memory>

#include "core/game/Game.h"
#include "core/game/MissionList.h"
#include "core/text/StringTable.h"

class QCheckBox;
class QComboBox;

namespace Ui {
class MissionResultEntry;
}

/// Asks which team played each objective set of the active mission, and what was completed. OK and Escape
/// store that, the close box does not.
class MissionResultEntry : public QDialog {
  Q_OBJECT

 public:
  /// Shows the results that `game` holds, and changes them on OK.
  MissionResultEntry(Game& game, MissionList& missions, const StringTable& strings, QWidget* parent);
  ~MissionResultEntry() override;

 protected:
  void keyPressEvent(QKeyEvent* event) override;
  bool eventFilter(QObject* watched, QEvent* event) override;

 private:
  /// The controls of one objective set.
  struct SetControls {
    QComboBox* Team;
    QCheckBox* PrimaryCompleted;
    QCheckBox* SecondaryCompleted;
  };

  void ShowTexts(const StringTable& strings);
  void ShowResults();
  void ShowObjectives(MissionList& missions);
  void StoreResults();

  std::unique_ptr<Ui::MissionResultEntry> ui_;
  std::array<SetControls, TeamCount> sets_;
  Game& game_;
};
