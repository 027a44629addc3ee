#include "firmware/pic24f/PicComms.h"

#include <algorithm>
#include <limits>
#include <utility>

#include "core/text/NumberForms.h"
#include "firmware/hex/HexText.h"
#include "firmware/pic24f/ImageBlock.h"
#include "firmware/pic24f/PicFrame.h"
#include "platform/RuntimeError.h"

namespace {

constexpr std::size_t BytesOfInstruction = 4;
constexpr std::uint32_t AddressesOfInstruction = 2;

std::uint32_t LittleEndian(std::span<const std::uint8_t> bytes) {
  std::uint32_t value = 0;
  for (std::size_t i = BytesOfInstruction; i-- > 0;) {
    value = value << 8U | bytes[i];
  }
  return value;
}

}  // namespace

PicComms::PicComms(Parts parts) : parts_(std::move(parts)) {}

std::string PicComms::ReadBootVersion() {
  constexpr std::size_t longest = 10;
  std::array<std::uint8_t, 11> buffer = {PicCommand::Version, 2};
  if (parts_.Library.SendGetPacket(PortHandle, buffer, 2, longest, 3) < 0) {
    return {};
  }
  return "v" + std::to_string(buffer[3]) + "." + std::to_string(buffer[2]);
}

std::string PicComms::ReadDeviceId() {
  const PicRecord record{.Command = PicCommand::ReadFlash,
                         .DataLength = 4,
                         .Address = 0xFF0000,
                         .BlockSize = 4,
                         .BytesPerAddress = 2,
                         .MaxRetries = static_cast<std::uint16_t>(Settings.MaxRetry)};
  std::array<std::uint8_t, 11> buffer{};
  if (parts_.Library.ReadPIC(PortHandle, record, buffer) <= 0) {
    return "0";
  }
  const std::int32_t identity = buffer[1] * 256 + buffer[0];
  if (identity > std::numeric_limits<std::int16_t>::max()) {
    throw RuntimeError(Fault::Overflow);
  }
  return std::to_string(identity);
}

std::string PicComms::ReadResetVector() {
  constexpr std::size_t header = 5;
  constexpr std::size_t bytes = 8;
  std::array<std::uint8_t, 21> buffer = {PicCommand::ReadFlash, 2, 0, 0, 0};
  if (parts_.Library.SendGetPacket(PortHandle, buffer, header, 255, 5) < 0) {
    return {};
  }
  std::string text;
  for (std::size_t i = header; i < header + bytes; ++i) {
    text += HexText(buffer[i]) + ' ';
  }
  return text;
}

std::int32_t PicComms::SendVerifyOk() {
  std::array<std::uint8_t, 21> buffer = {PicCommand::VerifyOk};
  return parts_.Library.SendGetPacket(PortHandle, buffer, 1, 255, 5);
}

void PicComms::ResetDevice() {
  constexpr std::array<std::uint8_t, 2> run = {PicCommand::Version, 0};
  parts_.Library.SendPacket(PortHandle, run);
}

std::int32_t PicComms::WriteRangeDevice(std::int16_t blockSize, std::uint8_t bytesPerAddress,
                                        std::uint8_t command, const std::string& fileName) {
  const PicRecord record{.Command = command,
                         .BlockSize = static_cast<std::uint16_t>(blockSize),
                         .BytesPerAddress = bytesPerAddress};
  return EachBlock("Writing: ", record, fileName,
                   [this](const PicRecord& block, std::span<const std::uint8_t> bytes) -> std::int32_t {
                     const std::int32_t written = parts_.Library.WritePIC(PortHandle, block, bytes);
                     return written < 0 ? written : VerifyRangeDevice(block, bytes);
                   });
}

std::int32_t PicComms::CompareRangeDevice(std::int16_t blockSize, std::uint8_t bytesPerAddress,
                                          std::uint8_t command, const std::string& fileName) {
  const PicRecord record{.Command = command,
                         .BlockSize = static_cast<std::uint16_t>(blockSize),
                         .BytesPerAddress = bytesPerAddress};
  return EachBlock("Reading: ", record, fileName,
                   [this](const PicRecord& block, std::span<const std::uint8_t> bytes) {
                     return VerifyRangeDevice(block, bytes);
                   });
}

