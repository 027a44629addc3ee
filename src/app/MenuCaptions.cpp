#include "app/MenuCaptions.h"

#include <utility>

#include "ui/Captions.h"
#include "ui_frmRx.h"

namespace {

/// Sets an item's caption. If that has not got the Alt-key letter of the design, the letter stands behind it:
/// "游戏(G)".
void SetCaption(const StringTable& strings, QAction& item, int number) {
  const QString design = item.text();
  SetCaptions(strings, {{&item, number}});
  if (const auto mark = design.indexOf(u'&'); mark >= 0 && !item.text().contains(u'&')) {
    item.setText(item.text() + QStringLiteral("(&") + design.mid(mark + 1, 1).toUpper() + u')');
  }
}

}  // namespace

void SetCaptions(Ui::frmRx& ui, const StringTable& strings) {
  SetCaptions(strings, {{ui.Label1, 203}, {ui.Label2, 201}, {ui.ActiveMissionLabel, 202}});
  ui.ScoreDisplay->setAccessibleName(ui.Label1->text());
  ui.TeamScores->setAccessibleName(ui.Label2->text());
  const std::pair<QAction*, int> items[] = {
      {ui.mnuFile->menuAction(), 204},
      {ui.mnuLoadScores, 205},
      {ui.mnuSaveScores, 206},
      {ui.mnuClearScores, 207},
      {ui.mnuPrintScores, 208},
      {ui.mnuAdminData, 209},
      {ui.mnuExit, 210},
      {ui.mnuGameCharts, static_cast<int>(OwnText::GameChartsItem)},
      {ui.mnuExport, static_cast<int>(OwnText::GameExportMenu)},
      {ui.mnuImportGames, static_cast<int>(OwnText::ImportGamesItem)},
      {ui.mnuMissions->menuAction(), 211},
      {ui.mnuMissionResults, 212},
      {ui.mnuSetupMissions, 213},
      {ui.mnuBackupCopies, static_cast<int>(OwnText::BackupCopiesItem)},
      {ui.mnuTakeOver, static_cast<int>(OwnText::TakeOverItem)},
      {ui.mnuExportMembers, static_cast<int>(OwnText::ExportMembersItem)},
      {ui.mnuImportMembers, static_cast<int>(OwnText::ImportMembersItem)},
      {ui.mnuSettings->menuAction(), 214},
      {ui.mnuCommPort, 215},
      {ui.mnuSoldieringCalc, 216},
      {ui.mnuShow->menuAction(), static_cast<int>(OwnText::ShowMenu)},
      {ui.mnuLargerLetters, static_cast<int>(OwnText::LargerLetters)},
      {ui.mnuSmallerLetters, static_cast<int>(OwnText::SmallerLetters)},
      {ui.mnuUsualLetters, static_cast<int>(OwnText::UsualLetters)},
      {ui.mnuUsualColumns, static_cast<int>(OwnText::UsualColumns)},
      {ui.mnuAudienceBoard, static_cast<int>(OwnText::AudienceBoardItem)},
      {ui.mnuAudienceResults, static_cast<int>(OwnText::AudienceResultsItem)},
      {ui.mnuAudienceVenue, static_cast<int>(OwnText::AudienceVenueItem)},
      {ui.mnuAudienceBlank, static_cast<int>(OwnText::AudienceBlankItem)},
      {ui.mnuGuestNames, static_cast<int>(OwnText::GuestNamesItem)},
      {ui.mnuAudienceSettings, static_cast<int>(OwnText::AudienceSettingsItem)},
      {ui.mnuHelp->menuAction(), 217},
      {ui.mnuAbout, 218},
      {ui.mnuManual, static_cast<int>(OwnText::ManualTitle)},
  };
  for (const auto& [item, number] : items) {
    SetCaption(strings, *item, number);
  }
}
