#pragma once

#include "core/game/TeamColour.h"

/// Colour of a share of the greatest amount, 0 to 1: from a light yellow over red to a dark violet. The
/// lightness falls evenly, so that the order can be seen without colours too.
Rgb HeatColour(double share);

/// Lightness as the eye sees it, 0 for black to 100 for white.
double LightnessOf(const Rgb& colour);
