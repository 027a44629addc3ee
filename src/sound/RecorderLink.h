#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <initializer_list>
#include <span>
#include <string>

#include "core/line/SerialJob.h"
#include "platform/MessageBoxes.h"

/// Which hardware is at the far end of the line.
enum class Recorder {
  InProduct = 0,  ///< a gun's own firmware
  StandAlone = 1  ///< the separate recorder
};

/// Line settings of a recorder.
const char* LineSettings(Recorder recorder);

/// Where a job on the recorder's line shows what it does.
class RecorderDisplay {
 public:
  virtual ~RecorderDisplay() = default;

  virtual void SetStatus(const std::string& text) = 0;
  virtual void SetStatus2(const std::string& text) = 0;
  /// Selects a row of the list, counted from 0, and scrolls it into view.
  virtual void SelectRow(std::size_t row) = 0;
  /// The next page of a sound begins.
  virtual void PageBegins() = 0;
};

/// Strict stop-and-wait on one byte, 0xAA. Whoever sends clears the acknowledgement, so one that came early
/// or is left from before ends the next wait at once.
class RecorderLink {
 public:
  static constexpr std::chrono::milliseconds AckTimeLimit{6000};
  static constexpr std::chrono::milliseconds CommandPause{10};
  static constexpr std::chrono::milliseconds BlockPause{20};
  static constexpr std::size_t DataBytes = 256;
  using Data = std::span<const std::uint8_t, DataBytes>;

  /// What the link works with; all of it must outlive it.
  struct Parts {
    SerialPort& MSComm1;
    EventPump& Events;
    MessageBoxes& Boxes;
    /// Called at each use, since the operator may change it in the middle of a job.
    std::function<Recorder()> RecorderSelect;
    /// Says whether the operator closes the window.
    std::function<bool()> StopRequested;
  };

  explicit RecorderLink(const Parts& parts);

  /// Opens the line. If an earlier job left it open, what came too late for that one is dropped. Throws as
  /// SerialPort::Open does.
  void Open(const std::string& device);

  /// Gives the open line the speed of the selected recorder.
  void SetupComm();

  Recorder Mode() const { return parts_.RecorderSelect(); }
  SerialJob& Job() { return job_; }

  void ClearAck() { ackReceived_ = false; }

  /// Sends the bytes of a command, with a pause between them.
  void SendCommand(std::initializer_list<std::uint8_t> bytes);

  /// Sends the bytes before data, with a pause behind each.
  void SendPrefix(std::initializer_list<std::uint8_t> bytes);

  /// Waits for the acknowledgement; a box tells that it did not come. Any other byte is ignored.
  bool WaitForAck(std::chrono::milliseconds limit = AckTimeLimit);

  /// Sends data with their check byte, whose start value is `crc`, and waits for the acknowledgement. `paced`
  /// tells, at each byte, whether a pause of 1 ms follows it.
  bool SendData(Data data, std::uint8_t crc, const std::function<bool()>& paced);

  /// Processes events, and all bytes that came.
  void DoEvents();

  /// Throws the fault of a line that failed, once.
  void ThrowIfLineLost();

 private:
  void Take(std::uint8_t byte) { ackReceived_ = byte == Ack; }

  static constexpr std::uint8_t Ack = 0xAA;

  const Parts parts_;
  SerialJob job_;
  bool ackReceived_ = false;
};
