#include "ui/EntryChecks.h"

#include <gmock/gmock.h>

#include <QApplication>
#include <QDialog>
#include <QFocusEvent>
#include <QLineEdit>
#include <QVBoxLayout>

#include "platform/RuntimeError.h"
#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/Controls.h"
#include "ui/Commands.h"

namespace {

using testing::ElementsAre;
using testing::IsEmpty;

/// Two entries that hold no more than three letters, one without a check, and buttons, of which Cancel never
/// checks.
class CheckedDialog : public QDialog {
 public:
  explicit CheckedDialog(MessageBoxes& boxes) : Table(*this, boxes), Checks(Table, boxes) {
    auto* layout = new QVBoxLayout(this);
    for (QWidget* control : std::initializer_list<QWidget*>{&First, &Second, &Free, &Send, &Cancel}) {
      layout->addWidget(control);
    }
    Send.setDefault(true);
    Cancel.setAutoDefault(false);
    Checks.Add(First, [this] { return FaultOf(First); });
    Checks.Add(Second, [this] { return FaultOf(Second); });
    Checks.LeaveFreelyFor(Cancel);
    Table.Connect(Send, [this] { ++Sent; });
    connect(&Cancel, &QPushButton::clicked, this, &QDialog::reject);
  }

  static std::optional<EntryFault> FaultOf(const QLineEdit& entry) {
    if (entry.text().isEmpty()) {
      throw RuntimeError(13);
    }
    if (entry.text().size() > 3) {
      return EntryFault{"Too long: " + entry.text().toStdString(), "Entry Error", BoxIcon::Exclamation};
    }
    return std::nullopt;
  }

  int Sent = 0;
  QLineEdit First{QStringLiteral("one")};
  QLineEdit Second{QStringLiteral("two")};
  QLineEdit Free;
  QPushButton Send{QStringLiteral("&Send")};
  QPushButton Cancel{QStringLiteral("Cancel")};
  Commands Table;
  EntryChecks Checks;
};

class CheckedEntries : public testing::Test {
 protected:
  CheckedEntries() {
    Show(window);
    window.First.setFocus();
  }

  static FakeMessageBoxes::Box TooLong(const std::string& text) {
    return {"Too long: " + text, "Entry Error", BoxIcon::Exclamation, BoxButtons::Ok};
  }
  const FakeMessageBoxes::Box mismatch{"Run-time error '13': Type mismatch", "Tessarine", BoxIcon::Critical,
                                       BoxButtons::Ok};

  void TypeTab() {
    Type(window, Qt::Key_Tab);
    QApplication::processEvents();
  }

  static void Click(QWidget& control) {
    QTest::mouseClick(&control, Qt::LeftButton);
    QApplication::processEvents();
  }

