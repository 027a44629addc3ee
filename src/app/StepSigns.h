#pragma once

#include <QIcon>

#include "core/game/GameProgress.h"

/// The sign of a step after the game in the given colour, with a tick in its corner once the step is done.
QIcon StepSign(GameStep step, bool done, const QColor& colour);
