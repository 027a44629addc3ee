#pragma once

#include <functional>

class QComboBox;

/// Keeps a drop-down list from being changed by accident: while it is closed it ignores the mouse wheel, and
/// a letter opens it, so that nothing is chosen before Return. Calls `leave` soon after the list was closed,
/// with or without a choice.
void KeepCalm(QComboBox& list, std::function<void()> leave);
