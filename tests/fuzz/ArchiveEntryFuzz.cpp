#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>

#include "archive/Entries.h"
#include "core/gamefile/GameFile.h"
#include "platform/RuntimeError.h"

namespace {

void Require(bool condition) {
  if (!condition) {
    std::abort();
  }
}

/// A game, not a game, or one of the three expected errors.
void ReadAsGame(const std::string& bytes) {
  static const StringTable strings(Language::English);
  Game game(strings);
  try {
    ReadGameFile(bytes, game, [](const std::string&) {});
  } catch (const RuntimeError& error) {
    Require(error.Number() == 6 || error.Number() == 9 || error.Number() == 13);
  }
}

}  // namespace

/// The first four bytes are the size that the entry claims, the lowest first; the rest is what it holds. It
/// is unpacked to that size or refused, and what was unpacked survives being packed.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  constexpr std::size_t claimLength = 4;
  if (size < claimLength) {
    return 0;
  }
  std::uint32_t claimed = 0;
  for (std::size_t at = claimLength; at > 0; --at) {
    claimed = claimed << 8U | data[at - 1];
  }
  std::string bytes = "left over";
  const Unpacking result =
      Unpack(Blob(data + claimLength, data + size), static_cast<std::int32_t>(claimed), bytes);
  if (result != Unpacking::Done) {
    Require(bytes.empty());
    return 0;
  }
  Require(bytes.size() == claimed && claimed <= LargestEntry);
  ReadAsGame(bytes);
  std::string again;
  Require(Unpack(Packed(bytes), static_cast<std::int64_t>(bytes.size()), again) == Unpacking::Done);
  Require(again == bytes);
  return 0;
}
