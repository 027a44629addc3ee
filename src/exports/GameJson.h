#pragma once

#include <string>

#include "exports/GameWriter.h"

inline constexpr const char* GameJsonFormat = "tessarine-games";
/// Raised when a reader of the former version would go wrong; new keys alone do not raise it.
inline constexpr int GameJsonVersion = 1;

/// The games with their players and hits: an object with the keys `format`, `version` and `games`.
class GamesJson : public GameWriter {
 public:
  explicit GamesJson(const PersonalData& personal);

  void Add(const ExportedGame& game) override;
  void End() override;
  std::string Take() override;

 private:
  const PersonalData personal_;
  std::string text_;
  int number_ = 0;
};
