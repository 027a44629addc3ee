#pragma once

class QWidget;

/// The window that a box or dialog opened now belongs to: the one the operator is working in, else
/// `mainWindow` when it is visible, else none.
QWidget* DialogParent(QWidget* mainWindow);
