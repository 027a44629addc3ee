#pragma once

/// Sets the application's name, icon and style; call once before the first window. Needs a QApplication.
void PrepareLook();
