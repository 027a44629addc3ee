#pragma once

#include <numeric>

#include "tests/support/JoinedBytes.h"

/// Packets of a firmware download, written out from the format.
namespace sim::wire {

inline const Bytes ErasePage0{0x45, 0x00, 0x00, 0x00, 0x01, 0xBA};
inline const Bytes ErasePage1{0x45, 0x00, 0x04, 0x00, 0x01, 0xB6};
inline const Bytes ErasePage511{0x45, 0x07, 0xFC, 0x00, 0x01, 0xB7};

/// 0, 1, 2, ... 191.
inline Bytes CountingRow() {
  Bytes row(192);
  std::iota(row.begin(), row.end(), std::uint8_t{0});
  return row;
}

inline const Bytes WriteBlankRow0 = Bytes{0x5A, 0x00, 0x00, 0x00, 0xC1} + Bytes(192, 0xFF) + Bytes{0xA5};
inline const Bytes WriteCountingRow1 = Bytes{0x5A, 0x00, 0x00, 0x80, 0xC1} + CountingRow() + Bytes{0xC5};
inline const Bytes WriteCountingRow4095 = Bytes{0x5A, 0x07, 0xFF, 0x80, 0xC1} + CountingRow() + Bytes{0xBF};

}  // namespace sim::wire
