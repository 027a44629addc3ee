#pragma once

#include <array>
#include <cstdint>

#include "platform/OneWire.h"

/// One pass of the chip's search accelerator: a pair of bits for each of the ROM's 64, lowest first. The
/// upper bit of a pair is the path, requested or taken; the lower one, in an answer, is set where devices
/// differed or none was left. Source: DS2480B data sheet, "Search accelerator operation".
using SearchBlock = std::array<std::uint8_t, 16>;

/// The path to the device after the one in `state`, or to the first one.
SearchBlock PathToNext(const OneWireState& state);

/// Sets `state` to the device that the chip found along the path to the next one. Returns false, and restarts
/// the search, if the bytes are not a ROM number (wrong CRC, or family 0: a shorted bus reads as zeros, whose
/// CRC is right), or if the chip did not follow the requested path where devices differed.
bool TakeFound(const SearchBlock& answer, OneWireState& state);

/// The path to the device with this number.
SearchBlock PathTo(const std::array<std::uint8_t, 8>& rom);

/// True if `answer` is a device's number and the search has no further device after it.
bool IsLast(const SearchBlock& answer);
