#include "platform/qt/UprightPicture.h"

#include <QBuffer>
#include <QImageReader>
#include <QImageWriter>

namespace {

/// An image that tells no density gets the screen's.
void SetDensityIfNoneIsTold(QImage& image) {
  const QImage other(1, 1, QImage::Format_RGB32);
  if (image.dotsPerMeterX() == other.dotsPerMeterX() && image.dotsPerMeterY() == other.dotsPerMeterY()) {
    constexpr int dotsPerMetre = 3780;  // 96 dots per inch
    image.setDotsPerMeterX(dotsPerMetre);
    image.setDotsPerMeterY(dotsPerMetre);
  }
}

}  // namespace

std::string UprightPicture(const std::string& bytes) {
  QByteArray content = QByteArray::fromRawData(bytes.data(), static_cast<qsizetype>(bytes.size()));
  QBuffer buffer(&content);
  QImageReader reader(&buffer);
  reader.setDecideFormatFromContent(true);
  reader.setAutoTransform(true);
  if (reader.transformation() == QImageIOHandler::TransformationNone) {
    return bytes;
  }
  QImage image = reader.read();
  if (image.isNull()) {
    return bytes;
  }
  SetDensityIfNoneIsTold(image);
  QByteArray upright;
  QBuffer target(&upright);
  const bool isPhoto = reader.format() == "jpeg";
  QImageWriter writer(&target, isPhoto ? "jpeg" : "png");
  constexpr int hardlyAnyLoss = 95;  // in percent
  if (isPhoto) {
    writer.setQuality(hardlyAnyLoss);
  }
  return writer.write(image) ? upright.toStdString() : bytes;
}
