#pragma once

#include <functional>

class QComboBox;

/// Calls `choose` with the entry each time one is chosen in `list`, by the operator, a screen reader or the
/// program; also when the operator chooses the current entry again.
void OnChoice(QComboBox& list, const std::function<void(int)>& choose);
