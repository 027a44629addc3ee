#include "firmware/hex/HexCheck.h"

#include <limits>

#include "firmware/hex/HexRecord.h"
#include "platform/RuntimeError.h"

namespace {

constexpr std::size_t BytesBesideData = 5;  ///< count, address (2), type, checksum

/// Sum of all bytes of a record, its checksum among them.
std::int16_t SumOf(std::string_view line) {
  const std::size_t bytes = HexRecord(line).Count() + BytesBesideData;
  std::int32_t sum = 0;
  for (std::size_t i = 0; i < bytes; ++i) {
    sum += HexByteAt(line, 1 + 2 * i);
    if (sum > std::numeric_limits<std::int16_t>::max()) {
      throw RuntimeError(Fault::Overflow);
    }
  }
  return static_cast<std::int16_t>(sum);
}

std::int16_t CheckLines(LineReader lines) {
  while (!lines.AtEnd()) {
    const std::string_view line = lines.Next();
    const char first = line.empty() ? ' ' : line.front();
    if (first == HexRecord::Start) {
      const std::uint8_t type = HexRecord(line).Type();
      if (SumOf(line) % 256 != 0) {
        return HexCode::WrongChecksum;
      }
      if (type == HexRecordType::End) {
        return HexCode::Good;
      }
    } else if (std::string_view(" \t\r\n").find(first) == std::string_view::npos) {
      return HexCode::NoRecord;
    }
  }
  return HexCode::NoEnd;
}

}  // namespace

std::int16_t CheckHexText(std::string_view text) {
  if (text.empty()) {
    return HexCode::Empty;
  }
  try {
    return CheckLines(LineReader(text));
  } catch (const RuntimeError&) {
    return HexCode::Failure;
  }
}

std::int16_t CheckHexFile(const Files& files, const std::string& path) {
  std::string text;
  try {
    text = files.Read(path);
  } catch (const RuntimeError&) {
    return HexCode::Failure;
  }
  return CheckHexText(text);
}
