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

/// The way to the guns for one job: a radio modem on the serial line of the settings. Leaves the line closed.
///
/// A job that is stopped (its window closed, a later job started, the program closing) or whose line is lost
/// sends nothing more, and every wait ends as if nobody had answered.
class RadioLink {
 public:
  static constexpr const char* LineSettings = "57600,N,8,1";

  /// `stopped` tells in the middle of waits that the job is to end; it must depend on what events change.
  RadioLink(SerialPort& port, CommPort& commPort, EventPump& events, std::function<bool()> stopped);

  /// Opens the line and forgets what came before. A line that does not open is not reported here: the first
  /// byte sent finds out.
  void OpenXBeePort();

  void XBee_CloseCommPort() { job_.Close(); }

  /// Sends a packet to the gun `playerId` behind the modem at `address`.
  void SendGunPacket(std::uint8_t playerId, const XBeeAddress& address, std::uint8_t byte2,
                     std::uint8_t byte3, std::uint8_t packetType, std::span<const std::uint8_t> payload = {});

  /// Sends a command to the modem itself.
  void SendAtCommand(std::uint8_t frameId, const AtLetters& letters, std::span<const std::uint8_t> value);

  /// Waits 2 s, or 12 ms, for a good frame of whatever kind. Throws RuntimeError 9 for a frame that is longer
  /// than its buffer.
  bool WaitForFrame(bool longWait);

  /// True when a good frame is among the bytes that have come in; it is then taken. Throws as WaitForFrame.
  bool TakeFrame();

  /// API identifier of the last frame; 0 when none was taken since the last packet was sent.
  std::uint8_t ReceivedFrameType() const { return receivedFrameType_; }

  const ReceivedFrame& Frame() const { return parser_.Frame(); }

  /// True when the job is to end.
  bool Stopped() const { return job_.Over(); }

  /// Throws what went wrong with the line, unless the job was stopped anyway.
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
