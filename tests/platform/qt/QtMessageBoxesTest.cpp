#include "platform/qt/QtMessageBoxes.h"

#include <gtest/gtest.h>

#include <QDialog>
#include <QMessageBox>
#include <QPushButton>
#include <QTest>

#include "tests/support/WhileModal.h"

namespace {

class QtMessageBoxesTest : public testing::Test {
 protected:
  /// Shows a box that `act` answers.
  BoxAnswer Show(BoxButtons buttons, const std::function<void(QMessageBox&)>& act,
                 const std::string& text = "Text", BoxIcon icon = BoxIcon::Information) {
    const WhileModal<QMessageBox> operatorAtWork(act);
    const BoxAnswer answer = Boxes.Show(text, "Title", icon, buttons);
    EXPECT_EQ(operatorAtWork.Runs(), 1);
    return answer;
  }

  static std::function<void(QMessageBox&)> Press(QMessageBox::StandardButton button) {
    return [button](QMessageBox& box) { QTest::mouseClick(box.button(button), Qt::LeftButton); };
  }

  static std::function<void(QMessageBox&)> Type(Qt::Key key) {
    return [key](QMessageBox& box) { QTest::keyClick(&box, key); };
  }

  QtMessageBoxes Boxes{[] { return QApplication::activeModalWidget(); }};
};

TEST_F(QtMessageBoxesTest, ShowsTextAndTitleToTheLetter) {
  const std::string text = "<b>得分</b> & \"more\"\nsecond line ";
  Show(
      BoxButtons::Ok,
      [&](QMessageBox& box) {
        EXPECT_EQ(box.text().toStdString(), text);
        EXPECT_EQ(box.textFormat(), Qt::PlainText);
        EXPECT_EQ(box.windowTitle().toStdString(), "Title");
        EXPECT_TRUE(box.isVisible());
        box.close();
      },
      text);
}

TEST_F(QtMessageBoxesTest, ShowsTheIcons) {
  const std::vector<std::pair<BoxIcon, QMessageBox::Icon>> icons{
      {BoxIcon::None, QMessageBox::NoIcon},
      {BoxIcon::Information, QMessageBox::Information},
      {BoxIcon::Question, QMessageBox::Question},
      {BoxIcon::Exclamation, QMessageBox::Warning},
      {BoxIcon::Critical, QMessageBox::Critical}};
  for (const auto& [icon, shown] : icons) {
    Show(
        BoxButtons::Ok,
        [shown = shown](QMessageBox& box) {
          EXPECT_EQ(box.icon(), shown);
          box.close();
        },
        "Text", icon);
  }
}

TEST_F(QtMessageBoxesTest, OffersTheButtonsAndAnswersTheOnePressed) {
  const auto offers = [](QMessageBox& box, QMessageBox::StandardButtons buttons,
                         QMessageBox::StandardButton first) {
    EXPECT_EQ(box.standardButtons(), buttons);
    EXPECT_EQ(box.defaultButton(), box.button(first));
    QTest::mouseClick(box.button(first), Qt::LeftButton);
  };
  using std::placeholders::_1;
  EXPECT_EQ(Show(BoxButtons::Ok, std::bind(offers, _1, QMessageBox::Ok, QMessageBox::Ok)), BoxAnswer::Ok);
  EXPECT_EQ(Show(BoxButtons::OkCancel,
                 std::bind(offers, _1, QMessageBox::Ok | QMessageBox::Cancel, QMessageBox::Ok)),
            BoxAnswer::Ok);
  EXPECT_EQ(
      Show(BoxButtons::YesNo, std::bind(offers, _1, QMessageBox::Yes | QMessageBox::No, QMessageBox::Yes)),
      BoxAnswer::Yes);
  EXPECT_EQ(
      Show(BoxButtons::YesNoCancel,
           std::bind(offers, _1, QMessageBox::Yes | QMessageBox::No | QMessageBox::Cancel, QMessageBox::Yes)),
      BoxAnswer::Yes);
  EXPECT_EQ(Show(BoxButtons::OkCancel, Press(QMessageBox::Cancel)), BoxAnswer::Cancel);
  EXPECT_EQ(Show(BoxButtons::YesNo, Press(QMessageBox::No)), BoxAnswer::No);
  EXPECT_EQ(Show(BoxButtons::YesNoCancel, Press(QMessageBox::No)), BoxAnswer::No);
  EXPECT_EQ(Show(BoxButtons::YesNoCancel, Press(QMessageBox::Cancel)), BoxAnswer::Cancel);
}

TEST_F(QtMessageBoxesTest, NoHourglassStandsOverABox) {
  QGuiApplication::setOverrideCursor(Qt::WaitCursor);
  QGuiApplication::setOverrideCursor(Qt::BusyCursor);
  bool ordinary = false;
  Show(BoxButtons::Ok, [&](QMessageBox& box) {
    ordinary = QGuiApplication::overrideCursor() == nullptr;
    box.close();
  });
  EXPECT_TRUE(ordinary);
  for (const Qt::CursorShape shape : {Qt::BusyCursor, Qt::WaitCursor}) {
    ASSERT_NE(QGuiApplication::overrideCursor(), nullptr);
    EXPECT_EQ(QGuiApplication::overrideCursor()->shape(), shape);
    QGuiApplication::restoreOverrideCursor();
  }
  EXPECT_EQ(QGuiApplication::overrideCursor(), nullptr);
}

TEST_F(QtMessageBoxesTest, ReturnPressesTheFirstButton) {
  EXPECT_EQ(Show(BoxButtons::Ok, Type(Qt::Key_Return)), BoxAnswer::Ok);
  EXPECT_EQ(Show(BoxButtons::OkCancel, Type(Qt::Key_Return)), BoxAnswer::Ok);
  EXPECT_EQ(Show(BoxButtons::YesNo, Type(Qt::Key_Return)), BoxAnswer::Yes);
  EXPECT_EQ(Show(BoxButtons::YesNoCancel, Type(Qt::Key_Return)), BoxAnswer::Yes);
}

TEST_F(QtMessageBoxesTest, EscapeAndTheCloseBoxAnswerOkOrCancel) {
  const auto close = [](QMessageBox& box) { EXPECT_TRUE(box.close()); };
  EXPECT_EQ(Show(BoxButtons::Ok, Type(Qt::Key_Escape)), BoxAnswer::Ok);
  EXPECT_EQ(Show(BoxButtons::OkCancel, Type(Qt::Key_Escape)), BoxAnswer::Cancel);
  EXPECT_EQ(Show(BoxButtons::YesNoCancel, Type(Qt::Key_Escape)), BoxAnswer::Cancel);
  EXPECT_EQ(Show(BoxButtons::Ok, close), BoxAnswer::Ok);
  EXPECT_EQ(Show(BoxButtons::OkCancel, close), BoxAnswer::Cancel);
  EXPECT_EQ(Show(BoxButtons::YesNoCancel, close), BoxAnswer::Cancel);
}

TEST_F(QtMessageBoxesTest, AQuestionOfYesAndNoIsClosedByItsButtonsAlone) {
  for (const auto& [button, answer] :
       {std::pair{QMessageBox::Yes, BoxAnswer::Yes}, {QMessageBox::No, BoxAnswer::No}}) {
    EXPECT_EQ(Show(BoxButtons::YesNo,
                   [button = button](QMessageBox& box) {
                     EXPECT_FALSE(box.windowFlags() & Qt::WindowCloseButtonHint);
                     EXPECT_TRUE(box.windowFlags() & Qt::WindowTitleHint);
                     QTest::keyClick(&box, Qt::Key_Escape);
                     QTest::keyClick(box.button(QMessageBox::No), Qt::Key_Escape);
                     EXPECT_FALSE(box.close());
                     QCoreApplication::processEvents();
                     EXPECT_TRUE(box.isVisible());
                     QTest::mouseClick(box.button(button), Qt::LeftButton);
                   }),
              answer);
  }
}

TEST_F(QtMessageBoxesTest, AnswersTheLastButtonWhenItsWindowIsDestroyed) {
  for (const auto& [buttons, answer] : {std::pair{BoxButtons::OkCancel, BoxAnswer::Cancel},
                                        {BoxButtons::YesNo, BoxAnswer::No},
                                        {BoxButtons::YesNoCancel, BoxAnswer::Cancel}}) {
    auto* dialog = new QDialog;
    dialog->setModal(true);
    dialog->show();
    EXPECT_EQ(Show(buttons,
                   [&](QMessageBox& box) {
                     EXPECT_EQ(box.parentWidget(), dialog);
                     delete dialog;
                   }),
              answer);
  }
}

TEST_F(QtMessageBoxesTest, WrapsALongTextToAReadableWidth) {
  std::string text;
  for (int word = 0; word < 80; ++word) {
    text += "bookmarks ";
  }
  Show(
      BoxButtons::Ok,
      [](QMessageBox& box) {
        EXPECT_LE(box.width(), 800);
        box.close();
      },
      text);
}

}  // namespace
