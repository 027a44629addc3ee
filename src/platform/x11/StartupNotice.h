#pragma once

#include <string>

/// Tells the desktop on an X display that the start which it calls `id` (from the variable
/// DESKTOP_STARTUP_ID) has ended without a window of its own, so that it no longer shows it as busy. Does
/// nothing where `id` is empty or the display cannot be opened.
void EndStartupNotice(const std::string& display, const std::string& id);
