#pragma once

#include <QImage>
#include <QRectF>
#include <string>

class QPainter;

/// The QR code of a text, a pixel a module, dark on white with the white border that readers need. Null for
/// an empty text and one that is too long for a code.
QImage QrCode(const std::string& text);

/// Paints it as large as `area` allows, in the middle. On a raster all modules are equally many whole pixels
/// where there is room for that.
void PaintQrCode(QPainter& painter, const QRectF& area, const std::string& text);
