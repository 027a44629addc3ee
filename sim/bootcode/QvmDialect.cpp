#include "sim/bootcode/QvmDialect.h"

#include <span>

namespace sim {
namespace {

constexpr std::size_t MostBufferBytes = 51;
const std::vector<std::uint8_t> SetUpBytes{'S', 0x00, 0x70, 0x8F};

}  // namespace

void QvmDialect::Restart() {
  setUp_ = false;
  piece_.clear();
}

BootDialect::Heard QvmDialect::Take(std::uint8_t byte) {
  if (piece_.empty() && byte != (setUp_ ? 'Z' : SetUpBytes.front())) {
    return Heard::Foreign;
  }
  piece_.push_back(byte);
  const std::size_t whole = setUp_ ? 1 + MostBufferBytes : SetUpBytes.size();
  return piece_.size() == whole ? Heard::Complete : Heard::More;
}

BootVerdict QvmDialect::CarryOut() {
  if (!setUp_) {
    return SetUp();
  }
  const std::span<const std::uint8_t> buffer = std::span(piece_).subspan(1);
  store_.Add(buffer);
  BootVerdict verdict{.Answer = 'f', .Note = "buffer " + std::to_string(store_.Buffers().size())};
  piece_.clear();
  return verdict;
}

BootVerdict QvmDialect::SetUp() {
  const bool good = piece_ == SetUpBytes;
  piece_.clear();
  if (!good) {
    return {.Answer = 'e', .Note = "set-up", .Fault = "sent a set-up other than 00 70 8F"};
  }
  setUp_ = true;
  store_.Clear();
  return {.Answer = 'f', .Note = "set-up"};
}

}  // namespace sim
