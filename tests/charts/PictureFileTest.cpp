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

TEST(PictureFile, IsNotMadeOfAPictureThatThereWasNoMemoryFor) {
  for (const Language language : {Language::English, Language::SimplifiedChinese}) {
    const StringTable strings(language);
    const Thrown thrown = ThrownBy([&] { PngOf(QImage(), strings); });
    EXPECT_EQ(thrown.Number, 7);
    EXPECT_EQ(thrown.Text, strings.Text(OwnText::PictureTooLarge));
  }
}

}  // namespace