/// `record` holds what all blocks have in common.
std::int32_t PicComms::EachBlock(const std::string& verb, PicRecord record, const std::string& fileName,
                                 const BlockStep& step) {
  // The whole file at once: it may be replaced or deleted while it is being written.
  const std::string image = parts_.Disk.Read(parts_.Folder.ForReading(parts_.Disk, fileName));
  parts_.Disk.Write(parts_.Folder.ForWriting(Settings.ErrorLog), "");
  record.MaxRetries = static_cast<std::uint16_t>(Settings.MaxRetry);
  record.DeviceType = static_cast<std::uint16_t>(Device.DeviceType);
  ImageBlock block(record);
  const auto lineCount = static_cast<std::size_t>(std::count(image.begin(), image.end(), '\n'));
  std::size_t done = 0;
  bool differs = false;
  RunFlag = 1;
  for (LineReader lines(image); !lines.AtEnd();) {
    parts_.Events.DoEvents();
    const std::string_view line = lines.Next();
    ++done;
    if (RunFlag == 0) {
      return differs ? PicCode::NotAsFile : PicCode::Aborted;
    }
    if (!block.Add(line)) {
      continue;
    }
    const std::int32_t result = step(block.Record(), block.Bytes());
    if (result < 0 && result != PicCode::Different) {
      return result;
    }
    differs = differs || result == PicCode::Different;
    parts_.ShowStatus(verb + HexText(block.Record().Address));
    if (parts_.ShowProgress) {
      parts_.ShowProgress(done, lineCount);
    }
  }
  return differs ? PicCode::NotAsFile : PicCode::Done;
}

std::int32_t PicComms::VerifyRangeDevice(PicRecord record, std::span<const std::uint8_t> expected) {
  record.Command = PicCommand::ReadFlash;
  record.BlockSize = static_cast<std::uint16_t>(Device.ReadBlock);
  std::array<std::uint8_t, ImageBlock::MostBytes + 1> buffer{};
  const std::int32_t count = parts_.Library.ReadPIC(PortHandle, record, buffer);
  if (count < 0) {
    return count;
  }
  const std::size_t length = std::min<std::size_t>({record.DataLength, expected.size(), buffer.size() - 1});
  if (static_cast<std::size_t>(count) < length) {
    return PicCode::Short;
  }
  bool differs = false;
  std::uint32_t address = record.Address;
  for (std::size_t i = 0; i + BytesOfInstruction <= length; i += BytesOfInstruction) {
    const std::uint32_t wanted = LittleEndian(expected.subspan(i));
    const std::uint32_t read = LittleEndian(std::span<const std::uint8_t>(buffer).subspan(i));
    if (wanted != read && !MayDiffer(address)) {
      LogDifference(address, wanted, read);
      differs = true;
    }
    address += AddressesOfInstruction;
  }
  return differs ? PicCode::Different : count;
}

/// The boot loader rewrites these words itself.
bool PicComms::MayDiffer(std::uint32_t address) const {
  return address == 0 || address == 2 || address == Device.UserResetVector || address == Device.BootDelay;
}

void PicComms::LogDifference(std::uint32_t address, std::uint32_t expected, std::uint32_t read) {
  parts_.Disk.Append(parts_.Folder.ForWriting(Settings.ErrorLog), "Verify Error at 0x" + HexText(address) +
                                                                      " should be: 0x" + HexText(expected) +
                                                                      " but read: 0x" + HexText(read) + "\n");
}

std::int32_t PicComms::EraseRangeDevice(std::int32_t low, std::int32_t high) {
  RunFlag = 1;
  const std::int64_t end = std::int64_t{high} + 1;
  for (std::int64_t address = low; address < end;) {
    parts_.Events.DoEvents();
    if (RunFlag == 0) {
      return PicCode::Aborted;
    }
    if (Device.EraseBlock == 0 || Device.BytesPerAddr == 0) {
      throw RuntimeError(Fault::DivisionByZero);
    }
    const std::int32_t blocks =
        RoundToInt32(static_cast<long double>(end - low) * Device.BytesPerAddr / Device.EraseBlock);
    if (blocks < 0 || blocks > std::numeric_limits<std::uint8_t>::max()) {
      throw RuntimeError(Fault::Overflow);
    }
    const std::int32_t result =
        parts_.Library.ErasePIC(PortHandle, static_cast<std::uint32_t>(address), blocks, 5);
    if (result < 0) {
      return result;
    }
    const std::int32_t step =
        RoundToInt32(static_cast<long double>(Device.EraseBlock) / Device.BytesPerAddr * blocks);
    if (step == 0) {
      throw RuntimeError(Fault::InvalidProcedureCall);  // it would erase the same block for ever
    }
    address += step;
    parts_.ShowStatus("Erasing: " + HexText(static_cast<std::uint32_t>(address)));
  }
  return PicCode::Done;
}
