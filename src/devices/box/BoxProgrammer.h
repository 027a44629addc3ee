#pragma once

#include <functional>

#include "core/line/CommPort.h"
#include "core/line/SerialJob.h"
#include "devices/box/ProgrammedBoxes.h"
#include "platform/EventPump.h"
#include "platform/MessageBoxes.h"
#include "platform/SerialPort.h"

/// Programs utility boxes over the serial port of the settings, one at a time.
class BoxProgrammer {
 public:
  static constexpr const char* LineSettings = "19200,N,8,1";

  /// All of it must outlive the object.
  struct Parts {
    SerialPort& MSComm1;
    const CommPort& Port;
    EventPump& Events;
    MessageBoxes& Boxes;
    /// Polled during the wait: true if it must end without a box. May change only through events.
    std::function<bool()> Stopped;
    /// Told how a press ended, before its box opens. Not called for a press whose frame goes out during the
    /// wait of an earlier one, which tells for both, with the entries of the later one.
    std::function<void(const BoxEntries&, BoxResult)> OnResult;
  };

  explicit BoxProgrammer(Parts parts) : parts_(std::move(parts)) {}

  /// Sends the entries to a box, waits up to 2 s for its answer and shows a box with the result. Called again
  /// meanwhile, it only sends, on the open port, and the first answer counts. Throws RuntimeError 8012 or
  /// 8018 if the line fails during the wait.
  void Program(const BoxEntries& entries);

 private:
  /// Runs the steps of a press. Any fault in them closes the port and is told; then returns false.
  bool Succeeds(SerialJob& job, const std::function<void()>& steps);
  void Send(SerialJob& job, const BoxEntries& entries);
  void TellAnswer(std::uint8_t answer);
  void Tell(BoxResult result) const { parts_.OnResult(sent_, result); }

  const Parts parts_;
  SerialJob* waiting_ = nullptr;  ///< the job of the press that is on the stack
  bool failed_ = false;           ///< a later press failed and ended that job
  BoxEntries sent_;               ///< in the last frame
};
