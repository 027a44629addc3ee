#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>

#include "platform/EventPump.h"
#include "platform/RuntimeError.h"
#include "platform/SerialPort.h"

/// How a wait of a job ended.
enum class LineWait {
  Met,       ///< what was waited for happened
  TimedOut,  ///< the limit passed first
  Stopped,   ///< the job must end silently: stopped from outside, or the program is closing
  Fault      ///< the line failed
};

/// What went wrong with a line, and in which direction.
struct LineFault {
  bool Sending;
  RuntimeError Error;
};

/// One conversation over a serial line that is opened here or already open, and closed in the destructor.
///
/// A job is over once it was stopped or its line failed: it then sends and takes nothing more, and every wait
/// and pause ends at once. So a routine can run to its end without checking each step, and the line gives one
/// fault, not one per byte. Other jobs may run during its waits, even on the same port; a job whose port was
/// closed or taken over meanwhile gets a fault.
class SerialJob {
 public:
  using Milliseconds = std::chrono::milliseconds;

  /// `instrument` names the far end for the line's log. `stopped`, also called during waits, says whether the
  /// job must end; it must depend on something that an event changes. The port may be open already.
  SerialJob(SerialPort& port, EventPump& events, std::string instrument, std::function<bool()> stopped);
  ~SerialJob();
  SerialJob(const SerialJob&) = delete;
  SerialJob& operator=(const SerialJob&) = delete;

  /// Opens the line, closing it first if it is open, and begins a new conversation: an old fault and any
  /// bytes waiting on the line are discarded. Throws as SerialPort::Open does; that is not a fault of the
  /// job.
  void Open(const std::string& device, const std::string& settings);

  /// Drains the line and closes it. Does nothing when it is closed.
  void Close();

  /// Leaves the line open for another job when this one ends, unless the line failed.
  void LeaveOpen() { leaveOpen_ = true; }

  /// Changes the settings of the open line. False when the job is over.
  bool SetSettings(const std::string& settings);

  /// Puts a byte on the line. False when the job is over.
  bool Send(std::uint8_t byte);

  /// Drops what was received so far.
  void ClearInput();

  /// Pauses. A pause of 10 ms or more begins when all bytes have been transmitted, a shorter one at once,
  /// when the last byte was handed over. Up to 50 ms it blocks; a longer one processes events and ends with
  /// the job.
  void Pause(Milliseconds time);

  /// Takes a received byte, if there is one.
  std::optional<std::uint8_t> Take();

  /// Waits until `condition` is true. It is tested first and again after each batch of events, but not once
  /// the job is over. It may take bytes; an exception from it ends the wait.
  LineWait WaitUntil(const std::function<bool()>& condition, Milliseconds limit);

  struct ReceivedByte {
    LineWait Wait;
    std::uint8_t Byte;  ///< when `Wait` is Met
  };
  ReceivedByte WaitForByte(Milliseconds limit);

  /// True when the job is over.
  bool Over() const { return fault_ || Stopped(); }

  /// True when the job must end silently.
  bool Stopped() const { return programCloses_ || stopped_(); }

  const std::optional<LineFault>& Fault() const { return fault_; }

  /// The fault, only for the first caller, who must report it to the operator. Nothing once the job was
  /// stopped.
  std::optional<LineFault> FaultToTell();

 private:
  /// Runs an operation on the line unless the job is over; what the line throws becomes the job's fault.
  template <typename Operation>
  bool Run(bool sending, const Operation& operation);

  SerialPort& port_;
  EventPump& events_;
  const std::string instrument_;
  const std::function<bool()> stopped_;
  std::optional<LineFault> fault_;
  bool faultTold_ = false;
  bool programCloses_ = false;
  bool leaveOpen_ = false;
};
