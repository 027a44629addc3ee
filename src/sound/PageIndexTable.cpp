#include "sound/PageIndexTable.h"

#include <limits>

#include "platform/RuntimeError.h"
#include "sound/SoundPages.h"
#include "sound/SoundSamples.h"

std::int16_t ToPage(std::int64_t value) {
  if (value < std::numeric_limits<std::int16_t>::min() || value > std::numeric_limits<std::int16_t>::max()) {
    throw RuntimeError(Fault::Overflow);
  }
  return static_cast<std::int16_t>(value);
}

void PageIndexTable::Set(std::size_t index, std::int16_t page) {
  if (index >= entries_.size()) {
    throw RuntimeError(Fault::SubscriptOutOfRange);
  }
  entries_[index] = page;
}

void PageIndexTable::Build(const SoundList& list, const Files& files, WaveFile& wave) {
  std::size_t next = 0;
  std::int16_t page = 1;
  std::int16_t step = 1;
  for (const SoundRow& row : list.Rows()) {
    Set(next, page);
    ++next;
    if (!row.File.empty()) {
      std::int64_t size = 0;
      if (IsWave(row.File)) {
        wave.WaveOpenFile(row.File);
        size = std::int64_t{wave.ReadSize()} - static_cast<std::int64_t>(wave.DataOffset());
      } else {
        size = RawSize(files, row.File);
      }
      step = ToPage(SoundChip::PagesOf(size));
    }
    page = ToPage(page + step);
  }
  Set(next, page);
}

std::array<std::uint8_t, PageIndexTable::SentBytes> PageIndexTable::Bytes() const {
  std::array<std::uint8_t, SentBytes> bytes{};
  for (std::size_t entry = 0; entry < SentBytes / 2; ++entry) {
    bytes[2 * entry] = HiByte(entries_[entry]);
    bytes[2 * entry + 1] = LoByte(entries_[entry]);
  }
  return bytes;
}
