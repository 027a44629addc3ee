#pragma once

#include <chrono>
#include <cstdint>
#include <vector>

/// Plays one sound at a time on the computer's sound device, which it holds only while playing. Playback
/// continues while events are processed (EventPump), and its end is noticed then too.
class SoundPlayer {
 public:
  virtual ~SoundPlayer() = default;

  /// Starts a mono sound of unsigned 8-bit samples (128 is silence) and returns at once. Stops any sound
  /// already playing. Throws RuntimeError 68, and plays nothing, if there is no sound device or it cannot be
  /// opened for this format.
  virtual void Play(std::vector<std::uint8_t> samples, int samplesPerSecond) = 0;

  /// Stops at once and returns to the start. Does nothing when nothing is playing.
  virtual void Stop() = 0;

  /// True from Play until the last sample has been heard or Stop was called.
  virtual bool Playing() const = 0;

  /// How much of the sound has been heard: its whole length once it has ended by itself, 0 after Stop.
  virtual std::chrono::milliseconds Position() const = 0;
};
