#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <memory>
#include <string>

#include "core/GameFile.h"
#include "platform/RuntimeError.h"

/// Whatever the bytes: a game, no game, or one of the three told faults. What was read survives a save and a load.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  static const StringTable strings(Language::English);
  const auto game = std::make_unique<Game>(strings);
  std::string mission;
  const auto keepMission = [&mission](const std::string& name) { mission = name; };
  try {
    if (!ReadGameFile(std::string(reinterpret_cast<const char*>(data), size), *game, keepMission)) {
      return 0;
    }
  } catch (const RuntimeError& error) {
    if (error.Number() != 6 && error.Number() != 9 && error.Number() != 13) {
      std::abort();
    }
    return 0;
  }
  const std::string saved = WriteGameFile(*game, mission);
  const auto again = std::make_unique<Game>(strings);
  if (!ReadGameFile(saved, *again, keepMission)) {
    std::abort();
  }
  for (int index = 1; index <= PlayerCount; ++index) {
    const Player& player = game->Players(index);
    const bool same = player.ShotCount == again->Players(index).ShotCount &&
                      player.Active == again->Players(index).Active && player.Rank == again->Players(index).Rank;
    if (player.Active && !same) {
      std::abort();
    }
  }
  return 0;
}
