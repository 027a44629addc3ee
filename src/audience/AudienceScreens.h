#pragma once

#include <string>
#include <vector>

/// A screen of the desktop.
struct AudienceScreen {
  std::string Name;
  bool IsOperators = false;  ///< the main window is there, or its picture
};

/// Where the board goes.
struct AudienceSpot {
  enum class Kind {
    Window,   ///< an ordinary window among the operator's
    Screen,   ///< the whole of the screen `Name`
    Nowhere,  ///< it waits for the screen `Name`, which is not there
  };
  Kind Where = Kind::Window;
  std::string Name = {};

  bool operator==(const AudienceSpot&) const = default;
};

/// The spot on these screens. `held` is the screen that the board has had since it was switched on, empty if
/// none: it never leaves it for another. Else `wanted` counts, the one that was set, and then the first that
/// is not the operator's; the operator's own is never covered.
AudienceSpot SpotOn(const std::vector<AudienceScreen>& screens, const std::string& wanted,
                    const std::string& held);
