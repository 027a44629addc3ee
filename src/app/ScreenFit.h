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

/// True for a screen so small that the window always starts as FitToScreen says, wherever it was before.
constexpr bool AlwaysFits(int screenWidth, int screenHeight) {
  const ScreenFit fit = FitToScreen(screenWidth, screenHeight);
  return fit.Warn || fit.Maximised;
}

/// True for a screen on which the window is maximised as long as the operator has given it no place.
constexpr bool StartsMaximised(int screenWidth, int screenHeight) {
  constexpr int mostWidth = 1366;
  constexpr int mostHeight = 800;
  return !AlwaysFits(screenWidth, screenHeight) && screenWidth <= mostWidth && screenHeight <= mostHeight;
}

/// Size of a screen in its own pixels, not divided by the desktop's scale factor.
QSize PixelsOf(const QScreen& screen);

/// Fits the main window to its screen, and warns in a box if the screen has few pixels.
void FitToScreen(QWidget& window, MessageBoxes& boxes);

/// Maximises a window that has no place of its own yet, where it is larger than the work area or its screen
/// not larger than a laptop's.
void MaximiseOnSmallScreen(QWidget& window);
