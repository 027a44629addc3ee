#include "firmware/hex/HexImage.h"

#include <algorithm>
#include <limits>

#include "firmware/files/HexConvert.h"
#include "firmware/hex/HexRecord.h"
#include "platform/RuntimeError.h"

namespace {

constexpr std::int64_t LastAddress = 175'104;
constexpr std::int64_t FirstOfConfig = 0xF80000;
constexpr std::int64_t LastOfConfig = 0xF8000E;
constexpr std::int64_t InstructionsOfPage = 512;
constexpr std::int64_t InstructionsOfRow = 64;
constexpr std::int64_t FileBytesOfInstruction = 4;
constexpr std::size_t BytesOfInstruction = 3;

constexpr std::size_t BootLoader = 88'064 - 2'048;
constexpr std::size_t BootLoaderRow = BootLoader / 256;
constexpr std::size_t BootLoaderRows = 24;
constexpr std::size_t JumpBytes = 6;
constexpr std::size_t JumpCopy = BootLoader / 2 * 3 - JumpBytes;

std::uint8_t ByteOf(std::string_view text) {
  const std::int16_t number = Hex_Convert(text);
  if (number > std::numeric_limits<std::uint8_t>::max()) {
    throw RuntimeError(Fault::Overflow);
  }
  return static_cast<std::uint8_t>(number);
}

class HexImageReader {
 public:
  explicit HexImageReader(FirmwareImage& image) : image_(image) {}

  void Read(LineReader lines) {
    while (!lines.AtEnd()) {
      const std::string_view line = lines.Next();
      if (!line.starts_with(HexRecord::Start)) {
        continue;
      }
      const std::int32_t type = Hex_Convert2(Middle(line, 7, 2));
      if (type == HexRecordType::End) {
        return;
      }
      if (type == HexRecordType::LinearAddress) {
        upper_ = Hex_Convert2(Middle(line, HexRecord::DataColumn, 4));
      } else if (type == HexRecordType::Data) {
        ReadData(line);
      }
    }
  }

 private:
  void ReadData(std::string_view line) {
    const std::int32_t count = Hex_Convert2(Middle(line, 1, 2));
    const std::int64_t address = ((upper_ << 16U) + Hex_Convert2(Middle(line, 3, 4))) / 2;
    if (address > LastAddress && (address < FirstOfConfig || address > LastOfConfig)) {
      return;
    }
    for (std::int64_t i = 0; i < count / FileBytesOfInstruction; ++i) {
      const std::size_t column = HexRecord::DataColumn + static_cast<std::size_t>(i) * 8;
      Store(static_cast<std::size_t>(address * 3 / 2 + 3 * i), Middle(line, column, 6));
      Mark(address / 2 + i);
    }
  }

  void Store(std::size_t at, std::string_view digits) {
    if (at + BytesOfInstruction > image_.ImageBuffer.size()) {
      throw RuntimeError(Fault::SubscriptOutOfRange);
    }
    for (std::size_t i = 0; i < BytesOfInstruction; ++i) {
      image_.ImageBuffer[at + i] = ByteOf(Middle(digits, 2 * i, 2));
    }
  }

  void Mark(std::int64_t instruction) {
    if (instruction > std::numeric_limits<std::int16_t>::max()) {
      throw RuntimeError(Fault::Overflow);
    }
    image_.PageUsed[static_cast<std::size_t>(instruction / InstructionsOfPage)] = true;
    image_.RowUsed[static_cast<std::size_t>(instruction / InstructionsOfRow)] = true;
  }

  FirmwareImage& image_;
  std::int64_t upper_ = 0;
};

bool MeetsBootLoader(const FirmwareImage& image) {
  for (std::size_t row = BootLoaderRow; row < BootLoaderRow + BootLoaderRows; ++row) {
    if (image.RowUsed.test(row)) {
      return true;
    }
  }
  return false;
}

bool HasResetJump(const FirmwareImage& image) {
  const auto jump = image.ImageBuffer.begin();
  return image.RowUsed[0] &&
         std::any_of(jump, jump + JumpBytes, [](std::uint8_t byte) { return byte != 0xFF; });
}

/// The last entry of a table is never counted.
template <std::size_t Counted>
std::int16_t CountOf(const std::bitset<Counted + 1>& used) {
  return static_cast<std::int16_t>(used.count() - (used.test(Counted) ? 1 : 0));
}

void CopyResetJump(FirmwareImage& image) {
  std::copy_n(image.ImageBuffer.begin(), JumpBytes, image.ImageBuffer.begin() + JumpCopy);
  image.PageUsed[JumpCopy / (InstructionsOfPage * BytesOfInstruction)] = true;
  image.RowUsed[JumpCopy / (InstructionsOfRow * BytesOfInstruction)] = true;
}

}  // namespace

bool LoadHexImage(std::string_view text, FirmwareImage& image, MessageBoxes& boxes) {
  image = {};
  std::fill(image.ImageBuffer.begin(), image.ImageBuffer.end(), std::uint8_t{0xFF});
  HexImageReader(image).Read(LineReader(text));
  if (MeetsBootLoader(image)) {
    boxes.Show("The hex-file contains code that will overwrite the bootloader, aborting", DefaultBoxTitle,
               BoxIcon::None);
    return false;
  }
  if (!HasResetJump(image)) {
    boxes.Show("There\u00B4s no GOTO at location 0x00, aborting", DefaultBoxTitle, BoxIcon::None);
    return false;
  }
  CopyResetJump(image);
  image.PageCount = CountOf<FirmwareImage::MostPages>(image.PageUsed);
  image.RowCount = CountOf<FirmwareImage::MostRows>(image.RowUsed);
  return true;
}
