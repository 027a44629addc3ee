#include "board/AdminData.h"

#include <gmock/gmock.h>

#include <QClipboard>
#include <QTableWidget>

#include "tests/support/Venue.h"
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
    venue.Trigger("mnuAdminData");
    EXPECT_EQ(open.Runs(), 1);
  }

  Venue venue;
};

TEST_F(Admin, ListsRunTimeAndKillsOfAllGuns) {
  venue.Start();
  venue.LoadGame(GameFile(PlayerOf(2, "<RunCounter>125</RunCounter><AdminKillCount>3</AdminKillCount>")));
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

TEST_F(Admin, CopiesTheSelectedRowsAsTextWithTabs) {
  venue.Start();
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
