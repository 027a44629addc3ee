#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <ostream>
#include <span>
#include <string>
#include <thread>
#include <vector>

#include "sim/line/LineSettings.h"
#include "sim/line/PseudoTerminal.h"
#include "sim/line/TrafficRecord.h"
#include "sim/line/WireLog.h"

namespace sim {

/// What every simulated device needs of its line.
struct DeviceLine {
  std::string LogName;                   ///< the device in the rows of the log
  std::vector<LineSettings> Understood;  ///< see PseudoTerminal
  Pace LinePace = Pace::AsWired;
  std::ostream* Log = nullptr;  ///< gets both directions of the line; must outlive the device
};

/// A simulated device: a line, its log, a thread of its own and the faults of the host. A new device
///
/// * derives from this and hands over its DeviceLine,
/// * holds its conversation with the host in one routine, by the reading and writing operations of Line(),
///   which end for good when the device is destroyed or its line has been pulled out,
/// * has a Serving as its last member, which runs that routine,
/// * writes what passes into Log(),
/// * notes what it wants to tell (requests, counts) in a TrafficRecord, and calls NoteHostFault for what a
///   host must not send. Settings of the line that it does not understand are noted without its doing.
///
/// It becomes part of the venue by an entry of its own, see sim/venue/DeviceEntry.h.
class Device {
 public:
  virtual ~Device() = default;
  Device(const Device&) = delete;
  Device& operator=(const Device&) = delete;

  /// What the host opens.
  const std::string& DevicePath() const { return line_.SlavePath(); }

  /// What the host must not have done, in the order of its coming, each as what follows the device's title:
  /// "the host speaks 9600,8N1 instead of 19200,8N1". A run of bytes at the same wrong settings is one fault.
  std::vector<std::string> HostFaults() const { return faults_.Copy(); }

  /// Waits until the host has made `count` faults; false when `limit` passes first.
  bool WaitUntilHostFaults(std::size_t count, std::chrono::milliseconds limit) const;

 protected:
  /// Throws std::system_error when the system grants no pseudo terminal.
  explicit Device(DeviceLine line);

  /// The thread of a device. As the last member of its class it starts when all others stand and ends before
  /// the first of them goes.
  class Serving {
   public:
    Serving(Device& device, std::function<void()> conversation);
    ~Serving();
    Serving(const Serving&) = delete;
    Serving& operator=(const Serving&) = delete;

   private:
    PseudoTerminal& line_;
    std::thread thread_;
  };

  PseudoTerminal& Line() { return line_; }
  WireLog& Log() { return log_; }
  void NoteHostFault(std::string fault);

 private:
  void NoteForeignBytes(const LineSettings& host, std::span<const std::uint8_t> bytes, bool begin);

  PseudoTerminal line_;
  WireLog log_;
  TrafficRecord<std::vector<std::string>> faults_;
};

}  // namespace sim
