#include "sim/radio/TransmitRequest.h"

#include <numeric>
#include <span>

namespace sim {
namespace {

constexpr std::uint8_t StartByte = 0x7E;
constexpr std::uint8_t TransmitRequestApi = 0x00;
constexpr std::size_t LeadBytes = 3;  // start byte and length
// API identifier, frame identifier, address and options.
constexpr std::size_t HeadBytes = 1 + 1 + 8 + 1;
constexpr std::size_t AddressAt = 2;
constexpr std::size_t OptionsAt = 10;
constexpr std::size_t MostDataBytes = 100;

}  // namespace

std::optional<std::variant<TransmitRequest, HostFault>> TransmitRequestReader::Take(std::uint8_t byte) {
  if (state_ != State::InFrame) {
    const bool firstStray = byte != StartByte && state_ == State::Idle;
    bytes_.assign(1, byte);
    state_ = byte == StartByte ? State::InFrame : State::Astray;
    return firstStray ? std::optional(HostFault{"a byte outside a frame"}) : std::nullopt;
  }
  bytes_.push_back(byte);
  if (bytes_.size() < LeadBytes) {
    return std::nullopt;
  }
  const std::size_t length = bytes_[1] * 256U + bytes_[2];
  if (length < HeadBytes + 1 || length > HeadBytes + MostDataBytes) {
    state_ = State::Astray;
    return HostFault{"a length that no transmit request has"};
  }
  if (bytes_.size() < LeadBytes + length + 1) {
    return std::nullopt;
  }
  state_ = State::Idle;
  return ReadFrame();
}

std::variant<TransmitRequest, HostFault> TransmitRequestReader::ReadFrame() const {
  const auto checked = std::span(bytes_).subspan(LeadBytes);
  if (std::accumulate(checked.begin(), checked.end(), 0U) % 256U != 0xFFU) {
    return HostFault{"a wrong checksum"};
  }
  const auto body = checked.first(checked.size() - 1);
  if (body[0] != TransmitRequestApi) {
    return HostFault{"an API identifier other than 0"};
  }
  if (body[1] != 0) {
    return HostFault{"a frame identifier other than 0"};
  }
  if (body[OptionsAt] != 0) {
    return HostFault{"options other than 0"};
  }
  TransmitRequest request;
  for (const std::uint8_t byte : body.subspan(AddressAt, 8)) {
    request.Destination = request.Destination << 8U | byte;
  }
  const auto data = body.subspan(HeadBytes);
  request.Data.assign(data.begin(), data.end());
  return request;
}

}  // namespace sim
