#pragma once

#include <QImage>
#include <string>

#include "core/text/StringTable.h"

/// The bytes of a PNG file. Throws RuntimeError 7 for a picture that there was no memory for, or which is too
/// large for such a file.
std::string PngOf(const QImage& picture, const StringTable& strings);
