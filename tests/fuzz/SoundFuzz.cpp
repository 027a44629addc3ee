#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>
#include <vector>

#include "core/text/TextEncoding.h"
#include "sound/Playlist.h"
#include "sound/RecordingNotes.h"
#include "sound/SoundConversion.h"
#include "sound/SoundDefinition.h"
#include "sound/SoundPages.h"
#include "sound/SoundSamples.h"
#include "sound/WaveCheck.h"
#include "tests/fakes/FakeFiles.h"
#include "tests/fakes/FakeMessageBoxes.h"

namespace {

constexpr const char* Wave = "/sound.wav";
constexpr const char* Raw = "/sound.raw";
constexpr std::size_t MostSamples = std::size_t{1} << 20U;

void Require(bool condition) {
  if (!condition) {
    std::abort();
  }
}

/// Samples that were found can be read, and come back from a file of our own.
void CheckReader(const std::string& bytes) {
  FakeFiles disk;
  disk.Put(Wave, bytes);
  disk.Put(Raw, bytes);
  const WaveCheck check = CheckWave(disk, Wave);
  if (check.Error == WaveError::None) {
    Require(check.Format.Channels == 1 && check.Format.BitsPerSample == 8);
    Require(check.DataOffset >= 44 && check.DataOffset <= bytes.size());
    const std::vector<std::uint8_t> samples = ReadSamples(disk, Wave, MostSamples);
    Require(samples.size() == std::min({std::size_t{check.DataLength}, MostSamples,
                                        bytes.size() - static_cast<std::size_t>(check.DataOffset)}));
    disk.Put("/again.wav", WaveBytes(samples));
    Require(ReadSamples(disk, "/again.wav", MostSamples) == samples);
  }
  FakeMessageBoxes boxes;
  WaveFile wave(disk, boxes);
  SoundList list(disk, wave);
  list.Fill({"Wave", "None", "Raw"});
  list.AddSoundToList(Wave, 0);
  list.AddSoundToList(Raw, 2);
  Require(list.Reckon() >= SoundChip::SecondsOf(list.Rows()[2].Pages.value()));
  Require(boxes.Boxes.size() == (check.Error == WaveError::None ? 0U : 1U));
  RecordingNotes(list, disk, Recorder::InProduct, StringTable(Language::English));
}

/// A list that was read is one that can be written, and then comes back as it is.
void CheckPlaylist(const std::string& bytes) {
  std::vector<std::string> records = ReadPlaylist(bytes);
  for (const std::string& record : records) {
    Require(IsUtf8(record) && record.find('\n') == std::string::npos);
  }
  std::erase_if(records, [](const std::string& record) { return !FitsPlaylist(record); });
  Require(ReadPlaylist(WritePlaylist(records)) == records);
}

void CheckDefinition(const std::string& bytes) {
  const auto events = ReadSoundDefinition(bytes);
  if (events) {
    Require(
        std::all_of(events->begin(), events->end(), [](const std::string& event) { return IsUtf8(event); }));
  }
}

}  // namespace

/// Whatever the bytes, as a wave file, a play list or a product's list they are taken or refused.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::string bytes(reinterpret_cast<const char*>(data), size);
  CheckReader(bytes);
  CheckPlaylist(bytes);
  CheckDefinition(bytes);
  return 0;
}
