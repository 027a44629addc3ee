#pragma once

#include <string>

/// Shows the progress of a run and lets the operator stop it.
class SheetProgress {
 public:
  virtual ~SheetProgress() = default;

  virtual void Open() = 0;

  /// Shows that sheet `number` (from 1) of `count` is being made, for the player `name`.
  virtual void ShowSheet(int number, int count, const std::string& name) = 0;

  /// True once the operator has asked to stop after the current sheet.
  virtual bool Stopped() const = 0;

  virtual void Close() = 0;
};
