#include "members/PictureReader.h"

#include <QBuffer>
#include <QImageReader>

#include "members/PictureEnd.h"

QImage ReadPicture(const std::string& bytes, QSize largest) {
  QByteArray content = QByteArray::fromRawData(bytes.data(), static_cast<qsizetype>(bytes.size()));
  QBuffer buffer(&content);
  QImageReader reader(&buffer);
  reader.setDecideFormatFromContent(true);
  reader.setAutoTransform(true);
  const QSize size = reader.size();
  if (size.width() > largest.width() || size.height() > largest.height()) {
    reader.setScaledSize(size.scaled(largest, Qt::KeepAspectRatio).expandedTo(QSize(1, 1)));
  }
  // In some formats Qt does not notice itself that the end is missing.
  const bool isWhole = reader.canRead() && !IsCutShort(bytes, reader.format().toStdString());
  return isWhole ? reader.read() : QImage();
}
