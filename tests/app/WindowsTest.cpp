#include <QScrollBar>

#include "app/About.h"
#include "app/UploadProgress.h"
#include "archive/copies/BackupCopies.h"
#include "archive/history/MemberHistoryWindow.h"
#include "archive/history/RankingWindow.h"
#include "archive/import/ImportGames.h"
#include "archive/past/PastGames.h"
#include "audience/AudienceSettings.h"
#include "audience/GuestNameEntry.h"
#include "board/AdminData.h"
#include "board/BonusPoints.h"
#include "board/MissionResultEntry.h"
#include "board/PlayerDetails.h"
#include "check/SystemCheck.h"
#include "devices/box/BoxConfig.h"
#include "devices/charging/ChargeiButton.h"
#include "devices/radio/RemoteManage.h"
#include "exports/ExportGames.h"
#include "firmware/download/FirmwareFlash.h"
#include "members/ExportMembers.h"
#include "members/ImportMembers.h"
#include "members/Members.h"
#include "missions/MissionNameEntry.h"
#include "missions/Scenarios.h"
#include "settings/Settings.h"
#include "settings/SoldieringCalc.h"
#include "sound/ISD_rec.h"
#include "takeover/TakeOver.h"
#include "tests/support/CaredFor.h"
#include "tests/support/OnScreen.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"
#include "web/ResultsPage.h"

namespace {

/// Where the windows are looked at.
struct Desktop {
  const char* Name;
  const char* Screen;  ///< of Screens.json
  int Points;          ///< of the desktop's font; 0 for the usual size
};

constexpr Desktop Desktops[] = {
    {"OnALargeScreen", "recommended or better", 0},
    {"OnTheRecommendedScreen", "as recommended", 0},
    {"OnALaptop", "laptop", 0},
    {"OnAScaledScreen", "scaled by 2", 0},
    {"InLargeLetters", "as recommended", 11},
    {"InLargeLettersOnALaptop", "laptop", 11},
    {"InLargeLettersOnAScaledScreen", "scaled by 2", 11},
};

class Windows : public testing::TestWithParam<std::tuple<Language, Desktop>> {
 protected:
  Windows() {
    venue.PutDefaultFiles();
    QScreen& screen = ScreenNamed(desktop.Screen);
    venue.MakeWindow().setScreen(&screen);
    venue.Window->move(screen.geometry().topLeft() + QPoint(10, 30));
    venue.Window->FormLoad();
    Show(*venue.Window);
  }

  /// Opens a modal window by its menu item and looks at it.
  template <typename Window>
  void LookAt(const char* menuItem) {
    const WhileModal<Window> look([](Window& window) {
      ExpectCaredFor(window);
      window.close();
    });
    venue.Trigger(menuItem);
    EXPECT_EQ(look.Runs(), 1);
  }

