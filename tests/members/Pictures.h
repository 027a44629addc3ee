#pragma once

#include <QBuffer>
#include <QColor>
#include <QImage>
#include <string>

/// A picture file of one colour.
inline std::string PictureFile(const QColor& colour, const char* format = "PNG", QSize size = QSize(80, 60)) {
  QImage image(size, QImage::Format_RGB32);
  image.fill(colour);
  QByteArray bytes;
  QBuffer buffer(&bytes);
  image.save(&buffer, format);
  return bytes.toStdString();
}

/// The same with bytes after the end of the picture, `size` bytes in all.
inline std::string PictureFileOf(std::size_t size, const QColor& colour) {
  std::string bytes = PictureFile(colour);
  bytes.resize(size, 'x');
  return bytes;
}
