#pragma once

#include <QString>
#include <functional>

class QAbstractItemView;

/// The selected rows of a list, or all if none is selected, from the top as tab-separated text, headers
/// first.
QString RowsAsText(const QAbstractItemView& list);

/// Puts them on the clipboard.
void CopyRows(const QAbstractItemView& list);

/// The same for a list of any length: `goOn` is asked between rows with the part done, 0 to 1, and may
/// process events that do not change the rows. Returns false, with the clipboard as it was, if it says so.
bool CopyRowsInSteps(const QAbstractItemView& list, const std::function<bool(double done)>& goOn);
