#include "ui/Commands.h"

#include <gmock/gmock.h>

#include <QAction>
#include <QDialog>
#include <QLineEdit>
#include <QVBoxLayout>
#include <string>
#include <vector>

#include "platform/RuntimeError.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/Controls.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

/// A dialog with an entry and two buttons, "&Go" (pressed by Return, too) and "&Send".
class CommandDialog : public QDialog {
 public:
  explicit CommandDialog(MessageBoxes& boxes) : Table(*this, boxes) {
    auto* layout = new QVBoxLayout(this);
    for (QWidget* control : std::initializer_list<QWidget*>{&Entry, &Go, &Send}) {
      layout->addWidget(control);
    }
    addAction(&Menu);
    Go.setDefault(true);
    Send.setAutoDefault(false);
  }

  void reject() override {
    if (Table.MayClose()) {
      QDialog::reject();
    }
  }

  void LogOne() { Log.emplace_back("one"); }
  void LogTwo() { Log.emplace_back("two"); }

  std::vector<std::string> Log;
  QLineEdit Entry;
  QPushButton Go{QStringLiteral("&Go")};
  QPushButton Send{QStringLiteral("&Send")};
  QAction Menu;
  Commands Table;
};

class CommandTable : public testing::Test {
 protected:
  CommandTable() {
    Show(window);
    window.Entry.setFocus();
  }

  void OnGo(const std::function<void()>& command, WhileBusy whileBusy = WhileBusy::Run) {
    window.Table.Connect(window.Go, command, whileBusy);
  }

  static void Click(QPushButton& button) { QTest::mouseClick(&button, Qt::LeftButton); }

  /// Presses Alt and a letter, and waits until the button that was pressed by it is up again.
  void TypeAlt(Qt::Key key) {
    QTest::keyClick(&window.Entry, key, Qt::AltModifier);
    EXPECT_TRUE(QTest::qWaitFor([this] { return !window.Go.isDown() && !window.Send.isDown(); }));
  }

  FakeMessageBoxes boxes;
  CommandDialog window{boxes};
};

TEST_F(CommandTable, RunsTheCommandOfEachButtonAndAction) {
  window.Table.Connect(window,
                       {{&window.Go, &CommandDialog::LogOne}, {&window.Send, &CommandDialog::LogTwo}});
  window.Table.Connect(window, {{&window.Menu, &CommandDialog::LogTwo}});
  Click(window.Go);
  EXPECT_THAT(window.Log, ElementsAre("one"));
  Click(window.Send);
  window.Menu.trigger();
  EXPECT_THAT(window.Log, ElementsAre("one", "two", "two"));
}

TEST_F(CommandTable, ReportsAFailureAndGoesOn) {
  bool fails = true;
  OnGo([&] {
    if (fails) {
      throw RuntimeError(6);
    }
    window.LogOne();
  });
  Click(window.Go);
  EXPECT_THAT(boxes.Boxes, ElementsAre(FakeMessageBoxes::Box{"Run-time error '6': Overflow", "Tessarine",
                                                             BoxIcon::Critical, BoxButtons::Ok}));
  EXPECT_FALSE(window.Table.Running());
  fails = false;
  Click(window.Go);
  EXPECT_THAT(window.Log, ElementsAre("one"));
  EXPECT_EQ(boxes.Boxes.size(), 1U);
}

TEST_F(CommandTable, LetsEscapePressTheButtonThatEndsTheWindow) {
  window.Table.Connect(window, {{&window.Send, &CommandDialog::LogOne}});
  window.Table.EscapePresses(window.Send);
  QTest::keyClick(&window.Entry, Qt::Key_Escape);
  EXPECT_THAT(window.Log, ElementsAre("one"));
  EXPECT_TRUE(window.isVisible());
  EXPECT_TRUE(window.Send.hasFocus());
}

TEST_F(CommandTable, LetsEscapeDoNothingWhileACommandRuns) {
  window.Table.Connect(window, {{&window.Send, &CommandDialog::LogOne}});
  window.Table.EscapePresses(window.Send);
  window.Table.Run([this] { QTest::keyClick(&window, Qt::Key_Escape); });
  EXPECT_THAT(window.Log, IsEmpty());
  EXPECT_TRUE(window.isVisible());
}

TEST_F(CommandTable, LetsAFailedCheckStopEscape) {
  window.Table.Connect(window, {{&window.Send, &CommandDialog::LogOne}});
  window.Table.EscapePresses(window.Send);
  window.Table.EntriesHold = [] { return false; };
  QTest::keyClick(&window.Entry, Qt::Key_Escape);
  EXPECT_THAT(window.Log, IsEmpty());
}

TEST_F(CommandTable, TellsWhetherACommandFailed) {
  EXPECT_TRUE(window.Table.Run([] {}));
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  EXPECT_FALSE(window.Table.Run([] { throw RuntimeError(53); }));
  EXPECT_EQ(boxes.Boxes.size(), 1U);
}

