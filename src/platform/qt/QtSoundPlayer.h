#pragma once

#include <memory>

#include "platform/SoundPlayer.h"

/// Plays on the computer's default sound device. Needs a QCoreApplication.
class QtSoundPlayer final : public SoundPlayer {
 public:
  QtSoundPlayer();
  ~QtSoundPlayer() override;

  void Play(std::vector<std::uint8_t> samples, int samplesPerSecond) override;
  void Stop() override;
  bool Playing() const override;
  std::chrono::milliseconds Position() const override;

 private:
  class Sound;
  std::unique_ptr<Sound> sound_;
};
