#include "board/BonusPoints.h"

#include <gmock/gmock.h>

#include <QLineEdit>

#include "tests/fakes/FakeMessageBoxes.h"
#include "tests/support/Captions.h"

namespace {

class BonusWindow : public testing::Test {
 protected:
  /// The value after `text` was typed and `button` pressed.
  std::int32_t ValueAfter(const char* text, const char* button = "OK") {
    BonusPoints window(5, boxes, nullptr);
    Show(window);
    Find<QLineEdit>(window, "BonusPointsEntry").setText(QString::fromUtf8(text));
    Press(window, button);
    closed = !window.isVisible();
    return window.Value();
  }

  FakeMessageBoxes boxes;
  bool closed = false;
};

TEST_F(BonusWindow, ShowsTheValueInTheNumberForm) {
  for (const auto& [value, text] : {std::pair{5, " 5"}, {0, " 0"}, {-3, "-3"}}) {
    const BonusPoints window(value, boxes, nullptr);
    EXPECT_EQ(Find<QLineEdit>(window, "BonusPointsEntry").text().toStdString(), text);
    EXPECT_EQ(window.windowTitle(), QStringLiteral("Bonus Points"));
  }
}

TEST_F(BonusWindow, HasItsCaptions) {
  const BonusPoints window(5, boxes, nullptr);
  ExpectCaptions(window, {{"Label1", "Bonus Points for this player:"},
                          {"Label2", "This value is added to the player's Soldiering Total."},
                          {"OK", "OK"},
                          {"Cancel", "Cancel"}});
  ExpectLabels(window, {{"BonusPointsEntry", "Bonus Points for this player:"}});
}

TEST_F(BonusWindow, RoundsToTheEvenNumber) {
  EXPECT_EQ(ValueAfter("12.5"), 12);
  EXPECT_EQ(ValueAfter("13.5"), 14);
  EXPECT_TRUE(closed);
}

TEST_F(BonusWindow, TakesTheLeadingNumber) {
  EXPECT_EQ(ValueAfter("abc"), 0);
  EXPECT_EQ(ValueAfter(""), 0);
  EXPECT_EQ(ValueAfter("-3"), -3);
  EXPECT_EQ(ValueAfter("12abc"), 12);
}

TEST_F(BonusWindow, KeepsTheValueOnCancel) {
  EXPECT_EQ(ValueAfter("12", "Cancel"), 5);
  EXPECT_TRUE(closed);
}

TEST_F(BonusWindow, TellsOfANumberThatIsTooLarge) {
  EXPECT_EQ(ValueAfter("3000000000"), 5);
  ASSERT_EQ(boxes.Boxes.size(), 1U);
  EXPECT_EQ(boxes.Boxes[0].Text, "Run-time error '6': Overflow");
  EXPECT_FALSE(closed);
}

TEST_F(BonusWindow, TakesReturnForOkAndEscapeForCancel) {
  for (const auto& [key, value] : {std::pair{Qt::Key_Return, 8}, {Qt::Key_Escape, 5}}) {
    BonusPoints window(5, boxes, nullptr);
    Show(window);
    auto& entry = Find<QLineEdit>(window, "BonusPointsEntry");
    entry.setText(QStringLiteral("8"));
    QTest::keyClick(&entry, key);
    EXPECT_FALSE(window.isVisible());
    EXPECT_EQ(window.Value(), value);
  }
}

}  // namespace
