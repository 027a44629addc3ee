#pragma once

#include <optional>

#include "platform/MessageBoxes.h"

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

/// Fits the main window to its screen, whose size is in the screen's own pixels, and warns in a box if the
/// screen is small.
void FitToScreen(QWidget& window, MessageBoxes& boxes);
