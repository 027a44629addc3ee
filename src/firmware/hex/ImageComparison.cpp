#include "firmware/hex/ImageComparison.h"

#include <algorithm>
#include <array>
#include <bitset>
#include <memory>

#include "firmware/hex/HexRecord.h"
#include "firmware/hex/ImageLines.h"
#include "firmware/hex/MemoryRanges.h"
#include "platform/RuntimeError.h"

namespace {

constexpr std::uint32_t PageBytes = 65536;
constexpr std::uint32_t PageCount = 256;  ///< program memory and EEPROM: addresses of 24 bits
constexpr std::uint32_t AddressMask = 0xFFFFFF;

/// What the file has for 64 KB of addresses, and what the device would hold there.
struct Page {
  Page() {
    for (std::size_t i = 0; i < PageBytes; ++i) {
      Held[i] = ImageLine::FillAt(i);
    }
  }

  std::array<std::uint8_t, PageBytes> Expected;
  std::array<std::uint8_t, PageBytes> Held;
  std::bitset<PageBytes> InFile;
};

bool IsFill(std::uint32_t address, std::uint8_t byte) {
  return byte == 0xFF || byte == ImageLine::FillAt(address);
}

bool IsWritten(Memory memory) {
  return memory == Memory::Program || memory == Memory::EeData;
}

class Comparison {
 public:
  void AddHexText(std::string_view text);
  void WriteProgMem(std::string_view image);
  void WriteEeData(std::string_view image);
  std::vector<LostStretch> Result();

 private:
  /// Pages come into being with the file's first byte there; what lies elsewhere was not in the file.
  Page& PageFor(std::uint32_t address) {
    auto& page = pages_[address / PageBytes];
    if (!page) {
      page = std::make_unique<Page>();
    }
    return *page;
  }

  void AddByte(std::uint32_t address, std::uint8_t byte);
  void Hold(std::uint32_t address, const ImageLine::Data& data);
  void CompareByte(std::uint32_t address, const Page& page);
  void Lose(std::uint32_t address, LostStretch::Cause cause);
  void JoinOutside();

