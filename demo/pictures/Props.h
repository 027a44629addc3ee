#pragma once

#include <QDir>
#include <QString>

/// Firmware for a device, large enough that its download can be watched. Returns the file.
QString MakeFirmware(const QDir& folder);

/// Some sounds in the format of the sound chip, and the play list that has them in its first rows. Returns
/// the play list.
QString MakeSounds(const QDir& folder);
