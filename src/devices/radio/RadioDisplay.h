#pragma once

#include <string>

/// Where a job on the radio link shows its progress.
class RadioDisplay {
 public:
  virtual ~RadioDisplay() = default;

  virtual void SetStatus(const std::string& text) = 0;
  virtual void SetPlayersFound(int count) = 0;
  virtual void ClearGunList() = 0;

  /// Shows the guns as they are now and processes pending events.
  virtual void RefreshGunList() = 0;

  /// Step `step` of `steps`, counted from 0, begins.
  virtual void SetProgress(const std::string& text, int step, int steps) = 0;
};
