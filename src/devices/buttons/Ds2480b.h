#pragma once

#include <chrono>
#include <optional>
#include <span>

#include "devices/buttons/RomSearch.h"
#include "platform/EventPump.h"
#include "platform/SerialPort.h"

/// What a reset found on the bus.
enum class Presence { None, Devices, Shorted };

/// Driver for the DS2480B, a chip that translates between a serial line and a 1-Wire bus, on an open line at
/// 9600 baud, 8 data bits, no parity. The bus runs at regular speed, which needs no change to the chip's
/// power-on timing; the strong pull-up stays off. Waits process events. All operations throw what the line
/// throws (8012, 8018).
class Ds2480b {
 public:
  /// How long an answer may take beyond its transmission time. A reset by itself takes 3 ms, and USB adapters
  /// hold bytes back for up to 16 ms.
  static constexpr std::chrono::milliseconds AnswerLimit{30};

  /// The same for the last attempt and for answers that must come, so that a busy machine is not mistaken for
  /// a missing chip.
  static constexpr std::chrono::milliseconds LastLimit{200};

  /// Both must outlive this object.
  Ds2480b(SerialPort& port, EventPump& events) : port_(port), events_(events) {}

  /// Finds the chip, whatever state it is in, and resets the bus. False if no such chip answers. If the
  /// program closes meanwhile, returns true with an empty bus, since that is not an error to report.
  bool Detect();

  /// False once an answer was missing or wrong: the chip counts as gone for the rest of the session.
  bool Answers() const { return !lost_; }

  /// Resets the bus, unless nothing was sent to it since the last reset. Presence::None also if the chip does
  /// not answer.
  Presence Reset();

  /// Runs one pass of the search on a bus that has been reset. Returns nullopt if the chip does not answer.
  std::optional<SearchBlock> Search(const SearchBlock& path);

  /// Sends bytes over the bus and replaces them with the bus's answer. If the chip does not answer, returns
  /// false and leaves `bytes` unchanged.
  bool Exchange(std::span<std::uint8_t> bytes);

  /// Leaves the chip in a state in which a later session finds it at once.
  void Rest();

 private:
  void SendCommand(std::uint8_t command);
  void SendData(std::uint8_t byte);
  bool Await(std::size_t answers, std::size_t bytesOnLine, std::chrono::milliseconds limit = LastLimit);
  bool TakeResetAnswer();

  SerialPort& port_;
  EventPump& events_;
  Presence presence_ = Presence::None;
  bool busIsReset_ = false;
  bool inDataMode_ = false;
  bool lost_ = false;
  bool ended_ = false;  ///< the program is closing
};
