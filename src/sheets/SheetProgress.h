#pragma once

#include <string>

/// Shows how far a run is, and takes the operator's wish to stop it.
class SheetProgress {
 public:
  virtual ~SheetProgress() = default;

  virtual void Open() = 0;

  /// Sheet `number` (from 1) of `count` is being made, for the player `name`.
  virtual void ShowSheet(int number, int count, const std::string& name) = 0;

  /// True once the operator wants the run to end after the present sheet.
  virtual bool Stopped() const = 0;

  virtual void Close() = 0;
};
