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
  Met,       ///< with what was waited for
  TimedOut,  ///< the limit passed first
  Stopped,   ///< the job is to end without a word: stopped from outside, or the program closes
  Fault      ///< the line failed
};

/// What went wrong with a line, and in which direction.
struct LineFault {
  bool Sending;
  RuntimeError Error;
};

/// One conversation over a serial line: opened here or before, closed in the destructor.
///
/// Over once it was stopped or its line failed: it then sends nothing more, takes nothing more, and every
/// wait and pause ends at once. So a routine can go on to its end without looking at each step, and the line
/// gives one fault and not one for each byte. Other jobs may run in the middle of its waits, on the same port
/// too; a job whose port was closed or taken over meanwhile finds a fault.
class SerialJob {
 public:
  using Milliseconds = std::chrono::milliseconds;

  /// `instrument` names the far end for the log of the line. `stopped` tells in the middle of waits that the
  /// job is to end; it must depend on what events change. The port may be open already.
  SerialJob(SerialPort& port, EventPump& events, std::string instrument, std::function<bool()> stopped);
  ~SerialJob();
  SerialJob(const SerialJob&) = delete;
  SerialJob& operator=(const SerialJob&) = delete;

  /// Opens the line, which is closed first when it is open, and begins a new conversation: an old fault is
  /// forgotten, and so are bytes that waited on the line. Throws as SerialPort::Open does; that is no fault
  /// of the job.
  void Open(const std::string& device, const std::string& settings);

  /// Drains the line and closes it. Does nothing when it is closed.
  void Close();

  /// The end of the job leaves the line open for another one, unless the line failed.
  void LeaveOpen() { leaveOpen_ = true; }

  /// Changes the settings of the open line. False when the job is over.
  bool SetSettings(const std::string& settings);

  /// Puts a byte on the line. False when the job is over.
  bool Send(std::uint8_t byte);

  /// Drops what was received so far.
  void ClearInput();

  /// Pauses. One of 10 ms or more begins when all bytes sent are on the line, a shorter one at once, when the
  /// last byte was handed over. Up to 50 ms it blocks; a longer one serves events and ends with the job.
  void Pause(Milliseconds time);

  /// A byte that has come in.
  std::optional<std::uint8_t> Take();

  /// Waits until `condition` holds. It is tested first and again after each batch of events, but not once the
  /// job is over, and may take bytes; what it throws ends the wait.
  LineWait WaitUntil(const std::function<bool()>& condition, Milliseconds limit);

  struct ReceivedByte {
    LineWait Wait;
    std::uint8_t Byte;  ///< when `Wait` is Met
  };
  ReceivedByte WaitForByte(Milliseconds limit);

  /// True when the job is over.
  bool Over() const { return fault_ || Stopped(); }

  /// True when the job is to end without a word.
  bool Stopped() const { return programCloses_ || stopped_(); }

  const std::optional<LineFault>& Fault() const { return fault_; }

  /// The fault, to the first who asks: whoever gets it tells the operator. Nothing once the job was stopped.
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
