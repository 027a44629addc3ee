#include "ui/DialogParent.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QDialog>
#include <QMessageBox>

#include "platform/qt/QtMessageBoxes.h"
#include "tests/support/WhileModal.h"

namespace {

class QtMessageBoxesTest : public testing::Test {
 protected:
  /// Shows a box that `act` closes.
  void Show(BoxButtons buttons, const std::function<void(QMessageBox&)>& act) {
    const WhileModal<QMessageBox> operatorAtWork(act);
    Boxes.Show("Text", "Title", BoxIcon::Information, buttons);
    EXPECT_EQ(operatorAtWork.Runs(), 1);
  }

  DialogParent Parent;
  QtMessageBoxes Boxes{[this] { return Parent.Window(); }};
};

TEST_F(QtMessageBoxesTest, BelongsToTheModalWindowThatIsOpen) {
  QWidget mainWindow;
  mainWindow.show();
  Parent.SetMainWindow(&mainWindow);
  QDialog dialog(&mainWindow);
  dialog.setModal(true);
  dialog.show();
  Show(BoxButtons::Ok, [&](QMessageBox& box) {
    EXPECT_EQ(box.parentWidget(), &dialog);
    box.close();
  });
}

TEST_F(QtMessageBoxesTest, BelongsToTheMainWindowWhenItIsVisibleAndNothingElseIsActive) {
  QWidget mainWindow;
  Parent.SetMainWindow(&mainWindow);
  ASSERT_EQ(QApplication::activeWindow(), nullptr);
  Show(BoxButtons::Ok, [&](QMessageBox& box) {
    EXPECT_EQ(box.parentWidget(), nullptr);
    box.close();
  });
  mainWindow.setAttribute(Qt::WA_ShowWithoutActivating);
  mainWindow.show();
  Show(BoxButtons::Ok, [&](QMessageBox& box) {
    EXPECT_EQ(box.parentWidget(), &mainWindow);
    box.close();
  });
}

TEST(DialogParentOfBoxes, ForgetsAMainWindowThatIsGone) {
  DialogParent parent;
  auto mainWindow = std::make_unique<QWidget>();
  mainWindow->setAttribute(Qt::WA_ShowWithoutActivating);
  parent.SetMainWindow(mainWindow.get());
  mainWindow->show();
  ASSERT_EQ(parent.Window(), mainWindow.get());
  mainWindow.reset();
  EXPECT_EQ(parent.Window(), nullptr);
}

}  // namespace
