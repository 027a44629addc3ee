#include <QAbstractButton>
#include <QLabel>
#include <QLineEdit>
#include <QTableView>
#include <functional>
#include <tuple>

#include "board/AdminData.h"
#include "devices/radio/RemoteManage.h"
#include "members/DatePicker.h"
#include "members/Members.h"
#include "sheets/SheetProgressWindow.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

namespace {

/// What the windows say beyond the numbered captions, in the language of the system.
class OwnTexts : public testing::TestWithParam<Language> {
 protected:
  template <typename Window>
  void LookAt(const char* menuItem, const std::function<void(Window&)>& look) {
    const WhileModal<Window> open([&look](Window& window) {
      look(window);
      window.close();
    });
    venue.Trigger(menuItem);
    EXPECT_EQ(open.Runs(), 1);
  }

  QString In(const QString& english, const QString& chinese) const {
    return GetParam() == Language::English ? english : chinese;
  }

  Venue venue{GetParam()};
};

TEST_P(OwnTexts, NameTheArrowsAndEntriesOfTheMembers) {
  venue.Start();
  LookAt<Members>("mnuManageMembers", [this](Members& window) {
    const std::tuple<const char*, QString> arrows[] = {
        {"DataFirst", In(QStringLiteral("First member"), QStringLiteral("第一位会员"))},
        {"DataPrevious", In(QStringLiteral("Previous member"), QStringLiteral("上一位会员"))},
        {"DataNext", In(QStringLiteral("Next member"), QStringLiteral("下一位会员"))},
        {"DataLast", In(QStringLiteral("Last member"), QStringLiteral("最后一位会员"))}};
    for (const auto& [name, text] : arrows) {
      EXPECT_EQ(Find<QAbstractButton>(window, name).toolTip(), text);
      EXPECT_EQ(Find<QAbstractButton>(window, name).accessibleName(), text);
    }
    EXPECT_EQ(Find<QLineEdit>(window, "SearchText").placeholderText(),
              In(QStringLiteral("Name"), QStringLiteral("姓名")));
    EXPECT_EQ(Find<QWidget>(window, "MemberPhoto").accessibleName(),
              In(QStringLiteral("Photo"), QStringLiteral("照片")));
    EXPECT_EQ(Find<DatePicker>(window, "DOBPicker").findChild<QAbstractButton*>()->accessibleName(),
              In(QStringLiteral("Calendar"), QStringLiteral("日历")));
  });
}

TEST_P(OwnTexts, NameTheCopyButtonAndTheListOfGuns) {
  venue.Start();
  LookAt<AdminData>("mnuAdminData", [this](AdminData& window) {
    EXPECT_EQ(Find<QAbstractButton>(window, "CopyButton").text(),
              In(QStringLiteral("Copy"), QStringLiteral("复制")));
  });
  LookAt<RemoteManage>("mnuRemoteManage", [this](RemoteManage& window) {
    EXPECT_EQ(Find<QTableView>(window, "DataList").accessibleName(),
              In(QStringLiteral("Guns"), QStringLiteral("枪支")));
  });
}

TEST_P(OwnTexts, TellHowFarARunOfSheetsIs) {
  const StringTable strings(GetParam());
  SheetProgressWindow window(strings, nullptr);
  window.Open();
  const auto& label = Find<QLabel>(window, "SheetLabel");
  EXPECT_EQ(Find<QAbstractButton>(window, "Stop").text(), In(QStringLiteral("Stop"), QStringLiteral("停止")));
  EXPECT_EQ(label.text(),
            In(QStringLiteral("Starting the word processor..."), QStringLiteral("正在启动文字处理程序……")));
  window.ShowSheet(3, 40, "Ada");
  EXPECT_EQ(label.text(), In(QStringLiteral("Sheet 3 of 40"), QStringLiteral("第 3 张，共 40 张")));
  window.reject();
  EXPECT_EQ(label.text(),
            In(QStringLiteral("Stopping after this sheet..."), QStringLiteral("完成本张后停止……")));
  window.Close();
}

INSTANTIATE_TEST_SUITE_P(Languages, OwnTexts, testing::Values(Language::English, Language::SimplifiedChinese),
                         [](const auto& language) {
                           return language.param == Language::English ? "English" : "SimplifiedChinese";
                         });

}  // namespace
