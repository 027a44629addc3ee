#pragma once

#include <chrono>
#include <optional>
#include <span>

#include "devices/buttons/RomSearch.h"
#include "platform/EventPump.h"
#include "platform/SerialPort.h"

/// What a reset of the bus found. A short circuit looks like no device but for its own code.
enum class Presence { None, Devices, Shorted };

/// The DS2480B, a chip that turns the bytes of a serial line into pulses of a 1-Wire bus, on an open line of
/// 9600 baud, 8 data bits, no parity. Bus speed is "regular", for which the chip's power-on timing holds; the
/// strong pull-up stays off. Waits serve events. All operations throw what the line throws (8012, 8018).
class Ds2480b {
 public:
  /// How long an answer may take beyond its time on the line. A reset takes 3 ms by itself, and adapters on
  /// USB hold bytes back for up to 16 ms.
  static constexpr std::chrono::milliseconds AnswerLimit{30};

  /// The same where nothing but the answer can be right, so that a busy machine is not taken for a missing
  /// chip.
  static constexpr std::chrono::milliseconds LastLimit{200};

  /// Both must outlive this object.
  Ds2480b(SerialPort& port, EventPump& events) : port_(port), events_(events) {}

  /// Finds the chip, in whatever state it is, and resets the bus. False when no such chip answers. True with
  /// an empty bus when the program closes meanwhile, since that is no fault to tell of.
  bool Detect();

  /// False once an answer did not come or was wrong: the chip counts as gone for this session.
  bool Answers() const { return !lost_; }

  /// Resets the bus, unless nothing was sent to it since the last reset. None also when the chip does not
  /// answer.
  Presence Reset();

  /// Runs one pass of the search on a bus that was reset. Nothing when the chip does not answer.
  std::optional<SearchBlock> Search(const SearchBlock& path);

  /// Sends bytes over the bus and replaces them by what the bus answered. False, and `bytes` as they were,
  /// when the chip does not answer.
  bool Exchange(std::span<std::uint8_t> bytes);

  /// Leaves the chip so that a later session finds it at once.
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
  bool ended_ = false;  ///< the program closes
};
