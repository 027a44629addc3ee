#include "sim/pic24f/Pic24fTrouble.h"

#include <stdexcept>
#include <string>
#include <utility>

#include "sim/pic24f/Pic24fPacket.h"
#include "sim/pic24f/Pic24fRequest.h"

namespace sim {
namespace {

using Bytes = std::vector<std::uint8_t>;

const Bytes Noise{0xFE, 0xF0, 0x7F};
const Bytes NoiseWithStart{0xFE, 0x55, 0x55, 0x12};

Bytes operator+(Bytes left, const Bytes& right) {
  left.insert(left.end(), right.begin(), right.end());
  return left;
}

Bytes FirstHalf(Bytes bytes) {
  bytes.resize(bytes.size() / 2);
  return bytes;
}

Bytes WithOtherCommand(Bytes data) {
  data[0] = static_cast<std::uint8_t>(data[0] + 8);
  return data;
}

// Header and half of the bytes.
Bytes ShortRead(Bytes data) {
  constexpr std::size_t headerBytes = 5;
  if (data.size() > headerBytes) {
    data.resize(headerBytes + (data.size() - headerBytes) / 2);
  }
  return data;
}

std::string PlaceName(FailurePlace place) {
  switch (place) {
    case FailurePlace::Frame:
      return "request";
    case FailurePlace::Row:
      return "row";
    default:
      return "answer";
  }
}

}  // namespace

Pic24fTrouble::Pic24fTrouble(Pic24fFailure failure, std::size_t place) : failure_(failure), place_(place) {
  const FailurePlace kind = Pic24fFailures.at(static_cast<std::size_t>(failure)).Place;
  if (kind != FailurePlace::None && place == 0) {
    throw std::invalid_argument("There is no " + PlaceName(kind) + " 0");
  }
}

bool Pic24fTrouble::LosesRequest() {
  ++request_;
  return Strikes(Pic24fFailure::LostRequest, request_);
}

Pic24fTrouble::RowFate Pic24fTrouble::NextRow() {
  ++row_;
  if (Strikes(Pic24fFailure::LostRow, row_)) {
    return RowFate::Lost;
  }
  if (Strikes(Pic24fFailure::BadCells, row_)) {
    return RowFate::BadCells;
  }
  return Strikes(Pic24fFailure::UnpluggedInWrite, row_) ? RowFate::LineEnds : RowFate::Programmed;
}

Pic24fReply Pic24fTrouble::Answer(Bytes data) {
  ++answer_;
  if (failure_ == Pic24fFailure::Silence && answer_ >= place_) {
    return {};
  }
  const Bytes packet = EncodePic24fPacket(data, failure_ == Pic24fFailure::EscapedAnswers);
  if (failure_ == Pic24fFailure::TornAnswers) {
    return {.Bytes = packet, .Torn = true};
  }
  if (answer_ != place_) {
    return {.Bytes = packet};
  }
  switch (failure_) {
    case Pic24fFailure::LostAnswer:
      return {};
    case Pic24fFailure::WrongChecksum:
      return {.Bytes = EncodeWrongPic24fPacket(data)};
    case Pic24fFailure::OtherCommand:
      return {.Bytes = EncodePic24fPacket(WithOtherCommand(std::move(data)))};
    case Pic24fFailure::ShortRead:
      return {.Bytes = EncodePic24fPacket(ShortRead(std::move(data)))};
    case Pic24fFailure::CutAnswer:
      return {.Bytes = FirstHalf(packet)};
    case Pic24fFailure::LateAnswer:
      return {.Bytes = packet, .Late = true};
    case Pic24fFailure::DoubleAnswer:
      return {.Bytes = packet + packet};
    case Pic24fFailure::Noise:
      return {.Bytes = Noise + packet};
    case Pic24fFailure::FalseStart:
      return {.Bytes = NoiseWithStart + packet};
    case Pic24fFailure::UnpluggedInAnswer:
      return {.Bytes = FirstHalf(packet), .LineEndsBehind = true};
    default:
      return {.Bytes = packet};
  }
}

}  // namespace sim
