#pragma once

#include <array>
#include <cstdint>

#include "platform/OneWire.h"

/// One pass of the chip's search accelerator: two bits for each of the ROM's 64, the first one lowest. The
/// upper bit of a pair is the path, asked for or taken; the lower one of an answer tells that devices
/// differed there or that none was left. Source: data sheet of the DS2480B, "Search accelerator operation".
using SearchBlock = std::array<std::uint8_t, 16>;

/// The path to the device behind the one that `state` stands on, or to the first one.
SearchBlock PathToNext(const OneWireState& state);

/// Puts `state` on the device that the chip found along the path to the next one. False, and a new walk, when
/// the bytes are no ROM number (wrong CRC, or no family: a bus that is shorted reads as zeros, whose CRC is
/// right), or when the chip went another way than it was asked where devices differed.
bool TakeFound(const SearchBlock& answer, OneWireState& state);

/// The path to the device with this number.
SearchBlock PathTo(const std::array<std::uint8_t, 8>& rom);

/// True when `answer` is a device's number, and no other device comes behind it in the walk.
bool IsLast(const SearchBlock& answer);
