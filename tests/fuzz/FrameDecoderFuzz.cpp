#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>

#include "core/FrameDecoder.h"
#include "tests/fakes/FakeClock.h"

namespace {

void Require(bool condition) {
  if (!condition) {
    std::abort();
  }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  static const StringTable strings(Language::English);
  static Game game(strings);
  game.Clear();
  ReceiveBuffer buffer{};
  std::copy_n(data, std::min(size, buffer.size()), buffer.begin());
  const int index = IndexFromId(buffer[4]);
  AnalyseData(buffer, game, FakeClock());
  Require(game.DataPresent && !game.GameDate.empty());
  Require(std::all_of(buffer.begin(), buffer.end(), [](std::uint8_t byte) { return byte == 0; }));
  for (int i = 1; i <= PlayerCount; ++i) {
    const Player& player = game.Players(i);
    Require(player.Active == (i == index));
    Require(player.DallasID.size() == 16);
    Require(player.ShotCount >= 0 && player.ShotCount <= 32767);
  }
  return 0;
}
