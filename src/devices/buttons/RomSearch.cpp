#include "devices/buttons/RomSearch.h"

#include "core/line/Checksum.h"

namespace {

constexpr int BitCount = 64;

/// Where the pair for one bit of the ROM is.
struct Pair {
  explicit Pair(int bit)
      : Byte(static_cast<std::size_t>(bit / 4)),
        Conflict(static_cast<std::uint8_t>(1U << (bit % 4 * 2))),
        Path(static_cast<std::uint8_t>(Conflict << 1U)) {}

  std::size_t Byte;
  std::uint8_t Conflict;
  std::uint8_t Path;
};

bool BitOf(const std::array<std::uint8_t, 8>& rom, int bit) {
  return (rom[static_cast<std::size_t>(bit / 8)] >> (bit % 8) & 1) != 0;
}

/// The device that the chip found, with its place in the walk; not `Found` when the bytes are no number.
OneWireState StateFrom(const SearchBlock& answer) {
  OneWireState state;
  for (int bit = 0; bit < BitCount; ++bit) {
    const Pair pair(bit);
    if ((answer[pair.Byte] & pair.Path) != 0) {
      state.Rom[static_cast<std::size_t>(bit / 8)] |= static_cast<std::uint8_t>(1U << (bit % 8));
    } else if ((answer[pair.Byte] & pair.Conflict) != 0) {
      state.Branch = bit;
    }
  }
  state.Found = state.Rom[0] != 0 && Crc8(state.Rom) == 0;
  return state;
}

/// True when the chip took the asked path wherever devices differed.
bool WentAlong(const SearchBlock& path, const SearchBlock& answer) {
  for (std::size_t byte = 0; byte < path.size(); ++byte) {
    constexpr unsigned int conflicts = 0x55;
    const unsigned int differed = (answer[byte] & conflicts) << 1U;
    if (((answer[byte] ^ path[byte]) & differed) != 0) {
      return false;
    }
  }
  return true;
}

}  // namespace

SearchBlock PathToNext(const OneWireState& state) {
  SearchBlock path{};
  for (int bit = 0; bit <= state.Branch && bit < BitCount; ++bit) {
    if (bit == state.Branch || BitOf(state.Rom, bit)) {
      const Pair pair(bit);
      path[pair.Byte] |= pair.Path;
    }
  }
  return path;
}

SearchBlock PathTo(const std::array<std::uint8_t, 8>& rom) {
  SearchBlock path{};
  for (int bit = 0; bit < BitCount; ++bit) {
    if (BitOf(rom, bit)) {
      const Pair pair(bit);
      path[pair.Byte] |= pair.Path;
    }
  }
  return path;
}

bool TakeFound(const SearchBlock& answer, OneWireState& state) {
  const bool wentAlong = WentAlong(PathToNext(state), answer);
  state = StateFrom(answer);
  if (!wentAlong || !state.Found) {
    state = {};
  }
  return state.Found;
}

bool IsLast(const SearchBlock& answer) {
  const OneWireState state = StateFrom(answer);
  return state.Found && state.Branch == OneWireState::None;
}
