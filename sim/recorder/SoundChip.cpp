#include "sim/recorder/SoundChip.h"

#include <algorithm>

namespace sim {
namespace {

constexpr std::size_t TableEntries = 128;
constexpr std::uint8_t Silence = 0x80;

}  // namespace

void SoundChip::AppendToSound(std::uint8_t number, std::span<const std::uint8_t> page) {
  Samples& sound = sounds_[number];
  sound.insert(sound.end(), page.begin(), page.end());
}

void SoundChip::SetTable(std::span<const std::uint8_t, PageBytes> bytes) {
  std::copy(bytes.begin(), bytes.end(), table_.emplace().begin());
}

void SoundChip::SetPage(std::uint16_t number, std::span<const std::uint8_t> page) {
  pages_[number].assign(page.begin(), page.end());
}

SoundChip::Samples SoundChip::AllPages() const {
  Samples all;
  for (const auto& [number, page] : pages_) {
    all.resize(number * PageBytes, Silence);
    all.insert(all.end(), page.begin(), page.end());
  }
  return all;
}

std::map<std::uint8_t, SoundChip::Samples> SoundChip::Sounds() const {
  std::map<std::uint8_t, Samples> sounds;
  for (const auto& [number, samples] : sounds_) {
    if (!samples.empty()) {
      sounds[number] = samples;
    }
  }
  if (!table_ || pages_.empty()) {
    return sounds;
  }
  const Samples all = AllPages();
  const std::size_t allPages = all.size() / PageBytes;
  for (std::size_t i = 0; i < TableEntries; ++i) {
    // The entry behind the last one is not sent: a last sound goes on to the end of the chip.
    const std::size_t behind = i + 1 < TableEntries ? Entry(i + 1) : allPages + 1;
    const std::size_t end = std::min(behind, allPages + 1);
    const std::size_t begin = Entry(i);
    if (begin >= 1 && begin < end) {
      const auto first = all.begin() + static_cast<std::ptrdiff_t>((begin - 1) * PageBytes);
      const auto last = all.begin() + static_cast<std::ptrdiff_t>((end - 1) * PageBytes);
      sounds[static_cast<std::uint8_t>(i)] = Samples(first, last);
    }
  }
  return sounds;
}

std::uint16_t SoundChip::Entry(std::size_t index) const {
  return static_cast<std::uint16_t>(256U * (*table_)[2 * index] + (*table_)[2 * index + 1]);
}

}  // namespace sim
