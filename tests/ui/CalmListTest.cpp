#include "ui/CalmList.h"

#include <gtest/gtest.h>

#include <QAbstractItemView>
#include <QComboBox>
#include <QTest>
#include <QWheelEvent>

#include "tests/support/Controls.h"

namespace {

void Turn(QWidget& widget) {
  const QPointF middle(widget.rect().center());
  QWheelEvent wheel(middle, widget.mapToGlobal(middle), {}, QPoint(0, -120), Qt::NoButton, Qt::NoModifier,
                    Qt::NoScrollPhase, false);
  QApplication::sendEvent(&widget, &wheel);
}

class CalmLists : public testing::Test {
 protected:
  CalmLists() {
    list.addItems({QStringLiteral("None"), QStringLiteral("Bridge"), QStringLiteral("Keep")});
    KeepCalm(list, [this] { ++left; });
    Show(list);
    list.setFocus();
  }

  int left = 0;  ///< how often the list was closed
  QComboBox list;
};

TEST_F(CalmLists, IgnoreTheWheelWhileTheyAreClosed) {
  Turn(list);
  EXPECT_EQ(list.currentIndex(), 0);
  EXPECT_FALSE(list.view()->isVisible());
}

TEST_F(CalmLists, AreOpenedByALetterWhichChoosesNothingBeforeReturn) {
  QTest::keyClick(&list, Qt::Key_K);
  ASSERT_TRUE(list.view()->isVisible());
  EXPECT_EQ(list.currentIndex(), 0);
  EXPECT_EQ(list.view()->currentIndex().row(), 2);
  QTest::keyClick(list.view(), Qt::Key_Return);
  EXPECT_EQ(list.currentIndex(), 2);
}

TEST_F(CalmLists, ForgetALetterOnEscape) {
  QTest::keyClick(&list, Qt::Key_K);
  QTest::keyClick(list.view(), Qt::Key_Escape);
  EXPECT_FALSE(list.view()->isVisible());
  EXPECT_EQ(list.currentIndex(), 0);
  EXPECT_TRUE(QTest::qWaitFor([this] { return left == 1; }));
}

TEST_F(CalmLists, LeaveKeysOfCommandsAndArrowsAlone) {
  for (const Qt::KeyboardModifier modifier : {Qt::ControlModifier, Qt::AltModifier}) {
    QTest::keyClick(&list, Qt::Key_K, modifier);
    EXPECT_FALSE(list.view()->isVisible());
    EXPECT_EQ(list.currentIndex(), 0);
  }
  QTest::keyClick(&list, Qt::Key_Down);
  EXPECT_EQ(list.currentIndex(), 1);
}

}  // namespace