  const Desktop desktop = std::get<Desktop>(GetParam());
  const FontOfSize font{desktop.Points};
  Venue venue{std::get<Language>(GetParam())};
};

TEST_P(Windows, AreCaredFor) {
  LookAt<About>("mnuAbout");
  LookAt<Settings>("mnuCommPort");
  LookAt<SoldieringCalc>("mnuSoldieringCalc");
  LookAt<AdminData>("mnuAdminData");
  LookAt<ExportGames>("mnuExport");
  LookAt<MemberHistoryWindow>("mnuMemberHistory");
  LookAt<RankingWindow>("mnuRankings");
  LookAt<ImportGames>("mnuImportGames");
  LookAt<AudienceSettings>("mnuAudienceSettings");
  LookAt<ResultsPage>("mnuResultsPage");
  LookAt<GuestNameEntry>("mnuGuestNames");
  LookAt<Scenarios>("mnuSetupMissions");
  LookAt<FirmwareFlash>("mnuFirmwareUpdate");
  LookAt<RemoteManage>("mnuRemoteManage");
  LookAt<BoxConfig>("mnuBoxConfig");
  LookAt<ChargeiButton>("mnuChargeiButton");
  LookAt<ISD_rec>("mnuSoundRecorder");
  LookAt<SystemCheck>("mnuSystemCheck");
  LookAt<TakeOver>("mnuTakeOver");
  venue.ActiveMission().setCurrentIndex(3);
  LookAt<MissionResultEntry>("mnuMissionResults");
}

TEST_P(Windows, OfTheMembersIsCaredForWithAndWithoutAMember) {
  LookAt<Members>("mnuManageMembers");
  venue.ChangeDatabase(
      "members.mdb",
      "INSERT INTO Members (DallasID, FirstName, LastName, DateJoined, LastPlayedDate, "
      "TotalGamesPlayed, TotalDamage, AverageDamage, TotalSoldiering, AverageSoldiering, "
      "AveragePrimAccuracy) VALUES ('EFCDAB8967452301', 'Ada', 'Byron', '2010-03-01 09:05:00', "
      "'2026-11-20 20:15:00', 1234, 123456.5, 1000.25, -123456, -1000.75, 1)");
  LookAt<Members>("mnuManageMembers");
}

TEST_P(Windows, OfFilesOfMembersAreCaredFor) {
  LookAt<ExportMembers>("mnuExportMembers");
  WriteFile(venue.Folder / "list.csv", "First name,Last name,Born\nAda,Byron,3/5/2001\nBo,Li,\n");
  venue.Dialog.Answers = {venue.Folder / "list.csv"};
  LookAt<ImportMembers>("mnuImportMembers");
}

TEST_P(Windows, OfAPlayerAreCaredFor) {
  venue.LoadGame(GameOfManyHits());
  const WhileModal<PlayerDetails> details([](PlayerDetails& window) {
    ExpectCaredFor(window);
    window.close();
  });
  venue.ChooseInPopup(0, "mnuShowDetailed");
  EXPECT_EQ(details.Runs(), 1);
  const WhileModal<BonusPoints> bonus([](BonusPoints& window) {
    ExpectCaredFor(window);
    window.close();
  });
  venue.ChooseInPopup(0, "mnuBonusPoints");
  EXPECT_EQ(bonus.Runs(), 1);
}

TEST_P(Windows, OfPastGamesIsCaredForWithAndWithoutGames) {
  LookAt<PastGames>("mnuPastGames");
  venue.LoadGame(GameOfManyHits());
  LookAt<PastGames>("mnuPastGames");
}

TEST_P(Windows, OfTheGuestsIsCaredFor) {
  venue.LoadGame(GameOfManyHits());
  LookAt<GuestNameEntry>("mnuGuestNames");
}

TEST_P(Windows, OfANewMissionIsCaredFor) {
  const WhileModal<Scenarios> editor([](Scenarios& window) {
    const WhileModal<MissionNameEntry> name([](MissionNameEntry& entry) {
      ExpectCaredFor(entry);
      entry.close();
    });
    ::Press(window, "NewButton");
    EXPECT_EQ(name.Runs(), 1);
    window.close();
  });
  venue.Trigger("mnuSetupMissions");
}

TEST_P(Windows, OfTheDownloadIsCaredFor) {
  UploadProgress progress(venue.Strings, venue.Window.get());
  progress.Open();
  progress.SetStatusText("Accepting Score Data...");
  progress.SetProgress(224);
  Show(progress);
  ExpectCaredFor(progress);
}

TEST_P(Windows, TheMainOneIsCaredForAtTheSmallestSize) {
  if (!venue.Window->isMaximized()) {
    venue.Window->resize(1024, 700);
  }
  venue.LoadGame(GameOfManyHits());
  ExpectCaredFor(*venue.Window);
  EXPECT_TRUE(venue.Window->isMaximized() || venue.Window->width() == 1024);
  auto& board = venue.Find<QTableView>("ScoreDisplay");
  EXPECT_GE(board.columnWidth(1), board.sizeHintForIndex(board.model()->index(0, 1)).width());
  EXPECT_FALSE(venue.Find<QTableView>("TeamScores").verticalScrollBar()->isVisible());
}

INSTANTIATE_TEST_SUITE_P(Looks, Windows,
                         testing::Combine(testing::Values(Language::English, Language::SimplifiedChinese),
                                          testing::ValuesIn(Desktops)),
                         [](const auto& look) {
                           const bool isEnglish = std::get<Language>(look.param) == Language::English;
                           return std::string(isEnglish ? "English" : "SimplifiedChinese") +
                                  std::get<Desktop>(look.param).Name;
                         });

}  // namespace
