#pragma once

#include "archive/GamesPass.h"

/// Takes a member out of all games of an archive, with the button. Returns how many games named him.
inline int ForgetIn(Database& archive, Database& members, const StringTable& strings, std::int32_t number) {
  GamesPass pass(archive, {.Numbers = {number}, .TakesButtons = true}, GamesPass::Task::TakeOut);
  while (pass.Step(archive, GameArchive(archive, members, strings))) {
  }
  return pass.Games();
}
