#pragma once

/// Sets the application's name, icon and style, and keeps its windows on the screen; call once before the
/// first window. Needs a QApplication.
void PrepareLook();
