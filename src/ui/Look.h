#pragma once

/// Name, icon and style of the application; call once before the first window. Needs a QApplication.
void PrepareLook();
