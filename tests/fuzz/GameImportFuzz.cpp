#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>

#include "archive/PlayedTime.h"
#include "archive/import/GameFileCheck.h"
#include "core/text/TextEncoding.h"
#include "tests/fakes/FakeClock.h"

namespace {

const StringTable Texts(Language::English);

void Require(bool condition) {
  if (!condition) {
    std::abort();
  }
}

}  // namespace

/// Whatever the bytes, they are a game with players, or something is told of a line that they have.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::string bytes(reinterpret_cast<const char*>(data), size);
  GameInFile game{.Game = Game(Texts), .Mission = {}};
  const auto trouble = ReadCheckedGame(bytes, Texts, game, [] {});
  if (!trouble) {
    Require(std::any_of(game.Game.Players.begin(), game.Game.Players.end(),
                        [](const Player& player) { return player.Active; }));
    const std::string played = TimePlayed(game.Game.GameDate, "2026-11-21 20:15:30", FakeClock());
    Require(played.size() == std::string("2026-11-21 20:15:30").size());
    return 0;
  }
  Require(trouble->Line <= static_cast<std::size_t>(std::count(bytes.begin(), bytes.end(), '\n')) + 1);
  const std::string text = TextOf(*trouble, Texts);
  Require(!text.empty() && IsUtf8(text) && text.size() < 300);
  return 0;
}
