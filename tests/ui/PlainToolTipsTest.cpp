#include "ui/PlainToolTips.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QLabel>
#include <QScreen>
#include <QToolTip>

namespace {

/// The tool tip on the screen; null for none.
const QLabel* Tip() {
  for (const QWidget* widget : QApplication::topLevelWidgets()) {
    if (widget->isVisible() && widget->windowType() == Qt::ToolTip) {
      return qobject_cast<const QLabel*>(widget);
    }
  }
  return nullptr;
}

TEST(PlainToolTips, ShowMarkupAsItStands) {
  const PlainToolTips plain;
  QWidget window;
  window.show();
  for (const QString& text : {QStringLiteral("<b>Bold</b>"), QStringLiteral("Ada &amp; <i>Co</i>")}) {
    QToolTip::showText(QPoint(10, 10), text, &window);
    const QLabel* tip = Tip();
    ASSERT_NE(tip, nullptr);
    EXPECT_EQ(tip->text(), text);
    EXPECT_EQ(tip->textFormat(), Qt::PlainText);
    EXPECT_GE(tip->height(), tip->heightForWidth(tip->width()));
    QToolTip::hideText();
  }
}

TEST(PlainToolTips, WrapLongTextsAndLeaveShortOnesOnOneLine) {
  const PlainToolTips plain;
  QWidget window;
  window.show();
  const QString shortText = QStringLiteral("Short");
  const QString longText = QStringLiteral("word ").repeated(100);
  const int most = window.screen()->availableGeometry().width() / 2;
  int lineHeight = 0;
  for (const QString& text : {shortText, longText, shortText, longText}) {
    QToolTip::showText(QPoint(10, 10), text, &window);
    const QLabel* tip = Tip();
    ASSERT_NE(tip, nullptr);
    EXPECT_EQ(tip->text(), text);
    EXPECT_LE(tip->width(), most);
    EXPECT_GE(tip->height(), tip->heightForWidth(tip->width()));
    if (text == shortText) {
      lineHeight = tip->height();
    } else {
      EXPECT_GT(tip->height(), 2 * lineHeight);
    }
  }
  QToolTip::hideText();
}

}  // namespace
