#pragma once

#include <chrono>
#include <cstdint>
#include <vector>

/// Plays one sound at a time on the computer's sound device, which it holds only while it plays. The sound
/// goes on while events are served (EventPump); its end is noticed there too.
class SoundPlayer {
 public:
  virtual ~SoundPlayer() = default;

  /// Starts to play a sound of one channel, 8 bits unsigned a sample (128 is silence), and returns at once. A
  /// sound that played before is stopped. Throws RuntimeError 68, and then plays nothing, when there is no
  /// sound device or it cannot be opened for such a sound.
  virtual void Play(std::vector<std::uint8_t> samples, int samplesPerSecond) = 0;

  /// Stops at once and goes back to the start. Does nothing when nothing plays.
  virtual void Stop() = 0;

  /// True from Play until the last sample has been heard or Stop was called.
  virtual bool Playing() const = 0;

  /// How much of the sound has been heard: its whole length once it has ended by itself, 0 after Stop.
  virtual std::chrono::milliseconds Position() const = 0;
};
