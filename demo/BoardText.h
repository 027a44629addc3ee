#pragma once

#include <QAbstractItemModel>
#include <QString>

/// Header and rows as shown, one line each, cells separated by tabs.
QString TabSeparated(const QAbstractItemModel& list);

/// Header and rows in aligned columns for a terminal.
QString Aligned(const QAbstractItemModel& list);
