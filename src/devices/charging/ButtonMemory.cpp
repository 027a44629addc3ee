#include "devices/charging/ButtonMemory.h"

#include <algorithm>
#include <chrono>

namespace {

// Commands to the selected device.
constexpr std::uint8_t ReadMemory = 0xF0;
constexpr std::uint8_t WriteScratchpad = 0x0F;
constexpr std::uint8_t ReadScratchpad = 0xAA;
constexpr std::uint8_t CopyScratchpad = 0x55;

constexpr std::uint8_t IdleBus = 0xFF;  ///< sent to read

// Place of the block in the memory: 32.
constexpr std::uint8_t AddressLow = 0x20;
constexpr std::uint8_t AddressHigh = 0x00;

constexpr std::chrono::milliseconds CopyTime{1};

/// A command with its address, and the block: one exchange, since each would cost a way there and back.
using BlockCommand = std::array<std::uint8_t, 3 + std::tuple_size_v<ChargeBlock>>;

BlockCommand CommandOf(std::uint8_t command) {
  BlockCommand bytes{};
  bytes.fill(IdleBus);
  bytes[0] = command;
  bytes[1] = AddressLow;
  bytes[2] = AddressHigh;
  return bytes;
}

}  // namespace

bool ButtonMemory::ReadBlock(ChargeBlock& block) {
  const BlockCommand command = CommandOf(ReadMemory);
  BlockCommand answer = command;
  const std::size_t start = answer.size() - block.size();
  if (!poll_.Access() || !poll_.Exchange(answer) ||
      !std::equal(command.begin(), command.begin() + static_cast<std::ptrdiff_t>(start), answer.begin())) {
    return false;
  }
  std::copy(answer.begin() + static_cast<std::ptrdiff_t>(start), answer.end(), block.begin());
  return true;
}

void ButtonMemory::WriteBlock(const ChargeBlock& block) {
  BlockCommand write = CommandOf(WriteScratchpad);
  std::copy(block.begin(), block.end(), write.end() - static_cast<std::ptrdiff_t>(block.size()));
  poll_.Access();
  poll_.Exchange(write);

  std::array<std::uint8_t, 4> place = {ReadScratchpad, IdleBus, IdleBus, IdleBus};
  poll_.Access();
  poll_.Exchange(place);

  // Target address, ending offset and status authorise the copy.
  std::array<std::uint8_t, 4> copy = {CopyScratchpad, place[1], place[2], place[3]};
  poll_.Access();
  poll_.Exchange(copy);
  events_.Sleep(CopyTime);
}
