#pragma once

#include <string>

#include "exports/ExportedGame.h"

/// Writes games one after the other in one of the forms of an export, so that there may be more of them than
/// fit into memory.
class GameWriter {
 public:
  GameWriter() = default;
  virtual ~GameWriter() = default;
  GameWriter(const GameWriter&) = delete;
  GameWriter& operator=(const GameWriter&) = delete;

  /// Writes the next game. The number of each, counted from 1, stands with it.
  virtual void Add(const ExportedGame& game) = 0;

  /// Writes what stands behind the last game. Nothing may be added afterwards.
  virtual void End() {}

  /// Returns what was written since the last call.
  virtual std::string Take() = 0;
};
