#include "firmware/pic24f/SerialPicBoot.h"

#include <algorithm>
#include <utility>

#include "firmware/pic24f/PicFrame.h"
#include "platform/RuntimeError.h"

namespace {

using std::chrono::milliseconds;

constexpr std::size_t HeaderBytes = 5;
constexpr std::int32_t MostBlocks = 255;
constexpr std::size_t BytesOfInstruction = 4;
constexpr std::size_t BytesOfEepromWord = 2;

/// More than any device needs for a page, a row or a word.
constexpr milliseconds ErasePageTime{100};
constexpr milliseconds WriteRowTime{20};
constexpr milliseconds WriteWordTime{20};

/// Between the pieces of an answer that comes in slowly, once the time for it is over.
constexpr milliseconds PauseInAnswer{200};
constexpr milliseconds SlowestByte{20};

bool IsEeprom(std::uint8_t command) {
  return command == PicCommand::ReadEeprom || command == PicCommand::WriteEeprom;
}

/// Blocks that a packet counts; 0 if there is no packet for the record.
std::size_t CountOf(const PicRecord& record) {
  const std::size_t size = IsEeprom(record.Command) ? BytesOfEepromWord : record.BlockSize;
  const std::size_t count = size == 0 ? 0 : record.DataLength / size;
  return count > MostBlocks ? 0 : count;
}

/// Bytes of a packet on the line: each one of data may be escaped, and there are the marks and the checksum.
std::size_t LineBytes(std::size_t dataBytes) {
  return 2 * dataBytes + 5;
}

std::vector<std::uint8_t> Header(std::uint8_t command, std::size_t count, std::uint32_t address) {
  return {command, static_cast<std::uint8_t>(count), static_cast<std::uint8_t>(address),
          static_cast<std::uint8_t>(address >> 8U), static_cast<std::uint8_t>(address >> 16U)};
}

/// Bytes that the answer to a packet must have at least.
std::size_t DueBytes(std::span<const std::uint8_t> packet) {
  if (packet.size() < 2) {
    return 1;
  }
  if (packet[0] == PicCommand::Version) {
    return 2U + packet[1];
  }
  const bool isRead = packet[0] == PicCommand::ReadFlash && packet.size() == HeaderBytes;
  return isRead ? HeaderBytes + BytesOfInstruction * packet[1] : 1;
}

/// Bytes of its packet that an answer begins with.
std::size_t RepeatedBytes(std::span<const std::uint8_t> packet) {
  const bool isRead = packet[0] == PicCommand::ReadFlash || packet[0] == PicCommand::ReadEeprom ||
                      packet[0] == PicCommand::ReadConfig;
  return isRead ? std::min(HeaderBytes, packet.size()) : 1;
}

}  // namespace

SerialPicBoot::SerialPicBoot(Parts parts) : parts_(std::move(parts)) {}

std::int32_t SerialPicBoot::OpenPIC(const std::string& port, std::int32_t bitRate, std::int32_t timeOut) {
  job_.reset();
  try {
    const std::string device = parts_.DeviceOf(port);
    job_.emplace(parts_.Port, parts_.Events, "pic24f", [this] { return parts_.Stopped && parts_.Stopped(); });
    job_->Open(device, std::to_string(bitRate) + ",N,8,1");
  } catch (const RuntimeError&) {
    job_.reset();
    return NoPort;
  }
  bitRate_ = bitRate;
  timeOut_ = milliseconds(std::max(timeOut, 0));
  return ++handle_;
}

void SerialPicBoot::ClosePIC(std::int32_t handle) {
  if (IsOpen(handle)) {
    job_.reset();
  }
}

void SerialPicBoot::SendPacket(std::int32_t handle, std::span<const std::uint8_t> packet) {
  if (IsOpen(handle)) {
    Send(packet);
    if (job_->Fault()) {
      GiveUp(LineWait::Fault);
    }
  }
}

std::int32_t SerialPicBoot::GetPacket(std::int32_t handle, std::span<std::uint8_t> buffer) {
  if (!IsOpen(handle)) {
    return NoPort;
  }
  const LineWait wait =
      Await(buffer.size(), timeOut_ + LineTime(buffer.size()), [](const Bytes&) { return true; });
  if (wait != LineWait::Met) {
    return GiveUp(wait);
  }
  std::copy(answer_.begin(), answer_.end(), buffer.begin());
  return static_cast<std::int32_t>(answer_.size());
}

std::int32_t SerialPicBoot::SendGetPacket(std::int32_t handle, std::span<std::uint8_t> buffer,
                                          std::size_t length, std::size_t longest, std::int32_t retries) {
  if (!IsOpen(handle)) {
    return NoPort;
  }
  if (length == 0 || length > buffer.size()) {
    return InvalidRecord;
  }
  Request request{.Packet = Bytes(buffer.begin(), buffer.begin() + static_cast<std::ptrdiff_t>(length)),
                  .Longest = std::min(longest, buffer.size()),
                  .Retries = retries};
  request.Repeats = RepeatedBytes(request.Packet);
  request.Due = std::min(DueBytes(request.Packet), request.Longest);
  const std::int32_t result = Exchange(request);
  if (result > 0) {
    std::copy(answer_.begin(), answer_.end(), buffer.begin());
  }
  return result;
}

