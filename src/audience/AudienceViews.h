#pragma once

#include <QImage>
#include <QString>

#include "audience/AudienceLayout.h"

class QPainter;

/// What the board shows beside results. Each fills the whole area, whose page must be filled already.
namespace AudienceViews {

/// The venue's picture above its name; either may be missing.
void PaintVenue(QPainter& painter, const AudiencePlace& place, const QString& name, const QImage& picture);

/// A heading, and below it what matters, both as large as fits.
void PaintMessage(QPainter& painter, const AudiencePlace& place, const QString& heading,
                  const QString& message);

/// A heading, a QR code as large as the screen allows, and the address that it holds.
void PaintCode(QPainter& painter, const AudiencePlace& place, const QString& heading, const QString& address);

}  // namespace AudienceViews
