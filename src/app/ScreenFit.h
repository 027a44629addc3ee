#pragma once

#include <optional>

#include "platform/MessageBoxes.h"

class QWidget;

/// How the main window answers to the screen at start-up. Sizes are pixels.
struct ScreenFit {
  bool Warn = false;  ///< tell that the screen is small
  bool Maximised = false;
  std::optional<int> Width;   ///< limit, with the window at the left edge
  std::optional<int> Height;  ///< limit, with the window at the top edge
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

/// Fits the main window to its screen, whose size counts in the screen's own pixels, and tells in a box that
/// it is small.
void FitToScreen(QWidget& window, MessageBoxes& boxes);
