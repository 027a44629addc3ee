#pragma once

#include <QImage>
#include <QSize>
#include <string>

/// The picture in `bytes`, in any format that Qt reads, turned upright; null if they are not a whole picture.
/// Bytes after the end of the picture are ignored. A picture larger than `largest` is scaled down to it while
/// it is read, which takes a fraction of the time and memory.
QImage ReadPicture(const std::string& bytes, QSize largest);
