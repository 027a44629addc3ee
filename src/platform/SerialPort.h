#pragma once

#include <cstddef>
#include <cstdint>
#include <string>

/// One serial line. Bytes arrive while events are processed (EventPump), into an unbounded input buffer.
class SerialPort {
 public:
  virtual ~SerialPort() = default;

  /// Opens `device` (a path such as "/dev/ttyUSB0") with `settings` "baud,parity,data bits,stop bits", for
  /// instance "19200,N,8,1", without flow control, and clears the input. Throws RuntimeError 8005 if this
  /// object is already open, another program is using or has locked the device, or this user may not open it;
  /// 380 for unsupported settings; 8002 if the device is missing or not a serial port. A closed port stays
  /// closed on failure.
  virtual void Open(const std::string& device, const std::string& settings) = 0;

  /// Waits until all output has been sent, then closes. Does nothing when closed.
  virtual void Close() = 0;

  virtual bool PortOpen() const = 0;

  /// Changes the settings of the open line, once pending output has been sent with the old ones. Throws
  /// RuntimeError 380 for unsupported settings, which keeps the old ones; 8018 when closed, 8012 when the
  /// line was lost.
  virtual void SetSettings(const std::string& settings) = 0;

  /// Bytes that Input() can return at once. Throws RuntimeError 8018 when closed, 8012 when the line was lost
  /// (unplugged) and nothing is left to read.
  virtual std::size_t InBufferCount() = 0;

  /// Takes one byte. Throws as InBufferCount() does, and RuntimeError 62 when there is none.
  virtual std::uint8_t Input() = 0;

  /// Sends one byte at once. Throws RuntimeError 8018 when closed, 8012 when the line was lost.
  virtual void Output(std::uint8_t byte) = 0;

  /// Blocks until the last byte has been transmitted: at least as long as all bytes since the line was last
  /// idle take at its rate, whatever an adapter reports. Throws as Output() does.
  virtual void Drain() = 0;

  /// Drops all input received so far. Throws RuntimeError 8018 when closed.
  virtual void ClearInput() = 0;

  /// Names the instrument at the far end ("base-unit") from the next Open on. For logs; a plain port ignores
  /// it.
  virtual void SetInstrument(const std::string& /*name*/) {}
};
