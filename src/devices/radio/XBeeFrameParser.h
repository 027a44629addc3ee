#pragma once

#include <array>
#include <cstdint>

#include "devices/radio/XBeeFrames.h"

/// Contents of the modem's frames. A frame writes only its own fields, and only as far as it reaches, so
/// `Data` past `DataLength` is left over from an earlier one.
struct ReceivedFrame {
  XBeeAddress SourceAddress{};
  std::uint8_t Rssi = 0;     ///< signal strength, -dBm
  std::uint8_t Options = 0;  ///< receive options
  std::array<std::uint8_t, 101> Data{};
  std::uint8_t DataLength = 0;

  std::uint8_t AtFrameId = 0;
  AtLetters AtCommand{};
  std::uint8_t AtStatus = 0;
  std::array<std::uint8_t, 21> AtData{};
  std::uint8_t AtDataLength = 0;
};

/// Parses the modem's bytes one at a time. Received data (64-bit addresses) and AT responses are kept; other
/// known frames are only checked. Bytes that belong to no known frame, and frames with a wrong check byte,
/// are dropped silently.
class XBeeFrameParser {
 public:
  /// API identifier of the valid frame that `byte` completes, otherwise 0. Throws RuntimeError 9 for a byte
  /// that `Frame()` has no room for, and drops that frame.
  std::uint8_t Receive(std::uint8_t byte);

  /// The frame last reported by Receive(), until the next one begins.
  const ReceivedFrame& Frame() const { return frame_; }

 private:
  enum class State {
    Start,
    Length,
    Identifier,
    ModemStatus,
    AtResponse,
    TransmitStatus,
    Receive64,
    Receive16,
    Checksum
  };

  void BeginFrame();
  void TakeLength(std::uint8_t byte);
  void TakeIdentifier(std::uint8_t byte);
  void TakeAtResponse(std::uint8_t byte);
  void TakeReceive64(std::uint8_t byte);
  void CountBody(std::uint8_t byte);
  std::uint8_t TakeChecksum(std::uint8_t byte);
  template <std::size_t Size>
  void Append(std::array<std::uint8_t, Size>& data, std::uint8_t& length, std::uint8_t byte);

  State state_ = State::Start;
  std::uint8_t lengthBytes_ = 0;
  std::uint32_t frameLength_ = 0;
  std::uint32_t position_ = 0;  ///< bytes of the body so far
  std::uint32_t sum_ = 0;
  std::uint8_t frameType_ = 0;
  ReceivedFrame frame_;
};
