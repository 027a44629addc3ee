#include "sim/radio/RadioTrouble.h"

#include <algorithm>
#include <span>
#include <stdexcept>
#include <string>
#include <utility>

#include "sim/line/Crc.h"
#include "sim/radio/RadioAnswer.h"

namespace sim {
namespace {

using Bytes = std::vector<std::uint8_t>;

constexpr std::uint8_t StartByte = 0x7E;
// Neither 0 nor a plausible count, so that a reader that mistakes it for data is caught.
constexpr std::uint8_t Filler = 0xEE;
const Bytes TransmitStatus{0x89, 0, 0};
const Bytes ModemStatus{0x8A, 6};
const Bytes Noise{0xFE, 0xF0, 0x7F};
const Bytes NoiseWithStart{0xFE, StartByte, 0x12};
constexpr std::size_t StartOfBlock = 8;

// A frame has at least 47 bytes with its CRC, so these always take it past 270.
void LengthenScores(RadioGun& gun) {
  constexpr std::size_t extraBytes = 255;
  gun.Frame.pop_back();
  gun.Frame.insert(gun.Frame.end(), extraBytes, Filler);
  gun.Frame.push_back(Crc8(gun.Frame));
}

Bytes OtherBlock(const RadioGun& gun, GunRequest request, Bytes packet) {
  const std::size_t total = gun.Frame.size() - 1;
  const std::size_t end = std::size_t{request.Start} + request.Count;
  if (request.Start >= request.Count) {
    request.Start = static_cast<std::uint8_t>(request.Start - request.Count);
    return AnswerPacket(gun, request);
  }
  if (end < total) {
    request.Start = static_cast<std::uint8_t>(end);
    request.Count = static_cast<std::uint8_t>(std::min<std::size_t>(request.Count, total - end));
    return AnswerPacket(gun, request);
  }
  packet[6] = static_cast<std::uint8_t>(end);
  return packet;
}

Bytes AtResponse() {
  constexpr std::size_t valueBytes = 30;
  Bytes body{0x88, 1, 'N', 'D', 0};
  body.insert(body.end(), valueBytes, Filler);
  return EncodeModemFrame(body);
}

// What another gun says of 22,695 bytes of scores, cut off behind their number. The missing bytes let a
// reader lose no more than the next answer.
Bytes BeginningOfAnother() {
  constexpr std::size_t missing = 2;
  Bytes frame = EncodeReceivedFrame(0, Bytes{4, 32, 0, 0, 5, 1, 0, 89, Filler});
  frame.resize(frame.size() - missing);
  return frame;
}

LinePiece FirstHalf(const Bytes& frame, bool lineEndsBehind) {
  return {.Bytes = Bytes(frame.begin(), frame.begin() + static_cast<std::ptrdiff_t>(frame.size() / 2)),
          .LineEndsBehind = lineEndsBehind};
}

Bytes SpoilPacket(RadioFailure failure, const RadioGun& gun, const GunRequest& request, Bytes packet) {
  constexpr std::size_t longData = 300;
  switch (failure) {
    case RadioFailure::OtherBlock:
      return OtherBlock(gun, request, std::move(packet));
    case RadioFailure::WrongCrc:
      packet[StartOfBlock] ^= 0xFFU;
      break;
    case RadioFailure::TotalZero:
      packet[6] = 0;
      packet[7] = 0;
      break;
    case RadioFailure::LowPlayerId:
      packet[1] %= 32;
      break;
    case RadioFailure::LongData:
      packet.resize(longData, Filler);
      break;
    case RadioFailure::LongPayload:
      packet[0] = 255;
      break;
    default:
      break;
  }
  return packet;
}

std::vector<LinePiece> SpoilFrame(RadioFailure failure, Bytes frame) {
  switch (failure) {
    case RadioFailure::SilentGun:
    case RadioFailure::LostSize:
    case RadioFailure::LostBlock:
    case RadioFailure::LostClose:
      return {};
    case RadioFailure::BadChecksum:
      frame.back() ^= 0xFFU;
      return {{frame}};
    case RadioFailure::DoubleAnswer:
      return {{frame}, {frame}};
    case RadioFailure::StatusFrames:
      return {{EncodeModemFrame(TransmitStatus)}, {frame}, {EncodeModemFrame(ModemStatus)}};
    case RadioFailure::TornFrames:
      return {{.Bytes = frame, .Torn = true}};
    case RadioFailure::CutFrames:
      return {FirstHalf(frame, false)};
    case RadioFailure::StartForChecksum:
      frame.back() = StartByte;
      return {{frame}};
    case RadioFailure::LostChecksum:
      return {{Bytes(frame.begin(), frame.end() - 1)}, {frame}};
    case RadioFailure::Noise:
      return {{Noise}, {frame}};
    case RadioFailure::FalseStart:
      return {{NoiseWithStart}, {frame}};
    case RadioFailure::HangUpInSearch:
    case RadioFailure::HangUpInBlock:
      return {FirstHalf(frame, true)};
    case RadioFailure::LongAtResponse:
      return {{AtResponse()}, {frame}};
    case RadioFailure::NextFrameBegins: {
      const Bytes another = BeginningOfAnother();
      frame.insert(frame.end(), another.begin(), another.end());
      return {{frame}};
    }
    default:
      return {{frame}};
  }
}

}  // namespace

RadioTrouble::RadioTrouble(const RadioTroubleSettings& settings, std::vector<RadioGun>& guns)
    : settings_(settings),
      concerned_(RadioFailures.at(static_cast<std::size_t>(settings.Failure)).Concerned) {
  if (settings.Failure == RadioFailure::None) {
    return;
  }
  if (settings.Gun > guns.size()) {
    throw std::invalid_argument("There is no gun " + std::to_string(settings.Gun) + " in a field of " +
                                std::to_string(guns.size()));
  }
  if (settings.Gun > 0) {
    stricken_ = guns[settings.Gun - 1].PlayerId;
  }
  if (settings.Failure == RadioFailure::TotalAbove270) {
    for (RadioGun& gun : guns) {
      if (!stricken_ || stricken_ == gun.PlayerId) {
        LengthenScores(gun);
      }
    }
  }
}

bool RadioTrouble::Strikes(const RadioGun& gun, const GunRequest& request) {
  if ((stricken_ && stricken_ != gun.PlayerId) || (concerned_ && concerned_ != request.Command) ||
      (settings_.Failure == RadioFailure::WrongCrc && request.Start != 0)) {
    return false;
  }
  int& strikes = strikes_[gun.PlayerId];
  if (settings_.Times > 0 && strikes == settings_.Times) {
    return false;
  }
  ++strikes;
  return true;
}

std::vector<LinePiece> RadioTrouble::Answer(const RadioGun& gun, const GunRequest& request) {
  Bytes packet = AnswerPacket(gun, request);
  if (settings_.Failure == RadioFailure::None || !Strikes(gun, request)) {
    latestPackets_[gun.PlayerId] = packet;
    return {{EncodeReceivedFrame(gun.Address, packet)}};
  }
  return Spoil(gun, request, std::move(packet));
}

std::vector<LinePiece> RadioTrouble::Spoil(const RadioGun& gun, const GunRequest& request, Bytes packet) {
  const Bytes stale = std::exchange(latestPackets_[gun.PlayerId], packet);
  if (settings_.Failure == RadioFailure::StaleAnswer && !stale.empty()) {
    packet = stale;
  }
  const Bytes frame =
      EncodeReceivedFrame(gun.Address, SpoilPacket(settings_.Failure, gun, request, std::move(packet)));
  if (settings_.Failure == RadioFailure::OtherSlot) {
    keptBack_.push_back({frame});
    return {};
  }
  return SpoilFrame(settings_.Failure, frame);
}

std::vector<LinePiece> RadioTrouble::KeptBack() {
  return std::exchange(keptBack_, {});
}

}  // namespace sim
