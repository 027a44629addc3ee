// System Check as the main window opens it.

#include <gmock/gmock.h>

#include <QPushButton>
#include <QRadioButton>
#include <QTableWidget>
#include <QTimer>
#include <QToolButton>

#include "check/SystemCheck.h"
#include "sheets/PrintOptions.h"
#include "tests/support/TestDatabase.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"

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
  bool IsOffered() const { return Link() != nullptr && Link()->isVisible(); }
  /// Prints the sheets of a game, each of them into a file.
  void PrintSheets() {
    venue.LoadGame(SmallGame());
    const WhileModal<PrintOptions> choose([](PrintOptions& window) {
      Find<QRadioButton>(window, "PrintFile").setChecked(true);
      window.accept();
    });
    venue.Trigger("mnuPrintScores");
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
  EXPECT_TRUE(IsOffered());
}

TEST_F(SystemCheckCommand, IsOfferedAfterALineThatWasLostInADownload) {
  venue.Start();
  venue.Port.FailOutput(8012);
  venue.Press("GetScores");
  ASSERT_THAT(venue.Boxes.Boxes, testing::SizeIs(1));
  EXPECT_EQ(venue.Boxes.Boxes[0].Text, "Error occured sending data. Please try again.");
  EXPECT_TRUE(IsOffered());
}

TEST_F(SystemCheckCommand, IsOfferedAfterSheetsThatFailed) {
  for (const char* operation : {"Add ", "SetBookmark", "SaveAs"}) {
    venue.Start();
    venue.Word.FailAt = operation;
    venue.Boxes.Boxes.clear();
    PrintSheets();
    ASSERT_THAT(venue.Boxes.Boxes, testing::SizeIs(1)) << operation;
    EXPECT_EQ(venue.Boxes.Boxes[0].Title, "Print Error");
    EXPECT_TRUE(IsOffered()) << operation;
    venue.Window.reset();
    venue.Word.FailAt.clear();
  }
}

TEST_F(SystemCheckCommand, IsNotOfferedAfterSheetsThatWereMade) {
  venue.Start();
  PrintSheets();
  EXPECT_THAT(venue.Boxes.Boxes, testing::SizeIs(1));
  EXPECT_FALSE(IsOffered());
}

TEST_F(SystemCheckCommand, IsOfferedWhenTheWordProcessorIsMissing) {
  venue.Word.FailAt = "Start";
  venue.Start();
  EXPECT_TRUE(QTest::qWaitFor([this] { return IsOffered(); }, 10000));
  EXPECT_THAT(venue.Boxes.Boxes, testing::SizeIs(1));
}

TEST_F(SystemCheckCommand, IsOfferedAfterACommitIntoALockedDatabase) {
  venue.PutDefaultFiles();
  venue.ChangeDatabase("members.mdb", "INSERT INTO Members (ContactID, FirstName) VALUES (4, 'Ada')");
  venue.Start();
  venue.LoadGame(GameFile(PlayerOf(1, "<MemberIndex>4</MemberIndex>")));
  OtherConnection other(venue.DataFile("members.mdb"));
  other.Execute("BEGIN IMMEDIATE");
  venue.Trigger("mnuCommitGame");
  ASSERT_THAT(venue.Boxes.Boxes, testing::SizeIs(1));
  EXPECT_EQ(venue.Boxes.Boxes[0].Title, "Database Error");
  EXPECT_TRUE(IsOffered());
}

TEST_F(SystemCheckCommand, IsOfferedAfterAStartWithADamagedDatabase) {
  venue.PutDefaultFiles();
  WriteFile(venue.DataFile("members.mdb"), "no database");
  venue.Boxes.Answers = {BoxAnswer::Ok};
  venue.Start();
  ASSERT_THAT(venue.Boxes.Boxes, testing::SizeIs(1));
  EXPECT_TRUE(IsOffered());
}

TEST_F(SystemCheckCommand, IsNotOfferedWhereNothingFailed) {
  venue.Start();
  venue.LoadGame("no game");
  ASSERT_THAT(venue.Boxes.Boxes, testing::SizeIs(1));
  EXPECT_FALSE(IsOffered());
}

}  // namespace
