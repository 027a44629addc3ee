#include "core/line/Shifts.h"

#include "platform/RuntimeError.h"

std::int32_t ShiftLeft32(std::int32_t value, std::int16_t shift) {
  if (shift < 0 || shift > 30) {
    throw RuntimeError(Fault::SubscriptOutOfRange);
  }
  return static_cast<std::int32_t>(static_cast<std::uint32_t>(value) << shift);
}

std::int32_t ShiftRight32(std::int32_t value, std::int16_t shift) {
  if (shift < 0 || (shift == 0 && value < 0)) {
    throw RuntimeError(Fault::DivisionByZero);
  }
  if (shift > 31) {
    return 0;
  }
  return static_cast<std::int32_t>((static_cast<std::uint32_t>(value) & ~1U) >> shift);
}
