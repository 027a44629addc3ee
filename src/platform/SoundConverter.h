#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

/// A sound that was converted.
struct ConvertedSound {
  std::vector<std::uint8_t> Samples;  ///< unsigned 8-bit mono
  double Peak = 0;                    ///< highest level before clipping; 1 is full scale
  std::size_t Clipped = 0;            ///< samples beyond full scale, which were cut to it
};

/// Reads sound files of many formats.
class SoundConverter {
 public:
  virtual ~SoundConverter() = default;

  /// True if the file holds sound in a format that can be converted.
  virtual bool CanRead(const std::string& path) const = 0;

  /// Mixes the channels of a file, whatever its rate and sample form, down to unsigned 8-bit mono at
  /// `samplesPerSecond`. `progress` is called now and then with the share that is done, 0 to 1; false from it
  /// stops, and nothing is returned. Throws RuntimeError 53 if there is no such file, 321 if it cannot be
  /// read or converted; the text names it and says why.
  virtual std::optional<ConvertedSound> Convert(const std::string& path, int samplesPerSecond,
                                                const std::function<bool(double)>& progress) const = 0;
};
