#pragma once

#include <functional>
#include <string>

#include "platform/EventPump.h"
#include "platform/Files.h"
#include "platform/MessageBoxes.h"
#include "platform/SoundPlayer.h"
#include "sound/RecorderLink.h"
#include "sound/SoundList.h"

/// Plays the list's sounds on the computer's sound device.
class SoundPreview {
 public:
  /// What it works with; all of it must outlive it.
  struct Parts {
    const Files& Disk;
    SoundPlayer& Player;
    EventPump& Events;
    MessageBoxes& Boxes;
  };

  explicit SoundPreview(const Parts& parts) : parts_(parts) {}

  enum class Started {
    Yes,
    NotThis,  ///< a box told why this sound does not play
    NoDevice  ///< a box told that no sound plays
  };

  /// Starts a file's sound, and stops any other.
  Started PlayRow(const std::string& path);

  /// Plays all rows, a second apart, and selects each; row 1 at the end. `stopped` ends the run, and must
  /// depend on something that an event changes.
  void PlayAll(const SoundList& list, RecorderDisplay& display, const std::function<bool()>& stopped);

  /// Stops the sound, if one plays.
  void Stop() { parts_.Player.Stop(); }

 private:
  void Tell(const RuntimeError& error);

  const Parts parts_;
};
