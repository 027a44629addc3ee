#pragma once

#include <QAbstractItemModel>
#include <QString>

/// Header and rows as displayed, one line each, with tabs between cells.
QString TabSeparated(const QAbstractItemModel& list);

/// Header and rows in aligned columns for a terminal.
QString Aligned(const QAbstractItemModel& list);
