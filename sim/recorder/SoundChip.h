#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <span>
#include <vector>

namespace sim {

constexpr std::size_t PageBytes = 256;
constexpr int SamplesPerSecond = 22050;

/// What a sound chip holds: 8-bit unsigned mono samples in pages of 256. A stand-alone recorder fills it
/// sound by sound; a gun page by page, with a table of 128 entries of which entry n is the page where sound n
/// starts.
class SoundChip {
 public:
  using Samples = std::vector<std::uint8_t>;
  using Table = std::array<std::uint8_t, PageBytes>;  ///< for each entry its high byte, then its low byte

  void Erase() { *this = {}; }

  /// Replaces what the chip had under that number.
  void BeginSound(std::uint8_t number) { sounds_[number].clear(); }
  void AppendToSound(std::uint8_t number, std::span<const std::uint8_t> page);

  void SetTable(std::span<const std::uint8_t, PageBytes> bytes);
  const std::optional<Table>& IndexTable() const { return table_; }
  void SetPage(std::uint16_t number, std::span<const std::uint8_t> page);
  std::size_t PageCount() const { return pages_.size(); }
  /// All pages one behind the other; those missing between others are silence.
  Samples AllPages() const;

  bool IsEmpty() const { return sounds_.empty() && pages_.empty() && !table_; }
  /// The sounds by number; those of a gun as its table tells. The table counts pages from 1 and the pages
  /// themselves from 0, so entry 1 is page 0. A sound without pages, or whose pages have not come, is left
  /// out.
  std::map<std::uint8_t, Samples> Sounds() const;

 private:
  std::uint16_t Entry(std::size_t index) const;

  std::map<std::uint8_t, Samples> sounds_;
  std::optional<Table> table_;
  std::map<std::uint16_t, Samples> pages_;
};

}  // namespace sim
