#pragma once

#include <map>
#include <string>
#include <vector>

#include "platform/RuntimeError.h"
#include "platform/SoundConverter.h"

/// Converts the files that a test names.
class FakeSoundConverter : public SoundConverter {
 public:
  /// What each file that can be read becomes.
  std::map<std::string, ConvertedSound> Sounds;

  /// Called in the midst of a conversion.
  std::function<void()> InTheMidst = [] {};

  bool CanRead(const std::string& path) const override { return Sounds.contains(path); }

  std::optional<ConvertedSound> Convert(const std::string& path, int /*samplesPerSecond*/,
                                        const std::function<bool(double)>& progress) const override {
    if (!CanRead(path)) {
      throw RuntimeError(Fault::InvalidFileFormat, "Unknown format");
    }
    InTheMidst();
    if (!progress(0.5)) {
      return std::nullopt;
    }
    return Sounds.at(path);
  }
};
