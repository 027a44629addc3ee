#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <vector>

#include "firmware/pic24f/PicFrame.h"

namespace {

constexpr std::size_t Longest = 261;

void Require(bool condition) {
  if (!condition) {
    std::abort();
  }
}

}  // namespace

/// The input is what comes in on the line; it is a packet's data as well.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  PicFrameDecoder decoder(Longest);
  for (std::size_t i = 0; i < size; ++i) {
    if (decoder.Receive(data[i])) {
      Require(!decoder.Data().empty() && decoder.Data().size() <= Longest);
    }
  }
  if (size == 0 || size > Longest) {
    return 0;
  }
  // A packet comes back as it was, whatever came before it. A lone DLE there would take its first mark.
  const std::vector<std::uint8_t> packet(data, data + size);
  decoder.Receive(0);
  bool found = false;
  for (const std::uint8_t byte : PicFrame(packet)) {
    found = decoder.Receive(byte);
  }
  Require(found && decoder.Data() == packet);
  return 0;
}
