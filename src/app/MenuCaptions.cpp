#include "app/MenuCaptions.h"

#include <utility>

#include "ui/Text.h"
#include "ui_frmRx.h"

namespace {

void SetCaption(QAction& action, QString caption) {
  const QString old = action.text();
  const auto mark = old.indexOf(u'&');
  const auto letter = mark < 0 ? -1 : caption.indexOf(old[mark + 1], 0, Qt::CaseInsensitive);
  if (letter >= 0) {
    caption.insert(letter, u'&');
  }
  action.setText(caption);
}

}  // namespace

void SetCaptions(Ui::frmRx& ui, const StringTable& strings) {
  ui.Label1->setText(Text(strings, 203));
  ui.Label2->setText(Text(strings, 201));
  ui.ActiveMissionLabel->setText(Text(strings, 202));
  ui.ScoreDisplay->setAccessibleName(ui.Label1->text());
  ui.TeamScores->setAccessibleName(ui.Label2->text());
  const std::pair<QAction*, int> captions[] = {
      {ui.mnuFile->menuAction(), 204},
      {ui.mnuLoadScores, 205},
      {ui.mnuSaveScores, 206},
      {ui.mnuClearScores, 207},
      {ui.mnuPrintScores, 208},
      {ui.mnuAdminData, 209},
      {ui.mnuExit, 210},
      {ui.mnuMissions->menuAction(), 211},
      {ui.mnuMissionResults, 212},
      {ui.mnuSetupMissions, 213},
      {ui.mnuSettings->menuAction(), 214},
      {ui.mnuCommPort, 215},
      {ui.mnuSoldieringCalc, 216},
      {ui.mnuHelp->menuAction(), 217},
      {ui.mnuAbout, 218},
  };
  for (const auto& [action, number] : captions) {
    SetCaption(*action, Text(strings, number));
  }
}
