#include "ui/FocusTips.h"

#include <gtest/gtest.h>

#include <QLineEdit>
#include <QToolTip>
#include <QVBoxLayout>

#include "tests/support/Controls.h"

namespace {

class FocusTipsOfAWindow : public testing::Test {
 protected:
  FocusTipsOfAWindow() {
    auto* layout = new QVBoxLayout(&window);
    for (QLineEdit* entry : {first, second, plain}) {
      layout->addWidget(entry);
    }
    first->setToolTip(QStringLiteral("First tip"));
    second->setToolTip(QStringLiteral("Second tip"));
    plain->setToolTip(QStringLiteral("Plain tip"));
    auto* tips = new FocusTips(window);
    tips->Add(*first);
    tips->Add(*second);
    Show(window);
  }
  ~FocusTipsOfAWindow() override { QToolTip::hideText(); }

  static void GoTo(QWidget* entry, Qt::FocusReason reason) {
    entry->setFocus(reason);
    QCoreApplication::processEvents();
  }

  QWidget window;
  QLineEdit* first = new QLineEdit;
  QLineEdit* second = new QLineEdit;
  QLineEdit* plain = new QLineEdit;
};

TEST_F(FocusTipsOfAWindow, AppearWhenTheKeyboardComes) {
  for (QLineEdit* entry : {second, first}) {
    GoTo(entry, Qt::TabFocusReason);
    EXPECT_TRUE(QToolTip::isVisible());
    EXPECT_EQ(QToolTip::text(), entry->toolTip());
  }
}

TEST_F(FocusTipsOfAWindow, DoNotAppearForOtherControls) {
  GoTo(plain, Qt::TabFocusReason);
  EXPECT_FALSE(QToolTip::isVisible());
}

TEST_F(FocusTipsOfAWindow, DoNotAppearWhenTheWindowComesToTheFront) {
  GoTo(plain, Qt::TabFocusReason);
  for (const Qt::FocusReason reason : {Qt::ActiveWindowFocusReason, Qt::PopupFocusReason}) {
    GoTo(second, reason);
    EXPECT_FALSE(QToolTip::isVisible());
    GoTo(plain, Qt::TabFocusReason);
  }
}

}  // namespace
