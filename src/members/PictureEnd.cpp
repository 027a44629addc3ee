#include "members/PictureEnd.h"

#include <cstddef>
#include <cstdint>
#include <cstdlib>

using namespace std::string_view_literals;

namespace {

constexpr std::size_t Missing = std::string_view::npos;

std::uint8_t ByteAt(std::string_view bytes, std::size_t at) {
  return at < bytes.size() ? static_cast<std::uint8_t>(bytes[at]) : 0;
}

/// The little-endian number of `size` bytes at `at`; bytes behind the end count as 0.
std::uint32_t NumberAt(std::string_view bytes, std::size_t at, std::size_t size) {
  std::uint32_t number = 0;
  for (std::size_t i = size; i > 0; --i) {
    number = number << 8U | ByteAt(bytes, at + i - 1);
  }
  return number;
}

/// Where a JPEG's first scan begins; Missing if it has none. A camera's thumbnail lies in a segment before it
/// and has scans and an end of its own.
std::size_t FirstScan(std::string_view bytes) {
  constexpr std::uint8_t scan = 0xDA;
  const auto standsAlone = [](std::uint8_t marker) {
    return marker <= 0x01 || (marker >= 0xD0 && marker <= 0xD9);
  };
  std::size_t at = 0;
  for (;;) {
    at = bytes.find_first_not_of('\xFF', bytes.find('\xFF', at));
    if (at == Missing) {
      return Missing;
    }
    const std::uint8_t marker = ByteAt(bytes, at);
    ++at;
    if (marker == scan) {
      return at;
    }
    if (!standsAlone(marker)) {
      constexpr std::size_t byte = 256;
      at += ByteAt(bytes, at) * byte + ByteAt(bytes, at + 1);
    }
  }
}

bool IsCutJpeg(std::string_view bytes) {
  return bytes.find("\xFF\xD9"sv, FirstScan(bytes)) == Missing;
}

/// The end of a GIF's chain of data blocks that begins at `at`; Missing if the bytes end before it.
std::size_t EndOfBlocks(std::string_view bytes, std::size_t at) {
  while (at < bytes.size()) {
    const std::size_t size = ByteAt(bytes, at);
    at += 1 + size;
    if (size == 0) {
      return at;
    }
  }
  return Missing;
}

/// Bytes of the colour table that the flags of a GIF's header or of its picture announce.
std::size_t ColourTable(std::uint8_t flags) {
  constexpr unsigned present = 0x80;
  constexpr unsigned size = 0x07;
  return (flags & present) == 0 ? 0 : std::size_t{6} << (flags & size);
}

bool IsCutGif(std::string_view bytes) {
  constexpr std::size_t header = 13;
  std::size_t at = header + ColourTable(ByteAt(bytes, 10));
  while (at < bytes.size()) {
    if (bytes[at] == ',') {
      constexpr std::size_t flagsAt = 9;
      const std::size_t data = at + flagsAt + 1 + ColourTable(ByteAt(bytes, at + flagsAt));
      return EndOfBlocks(bytes, data + 1) == Missing;
    }
    if (bytes[at] != '!') {
      return false;  // no picture: the reader refuses it itself
    }
    at = EndOfBlocks(bytes, at + 2);
  }
  return true;
}

bool IsCutBmp(std::string_view bytes) {
  constexpr std::uint32_t oldHeader = 12;  // the header of the first version, with 16-bit numbers
  constexpr std::uint64_t runLength8 = 1;
  constexpr std::uint64_t runLength4 = 2;
  const bool isOld = NumberAt(bytes, 14, 4) == oldHeader;
  const std::uint64_t width = isOld ? NumberAt(bytes, 18, 2) : NumberAt(bytes, 18, 4);
  // A negative height means rows from the top down.
  const auto height = static_cast<std::int32_t>(isOld ? NumberAt(bytes, 20, 2) : NumberAt(bytes, 22, 4));
  const std::uint64_t bits = NumberAt(bytes, isOld ? 24 : 28, 2);
  const std::uint64_t compression = isOld ? 0 : NumberAt(bytes, 30, 4);
  if (compression == runLength8 || compression == runLength4) {
    return false;
  }
  const std::uint64_t row = (width * bits + 31) / 32 * 4;  // rows are padded to 32 bits
  const std::uint64_t rows = static_cast<std::uint64_t>(std::abs(std::int64_t{height}));
  const std::uint64_t pixels = NumberAt(bytes, 10, 4);
  return bytes.size() < pixels || (row > 0 && (bytes.size() - pixels) / row < rows);
}

}  // namespace

bool IsCutShort(std::string_view bytes, std::string_view format) {
  if (format == "jpeg") {
    return IsCutJpeg(bytes);
  }
  if (format == "gif") {
    return IsCutGif(bytes);
  }
  return format == "bmp" && IsCutBmp(bytes);
}
