#include <gmock/gmock.h>

#include <QAbstractItemView>
#include <QCheckBox>
#include <QMouseEvent>

#include "board/MissionResultEntry.h"
#include "sheets/PrintOptions.h"
#include "tests/support/Frames.h"
#include "tests/support/Venue.h"
#include "tests/support/WhileModal.h"
#include "ui/AltLetters.h"

namespace {

using testing::HasSubstr;

/// What the operator does after each game: the evening has forty of them.
class CommonRound : public testing::Test {
 protected:
  CommonRound() {
    qApp->installEventFilter(&letters);
    venue.PutDefaultFiles();
    venue.ChangeDatabase("scenarios.mdb",
                         "DELETE FROM Table1; INSERT INTO Table1 (ID, MissionName, PrimaryObjectivePointsA, "
                         "SecondaryObjectivePointsB) VALUES (4, 'Bridge', 10, 20)");
    venue.ChangeDatabase("members.mdb",
                         "DELETE FROM Members; INSERT INTO Members (ContactID, NickName, DallasID) VALUES"
                         " (7, 'Mole', '0807060504030201')");
    venue.Start();
    // Each box is closed by Return, and the file dialog by Return on the name that it suggests.
    venue.Boxes.WhileOpen = [this](const auto& /*box*/) { ++answered; };
    venue.Dialog.WhileOpen = [this] {
      ++answered;
      venue.Dialog.Answers = {venue.Folder / venue.Dialog.Calls.back().Name};
    };
    venue.Boxes.Answers = std::deque<BoxAnswer>(10, BoxAnswer::Ok);
    PutUnit();
  }

  /// As window managers do for the window that is left when another closes.
  static void BringToFront(QWidget& window) {
    if (QApplication::activePopupWidget() == nullptr) {
      window.activateWindow();
      ASSERT_TRUE(QTest::qWaitFor([&] { return QApplication::activeWindow() == window.window(); }));
    }
  }

  /// Presses a key where the keyboard's focus is in `window`.
  void Key(QWidget& window, Qt::Key key, Qt::KeyboardModifiers modifiers = {}) {
    ++keys;
    BringToFront(window);
    Type(window, key, modifiers);
  }
  void Key(Qt::Key key, Qt::KeyboardModifiers modifiers = {}) { Key(*venue.Window, key, modifiers); }

  /// Presses Alt and the letter of a control.
  void AltKey(QWidget& window, const std::string& control) {
    const QString text = ::Find<QWidget>(window, control).property("text").toString();
    const auto mark = text.indexOf(u'&');
    ASSERT_GE(mark, 0) << control;
    Key(window, static_cast<Qt::Key>(text.at(mark + 1).toUpper().unicode()), Qt::AltModifier);
  }

  /// Printed, committed and saved, but still on the board.
  void ExpectOneRoundWasKept() {
    EXPECT_EQ(venue.RowCount("ScoreDisplay"), 1);
    EXPECT_EQ(venue.Word.Documents.size(), 1U);
    EXPECT_EQ(venue.QueryDatabase("members.mdb", "SELECT TotalGamesPlayed FROM Members"), "1");
    ASSERT_EQ(venue.Dialog.Calls.size(), 1U);
    const std::string file = ReadFile(venue.Folder / venue.Dialog.Calls.back().Name);
    EXPECT_THAT(file, HasSubstr("<MissionName>Bridge</MissionName>"));
    EXPECT_THAT(file, HasSubstr("<PrimaryObjectiveAchieved>1</PrimaryObjectiveAchieved>"));
    EXPECT_THAT(file, HasSubstr("<SecondryObjectiveAchieved>1</SecondryObjectiveAchieved>"));
    EXPECT_THAT(file, HasSubstr("<Committed>1</Committed>"));
    for (const char* ticked : {"BarResults", "BarPrint", "BarCommit", "BarSave"}) {
      EXPECT_EQ(venue.Find<QWidget>(ticked).accessibleDescription(), QStringLiteral("Done")) << ticked;
    }
  }

