#include "charts/PictureFile.h"

#include <QBuffer>

#include "platform/RuntimeError.h"

std::string PngOf(const QImage& picture, const StringTable& strings) {
  QByteArray bytes;
  QBuffer buffer(&bytes);
  if (picture.isNull() || !buffer.open(QIODevice::WriteOnly) || !picture.save(&buffer, "PNG")) {
    throw RuntimeError(Fault::OutOfMemory, strings.Text(OwnText::PictureTooLarge));
  }
  return bytes.toStdString();
}
