#include "sound/SoundPreview.h"

#include <chrono>
#include <utility>
#include <vector>

#include "platform/RuntimeError.h"
#include "sound/SoundPages.h"
#include "sound/SoundSamples.h"

using std::chrono::milliseconds;

namespace {

/// No more than this of a file is played: nearly an hour, and many times what the chip holds.
constexpr std::size_t MostSamples = std::size_t{64} << 20U;

}  // namespace

SoundPreview::Started SoundPreview::PlayRow(const std::string& path) {
  Stop();
  std::vector<std::uint8_t> samples;
  try {
    samples = ReadSamples(parts_.Disk, path, MostSamples);
  } catch (const RuntimeError& error) {
    Tell(error);
    return Started::NotThis;
  }
  if (samples.empty()) {
    return Started::Yes;  // and ended already
  }
  try {
    parts_.Player.Play(std::move(samples), SoundChip::SamplesPerSecond);
  } catch (const RuntimeError& error) {
    Tell(error);
    return Started::NoDevice;
  }
  return Started::Yes;
}

void SoundPreview::PlayAll(const SoundList& list, RecorderDisplay& display,
                           const std::function<bool()>& stopped) {
  constexpr milliseconds endless = milliseconds::max();
  constexpr milliseconds betweenSounds(1000);
  for (std::size_t row = 0; row < list.Rows().size(); ++row) {
    display.SelectRow(row);
    if (PlayRow(list.Rows()[row].File) == Started::NoDevice) {
      break;
    }
    const WaitResult end =
        parts_.Events.WaitFor([&] { return stopped() || !parts_.Player.Playing(); }, endless);
    Stop();
    if (end == WaitResult::Ended || stopped() ||
        parts_.Events.WaitFor(stopped, betweenSounds) != WaitResult::TimedOut) {
      return;
    }
  }
  if (!list.Rows().empty()) {
    display.SelectRow(0);
  }
}

void SoundPreview::Tell(const RuntimeError& error) {
  parts_.Boxes.Show("Error " + std::to_string(error.Number()) + "\n" + error.what(), DefaultBoxTitle,
                    BoxIcon::None);
}
