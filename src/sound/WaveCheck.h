#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "platform/Files.h"

/// What can be wrong with a sound file, by the number that the operator's text has.
enum class WaveError {
  None = 0,
  NotChipFormat = 1,
  CannotOpen = 2,
  NotWave = 3,
  NoFormat = 4,
  CannotReadFormat = 5,
  NoData = 6,
  OutOfMemory = 7,
  OutOfRange = 8
};

/// Text of an error from 1 to 8.
std::string_view TextOf(WaveError error);

/// The first 18 bytes of a format chunk, zeros where the chunk is shorter.
struct WaveFormat {
  std::uint16_t Tag = 0;
  std::uint16_t Channels = 0;
  std::uint32_t SamplesPerSecond = 0;
  std::uint32_t AverageBytesPerSecond = 0;
  std::uint16_t BlockAlign = 0;
  std::uint16_t BitsPerSample = 0;
  std::uint16_t ExtraSize = 0;
};

struct WaveCheck {
  WaveError Error = WaveError::None;
  WaveFormat Format;
  std::uint64_t DataOffset = 0;  ///< of the samples in the file
  std::uint32_t DataLength = 0;  ///< as the file declares it, which may be more than it holds
};

/// Looks for samples in the chip's format in a wave file. Chunks may come in any order before the samples,
/// which count only behind the format. Declared sizes are trusted.
WaveCheck CheckWave(const Files& files, const std::string& path);

/// True if the check found samples that are plain numbers. It takes companded ones (A-law, mu-law) as well,
/// since it does not look at the tag.
bool IsPlainChipWave(const WaveCheck& check);

/// True if the path's last three characters are "wav" in any case; every other file is raw samples.
bool IsWave(std::string_view path);
