#include "app/MenuCaptions.h"

#include "ui/Captions.h"
#include "ui_frmRx.h"

void SetCaptions(Ui::frmRx& ui, const StringTable& strings) {
  SetCaptions(strings, {{ui.Label1, 203}, {ui.Label2, 201}, {ui.ActiveMissionLabel, 202}});
  ui.ScoreDisplay->setAccessibleName(ui.Label1->text());
  ui.TeamScores->setAccessibleName(ui.Label2->text());
  SetCaptions(strings, {
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
                       });
}
