#include "sound/SoundList.h"

#include "core/text/NumberForms.h"
#include "core/text/Pieces.h"
#include "platform/RuntimeError.h"
#include "sound/Playlist.h"
#include "sound/SoundPages.h"
#include "sound/SoundSamples.h"

void SoundList::Fill(const std::vector<std::string>& events) {
  rows_.clear();
  for (const std::string& event : events) {
    rows_.push_back({.Event = event});
  }
}

void SoundList::AddSoundToList(const std::string& path, std::size_t row) {
  if (row >= rows_.size()) {
    throw RuntimeError(Fault::SubscriptOutOfRange);
  }
  rows_[row].File = Trimmed(path, [](char letter) { return letter == ' '; });
  rows_[row].Pages.reset();
}

std::string SoundList::Playlist() const {
  std::vector<std::string> paths;
  for (const SoundRow& row : rows_) {
    paths.push_back(row.File);
  }
  return WritePlaylist(paths);
}

void SoundList::TakePlaylist(const std::string& bytes) {
  std::size_t row = 0;
  for (const std::string& path : ReadPlaylist(bytes)) {
    if (!path.empty()) {
      AddSoundToList(path, row);
      ++row;
    }
  }
}

double SoundList::Reckon() {
  double seconds = 0;
  for (SoundRow& row : rows_) {
    row.Pages.reset();
    if (row.File.empty()) {
      continue;
    }
    std::int64_t size = 0;
    bool usable = true;
    if (IsWave(row.File)) {
      usable = wave_.WaveOpenFile(row.File);
      size = wave_.ReadSize();
    } else {
      size = RawSize(files_, row.File);
    }
    const std::int32_t pages = SoundChip::PagesOf(size);
    if (usable) {
      row.Pages = pages;
    }
    seconds += SoundChip::SecondsOf(pages);
  }
  return seconds;
}

std::string UtilisationText(double seconds) {
  const std::string start = "Sound Chip Utilisation: " + FormatFixed(seconds, 2) + " seconds";
  if (seconds > SoundChip::CapacitySeconds) {
    return start + ".  Error! Sounds too long!";
  }
  return start + ", " + FormatPercent(seconds / SoundChip::CapacitySeconds) + ".";
}
