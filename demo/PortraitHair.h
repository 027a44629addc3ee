#pragma once

#include <QColor>
#include <QPainter>

#include "demo/Portrait.h"

/// What is seen of the hair behind head and shoulders.
void DrawHairBehind(QPainter& painter, Hair hair, const QColor& colour);

void DrawHairInFront(QPainter& painter, Hair hair, const QColor& colour);

void DrawBeard(QPainter& painter, Beard beard, const QColor& colour);
