#pragma once

#include <QImage>
#include <string>

#include "core/text/StringTable.h"

/// A white picture to paint on: its size in points, and pixels to the point. Null where it would take more
/// than a gigabyte, or where there is no memory for it.
QImage WhitePicture(const QSizeF& size, double ratio);

/// The bytes of a PNG file. Throws RuntimeError 7 for a picture that there was no memory for, or which is too
/// large for such a file.
std::string PngOf(const QImage& picture, const StringTable& strings);
