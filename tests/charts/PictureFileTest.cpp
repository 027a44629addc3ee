#include "charts/PictureFile.h"

#include <gtest/gtest.h>

#include "tests/support/Thrown.h"

namespace {

TEST(PictureFile, HoldsThePicture) {
  const StringTable strings(Language::English);
  QImage picture(3, 2, QImage::Format_RGB32);
  picture.fill(Qt::red);
  QImage read;
  ASSERT_TRUE(read.loadFromData(QByteArray::fromStdString(PngOf(picture, strings)), "PNG"));
  EXPECT_EQ(read.size(), picture.size());
  EXPECT_EQ(read.pixelColor(1, 1), QColor(Qt::red));
}

TEST(PictureToPaint, IsWhiteWithSoManyPixelsToThePoint) {
  const QImage picture = WhitePicture({10.5, 4}, 2);
  EXPECT_EQ(picture.size(), QSize(21, 8));
  EXPECT_EQ(picture.devicePixelRatio(), 2);
  EXPECT_EQ(picture.pixelColor(20, 7), QColor(Qt::white));
}

TEST(PictureToPaint, IsNullBeyondAGigabyte) {
  EXPECT_TRUE(WhitePicture({16384, 16385}, 1).isNull());
  EXPECT_TRUE(WhitePicture({8192, 8193}, 2).isNull());
  EXPECT_TRUE(WhitePicture({1e9, 1e9}, 2).isNull());
}

TEST(PictureFile, IsNotMadeOfAPictureThatThereWasNoMemoryFor) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    const StringTable strings(language);
    const Thrown thrown = ThrownBy([&] { PngOf(QImage(), strings); });
    EXPECT_EQ(thrown.Number, 7);
    EXPECT_EQ(thrown.Text, strings.Text(OwnText::PictureTooLarge));
  }
}

}  // namespace