  AltLetters letters;
  Venue venue;
  int keys = 0;
  int answered = 0;  ///< boxes and file dialogs, each with one key or click

 private:
  void PutUnit() {
    venue.Port.OnOutput = [this](std::uint8_t byte) {
      if (byte == 0) {
        venue.Port.Receive({1});
        venue.Port.Receive(FrameOfRed1());
      }
    };
  }
};

/// With the mouse: a click for each box, and one for the file dialog's button.
TEST_F(CommonRound, TakesAtMostSixteenClicks) {
  int clicks = 0;
  const auto click = [&clicks](QWidget& control, const QPoint& place = {}) {
    ++clicks;
    BringToFront(control);
    QTest::mouseClick(&control, Qt::LeftButton, {}, place);
  };
  const auto clickIn = [&click](QWidget& window, const char* name) { click(::Find<QWidget>(window, name)); };
  const auto clickBox = [&click](QWidget& window, const char* name) {
    auto& box = ::Find<QCheckBox>(window, name);
    click(box, QPoint(box.height() / 2, box.height() / 2));
  };
  clickIn(*venue.Window, "GetScores");
  click(venue.ActiveMission());
  QAbstractItemView& missions = *venue.ActiveMission().view();
  ASSERT_TRUE(missions.isVisible());
  const QPoint bridge = missions.visualRect(missions.model()->index(2, 0)).center();
  // Without a move the list takes the next click for the second one of a double click.
  QMouseEvent move(QEvent::MouseMove, bridge, missions.viewport()->mapToGlobal(bridge), Qt::NoButton,
                   Qt::NoButton, Qt::NoModifier);
  QApplication::sendEvent(missions.viewport(), &move);
  click(*missions.viewport(), bridge);
  ASSERT_EQ(venue.ActiveMission().currentText(), QStringLiteral("Bridge"));
  const WhileModal<MissionResultEntry> results([&](MissionResultEntry& window) {
    clickBox(window, "PrimaryCompleted1");
    clickBox(window, "SecondaryCompleted2");
    clickIn(window, "OK");
  });
  clickIn(*venue.Window, "BarResults");
  const WhileModal<PrintOptions> print([&](PrintOptions& window) { clickIn(window, "OK"); });
  clickIn(*venue.Window, "BarPrint");
  ASSERT_EQ(results.Runs() + print.Runs(), 2);
  clickIn(*venue.Window, "BarCommit");
  clickIn(*venue.Window, "BarSave");
  ExpectOneRoundWasKept();
  clickIn(*venue.Window, "BarClear");
  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 0);
  EXPECT_LE(clicks + answered, 16);
}

TEST_F(CommonRound, TakesAtMostEighteenKeysAndNoTyping) {
  Key(Qt::Key_F5);
  ASSERT_EQ(venue.RowCount("ScoreDisplay"), 1);

  AltKey(*venue.Window, "ActiveMissionLabel");
  Key(Qt::Key_B);
  Key(*venue.ActiveMission().view(), Qt::Key_Return);
  ASSERT_EQ(venue.ActiveMission().currentText(), QStringLiteral("Bridge"));

  const WhileModal<MissionResultEntry> results([this](MissionResultEntry& window) {
    AltKey(window, "PrimaryCompleted1");
    AltKey(window, "SecondaryCompleted2");
    Key(window, Qt::Key_Return);
  });
  Key(Qt::Key_R, Qt::ControlModifier);
  ASSERT_EQ(results.Runs(), 1);

  const WhileModal<PrintOptions> print([this](PrintOptions& window) { Key(window, Qt::Key_Return); });
  Key(Qt::Key_P, Qt::ControlModifier);
  ASSERT_EQ(print.Runs(), 1);
  Key(Qt::Key_M, Qt::ControlModifier);
  Key(Qt::Key_S, Qt::ControlModifier);
  ExpectOneRoundWasKept();
  Key(Qt::Key_L, Qt::ControlModifier);

  EXPECT_EQ(venue.RowCount("ScoreDisplay"), 0);
  EXPECT_LE(keys + answered, 18);
}

}  // namespace
