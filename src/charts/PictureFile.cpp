#include "charts/PictureFile.h"

#include <QBuffer>

#include "platform/RuntimeError.h"

QImage WhitePicture(const QSizeF& size, double ratio) {
  constexpr double mostPixels = 1 << 28;
  if (size.width() * size.height() * ratio * ratio > mostPixels) {
    return {};
  }
  QImage picture((size * ratio).toSize(), QImage::Format_RGB32);
  if (!picture.isNull()) {
    picture.setDevicePixelRatio(ratio);
    picture.fill(Qt::white);
  }
  return picture;
}

std::string PngOf(const QImage& picture, const StringTable& strings) {
  QByteArray bytes;
  QBuffer buffer(&bytes);
  if (picture.isNull() || !buffer.open(QIODevice::WriteOnly) || !picture.save(&buffer, "PNG")) {
    throw RuntimeError(Fault::OutOfMemory, strings.Text(OwnText::PictureTooLarge));
  }
  return bytes.toStdString();
}
