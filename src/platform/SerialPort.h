#pragma once

#include <cstddef>
#include <cstdint>
#include <string>

/// One serial line. Bytes arrive while events are served (EventPump), into an unbounded input buffer.
class SerialPort {
 public:
  virtual ~SerialPort() = default;

  /// Opens `device` (a path such as "/dev/ttyUSB0") with `settings` "baud,parity,data bits,stop bits", for
  /// instance "19200,N,8,1", without flow control, and empties the input. Throws RuntimeError 8005 when this
  /// object is already open, another program holds or has locked the device, or this user may not open it;
  /// 380 for settings that cannot be had; 8002 when the device is missing or none. A failed open leaves it
  /// closed.
  virtual void Open(const std::string& device, const std::string& settings) = 0;

  /// Drains what is still under way, then closes. Does nothing when closed.
  virtual void Close() = 0;

  virtual bool PortOpen() const = 0;

  /// Changes the settings of the open line, once what is under way has gone out with the old ones. Throws
  /// RuntimeError 380 for settings that cannot be had, which leaves the old ones; 8018 when closed, 8012 when
  /// the line was lost.
  virtual void SetSettings(const std::string& settings) = 0;

  /// Bytes that Input() can return at once. Throws RuntimeError 8018 when closed, 8012 when the line was lost
  /// (unplugged) and nothing is left to read.
  virtual std::size_t InBufferCount() = 0;

  /// Takes one byte. Throws as InBufferCount() does, and RuntimeError 62 when there is none.
  virtual std::uint8_t Input() = 0;

  /// Puts one byte on the line at once. Throws RuntimeError 8018 when closed, 8012 when the line was lost.
  virtual void Output(std::uint8_t byte) = 0;

  /// Returns once the last byte put out is through: not before all bytes since the line was last idle have
  /// had their time at its rate, whatever an adapter says. Blocks meanwhile. Throws as Output() does.
  virtual void Drain() = 0;

  /// Drops all input received so far. Throws RuntimeError 8018 when closed.
  virtual void ClearInput() = 0;

  /// Tells what stands at the far end from the next open on ("base-unit"). For logs; a plain line does not
  /// care.
  virtual void SetInstrument(const std::string& /*name*/) {}
};
