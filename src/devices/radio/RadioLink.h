#pragma once

#include <cstdint>
#include <functional>
#include <span>

#include "core/line/CommPort.h"
#include "core/line/SerialJob.h"
#include "devices/radio/GunPacket.h"
#include "devices/radio/XBeeFrameParser.h"
#include "platform/EventPump.h"
#include "platform/SerialPort.h"

/// The radio link to the guns for one job: a modem on the serial port of the settings. A port that the job
/// leaves open is closed in the destructor.
///
/// A job that is stopped (its window closed, a later job started, the program closing) or whose line is lost
/// sends nothing more, and every wait ends as if nobody had answered.
class RadioLink {
 public:
  static constexpr const char* LineSettings = "57600,N,8,1";

  /// `stopped` is polled during waits: true if the job must end. Its result may change only through events.
  RadioLink(SerialPort& port, CommPort& commPort, EventPump& events, std::function<bool()> stopped);

  /// Opens the line and starts afresh. A line that cannot be opened is not reported here: the first byte sent
  /// fails.
  void OpenXBeePort();

  /// Closes the line, if it is open.
  void XBee_CloseCommPort() { job_.Close(); }

  /// Sends a packet to the gun `playerId` behind the modem at `address`.
  void SendGunPacket(std::uint8_t playerId, const XBeeAddress& address, std::uint8_t byte2,
                     std::uint8_t byte3, std::uint8_t packetType, std::span<const std::uint8_t> payload = {});

  /// Sends a command to the modem itself.
  void SendAtCommand(std::uint8_t frameId, const AtLetters& letters, std::span<const std::uint8_t> value);

  /// Waits 2 s (`longWait`) or 12 ms for a valid frame of any kind. Throws RuntimeError 9 for a frame that is
  /// too long for its buffer.
  bool WaitForFrame(bool longWait);

  /// Takes a valid frame from the bytes that have come in; false if there is none. Throws as WaitForFrame.
  bool TakeFrame();

  /// API identifier of the frame just taken; 0 if the last attempt found none, or after sending.
  std::uint8_t ReceivedFrameType() const { return receivedFrameType_; }

  const ReceivedFrame& Frame() const { return parser_.Frame(); }

  /// True if the job must end: it was stopped or the line failed.
  bool Stopped() const { return job_.Over(); }

  /// Throws the line's fault, if there is one and the job was not stopped anyway.
  void ThrowIfLineLost() const;

  std::uint32_t BytesSent() const { return bytesSent_; }

 private:
  void Send(std::span<const std::uint8_t> frame);

  CommPort& commPort_;
  EventPump& events_;
  SerialJob job_;
  XBeeFrameParser parser_;
  std::uint8_t receivedFrameType_ = 0;
  std::uint32_t bytesSent_ = 0;
};
