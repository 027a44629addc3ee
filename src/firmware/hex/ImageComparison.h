#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "core/text/StringTable.h"
#include "firmware/hex/HexImport.h"

/// A stretch of a HEX file's bytes that a device would not hold after its images were written.
struct LostStretch {
  enum class Cause {
    Missing,    ///< nothing would stand there
    Displaced,  ///< something else would stand there
    NoMemory    ///< no memory that is written has these addresses
  };

  std::uint32_t Address;  ///< of the file's first byte
  std::uint32_t Count;
  Cause Reason;

  bool operator==(const LostStretch&) const = default;
};

/// Compares a HEX file with what program memory and EEPROM hold after all blocks of their images were
/// written. The file is read as the format has it, segment addresses included; of two bytes for one address
/// the later one counts. Each fourth byte of program memory does not exist and is not looked at, bytes that
/// are fill are never lost, and configuration words are not written at all. Stretches come in ascending
/// order.
///
/// `hexText` must have passed the check. An image with a line that cannot be written counts up to there.
std::vector<LostStretch> CompareImages(std::string_view hexText, std::string_view progMem,
                                       std::string_view eeData);

/// The same for files. Throws RuntimeError if one cannot be read.
std::vector<LostStretch> CompareImages(const Files& files, const std::string& hexPath,
                                       const ImagePaths& images);

/// Why the bytes of a stretch are lost.
const std::string& LossText(LostStretch::Cause reason, const StringTable& strings);

/// The address of a stretch: six digits, or eight beyond 24 bits.
std::string AddressText(const LostStretch& stretch);