  FakeMessageBoxes boxes;
  CheckedDialog window{boxes};
};

TEST_F(CheckedEntries, AreLeftWhenTheyHold) {
  TypeTab();
  EXPECT_TRUE(window.Second.hasFocus());
  TypeTab();
  EXPECT_TRUE(window.Free.hasFocus());
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(CheckedEntries, KeepTheFocusWithAllSelectedWhenTheyDoNot) {
  window.First.setText(QStringLiteral("three"));
  TypeTab();
  EXPECT_THAT(boxes.Boxes, ElementsAre(TooLong("three")));
  EXPECT_TRUE(window.First.hasFocus());
  EXPECT_EQ(window.First.selectedText(), QStringLiteral("three"));
}

TEST_F(CheckedEntries, AreCheckedOnceTheFocusChangeIsOver) {
  window.First.setText(QStringLiteral("three"));
  bool hadMoved = false;
  boxes.WhileOpen = [&](const FakeMessageBoxes::Box&) { hadMoved = window.Second.hasFocus(); };
  Type(window, Qt::Key_Tab);
  EXPECT_THAT(boxes.Boxes, IsEmpty());
  QApplication::processEvents();
  EXPECT_TRUE(hadMoved);
}

/// The second entry loses the focus to the first one, which is not for the operator to pay for.
TEST_F(CheckedEntries, DoNotThrowTheFocusToAndFro) {
  window.First.setText(QStringLiteral("three"));
  window.Second.setText(QStringLiteral("four"));
  TypeTab();
  QApplication::processEvents();
  EXPECT_THAT(boxes.Boxes, ElementsAre(TooLong("three")));
  EXPECT_TRUE(window.First.hasFocus());
}

TEST_F(CheckedEntries, TellOnlyOfTheFirstOfTwoThatWereLeftInOneGo) {
  window.First.setText(QStringLiteral("three"));
  window.Second.setText(QStringLiteral("four"));
  Type(window, Qt::Key_Tab);
  Type(window, Qt::Key_Tab);
  QApplication::processEvents();
  EXPECT_THAT(boxes.Boxes, ElementsAre(TooLong("three")));
  EXPECT_TRUE(window.First.hasFocus());
}

TEST_F(CheckedEntries, StopTheCommandThatTheyWereLeftFor) {
  window.First.setText(QStringLiteral("three"));
  Click(window.Send);
  EXPECT_TRUE(window.First.hasFocus());
  Type(window, Qt::Key_Return);
  EXPECT_TRUE(window.First.hasFocus());
  QTest::keyClick(&window.First, Qt::Key_S, Qt::AltModifier);
  EXPECT_TRUE(window.First.hasFocus());
  EXPECT_FALSE(window.Send.isDown());
  EXPECT_EQ(boxes.Boxes.size(), 3U);
  EXPECT_EQ(window.Sent, 0);
}

TEST_F(CheckedEntries, StopACommandOfWhichTheButtonIsStillHeld) {
  window.First.setText(QStringLiteral("three"));
  QTest::mousePress(&window.Send, Qt::LeftButton);
  QApplication::processEvents();
  EXPECT_THAT(boxes.Boxes, ElementsAre(TooLong("three")));
  QTest::mouseRelease(&window.Send, Qt::LeftButton);
  EXPECT_EQ(window.Sent, 0);
  EXPECT_TRUE(window.First.hasFocus());
}

TEST_F(CheckedEntries, LetTheCommandRunWhenTheyHold) {
  Click(window.Send);
  window.First.setFocus();
  Type(window, Qt::Key_Return);
  EXPECT_EQ(window.Sent, 2);
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(CheckedEntries, LetNoOtherCommandRunUnderTheirBox) {
  window.First.setText(QStringLiteral("three"));
  boxes.WhileOpen = [this](const FakeMessageBoxes::Box&) {
    window.Send.setFocus();
    window.Send.click();
  };
  TypeTab();
  EXPECT_EQ(window.Sent, 0);
  EXPECT_EQ(boxes.Boxes.size(), 1U);
}

TEST_F(CheckedEntries, AreNotAskedByAScreenReader) {
  window.First.setText(QStringLiteral("three"));
  window.Send.click();
  EXPECT_TRUE(window.Send.hasFocus());
  QApplication::processEvents();
  EXPECT_EQ(window.Sent, 1);
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(CheckedEntries, AreLeftFreelyForAButtonThatNeverChecks) {
  window.First.setText(QStringLiteral("three"));
  Click(window.Cancel);
  EXPECT_FALSE(window.isVisible());
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(CheckedEntries, AreNotCheckedWhenTheWindowGoes) {
  window.First.setText(QStringLiteral("three"));
  Type(window, Qt::Key_Tab);
  Type(window, Qt::Key_Escape);
  QApplication::processEvents();
  EXPECT_FALSE(window.isVisible());
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(CheckedEntries, AreNotCheckedWhenAnotherWindowComesToTheFront) {
  window.First.setText(QStringLiteral("three"));
  QWidget other;
  Show(other);
  QApplication::processEvents();
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(CheckedEntries, AreNotCheckedWhenAMenuOpens) {
  window.First.setText(QStringLiteral("three"));
  QFocusEvent away(QEvent::FocusOut, Qt::PopupFocusReason);
  QApplication::sendEvent(&window.First, &away);
  QApplication::processEvents();
  EXPECT_THAT(boxes.Boxes, IsEmpty());
}

TEST_F(CheckedEntries, ReportACheckThatCannotBeMadeAndStopTheCommandButLetTheFocusGo) {
  window.First.clear();
  Click(window.Send);
  EXPECT_THAT(boxes.Boxes, ElementsAre(mismatch));
  EXPECT_TRUE(window.Send.hasFocus());
  EXPECT_EQ(window.Sent, 0);
  Click(window.Send);
  EXPECT_EQ(window.Sent, 1);
  EXPECT_EQ(boxes.Boxes.size(), 1U);
}

TEST_F(CheckedEntries, CanBeCheckedWhereverTheFocusIs) {
  window.Second.setText(QStringLiteral("four"));
  EXPECT_TRUE(window.Checks.Holds(window.First));
  EXPECT_FALSE(window.Checks.Holds(window.Second));
  QApplication::processEvents();
  EXPECT_THAT(boxes.Boxes, ElementsAre(TooLong("four")));
  EXPECT_TRUE(window.Second.hasFocus());
}

TEST_F(CheckedEntries, AreNotCheckedWhenAnotherTakesTheFocusBack) {
  window.First.setText(QStringLiteral("three"));
  window.Second.setText(QStringLiteral("four"));
  EXPECT_FALSE(window.Checks.Holds(window.Second));
  QApplication::processEvents();
  EXPECT_THAT(boxes.Boxes, ElementsAre(TooLong("four")));
  EXPECT_TRUE(window.Second.hasFocus());
}

}  // namespace
