#pragma once

#include <QColor>
#include <QPixmap>
#include <cstdint>

#include "devices/radio/GunTable.h"

/// A battery filled to `percent` (more than 100 counts as 100): green; amber at 40 % and below, red at 20 %
/// and below.
QPixmap BatteryPicture(std::uint8_t percent);

/// A mark for `status`, distinct in shape as well as in colour: ring, arrow, cross, tick.
QPixmap StatusPicture(ScoreStatus status);

/// Background of a row with this status: its colour, thinly over `base`. Pending rows keep `base`.
QColor StatusTint(ScoreStatus status, const QColor& base);
