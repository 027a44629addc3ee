#pragma once

#include <array>
#include <cstdint>
#include <functional>
#include <span>
#include <string>
#include <vector>

#include "firmware/pic24f/BootSettings.h"
#include "platform/EventPump.h"
#include "platform/Files.h"
#include "platform/PicBoot.h"

/// Results of the long operations; any other negative one comes from the library.
namespace PicCode {
inline constexpr std::int16_t Done = 1;
inline constexpr std::int16_t Different = -12;   ///< a comparison found a difference; inside a write only
inline constexpr std::int16_t Short = -13;       ///< the library gave less than was asked for
inline constexpr std::int16_t Aborted = -100;    ///< by the operator
inline constexpr std::int16_t NotAsFile = -101;  ///< the device's content is not that of the file
}  // namespace PicCode

/// Conversations with the boot loader of a PIC24F: its identity, and writing, comparing and erasing its
/// memories by the images on disk.
class PicComms {
 public:
  /// What it works with; all must outlive it.
  struct Parts {
    PicBoot& Library;
    Files& Disk;
    EventPump& Events;
    BootFolder Folder;
    std::function<void(const std::string& text)> ShowStatus;
    /// Lines of the image that are done, and of how many. May be empty.
    std::function<void(std::size_t done, std::size_t whole)> ShowProgress = {};
  };

  explicit PicComms(Parts parts);

  std::int32_t PortHandle = 0;  ///< above 0 when connected
  std::string PortName;
  std::int32_t BitRate = 0;
  std::uint8_t RunFlag = 0;  ///< 1 while an operation may go on; each begins with 1
  BootSettings Settings;
  PicDevice Device;

  /// "v", major, ".", minor; empty on failure.
  std::string ReadBootVersion();

  /// The identity in decimal; "0" on failure. Throws RuntimeError 6 for one of 0x8000 or more.
  std::string ReadDeviceId();

  /// The eight bytes at address 0 in hexadecimal, each followed by a blank; empty on failure.
  std::string ReadResetVector();

  /// Tells the boot loader that the new program is whole. Negative on failure.
  std::int32_t SendVerifyOk();

  /// Lets the device run its program.
  void ResetDevice();

  /// Writes an image and reads each block back; differences are listed in a new log. A block that is not
  /// complete at the end is not written. Returns a PicCode. Throws RuntimeError 53 or 75 if the image cannot
  /// be read, 13 for a line without 16 bytes, 9 for a block of more than 256 bytes, 11 for sizes of 0.
  std::int32_t WriteRangeDevice(std::int16_t blockSize, std::uint8_t bytesPerAddress, std::uint8_t command,
                                const std::string& fileName);

  /// The same without writing.
  std::int32_t CompareRangeDevice(std::int16_t blockSize, std::uint8_t bytesPerAddress, std::uint8_t command,
                                  const std::string& fileName);

  /// Reads what `record` tells and compares it. Words that the boot loader itself changes may differ. Returns
  /// the number of bytes, PicCode::Different, or the library's code.
  std::int32_t VerifyRangeDevice(PicRecord record, std::span<const std::uint8_t> expected);

  /// Erases from one device address to another. Returns a PicCode. Throws RuntimeError 11 for sizes of 0, 6
  /// for more than 255 blocks, 5 for a block of less than one address.
  std::int32_t EraseRangeDevice(std::int32_t low, std::int32_t high);

 private:
  using BlockStep = std::function<std::int32_t(const PicRecord&, std::span<const std::uint8_t>)>;

  std::int32_t EachBlock(const std::string& verb, PicRecord record, const std::string& fileName,
                         const BlockStep& step);
  void LogDifference(std::uint32_t address, std::uint32_t expected, std::uint32_t read);
  bool MayDiffer(std::uint32_t address) const;

  const Parts parts_;
};
