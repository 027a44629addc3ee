#include "sound/SoundConversion.h"

#include <algorithm>

#include "platform/Letters.h"
#include "sound/SoundPages.h"

namespace {

std::string LittleEndian(std::uint32_t value, int bytes) {
  std::string text;
  for (int i = 0; i < bytes; ++i) {
    text += static_cast<char>(value >> (8U * static_cast<unsigned int>(i)) & 0xFFU);
  }
  return text;
}

}  // namespace

std::string GetFileName(std::string_view path) {
  const std::size_t folder = path.rfind('/');
  const std::string_view name = folder == std::string_view::npos ? path : path.substr(folder + 1);
  const std::size_t point = name.rfind('.');
  return std::string(name.substr(0, point == 0 ? std::string_view::npos : point));
}

std::string ConvertedName(const Files& disk, const std::string& path) {
  const std::size_t folder = path.rfind('/');
  const std::string start =
      path.substr(0, folder == std::string::npos ? 0 : folder + 1) + GetFileName(path) + "-chip";
  std::string name = start + ".wav";
  for (int number = 2; disk.FileExists(name) || disk.FolderExists(name); ++number) {
    name = start + "-" + std::to_string(number) + ".wav";
  }
  return name;
}

std::string WaveBytes(std::span<const std::uint8_t> samples) {
  constexpr std::uint32_t headerBytes = 36;
  const auto size = static_cast<std::uint32_t>(samples.size());
  const std::uint32_t padding = size % 2;
  std::string bytes = "RIFF" + LittleEndian(headerBytes + size + padding, 4) + "WAVEfmt " +
                      LittleEndian(16, 4) + LittleEndian(1, 2) + LittleEndian(1, 2) +
                      LittleEndian(SoundChip::SamplesPerSecond, 4) +
                      LittleEndian(SoundChip::SamplesPerSecond, 4) + LittleEndian(1, 2) + LittleEndian(8, 2) +
                      "data" + LittleEndian(size, 4);
  bytes.append(samples.begin(), samples.end());
  bytes.append(padding, '\0');
  return bytes;
}

bool IsRawSamples(std::string_view path) {
  constexpr std::size_t extensionLength = 3;
  std::string end(path.substr(path.size() - std::min(path.size(), extensionLength)));
  std::transform(end.begin(), end.end(), end.begin(), LowerAscii);
  return end == "pcm" || end == "raw";
}
