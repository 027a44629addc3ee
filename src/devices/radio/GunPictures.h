#pragma once

#include <QColor>
#include <QPixmap>
#include <cstdint>

#include "devices/radio/GunTable.h"

/// A battery, as full as `percent` says (above 100 counts as 100): green, amber from 40 % down, red from 20
/// %.
QPixmap BatteryPicture(std::uint8_t percent);

/// A mark that differs in form as well as in colour: ring, arrow, cross, tick.
QPixmap StatusPicture(ScoreStatus status);

/// Background of a row with this status, laid thinly over `base`. Pending rows keep `base`.
QColor StatusTint(ScoreStatus status, const QColor& base);
