#include "firmware/pic24f/ImageBlock.h"

#include <algorithm>

#include "firmware/hex/ImageLines.h"
#include "firmware/pic24f/PicFrame.h"
#include "platform/RuntimeError.h"

namespace {

constexpr std::uint32_t FileAddressMask = 0xFFFFFF;

std::uint32_t DeviceAddress(std::string_view line, std::uint8_t bytesPerAddress) {
  if (bytesPerAddress == 0) {
    throw RuntimeError(Fault::DivisionByZero);
  }
  return (ImageLine::AddressOf(line) & FileAddressMask) / bytesPerAddress;
}

}  // namespace

bool ImageBlock::Add(std::string_view line) {
  const bool gathersLines = record_.Command == PicCommand::WriteFlash;
  if (complete_) {
    size_ = 0;
  }
  if (size_ == 0) {
    record_.DataLength = gathersLines ? record_.BlockSize : std::uint16_t{ImageLine::Bytes};
    record_.Address = DeviceAddress(line, record_.BytesPerAddress);
  }
  const ImageLine::Data data = ImageLine::DataOf(line);
  if (size_ + data.size() > bytes_.size()) {
    throw RuntimeError(Fault::SubscriptOutOfRange);
  }
  std::copy(data.begin(), data.end(), bytes_.begin() + static_cast<std::ptrdiff_t>(size_));
  size_ += data.size();
  const auto length = static_cast<std::int16_t>(record_.DataLength);
  if (length == 0) {
    throw RuntimeError(Fault::DivisionByZero);
  }
  complete_ = static_cast<std::int32_t>(size_) % length == 0;
  return complete_;
}
