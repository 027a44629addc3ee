#pragma once

#include <QSize>
#include <optional>

#include "platform/MessageBoxes.h"

class QScreen;
class QWidget;

/// How the main window adapts to the screen at start-up. Sizes are in pixels.
struct ScreenFit {
  bool Warn = false;  ///< warn that the screen is small
  bool Maximised = false;
  std::optional<int> Width;   ///< new width, with the window at the left edge
  std::optional<int> Height;  ///< new height, with the window at the top edge
};

inline constexpr int RecommendedScreenWidth = 1024;
inline constexpr int RecommendedScreenHeight = 768;

constexpr ScreenFit FitToScreen(int screenWidth, int screenHeight) {
  constexpr int taskBarHeight = 33;
  ScreenFit fit;
  if (screenWidth == RecommendedScreenWidth && screenHeight == RecommendedScreenHeight) {
    fit.Maximised = true;
    return fit;
  }
  fit.Warn = screenWidth < RecommendedScreenWidth || screenHeight < RecommendedScreenHeight;
  if (screenWidth < RecommendedScreenWidth) {
    fit.Width = screenWidth;
  }
  if (screenHeight < RecommendedScreenHeight) {
    fit.Height = screenHeight - taskBarHeight;
    fit.Maximised = true;
  }
  return fit;
}

/// Size of a screen in its own pixels, not divided by the desktop's scale factor.
QSize PixelsOf(const QScreen& screen);

/// Fits the main window to its screen, and warns in a box if the screen has few pixels. The window is
/// maximised where it is larger than the work area.
void FitToScreen(QWidget& window, MessageBoxes& boxes);
