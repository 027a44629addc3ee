#include "ui/QrCode.h"

#include <gtest/gtest.h>

#include <QPainter>

namespace {

constexpr int Border = 4;
constexpr int Finder = 7;

/// True if there is one of the three large squares of a code, its corner at this module.
bool HasFinder(const QImage& code, int left, int top) {
  for (int row = 0; row < Finder; ++row) {
    for (int column = 0; column < Finder; ++column) {
      const int ring = std::min({row, column, Finder - 1 - row, Finder - 1 - column});
      const QColor wanted = ring == 1 ? Qt::white : Qt::black;
      if (code.pixelColor(left + column, top + row) != wanted) {
        return false;
      }
    }
  }
  return true;
}

TEST(QrCode, HasItsThreeSquaresWithinAWhiteBorder) {
  const QImage code = QrCode("http://192.168.1.20:8080/");
  ASSERT_EQ(code.width(), code.height());
  const int last = code.width() - Border - Finder;
  EXPECT_TRUE(HasFinder(code, Border, Border));
  EXPECT_TRUE(HasFinder(code, last, Border));
  EXPECT_TRUE(HasFinder(code, Border, last));
  EXPECT_FALSE(HasFinder(code, last, last));
  for (int at = 0; at < code.width(); ++at) {
    for (int depth = 0; depth < Border; ++depth) {
      EXPECT_EQ(code.pixelColor(at, depth), QColor(Qt::white));
      EXPECT_EQ(code.pixelColor(depth, at), QColor(Qt::white));
    }
  }
}

TEST(QrCode, DiffersForDifferentTexts) {
  EXPECT_NE(QrCode("http://192.168.1.20:8080/"), QrCode("http://192.168.1.21:8080/"));
}

TEST(QrCode, IsNoneForNothingAndForTooMuch) {
  EXPECT_TRUE(QrCode({}).isNull());
  EXPECT_TRUE(QrCode(std::string(5000, 'x')).isNull());
}

TEST(QrCode, IsPaintedInWholePixelsAsLargeAsFits) {
  const std::string text = "http://192.168.1.20:8080/";
  const QImage code = QrCode(text);
  QImage page(code.width() * 5 + 40, code.width() * 5 + 3, QImage::Format_RGB32);
  page.fill(Qt::blue);
  QPainter painter(&page);
  PaintQrCode(painter, page.rect(), text);
  painter.end();
  const QRect square(20, 2, code.width() * 5, code.width() * 5);
  const QImage wanted = code.scaled(square.size());
  EXPECT_EQ(page.copy(square), wanted);
  EXPECT_EQ(page.pixelColor(square.left() - 1, 50), QColor(Qt::blue));
}

TEST(QrCode, LeavesThePageAloneWithoutAText) {
  QImage page(100, 100, QImage::Format_RGB32);
  page.fill(Qt::blue);
  const QImage before = page.copy();
  QPainter painter(&page);
  PaintQrCode(painter, page.rect(), {});
  painter.end();
  EXPECT_EQ(page, before);
}

}  // namespace
