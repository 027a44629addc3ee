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

/// What a simulated device specifies about its line.
struct DeviceLine {
  std::string LogName;                   ///< names the device in the log
  std::vector<LineSettings> Understood;  ///< see PseudoTerminal
  Pace LinePace = Pace::AsWired;
  std::ostream* Log = nullptr;  ///< receives the traffic in both directions; must outlive the device
};

/// A simulated device: a line, its log, its own thread and the faults of the host. A new device
///
/// * derives from this and passes on its DeviceLine,
/// * conducts its conversation with the host in one routine, using the read and write operations of Line(),
///   which end for good once the device is being destroyed or its line has been pulled out,
/// * has a Serving, which runs that routine, as its last member,
/// * writes the traffic to Log(),
/// * keeps what others may ask for (requests, counts) in a TrafficRecord, and calls NoteHostFault for
///   anything that a host must not send. Line settings that it does not understand are noted for it.
///
/// An entry of its own makes it part of the venue; see sim/venue/DeviceEntry.h.
class Device {
 public:
  virtual ~Device() = default;
  Device(const Device&) = delete;
  Device& operator=(const Device&) = delete;

  /// The path that the host opens.
  const std::string& DevicePath() const { return line_.SlavePath(); }

  /// What the host did wrong, in order of occurrence, worded to follow the device's title: "the host speaks
  /// 9600,8N1 instead of 19200,8N1". A run of bytes at the same wrong settings is one fault.
  std::vector<std::string> HostFaults() const { return faults_.Copy(); }

  /// Waits until `count` host faults have been noted; false if `limit` passes first.
  bool WaitUntilHostFaults(std::size_t count, std::chrono::milliseconds limit) const;

 protected:
  /// Throws std::system_error when the system grants no pseudo terminal.
  explicit Device(DeviceLine line);

  /// The thread of a device. As the last member of its class it starts after all others are constructed and
  /// ends before any of them is destroyed.
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
