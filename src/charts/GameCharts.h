#pragma once

#include <QDialog>
#include <memory>
#include <string>
#include <vector>

#include "charts/ChartGame.h"
#include "charts/ScoreParts.h"
#include "core/text/StringTable.h"
#include "platform/FileDialog.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"
#include "ui/Commands.h"

class ChartTable;
class HitRows;
class ScoreRows;

namespace Ui {
class GameCharts;
}

/// Charts of a game: who hit whom, and where the points come from. Stands beside the other windows.
class GameCharts : public QDialog {
  Q_OBJECT

 public:
  /// All of them must outlive the window.
  struct Parts {
    const StringTable& Strings;
    MessageBoxes& Boxes;
    FileDialog& CommonDialog1;
    Files& Disk;
  };

  explicit GameCharts(const Parts& parts);
  ~GameCharts() override;

  /// Shows this game, of which nothing is needed later.
  void ShowGame(const ChartGame& game);

  void reject() override;

 private:
  void SetTexts();
  void ConnectCharts();
  bool ShowsHits() const;
  void Tell(const QString& text, bool aloud);
  /// Tells what the operator went to last in the chart in view.
  void TellAgain();
  void SavePicture();
  /// Where to save; empty if the operator changes their mind.
  std::string AskForFile();

  const Parts parts_;
  std::unique_ptr<Ui::GameCharts> ui_;
  HitRows* hitRows_;
  ScoreRows* scoreRows_;
  std::string title_;
  std::string fileName_;
  std::string folder_;  ///< of the last picture
  Commands commands_;
};
