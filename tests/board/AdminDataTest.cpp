#include "board/AdminData.h"

#include <gmock/gmock.h>

#include <QClipboard>
#include <QTableWidget>

#include "tests/support/Captions.h"
#include "tests/support/WhileModal.h"

namespace {

class Admin : public testing::Test {
 protected:
  void Open(const std::function<void(AdminData&, QTableWidget&)>& look) {
    const WhileModal<AdminData> open([&](AdminData& window) {
      look(window, ::Find<QTableWidget>(window, "AdminData"));
      ::Press(window, "Command1");
      EXPECT_FALSE(window.isVisible());
    });
    AdminData(game, strings, nullptr).exec();
    EXPECT_EQ(open.Runs(), 1);
  }

  const StringTable strings{Language::English};
  Game game{strings};
};

TEST_F(Admin, ListsRunTimeAndKillsOfAllGuns) {
  game.Players(2).RunCounter = 125;
  game.Players(2).AdminKillCount = 3;
  Open([](AdminData& window, QTableWidget& list) {
    EXPECT_EQ(window.windowTitle(), QStringLiteral("Administration Data"));
    ASSERT_EQ(list.rowCount(), 224);
    EXPECT_EQ(list.horizontalHeaderItem(1)->text(), QStringLiteral("Run Time"));
    EXPECT_EQ(list.item(0, 0)->text(), QStringLiteral("Red  0"));
    EXPECT_EQ(list.item(0, 1)->text(), QStringLiteral(" 0H  0M"));
    EXPECT_EQ(list.item(1, 1)->text(), QStringLiteral(" 2H  5M"));
    EXPECT_EQ(list.item(1, 2)->text(), QStringLiteral("3"));
    EXPECT_EQ(list.item(223, 0)->text(), QStringLiteral("Blue  95"));
  });
}

TEST_F(Admin, HasItsCaptions) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    const StringTable texts(language);
    const Game empty(texts);
    const AdminData window(empty, texts, nullptr);
    const bool english = language == Language::English;
    EXPECT_EQ(window.windowTitle(),
              english ? QStringLiteral("Administration Data") : QStringLiteral("管理数据"));
    ExpectCaptions(window, {{"Command1", english ? "Close" : "关闭"}});
    const auto& list = ::Find<QTableWidget>(window, "AdminData");
    const QStringList headers =
        english
            ? QStringList{QStringLiteral("Player"), QStringLiteral("Run Time"), QStringLiteral("Admin Kills")}
            : QStringList{QStringLiteral("玩家"), QStringLiteral("运行时间"), QStringLiteral("管理员击杀")};
    ASSERT_EQ(list.columnCount(), 3);
    for (int column = 0; column < 3; ++column) {
      EXPECT_EQ(list.horizontalHeaderItem(column)->text(), headers[column]);
    }
  }
}

TEST_F(Admin, HasItsCaptionsAboveTheirFigures) {
  Open([](AdminData& /*window*/, QTableWidget& list) {
    for (int column = 0; column < 3; ++column) {
      EXPECT_EQ(list.horizontalHeaderItem(column)->textAlignment(), list.item(0, column)->textAlignment());
    }
  });
}

TEST_F(Admin, CopiesTheSelectedRowsAsTextWithTabs) {
  Open([](AdminData& window, QTableWidget& list) {
    Show(window);
    list.selectRow(1);
    QTest::keyClick(&list, Qt::Key_C, Qt::ControlModifier);
    EXPECT_EQ(QGuiApplication::clipboard()->text(),
              QStringLiteral("Player\tRun Time\tAdmin Kills\nRed  1\t 0H  0M\t0\n"));
    list.clearSelection();
    ::Press(window, "CopyButton");
    EXPECT_EQ(QGuiApplication::clipboard()->text().count(QLatin1Char('\n')), 225);
  });
}

}  // namespace
