#include "firmware/hex/HexImport.h"

#include <array>
#include <utility>

#include "firmware/hex/HexCheck.h"
#include "firmware/hex/HexRecord.h"
#include "firmware/hex/ImageLines.h"
#include "firmware/hex/ImagePadding.h"
#include "firmware/hex/MemoryRanges.h"
#include "platform/RuntimeError.h"

namespace {

/// The data of a record, with fill behind it. A record holds at most 255 bytes.
using RecordBytes = std::array<std::uint8_t, 256>;

RecordBytes BytesOf(const HexRecord& record) {
  RecordBytes bytes;
  for (std::size_t i = 0; i < bytes.size(); ++i) {
    bytes[i] = i < record.Count() ? record.DataAt(i) : ImageLine::FillAt(i);
  }
  return bytes;
}

class Divider {
 public:
  HexData Data;

  void SetUpper(std::uint16_t upper) { upper_ = upper; }

  void Add(const HexRecord& record) {
    const Memory memory = MemoryOf(upper_);
    if (memory == Memory::None) {
      return;
    }
    const RecordBytes bytes = BytesOf(record);
    std::uint32_t address = (std::uint32_t{upper_} << 16U) + record.Address();
    if (memory == Memory::Config) {
      address &= ~std::uint32_t{ImageLine::Bytes - 1};
    }
    for (std::size_t start = 0; start < record.Count(); start += ImageLine::Bytes) {
      AddLine(memory, address + static_cast<std::uint32_t>(start), bytes.data() + start);
    }
  }

 private:
  void AddLine(Memory memory, std::uint32_t address, const std::uint8_t* bytes) {
    std::string& text = memory == Memory::Program  ? Data.ProgMem.emplace_back()
                        : memory == Memory::EeData ? Data.EeData
                                                   : Data.Config;
    ImageLine::Append(text, address, bytes);
    if (memory != Memory::Program) {
      text += '\n';
    }
  }

  std::uint16_t upper_ = 0;
};

void WriteImages(Files& files, HexData data, const ImagePaths& images) {
  const std::string program = PaddedImage(std::move(data.ProgMem));
  files.Replace(images.EeData, data.EeData);
  files.Replace(images.Config, data.Config);
  files.Replace(images.ProgMem, program);
}

}  // namespace

HexData DivideHexText(std::string_view text) {
  Divider divider;
  for (LineReader lines(text); !lines.AtEnd();) {
    const std::string_view line = lines.Next();
    if (!line.starts_with(HexRecord::Start)) {
      continue;
    }
    const HexRecord record(line);
    const std::uint8_t type = record.Type();
    if (type == HexRecordType::End) {
      break;
    }
    if (type == HexRecordType::LinearAddress) {
      divider.SetUpper(record.UpperAddress());
    } else if (type == HexRecordType::Data) {
      divider.Add(record);
    }
  }
  return std::move(divider.Data);
}

std::int16_t ImportHexFile(Files& files, MessageBoxes& boxes, const std::string& path,
                           const ImagePaths& images) {
  const std::int16_t code = CheckHexFile(files, path);
  if (code < 0) {
    boxes.Show(std::to_string(code), DefaultBoxTitle, BoxIcon::None);
    return code;
  }
  // An image of an earlier file must never pass for one of this.
  DeleteImages(files, images);
  try {
    WriteImages(files, DivideHexText(files.Read(path)), images);
  } catch (const RuntimeError&) {
    DeleteImages(files, images);
    throw;
  }
  return code;
}

void DeleteImages(Files& files, const ImagePaths& images) {
  for (const std::string& path : {images.ProgMem, images.EeData, images.Config}) {
    if (files.FileExists(path)) {
      files.Delete(path);
    }
  }
}
