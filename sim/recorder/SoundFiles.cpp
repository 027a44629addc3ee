#include "sim/recorder/SoundFiles.h"

#include <cerrno>
#include <cstdint>
#include <cstdio>
#include <fstream>
#include <span>
#include <string>
#include <string_view>
#include <system_error>
#include <utility>

namespace sim {
namespace {

std::string LittleEndian(std::size_t value, std::size_t bytes) {
  std::string text;
  for (std::size_t i = 0; i < bytes; ++i) {
    text += static_cast<char>(value >> (8 * i) & 0xFF);
  }
  return text;
}

// Pages have 256 bytes, so the data never needs a padding byte.
std::string WaveHeader(std::size_t dataBytes) {
  constexpr std::size_t formatBytes = 16;
  constexpr std::size_t bytesBeforeData = 36;
  return "RIFF" + LittleEndian(bytesBeforeData + dataBytes, 4) + "WAVEfmt " + LittleEndian(formatBytes, 4) +
         LittleEndian(1, 2) + LittleEndian(1, 2) + LittleEndian(SamplesPerSecond, 4) +
         LittleEndian(SamplesPerSecond, 4) + LittleEndian(1, 2) + LittleEndian(8, 2) + "data" +
         LittleEndian(dataBytes, 4);
}

void Write(const std::filesystem::path& path, std::string_view header, std::span<const std::uint8_t> bytes) {
  std::ofstream file(path, std::ios::binary | std::ios::trunc);
  file << header << std::string(bytes.begin(), bytes.end());
  file.close();
  if (!file) {
    throw std::system_error(errno, std::generic_category(), "cannot write " + path.string());
  }
}

void WriteWave(const std::filesystem::path& path, const SoundChip::Samples& samples) {
  Write(path, WaveHeader(samples.size()), samples);
}

std::string SoundName(std::uint8_t number) {
  const std::string digits = std::to_string(number);
  return "sound-" + std::string(3 - digits.size(), '0') + digits + ".wav";
}

}  // namespace

SoundFiles::SoundFiles(std::filesystem::path folder) : folder_(std::move(folder)) {
  std::filesystem::create_directories(folder_);
}

std::filesystem::path SoundFiles::Keep(const SoundChip& chip) const {
  int number = 1;
  std::filesystem::path path = folder_ / "recording-1";
  while (!std::filesystem::create_directory(path)) {
    ++number;
    path = folder_ / ("recording-" + std::to_string(number));
  }
  for (const auto& [sound, samples] : chip.Sounds()) {
    WriteWave(path / SoundName(sound), samples);
  }
  if (chip.PageCount() > 0) {
    WriteWave(path / "pages.wav", chip.AllPages());
  }
  if (chip.IndexTable()) {
    Write(path / "table.bin", {}, *chip.IndexTable());
  }
  return path;
}

}  // namespace sim