TEST_F(CommandTable, ClosesAtOnceWhileNothingRuns) {
  window.close();
  EXPECT_FALSE(window.isVisible());
}

TEST_F(CommandTable, ClosesOnceTheLastCommandHasUnwound) {
  int ended = 0;
  window.Table.EndWaits = [&] { ++ended; };
  window.Table.Run([&] {
    window.Table.Run([&] {
      window.close();
      EXPECT_TRUE(window.isVisible());
      EXPECT_TRUE(window.Table.CloseRequested());
      EXPECT_EQ(ended, 1);
    });
    EXPECT_TRUE(window.isVisible());
    EXPECT_TRUE(window.Table.CloseRequested());
  });
  EXPECT_FALSE(window.isVisible());
  EXPECT_EQ(ended, 1);
}

TEST_F(CommandTable, ClosesLateAlsoWhenTheCommandFails) {
  window.Table.Run([&] {
    window.close();
    throw RuntimeError(8020);
  });
  EXPECT_FALSE(window.isVisible());
  EXPECT_EQ(boxes.Boxes.size(), 1U);
}

TEST_F(CommandTable, IsLikeNewWhenTheWindowComesUpAgainAfterALateClose) {
  window.Table.Run([&] { window.close(); });
  Show(window);
  window.Table.Run([&] { EXPECT_FALSE(window.Table.CloseRequested()); });
  EXPECT_TRUE(window.isVisible());
}

TEST_F(CommandTable, TellsThatAllHaveUnwoundOnceForEachOutermostCommandAndBeforeALateClose) {
  int told = 0;
  window.Table.AllUnwound = [&] {
    ++told;
    EXPECT_FALSE(window.Table.Running());
    EXPECT_TRUE(window.isVisible());
  };
  window.Table.Run([&] { window.Table.Run([] {}); });
  EXPECT_EQ(told, 1);
  window.Table.Run([&] { window.close(); });
  EXPECT_EQ(told, 2);
  EXPECT_FALSE(window.isVisible());
}

TEST_F(CommandTable, RunsACommandOnTopOfAnotherOnlyWhereThatIsWanted) {
  OnGo([this] { window.LogOne(); });
  window.Table.Connect(
      window.Send, [this] { window.LogTwo(); }, WhileBusy::Ignore);
  window.Table.Run([this] {
    Click(window.Go);
    Click(window.Send);
  });
  EXPECT_THAT(window.Log, ElementsAre("one"));
  Click(window.Send);
  EXPECT_THAT(window.Log, ElementsAre("one", "two"));
}

TEST_F(CommandTable, GivesAButtonTheFocusBeforeItsCommandHoweverItIsPressed) {
  int runs = 0;
  OnGo([&] {
    ++runs;
    EXPECT_TRUE(window.Go.hasFocus()) << runs;
  });
  const std::function<void()> presses[] = {[this] { Click(window.Go); },
                                           [this] { Type(window, Qt::Key_Return); },
                                           [this] { TypeAlt(Qt::Key_G); }, [this] { window.Go.click(); }};
  for (const auto& press : presses) {
    window.Entry.setFocus();
    press();
  }
  EXPECT_EQ(runs, 4);
}

TEST_F(CommandTable, StopsACommandWhoseButtonTookTheFocusFromAnEntryThatKeepsIt) {
  bool holds = false;
  int asked = 0;
  window.Table.EntriesHold = [&] {
    ++asked;
    if (!holds) {
      window.Entry.setFocus();
    }
    return holds;
  };
  OnGo([this] { window.LogOne(); });
  const std::function<void()> presses[] = {
      [this] { Click(window.Go); }, [this] { Type(window, Qt::Key_Return); }, [this] { TypeAlt(Qt::Key_G); }};
  for (const auto& press : presses) {
    window.Entry.setFocus();
    press();
    EXPECT_TRUE(window.Entry.hasFocus());
  }
  EXPECT_EQ(asked, 3);
  EXPECT_THAT(window.Log, IsEmpty());
  holds = true;
  for (const auto& press : presses) {
    window.Entry.setFocus();
    press();
  }
  EXPECT_EQ(window.Log.size(), 3U);
}

TEST_F(CommandTable, LetsAnEntryKnowThatItIsLeftAlsoByAScreenReader) {
  int finished = 0;
  QObject::connect(&window.Entry, &QLineEdit::editingFinished, &window, [&] { ++finished; });
  OnGo([&] { EXPECT_EQ(finished, 1); });
  QTest::keyClicks(&window.Entry, QStringLiteral("typed"));
  window.Go.click();
  EXPECT_EQ(finished, 1);
}

TEST_F(CommandTable, AsksNoEntryAboutAPressThroughAScreenReader) {
  window.Table.EntriesHold = [] { return false; };
  OnGo([this] { window.LogOne(); });
  window.Go.click();
  EXPECT_THAT(window.Log, ElementsAre("one"));
}

}  // namespace
