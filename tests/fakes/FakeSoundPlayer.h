#pragma once

#include <algorithm>
#include <chrono>
#include <cstdint>
#include <optional>
#include <utility>
#include <vector>

#include "platform/RuntimeError.h"
#include "platform/SoundPlayer.h"
#include "tests/fakes/FakeEventPump.h"

/// Plays silently, as fast as the pump's time passes, and records each sound.
class FakeSoundPlayer : public SoundPlayer {
 public:
  using Time = std::chrono::milliseconds;

  struct Sound {
    std::vector<std::uint8_t> Samples;
    int SamplesPerSecond = 0;

    Time Length() const { return Time(static_cast<std::int64_t>(Samples.size()) * 1000 / SamplesPerSecond); }
    bool operator==(const Sound&) const = default;
  };

  explicit FakeSoundPlayer(FakeEventPump& pump) : pump_(pump) {}

  /// All sounds that were started.
  std::vector<Sound> Played;

  /// If set, there is no sound device.
  bool NoDevice = false;

  void Play(std::vector<std::uint8_t> samples, int samplesPerSecond) override {
    Stop();
    if (NoDevice) {
      throw RuntimeError(Fault::DeviceUnavailable);
    }
    Played.push_back({std::move(samples), samplesPerSecond});
    start_ = pump_.Now();
    pump_.At(Played.back().Length(), [] {});  // makes a wait for the end test its condition then
  }

  void Stop() override { start_.reset(); }

  bool Playing() const override { return start_ && pump_.Now() - *start_ < Played.back().Length(); }

  Time Position() const override {
    return start_ ? std::min(pump_.Now() - *start_, Played.back().Length()) : Time(0);
  }

 private:
  FakeEventPump& pump_;
  std::optional<Time> start_;  ///< of the last sound, unless it was stopped
};
