#pragma once

#include <QImage>
#include <QString>

#include "audience/AudienceLayout.h"

class QPainter;

/// What the board shows beside results. Each fills the whole area, whose page must be filled already. Texts
/// are broken into lines where they could not be read from the place else. Each tells the height of the
/// smallest capitals in pixels of the screen; of no text, 0.
namespace AudienceViews {

/// The venue's picture above its name; either may be missing.
double PaintVenue(QPainter& painter, const AudiencePlace& place, const QString& name, const QImage& picture);

/// A heading, and below it what matters, both as large as fits.
double PaintMessage(QPainter& painter, const AudiencePlace& place, const QString& heading,
                    const QString& message);

/// A QR code as large as the screen allows, the address that it holds and a heading, below each other or side
/// by side. Where there is no room, first the address loses "http://", then the heading is left out.
double PaintCode(QPainter& painter, const AudiencePlace& place, const QString& heading,
                 const QString& address);

}  // namespace AudienceViews