  std::array<std::unique_ptr<Page>, PageCount> pages_;
  std::vector<LostStretch> outside_;
  std::vector<LostStretch> lost_;
};

void Comparison::AddHexText(std::string_view text) {
  std::uint32_t base = 0;
  bool isSegment = false;
  for (LineReader lines(text); !lines.AtEnd();) {
    const std::string_view line = lines.Next();
    if (!line.starts_with(HexRecord::Start)) {
      continue;
    }
    const HexRecord record(line);
    switch (record.Type()) {
      case HexRecordType::End:
        return;
      case HexRecordType::SegmentAddress:
        if (record.Count() >= 2) {  // a shorter one sets nothing
          base = std::uint32_t{record.UpperAddress()} << 4U;
          isSegment = true;
        }
        break;
      case HexRecordType::LinearAddress:
        base = std::uint32_t{record.UpperAddress()} << 16U;
        isSegment = false;
        break;
      case HexRecordType::Data:
        for (std::uint32_t i = 0; i < record.Count(); ++i) {
          const std::uint32_t offset = record.Address() + i;
          AddByte(base + (isSegment ? offset % PageBytes : offset), record.DataAt(i));
        }
        break;
      default:
        break;
    }
  }
}

void Comparison::AddByte(std::uint32_t address, std::uint8_t byte) {
  const Memory memory = MemoryOf(address >> 16U);
  if (IsWritten(memory)) {
    Page& page = PageFor(address);
    page.Expected[address % PageBytes] = byte;
    page.InFile.set(address % PageBytes);
  } else if (memory == Memory::None && !IsFill(address, byte)) {
    if (!outside_.empty() && outside_.back().Address + outside_.back().Count == address) {
      ++outside_.back().Count;
    } else {
      outside_.push_back({address, 1, LostStretch::Cause::NoMemory});
    }
  }
}

void Comparison::Hold(std::uint32_t address, const ImageLine::Data& data) {
  for (std::uint32_t i = 0; i < data.size(); ++i) {
    const std::uint32_t at = address + i;
    if (at > AddressMask) {
      return;
    }
    if (const auto& page = pages_[at / PageBytes]) {
      page->Held[at % PageBytes] = data[i];
    }
  }
}

void Comparison::WriteProgMem(std::string_view image) {
  constexpr std::size_t linesOfBlock = 16;
  std::vector<ImageLine::Data> block;
  std::uint32_t start = 0;
  try {
    for (LineReader lines(image); !lines.AtEnd();) {
      const std::string_view line = lines.Next();
      if (block.empty()) {
        start = ImageLine::AddressOf(line) & AddressMask & ~1U;  // two bytes for each address of the device
      }
      block.push_back(ImageLine::DataOf(line));
      if (block.size() == linesOfBlock) {
        for (const ImageLine::Data& data : block) {
          Hold(start, data);
          start += ImageLine::Bytes;
        }
        block.clear();
      }
    }
  } catch (const RuntimeError&) {
    return;  // the write ends here too
  }
}

void Comparison::WriteEeData(std::string_view image) {
  try {
    for (LineReader lines(image); !lines.AtEnd();) {
      const std::string_view line = lines.Next();
      Hold(ImageLine::AddressOf(line) & AddressMask, ImageLine::DataOf(line));
    }
  } catch (const RuntimeError&) {
    return;  // the write ends here too
  }
}

void Comparison::CompareByte(std::uint32_t address, const Page& page) {
  const std::size_t at = address % PageBytes;
  const bool isProgram = MemoryOf(address >> 16U) == Memory::Program;
  if (isProgram && address % 4 == 3) {
    // A stretch goes on across a byte that does not exist.
    if (!lost_.empty() && lost_.back().Address + lost_.back().Count == address) {
      ++lost_.back().Count;
    }
  } else if (page.Expected[at] != page.Held[at]) {
    Lose(address,
         IsFill(address, page.Held[at]) ? LostStretch::Cause::Missing : LostStretch::Cause::Displaced);
  }
}

void Comparison::Lose(std::uint32_t address, LostStretch::Cause cause) {
  if (lost_.empty() || lost_.back().Address + lost_.back().Count != address) {
    lost_.push_back({address, 1, cause});
    return;
  }
  LostStretch& stretch = lost_.back();
  ++stretch.Count;
  if (cause == LostStretch::Cause::Displaced) {
    stretch.Reason = cause;
  }
}

/// Records of other memories may overlap and come in any order.
void Comparison::JoinOutside() {
  std::sort(outside_.begin(), outside_.end(),
            [](const LostStretch& left, const LostStretch& right) { return left.Address < right.Address; });
  const auto endOf = [](const LostStretch& stretch) {
    return std::uint64_t{stretch.Address} + stretch.Count;
  };
  for (const LostStretch& stretch : outside_) {
    if (lost_.empty() || lost_.back().Reason != LostStretch::Cause::NoMemory ||
        endOf(lost_.back()) < stretch.Address) {
      lost_.push_back(stretch);
    } else if (endOf(stretch) > endOf(lost_.back())) {
      lost_.back().Count = static_cast<std::uint32_t>(endOf(stretch) - lost_.back().Address);
    }
  }
}

std::vector<LostStretch> Comparison::Result() {
  for (std::uint32_t number = 0; number < PageCount; ++number) {
    const auto& page = pages_[number];
    for (std::uint32_t at = 0; page && at < PageBytes; ++at) {
      if (page->InFile.test(at)) {
        CompareByte(number * PageBytes + at, *page);
      }
    }
  }
  JoinOutside();  // all of them lie above
  return std::move(lost_);
}

}  // namespace

std::vector<LostStretch> CompareImages(std::string_view hexText, std::string_view progMem,
                                       std::string_view eeData) {
  Comparison comparison;
  comparison.AddHexText(hexText);
  comparison.WriteProgMem(progMem);
  comparison.WriteEeData(eeData);
  return comparison.Result();
}

std::vector<LostStretch> CompareImages(const Files& files, const std::string& hexPath,
                                       const ImagePaths& images) {
  return CompareImages(files.Read(hexPath), files.Read(images.ProgMem), files.Read(images.EeData));
}

const std::string& LossText(LostStretch::Cause reason, const StringTable& strings) {
  switch (reason) {
    case LostStretch::Cause::Missing:
      return strings.Text(OwnText::BytesMissing);
    case LostStretch::Cause::Displaced:
      return strings.Text(OwnText::BytesDisplaced);
    default:
      return strings.Text(OwnText::BytesOutside);
  }
}

std::string AddressText(const LostStretch& stretch) {
  return FormatHex(stretch.Address, stretch.Address > AddressMask ? 8 : ImageLine::AddressDigits);
}
