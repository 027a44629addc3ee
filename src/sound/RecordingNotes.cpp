#include "sound/RecordingNotes.h"

#include <algorithm>
#include <cstdint>
#include <limits>
#include <utility>

#include "core/text/Filled.h"
#include "core/text/NumberForms.h"
#include "platform/RuntimeError.h"
#include "sound/SoundPages.h"
#include "sound/SoundSamples.h"

namespace {

constexpr std::int64_t LastPage = std::numeric_limits<std::int16_t>::max();

/// Far more than can be recorded, and few enough that their pages can be counted.
constexpr std::int64_t MostBytes = std::int64_t{1} << 36U;

/// What the hardware gets for a row, and how far the table of pages counts on for it.
struct Sizes {
  std::int64_t Sent = 0;
  std::int64_t InTable = 0;
};

class Notes {
 public:
  Notes(const Files& files, const StringTable& strings) : files_(files), strings_(strings) {}

  std::vector<std::string> Of(const SoundList& list, Recorder recorder) {
    const std::vector<SoundRow>& rows = list.Rows();
    for (std::size_t row = 0; row < rows.size(); ++row) {
      if (!rows[row].File.empty()) {
        NoteRow(row, rows[row].File, recorder);
      }
      tablePage_ += step_;
    }
    if (rows.size() > SoundChip::MostSounds) {
      Add(OwnText::NoteTooManyRows, {std::to_string(rows.size()), std::to_string(SoundChip::MostSounds)});
    }
    if (tablePage_ > LastPage) {
      Add(OwnText::NoteTooManyPages, {std::to_string(tablePage_), std::to_string(LastPage)});
    }
    if (SoundChip::SecondsOf(sentPage_) > SoundChip::CapacitySeconds) {
      Add(OwnText::NoteTooLong,
          {FormatFixed(SoundChip::SecondsOf(sentPage_), 2), PlainDecimal(SoundChip::CapacitySeconds)});
    }
    return std::move(notes_);
  }

 private:
  void Add(OwnText text, std::initializer_list<std::string_view> values) {
    notes_.push_back(Filled(strings_.Text(text), values));
  }

  void NoteRow(std::size_t row, const std::string& path, Recorder recorder) {
    const std::string number = std::to_string(row + 1);
    const Sizes sizes = SizesOf(number, path);
    const std::int64_t pages = SoundChip::PagesOf(sizes.Sent);
    if (usable_ && pages == 0) {
      Add(OwnText::NoteNoPages, {number, path});
    }
    if (recorder == Recorder::InProduct && !tableNoted_ && tablePage_ != sentPage_) {
      tableNoted_ = true;
      Add(OwnText::NoteTable, {number, std::to_string(tablePage_), std::to_string(sentPage_)});
    }
    step_ = SoundChip::PagesOf(sizes.InTable);
    sentPage_ += pages;
  }

  Sizes SizesOf(const std::string& number, const std::string& path) {
    usable_ = true;
    if (!IsWave(path)) {
      try {
        const auto size = std::min(RawSize(files_, path), MostBytes);
        return {size, size};
      } catch (const RuntimeError& error) {
        NoteUnusable(number, error.what());
        return {};
      }
    }
    const WaveCheck check = CheckWave(files_, path);
    if (check.Error != WaveError::None) {
      NoteUnusable(number, std::string(TextOf(check.Error)) + " " + path);
      return {.InTable = -dataOffset_};
    }
    dataOffset_ = static_cast<std::int64_t>(check.DataOffset);
    return {check.DataLength, check.DataLength - dataOffset_};
  }

  void NoteUnusable(const std::string& number, const std::string& why) {
    usable_ = false;
    Add(OwnText::NoteUnusable, {number, why});
  }

  const Files& files_;
  const StringTable& strings_;
  std::vector<std::string> notes_;
  std::int64_t tablePage_ = 1;
  std::int64_t step_ = 1;
  std::int64_t sentPage_ = 0;
  std::int64_t dataOffset_ = 0;  ///< of the last good wave file
  bool usable_ = true;
  bool tableNoted_ = false;
};

}  // namespace

std::vector<std::string> RecordingNotes(const SoundList& list, const Files& files, Recorder recorder,
                                        const StringTable& strings) {
  return Notes(files, strings).Of(list, recorder);
}
