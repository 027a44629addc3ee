#include "firmware/files/FirmwareDescription.h"

#include <algorithm>
#include <memory>

#include "core/line/Checksum.h"
#include "firmware/files/CrLfLines.h"
#include "firmware/files/FirmwareImage.h"
#include "firmware/files/HexConvert.h"
#include "firmware/files/QvmLines.h"
#include "platform/RuntimeError.h"

namespace {

bool HasBareLineFeed(std::string_view bytes) {
  for (std::size_t at = bytes.find('\n'); at != std::string_view::npos; at = bytes.find('\n', at + 1)) {
    if (at == 0 || bytes[at - 1] != '\r') {
      return true;
    }
  }
  return false;
}

void CountOddDigits(std::string_view digits, FirmwareDescription::OddLines& odd) {
  odd.OddDigits += digits.size() % 2;
  odd.ForeignCharacters += std::all_of(digits.begin(), digits.end(), IsHexDigit) ? 0 : 1;
}

void DescribeQvm(std::string_view bytes, FirmwareDescription& description) {
  constexpr std::size_t commands = 8;  // X, P, B, S with its three bytes, F
  description.WireBytes = commands;
  CrLfLines lines(bytes);
  while (const auto line = lines.Next()) {
    if (!QvmLines::IsData(*line)) {
      description.OtherLines += line->empty() ? 0 : 1;
      continue;
    }
    ++description.Lines;
    const std::string_view digits = line->substr(1);
    const std::size_t size = (digits.size() + 1) / 2;
    description.WireBytes += 1 + size;
    description.Odd.TooLong += size > QvmLines::MostBytesOfALine ? 1 : 0;
    CountOddDigits(digits, description.Odd);
  }
}

bool IsFilled(std::uint8_t byte) {
  return byte != 0xFF;
}

void DescribeImage(const FirmwareImage& image, FirmwareDescription& description) {
  constexpr std::size_t commands = 4;  // X, P, B, F
  constexpr std::size_t packetOfAPage = 6;
  constexpr std::size_t packetOfARow = 198;
  description.Pages = image.PageCount;
  description.Rows = image.RowCount;
  description.WireBytes = commands + static_cast<std::size_t>(image.PageCount) *
                                         (packetOfAPage + FirmwareImage::RowsOfAPage * packetOfARow);
  for (std::size_t row = 0; row < FirmwareImage::MostRows; ++row) {
    description.RowsOutsidePages +=
        image.RowUsed[row] && !image.PageUsed[row / FirmwareImage::RowsOfAPage] ? 1 : 0;
  }
  for (std::size_t page = 0; page < FirmwareImage::MostPages; ++page) {
    const auto first =
        image.ImageBuffer.begin() + static_cast<std::ptrdiff_t>(page * FirmwareImage::PageBytes);
    if (!image.PageUsed[page]) {
      description.BytesOutsidePages += static_cast<std::size_t>(
          std::count_if(first, first + static_cast<std::ptrdiff_t>(FirmwareImage::PageBytes), IsFilled));
    } else if (page * FirmwareImage::PageBytes >= image.BytesLoaded) {
      ++description.PagesBehindImage;
    }
  }
}

void DescribeQvm2(std::string_view bytes, FirmwareDescription& description) {
  CrLfLines lines(bytes);
  lines.Next();
  lines.Next();
  while (const auto line = lines.Next()) {
    CountOddDigits(*line, description.Odd);
  }
  const auto image = std::make_unique<FirmwareImage>();
  try {
    image->LoadQvm2File(bytes);
    DescribeImage(*image, description);
  } catch (const RuntimeError& error) {
    description.LoadFault = error.what();
  }
}

}  // namespace

FirmwareDescription Describe(std::string_view fileName, std::string_view bytes) {
  FirmwareDescription description;
  description.Type = TypeOf(fileName);
  description.Bytes = bytes.size();
  description.Checksum = Crc32(bytes);
  if (description.Type != FirmwareFileType::None) {
    description.BareLineFeeds = HasBareLineFeed(bytes);
  }
  if (description.Type == FirmwareFileType::Qvm) {
    DescribeQvm(bytes, description);
  } else if (description.Type == FirmwareFileType::Qvm2) {
    DescribeQvm2(bytes, description);
  }
  return description;
}
