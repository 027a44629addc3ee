#include "platform/qt/UprightPicture.h"

#include <gtest/gtest.h>

#include <QBuffer>
#include <QImage>
#include <QPainter>
#include <tuple>

namespace {

constexpr int DotsPerMetre300 = 11811;  ///< 300 dots per inch
constexpr int DotsPerMetre96 = 3780;

/// As the camera's sensor saw it: red at the left above, green at the right above, blue at the left below and
/// white at the right below.
std::string SensorPicture(const char* format, int dotsPerMetre = DotsPerMetre300) {
  QImage image(80, 40, QImage::Format_RGB32);
  image.setDotsPerMeterX(dotsPerMetre);
  image.setDotsPerMeterY(dotsPerMetre);
  QPainter painter(&image);
  painter.fillRect(0, 0, 40, 20, Qt::red);
  painter.fillRect(40, 0, 40, 20, Qt::green);
  painter.fillRect(0, 20, 40, 20, Qt::blue);
  painter.fillRect(40, 20, 40, 20, Qt::white);
  painter.end();
  QByteArray bytes;
  QBuffer buffer(&bytes);
  image.save(&buffer, format, 100);
  return bytes.toStdString();
}

/// A JPEG file with the camera's note of how it was held.
std::string Noted(const std::string& jpeg, int orientation) {
  std::string segment(
      "\xFF\xE1\x00\x22"
      "Exif\0\0"
      "II\x2A\x00\x08\x00\x00\x00"  // little-endian, the table of notes behind 8 bytes
      "\x01\x00"                    // one note: a 16-bit number
      "\x12\x01\x03\x00\x01\x00\x00\x00",
      28);
  segment += static_cast<char>(orientation);
  segment += std::string(7, '\0');
  return jpeg.substr(0, 2) + segment + jpeg.substr(2);
}

QImage Image(const std::string& bytes) {
  return QImage::fromData(reinterpret_cast<const uchar*>(bytes.data()), static_cast<int>(bytes.size()));
}

/// Colours of the four corners, row by row: "RGBW".
std::string Corners(const QImage& image) {
  std::string corners;
  for (const int y : {5, image.height() - 6}) {
    for (const int x : {5, image.width() - 6}) {
      const QColor colour = image.pixelColor(x, y);
      const bool red = colour.red() > 128;
      corners += red && colour.green() > 128 ? 'W' : red ? 'R' : colour.green() > 128 ? 'G' : 'B';
    }
  }
  return corners;
}

TEST(AnUprightPicture, IsTurnedAndMirroredAsTheCameraNoted) {
  const std::string picture = SensorPicture("JPG");
  for (const auto& [orientation, corners, isHigh] : {std::tuple{2, "GRWB", false},
                                                     {3, "WBGR", false},
                                                     {4, "BWRG", false},
                                                     {5, "RBGW", true},
                                                     {6, "BRWG", true},
                                                     {7, "WGBR", true},
                                                     {8, "GWRB", true}}) {
    const QImage upright = Image(UprightPicture(Noted(picture, orientation)));
    EXPECT_EQ(Corners(upright), corners) << orientation;
    EXPECT_EQ(upright.size(), isHigh ? QSize(40, 80) : QSize(80, 40)) << orientation;
  }
}

TEST(AnUprightPicture, CarriesNoNoteOfTheCamera) {
  const std::string once = UprightPicture(Noted(SensorPicture("JPG"), 6));
  EXPECT_EQ(UprightPicture(once), once);
}

TEST(AnUprightPicture, IsTheSameFileWhereNothingIsToBeTurned) {
  const std::string jpeg = SensorPicture("JPG");
  for (const std::string& bytes :
       {jpeg, Noted(jpeg, 1), Noted(jpeg, 0), Noted(jpeg, 9), SensorPicture("PNG"), SensorPicture("BMP"),
        std::string(), std::string("no picture"), Noted(jpeg, 6).substr(0, 60)}) {
    EXPECT_EQ(UprightPicture(bytes), bytes);
  }
}

TEST(AnUprightPicture, IsTurnedWhateverFollowsIt) {
  EXPECT_EQ(Corners(Image(UprightPicture(Noted(SensorPicture("JPG"), 6) + std::string(5000, 'x')))), "BRWG");
}

TEST(AnUprightPicture, KeepsItsDensity) {
  EXPECT_EQ(Image(UprightPicture(Noted(SensorPicture("JPG"), 6))).dotsPerMeterX(), DotsPerMetre300);
}

TEST(AnUprightPicture, Has96DotsPerInchWhereItToldNoDensity) {
  std::string jpeg = SensorPicture("JPG");
  const std::size_t header = jpeg.find("JFIF");
  ASSERT_NE(header, std::string::npos);
  constexpr std::size_t unitAt = 7;
  jpeg[header + unitAt] = 0;  // the two numbers behind it are a proportion
  EXPECT_EQ(Image(UprightPicture(Noted(jpeg, 6))).dotsPerMeterX(), DotsPerMetre96);
}

}  // namespace