std::int32_t SerialPicBoot::ReadPIC(std::int32_t handle, const PicRecord& record,
                                    std::span<std::uint8_t> buffer) {
  if (!IsOpen(handle)) {
    return NoPort;
  }
  const std::size_t count = CountOf(record);
  if (count == 0 || record.DataLength > buffer.size()) {
    return InvalidRecord;
  }
  const std::size_t due = HeaderBytes + record.DataLength;
  const std::int32_t result = Exchange({.Packet = Header(record.Command, count, record.Address),
                                        .Longest = due,
                                        .Due = due,
                                        .Repeats = HeaderBytes,
                                        .Retries = record.MaxRetries});
  if (result < 0) {
    return result;
  }
  std::copy_n(answer_.begin() + HeaderBytes, record.DataLength, buffer.begin());
  return record.DataLength;
}

std::int32_t SerialPicBoot::WritePIC(std::int32_t handle, const PicRecord& record,
                                     std::span<const std::uint8_t> bytes) {
  if (!IsOpen(handle)) {
    return NoPort;
  }
  const std::size_t count = CountOf(record);
  if (count == 0 || record.DataLength > bytes.size()) {
    return InvalidRecord;
  }
  Request request{.Packet = Header(record.Command, count, record.Address),
                  .Longest = HeaderBytes,
                  .Retries = record.MaxRetries,
                  .Work = (IsEeprom(record.Command) ? WriteWordTime : WriteRowTime) * count};
  request.Packet.insert(request.Packet.end(), bytes.begin(), bytes.begin() + record.DataLength);
  return Exchange(request);
}

std::int32_t SerialPicBoot::VerifyPIC(std::int32_t handle, const PicRecord& record,
                                      std::span<const std::uint8_t> bytes) {
  Bytes held(bytes.size());
  const std::int32_t result = ReadPIC(handle, record, held);
  if (result < 0) {
    return result;
  }
  const auto length = static_cast<std::ptrdiff_t>(result);
  return std::equal(held.begin(), held.begin() + length, bytes.begin()) ? 1 : NotEqual;
}

std::int32_t SerialPicBoot::ErasePIC(std::int32_t handle, std::uint32_t address, std::int32_t blocks,
                                     std::int32_t retries) {
  if (!IsOpen(handle)) {
    return NoPort;
  }
  if (blocks < 1 || blocks > MostBlocks) {
    return InvalidRecord;
  }
  return Exchange({.Packet = Header(PicCommand::EraseFlash, static_cast<std::size_t>(blocks), address),
                   .Longest = HeaderBytes,
                   .Retries = retries,
                   .Work = ErasePageTime * blocks});
}

std::int32_t SerialPicBoot::Exchange(const Request& request) {
  const auto isAnswer = [&request](const Bytes& packet) {
    return packet.size() >= request.Repeats &&
           std::equal(packet.begin(), packet.begin() + static_cast<std::ptrdiff_t>(request.Repeats),
                      request.Packet.begin());
  };
  const milliseconds limit =
      timeOut_ + request.Work + LineTime(request.Packet.size()) + LineTime(request.Longest);
  std::int32_t result = NoAnswer;
  const std::int32_t tries = 1 + std::clamp(request.Retries, 0, MostRetries);
  for (std::int32_t i = 0; i < tries; ++i) {
    Send(request.Packet);
    const LineWait wait = Await(request.Longest, limit, isAnswer);
    if (wait == LineWait::Met && answer_.size() >= request.Due) {
      return static_cast<std::int32_t>(answer_.size());
    }
    if (wait != LineWait::Met && wait != LineWait::TimedOut) {
      return GiveUp(wait);
    }
    result = wait == LineWait::Met ? ShortAnswer : NoAnswer;
  }
  return result;
}

LineWait SerialPicBoot::Await(std::size_t longest, Milliseconds limit,
                              const std::function<bool(const Bytes&)>& isDue) {
  PicFrameDecoder decoder(longest);
  bool comesIn = false;
  const auto isThere = [&] {
    while (const auto byte = job_->Take()) {
      comesIn = true;
      if (decoder.Receive(*byte) && isDue(decoder.Data())) {
        return true;
      }
    }
    return false;
  };
  LineWait wait = job_->WaitUntil(isThere, limit);
  for (Milliseconds more = SlowestByte * LineBytes(longest);
       wait == LineWait::TimedOut && comesIn && decoder.IsWithin() && more > Milliseconds(0);
       more -= PauseInAnswer) {
    comesIn = false;
    wait = job_->WaitUntil(isThere, PauseInAnswer);
  }
  answer_ = decoder.Data();
  return wait;
}

void SerialPicBoot::Send(std::span<const std::uint8_t> packet) {
  job_->ClearInput();
  for (const std::uint8_t byte : PicFrame(packet)) {
    job_->Send(byte);
  }
}

milliseconds SerialPicBoot::LineTime(std::size_t dataBytes) const {
  constexpr std::size_t bitsOfByte = 10;
  return milliseconds(1 + 1000 * bitsOfByte * LineBytes(dataBytes) / static_cast<std::size_t>(bitRate_));
}

std::int32_t SerialPicBoot::GiveUp(LineWait wait) {
  if (wait != LineWait::Fault) {
    return wait == LineWait::Stopped ? Ended : NoAnswer;
  }
  const RuntimeError fault = job_->Fault()->Error;
  job_.reset();
  throw fault;
}
