#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

#include "core/text/StringTable.h"
#include "firmware/files/FirmwareFile.h"
#include "platform/Files.h"

/// What a firmware file holds and what looks odd in it. For the operator only: it decides nothing.
struct FirmwareDescription {
  FirmwareFileType Type = FirmwareFileType::None;
  std::uint64_t Bytes = 0;
  std::uint32_t Checksum = 0;   ///< CRC-32 of the file
  std::uint64_t WireBytes = 0;  ///< that a download sends, if no packet is sent twice
  std::string LoadFault;        ///< why it cannot be loaded; empty if it can
  bool BareLineFeeds = false;   ///< a line feed without a carriage return before it

  /// Lines of data that are odd.
  struct OddLines {
    std::size_t OddDigits = 0;          ///< with an odd count of characters
    std::size_t TooLong = 0;            ///< more bytes than a buffer takes
    std::size_t ForeignCharacters = 0;  ///< with characters that are no hexadecimal digits
  };
  OddLines Odd;

  std::size_t Lines = 0;       ///< of data, in a QVM file
  std::size_t OtherLines = 0;  ///< left out, but not empty, in a QVM file

  int Pages = 0;  ///< used, in a QVM2 file
  int Rows = 0;
  int RowsOutsidePages = 0;
  int PagesBehindImage = 0;           ///< used, but the file gives no byte of them
  std::size_t BytesOutsidePages = 0;  ///< other than 0xFF, in pages that are not used
};

/// Describes a file by its name and its bytes.
FirmwareDescription Describe(std::string_view fileName, std::string_view bytes);

/// The description in words: one line, and a second one if something looks odd.
std::string DescriptionText(const FirmwareDescription& description, const StringTable& strings);

/// The same for a file on the disk; empty if there is no such file. One that cannot be read is told in words
/// too, and one beyond `MostDescribedBytes` is not looked into.
std::string DescribeFile(const Files& disk, const std::string& fileName, const StringTable& strings);

/// More than twice a full image of a device. Describing a file never holds the window up.
inline constexpr std::uint64_t MostDescribedBytes = 4U << 20U;

/// "7 min 4 s"
std::string MinutesText(std::int64_t seconds, const StringTable& strings);
