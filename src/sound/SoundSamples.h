#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

#include "platform/Files.h"

/// Size of a file of raw samples in bytes. Throws RuntimeError 53 if there is no such file, 75 if it cannot
/// be read; the text does not repeat a path that is too long for one.
std::int64_t RawSize(const Files& disk, const std::string& path);

/// The samples of a sound file, at most `most` of them; fewer than a wave file declares where it is cut.
/// Throws RuntimeError 53 if there is no such file, 75 if it cannot be read, and 321 if it is no wave file in
/// the chip's format.
std::vector<std::uint8_t> ReadSamples(const Files& disk, const std::string& path, std::size_t most);
