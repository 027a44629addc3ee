// System Check as the main window opens it.

#include <gmock/gmock.h>

#include <QPushButton>
#include <QTableWidget>
#include <QTimer>
#include <QToolButton>

#include "check/SystemCheck.h"
#include "tests/support/Venue.h"

namespace {

using testing::IsEmpty;

class SystemCheckCommand : public testing::Test {
 protected:
  SystemCheckCommand() : venue(Language::English, Waits::Real) {}

  /// Opens the window by `open` and waits until its check has ended; the texts of its third column.
  std::vector<std::string> TextsOf(const std::function<void()>& open) {
    std::vector<std::string> texts;
    // Not from a wait of its own, which would keep the check waiting.
    QTimer timer;
    QObject::connect(&timer, &QTimer::timeout, &timer, [&] {
      auto* window = qobject_cast<SystemCheck*>(QApplication::activeModalWidget());
      if (window == nullptr || !Find<QPushButton>(*window, "CopyReport").isEnabled()) {
        return;
      }
      timer.stop();
      auto& table = Find<QTableWidget>(*window, "CheckTable");
      for (int row = 0; row < table.rowCount(); ++row) {
        texts.push_back(table.item(row, 2)->text().toStdString());
      }
      window->close();
    });
    timer.start(10);
    open();
    return texts;
  }
  QToolButton* Link() const {
    return venue.Window->findChild<QToolButton*>(QStringLiteral("SystemCheckLink"));
  }

  Venue venue;
};

TEST_F(SystemCheckCommand, LooksAtTheProgramsOwnData) {
  venue.Start();
  venue.ChangeDatabase("members.mdb", "INSERT INTO Members (FirstName, LastName) VALUES ('Ada', 'Byron')");
  const std::vector<std::string> texts = TextsOf([this] { venue.Trigger("mnuSystemCheck"); });
  EXPECT_THAT(texts, testing::Contains("/dev/ttyS0"));
  EXPECT_THAT(texts, testing::Contains("Port 1 is /dev/ttyS0"));
  EXPECT_THAT(texts, testing::Contains("1 rows, last copy: none yet"));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(SystemCheckCommand, IsOfferedOnTheStatusLineOnlyAfterAFailure) {
  venue.Start();
  EXPECT_EQ(Link(), nullptr);
  venue.Window->PointToSystemCheck();
  ASSERT_NE(Link(), nullptr);
  EXPECT_TRUE(Link()->isVisible());
  EXPECT_THAT(TextsOf([this] { Link()->click(); }), testing::Not(IsEmpty()));
  EXPECT_THAT(venue.Boxes.Boxes, IsEmpty());
}

TEST_F(SystemCheckCommand, IsNoLongerOfferedOnceItWasOpened) {
  venue.Start();
  venue.Window->PointToSystemCheck();
  TextsOf([this] { Link()->click(); });
  EXPECT_FALSE(Link()->isVisible());
}

TEST_F(SystemCheckCommand, IsOfferedAfterACommandThatFailed) {
  venue.Start();
  venue.Dialog.Answers = {venue.Folder / "missing/Monday.game.xml"};
  venue.Trigger("mnuSaveScores");
  ASSERT_EQ(venue.Boxes.Boxes.size(), 1U);
  ASSERT_NE(Link(), nullptr);
  EXPECT_TRUE(Link()->isVisible());
}

TEST_F(SystemCheckCommand, LooksAtTheDatabaseInPlaceOfADamagedOne) {
  venue.PutDefaultFiles();
  WriteFile(venue.DataFile("members.mdb"), "no database");
  venue.Boxes.Answers = {BoxAnswer::Ok};
  venue.Start();
  const std::vector<std::string> texts = TextsOf([this] { venue.Trigger("mnuSystemCheck"); });
  EXPECT_THAT(texts, testing::Contains("0 rows, last copy: none yet"));
  EXPECT_THAT(texts, testing::Contains(testing::HasSubstr("so members-new.mdb is in use")));
}

TEST_F(SystemCheckCommand, IsOfferedAfterADownloadThatFailed) {
  venue.Start();
  venue.Port.FailNextOpen(8005);
  venue.Boxes.Answers = {BoxAnswer::Cancel};
  venue.Press("GetScores");
  ASSERT_NE(Link(), nullptr);
  EXPECT_TRUE(Link()->isVisible());
}

}  // namespace
