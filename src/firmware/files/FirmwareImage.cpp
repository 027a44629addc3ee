#include "firmware/files/FirmwareImage.h"

#include <algorithm>

#include "firmware/files/CrLfLines.h"
#include "firmware/files/HexConvert.h"
#include "platform/RuntimeError.h"

namespace {

/// Positions in a line of data are counted in 16 bits.
constexpr std::size_t LongestDataLine = 32767;
constexpr std::size_t MostPairsOfALine = (LongestDataLine + 1) / 2;

std::string_view NextLine(CrLfLines& lines) {
  const auto line = lines.Next();
  if (!line) {
    throw RuntimeError(Fault::PastEndOfFile);
  }
  return *line;
}

/// Calls `take` with each number of the list that is not empty.
template <typename Take>
void ForEachNumber(std::string_view list, const Take& take) {
  // Such a file has other line ends, and all of it would pass for one list of numbers.
  if (list.find('\n') != std::string_view::npos) {
    throw RuntimeError(Fault::Overflow);
  }
  while (!list.empty()) {
    const std::size_t end = std::min(list.find(','), list.size());
    if (end > 0) {
      take(list.substr(0, end));
    }
    list.remove_prefix(std::min(end + 1, list.size()));
  }
}

template <std::size_t Size>
void Mark(std::bitset<Size>& used, std::int32_t number) {
  if (static_cast<std::size_t>(number) >= Size) {
    throw RuntimeError(Fault::SubscriptOutOfRange);
  }
  used.set(static_cast<std::size_t>(number));
}

}  // namespace

bool FirmwareImage::LoadQvm2File(std::string_view bytes) {
  PageUsed.reset();
  RowUsed.reset();
  BytesLoaded = 0;
  std::fill(ImageBuffer.begin(), ImageBuffer.end() - 1, std::uint8_t{0xFF});
  PageUsed.set(0);
  RowUsed.set(0);
  CrLfLines lines(bytes);
  ForEachNumber(NextLine(lines), [this](std::string_view number) { Mark(PageUsed, Hex_Convert2(number)); });
  ForEachNumber(NextLine(lines), [this](std::string_view number) { Mark(RowUsed, Hex_Convert(number)); });
  while (const auto line = lines.Next()) {
    ReadData(*line);
  }
  PageCount = static_cast<std::int16_t>(PageUsed.count() - (PageUsed.test(MostPages) ? 1 : 0));
  RowCount = static_cast<std::int16_t>(RowUsed.count() - (RowUsed.test(MostRows) ? 1 : 0));
  return RowCount != 0;
}

void FirmwareImage::ReadData(std::string_view line) {
  // A line ends where the position of the next pair equals its length. Another one never ends: what is behind
  // it reads as zeros, until the position or the image overflows.
  const bool ends = line.size() % 2 == 0 && line.size() <= LongestDataLine;
  const std::size_t pairs = ends ? line.size() / 2 : MostPairsOfALine;
  const std::size_t inLine = std::min(pairs, line.size() / 2);
  const std::size_t room = ImageBuffer.size() - BytesLoaded;
  const std::size_t stored = std::min(inLine, room);
  unsigned int overflow = 0;
  for (std::size_t pair = 0; pair < stored; ++pair) {
    const unsigned int value = HexDigit(line[2 * pair]) * 16U + HexDigit(line[2 * pair + 1]);
    ImageBuffer[BytesLoaded + pair] = static_cast<std::uint8_t>(value);
    overflow |= value >> 8U;
  }
  if (overflow != 0) {
    throw RuntimeError(Fault::Overflow);
  }
  if (pairs > room) {
    throw RuntimeError(Fault::SubscriptOutOfRange);
  }
  if (!ends) {
    throw RuntimeError(Fault::Overflow);
  }
  BytesLoaded += stored;
}
