#include "members/PictureBox.h"

#include <gtest/gtest.h>

#include <QWidget>
#include <QtEndian>
#include <cstring>

#include "tests/members/Pictures.h"

namespace {

/// One black pixel.
const std::string Gif(
    "GIF89a\x01\x00\x01\x00\x80\x00\x00\x00\x00\x00\xFF\xFF\xFF\x2C\x00\x00\x00\x00\x01\x00\x01\x00\x00\x02"
    "\x02\x44\x01\x00\x3B",
    35);

class APictureBox : public testing::Test {
 protected:
  APictureBox() { box.resize(200, 100); }

  QColor At(int x, int y) { return box.grab().toImage().pixelColor(x, y); }

  PictureBox box{nullptr};
};

TEST_F(APictureBox, ReadsTheUsualKinds) {
  for (const char* format : {"BMP", "JPG", "PNG", "PPM"}) {
    box.Clear();
    box.Load(PictureFile(Qt::white, format));
    EXPECT_EQ(box.Picture().size(), QSize(80, 60)) << format;
  }
}

TEST_F(APictureBox, ReadsGif) {
  box.Load(Gif);
  EXPECT_EQ(box.Picture().size(), QSize(1, 1));
}

TEST_F(APictureBox, TurnsAPhotoAsItsCameraWasHeld) {
  std::string photo = PictureFile(Qt::white, "JPG");
  // A segment behind the start mark: one entry, 0x112 (orientation), one short number, 6 (turn it to the
  // right).
  const std::string exif(
      "\xFF\xE1\x00\x22"
      "Exif\0\0MM\0\x2A\0\0\0\x08\0\x01\x01\x12\0\x03\0\0\0\x01\0\x06\0\0\0\0\0\0",
      36);
  photo.insert(2, exif);
  box.Load(photo);
  EXPECT_EQ(box.Picture().size(), QSize(60, 80));
}

TEST_F(APictureBox, IgnoresBytesBehindThePicture) {
  for (const char* format : {"BMP", "JPG", "PNG"}) {
    box.Clear();
    box.Load(PictureFile(Qt::white, format) + std::string(10000, '\0'));
    EXPECT_EQ(box.Picture().size(), QSize(80, 60)) << format;
  }
}

TEST_F(APictureBox, ShowsAPictureWhateverFollowsIt) {
  for (const char* format : {"BMP", "JPG", "PNG"}) {
    const std::string picture = PictureFile(Qt::white, format);
    for (const std::string& rest :
         {std::string(5000, 'x'), std::string(5000, '\xFF'), PictureFile(Qt::red, "JPG"),
          PictureFile(Qt::red, "JPG").substr(2, 500), std::string("\xFF\xDA\x00\x0C and no end", 16),
          PictureFile(Qt::red, "BMP"), PictureFile(Qt::red, "PNG"), Gif,
          picture.substr(picture.size() / 2)}) {
      box.Clear();
      box.Load(picture + rest);
      EXPECT_EQ(box.Picture().pixelColor(0, 0), QColor(Qt::white)) << format << " and " << rest.substr(0, 9);
    }
  }
  for (const std::string& rest : {std::string(5000, 'x'), std::string(), PictureFile(Qt::red, "JPG")}) {
    box.Clear();
    box.Load(Gif.substr(0, Gif.size() - 1) + rest);  // without the mark at the end of the file
    EXPECT_EQ(box.Picture().size(), QSize(1, 1)) << rest.substr(0, 9);
  }
}

TEST_F(APictureBox, ShowsABmpWhateverItSaysOfTheFilesSize) {
  const std::string picture = PictureFile(Qt::red, "BMP");
  for (const int more : {-100, -1, 1, 2, 0x01000000}) {
    std::string changed = picture;
    const auto size = qToLittleEndian(static_cast<quint32>(static_cast<int>(picture.size()) + more));
    std::memcpy(changed.data() + 2, &size, sizeof size);
    box.Clear();
    box.Load(changed);
    EXPECT_EQ(box.Picture().size(), QSize(80, 60)) << more;
  }
}

TEST_F(APictureBox, ShowsAPhotoWithAThumbnail) {
  const std::string thumbnail = PictureFile(Qt::blue, "JPG", QSize(16, 12));
  const std::string photo = PictureFile(Qt::red, "JPG");
  std::string segment("\xFF\xE1\x00\x00", 4);
  segment[2] = static_cast<char>((thumbnail.size() + 2) / 256);
  segment[3] = static_cast<char>((thumbnail.size() + 2) % 256);
  const std::string whole = photo.substr(0, 2) + segment + thumbnail + photo.substr(2);
  box.Load(whole);
  EXPECT_EQ(box.Picture().size(), QSize(80, 60));
  box.Load(whole.substr(0, whole.size() - 2));
  EXPECT_TRUE(box.Picture().isNull());  // the thumbnail's end is not the photo's
}

TEST_F(APictureBox, FitsThePictureWithItsProportions) {
  box.Load(PictureFile(Qt::red));  // 4:3, in a 2:1 box
  EXPECT_EQ(At(100, 50), QColor(Qt::red));
  EXPECT_EQ(At(100, 6), QColor(Qt::red));
  EXPECT_NE(At(20, 50), QColor(Qt::red));
  EXPECT_NE(At(180, 50), QColor(Qt::red));
}

TEST_F(APictureBox, ShowsNoPictureOfDamagedBytes) {
  for (const std::string& bytes :
       {std::string(), std::string("no picture"), std::string("BM"), PictureFile(Qt::red).substr(0, 20)}) {
    box.Load(PictureFile(Qt::red));
    box.Load(bytes);
    EXPECT_TRUE(box.Picture().isNull());
    EXPECT_NE(At(100, 50), QColor(Qt::red));
  }
}

TEST_F(APictureBox, ShowsNoPictureWhoseEndIsMissing) {
  for (const char* format : {"BMP", "JPG", "PNG", "PPM"}) {
    const std::string whole = PictureFile(Qt::red, format);
    box.Load(whole.substr(0, whole.size() - 30));
    EXPECT_TRUE(box.Picture().isNull()) << format;
  }
  box.Load(Gif.substr(0, Gif.size() - 3));
  EXPECT_TRUE(box.Picture().isNull());
}

TEST_F(APictureBox, ReadsAVeryLargePictureSmaller) {
  box.Load(PictureFile(Qt::red, "JPG", QSize(4000, 1000)));
  EXPECT_EQ(box.Picture().size(), QSize(1600, 400));
}

TEST_F(APictureBox, ShowsNothingOfThePictureBeforeOnceCleared) {
  box.Load(PictureFile(Qt::red));
  box.Clear();
  EXPECT_TRUE(box.Picture().isNull());
  EXPECT_NE(At(100, 50), QColor(Qt::red));
}

}  // namespace
