// F1 in the windows of the program, as they open.

#include <QListWidget>
#include <algorithm>

#include "app/UploadProgress.h"
#include "manual/ManualWindow.h"
#include "missions/MissionNameEntry.h"
#include "sheets/SheetProgressWindow.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

/// Title of a page in both editions.
struct PageTitle {
  const char* English;
  const char* Chinese;
};

/// Title of the page that the manual shows.
std::string PageShown() {
  for (const QWidget* window : QApplication::topLevelWidgets()) {
    if (qobject_cast<const ManualWindow*>(window) != nullptr && window->isVisible()) {
      return Find<QListWidget>(*window, "Pages").currentItem()->text().toStdString();
    }
  }
  return "none";
}

class ManualKeyIn : public testing::TestWithParam<Language> {
 protected:
  ManualKeyIn() { venue.Start(); }

  static void ExpectPage(QWidget& window, const PageTitle& page) {
    QWidget* focus = window.focusWidget();
    QTest::keyClick(focus != nullptr ? focus : &window, Qt::Key_F1);
    EXPECT_EQ(PageShown(), GetParam() == Language::English ? page.English : page.Chinese)
        << window.objectName().toStdString();
  }

  /// Presses the key in the window that `open` opens, and closes it.
  static void ExpectPage(const std::function<void()>& open, const PageTitle& page) {
    const WhileModal<QDialog> look([&page](QDialog& window) {
      ExpectPage(window, page);
      window.close();
    });
    open();
    EXPECT_EQ(look.Runs(), 1) << page.English;
  }

  Venue venue{GetParam()};
};

TEST_P(ManualKeyIn, EachWindowOpensItsPage) {
  ExpectPage(*venue.Window, {"An evening with Tessarine", "使用 Tessarine 的一晚"});
  venue.ActiveMission().setCurrentIndex(3);
  const std::pair<const char*, PageTitle> windows[] = {
      {"mnuPrintScores", {"Score sheets", "成绩单"}},
      {"mnuAdminData", {"Administration data", "管理数据"}},
      {"mnuExport", {"Export", "导出"}},
      {"mnuImportGames", {"Past games", "历史比赛"}},
      {"mnuMissionResults", {"Mission results", "任务结果"}},
      {"mnuSetupMissions", {"Missions", "任务"}},
      {"mnuManageMembers", {"Members", "会员"}},
      {"mnuExportMembers", {"Members", "会员"}},
      {"mnuRemoteManage", {"Remote management", "远程管理"}},
      {"mnuBoxConfig", {"Utility boxes", "功能装置"}},
      {"mnuChargeiButton", {"Charging buttons", "信息扣充值"}},
      {"mnuFirmwareUpdate", {"Firmware", "固件"}},
      {"mnuSoundRecorder", {"Sound recorder", "声音录制"}},
      {"mnuBackupCopies", {"Backup copies", "备份副本"}},
      {"mnuTakeOver", {"Files from an old installation", "旧安装的文件"}},
      {"mnuCommPort", {"Settings", "设置"}},
      {"mnuSoldieringCalc", {"Soldiering calculation", "战功计算"}},
      {"mnuGuestNames", {"Audience board", "观众大屏"}},
      {"mnuAudienceSettings", {"Audience board", "观众大屏"}},
      {"mnuAbout", {"If you need help", "需要帮助时"}}};
  for (const auto& [item, page] : windows) {
    ExpectPage([this, item = item] { venue.Trigger(item); }, page);
  }
}

TEST_P(ManualKeyIn, TheWindowsAboutAPlayerOpensTheirPages) {
  venue.LoadGame(GameOfManyHits());
  ExpectPage([this] { venue.ChooseInPopup(0, "mnuShowDetailed"); }, {"Player details", "玩家详情"});
  ExpectPage([this] { venue.ChooseInPopup(0, "mnuBonusPoints"); }, {"Bonus points", "奖励分"});
}

TEST_P(ManualKeyIn, TheChartsOpenTheirPage) {
  venue.Trigger("mnuGameCharts");
  const QWidgetList windows = QApplication::topLevelWidgets();
  const auto charts = std::find_if(windows.begin(), windows.end(), [](const QWidget* window) {
    return window->objectName() == QStringLiteral("GameCharts") && window->isVisible();
  });
  ASSERT_NE(charts, windows.end());
  Show(**charts);
  ExpectPage(**charts, {"Game charts", "比赛图表"});
}

TEST_P(ManualKeyIn, AWindowOfAWindowOpensItsPage) {
  const WhileModal<QDialog> editor([](QDialog& window) {
    const WhileModal<MissionNameEntry> name([](MissionNameEntry& entry) {
      ExpectPage(entry, {"Missions", "任务"});
      entry.close();
    });
    ::Press(window, "NewButton");
    EXPECT_EQ(name.Runs(), 1);
    window.close();
  });
  venue.Trigger("mnuSetupMissions");
  EXPECT_EQ(editor.Runs(), 1);
}

TEST_P(ManualKeyIn, AWindowOfProgressOpensItsPage) {
  SheetProgressWindow sheets(venue.Strings, venue.Window.get());
  sheets.Open();
  ExpectPage(sheets, {"Score sheets", "成绩单"});
}

// It leaves the keyboard to the main window.
TEST_P(ManualKeyIn, TheMainWindowOpensThePageOfTheDownloadInFrontOfIt) {
  UploadProgress progress(venue.Strings, venue.Window.get());
  progress.Open();
  venue.Window->activateWindow();
  ExpectPage(*venue.Window, {"The download", "下载"});
  progress.Close();
  ExpectPage(*venue.Window, {"An evening with Tessarine", "使用 Tessarine 的一晚"});
}

INSTANTIATE_TEST_SUITE_P(Editions, ManualKeyIn,
                         testing::Values(Language::English, Language::SimplifiedChinese),
                         [](const auto& test) {
                           return std::string(test.param == Language::English ? "English" : "Chinese");
                         });

}  // namespace
