#pragma once

#include <QString>

class QAbstractItemView;

/// The selected rows of a list, or all if none is selected, from the top as tab-separated text, headers
/// first.
QString RowsAsText(const QAbstractItemView& list);

/// Puts them on the clipboard.
void CopyRows(const QAbstractItemView& list);
