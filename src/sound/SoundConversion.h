#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>

#include "platform/Files.h"

/// Name of a file without folder and extension.
std::string GetFileName(std::string_view path);

/// A free name for a converted sound beside its original: "NAME-chip.wav", or "NAME-chip-2.wav" and so on if
/// that is taken.
std::string ConvertedName(const Files& disk, const std::string& path);

/// A wave file in the chip's format.
std::string WaveBytes(std::span<const std::uint8_t> samples);

/// True for the endings that are known to hold samples in the chip's format, pcm and raw.
bool IsRawSamples(std::string_view path);
